#pragma once

#include "model/CellLine.h"
#include "model/ChoiceList.h"

#include <QString>
#include <array>

namespace zorbin {

// The value of a check box: 0 unchecked, 1 checked, 2 grey. Only 1 counts as ticked.
enum class CheckValue : int { Unchecked = 0, Checked = 1, Grayed = 2 };

inline bool isTicked(CheckValue value)
{
    return value == CheckValue::Checked;
}

// A group of option buttons of which at most one is set; setting one clears the others.
template <int N> class OptionGroup
{
public:
    bool value(int index) const { return m_values.at(static_cast<std::size_t>(index)); }
    void setValue(int index, bool set)
    {
        if (set)
            m_values.fill(false);
        m_values.at(static_cast<std::size_t>(index)) = set;
    }
    // The index of the set button (of several, the last); 0 when none is set.
    int selected() const
    {
        int chosen = 0;
        for (int i = 0; i < N; ++i) {
            if (m_values[static_cast<std::size_t>(i)])
                chosen = i;
        }
        return chosen;
    }
    static constexpr int size() { return N; }

private:
    std::array<bool, N> m_values{};
};

// Where the picture reference of an item comes from (`OptPicSource`).
enum PictureSource : int { PictureFromFileField = 0, PictureFromItemKey = 1, PictureFromExtraNote = 2 };

// Entry limits of the settings page's text boxes, in characters.
inline constexpr int MaxLengthSortBound = 15;  // txtToSort; txtFromSort has no limit
inline constexpr int MaxLengthItemBound = 15;  // txtToItem; txtFromItem has no limit
inline constexpr int MaxLengthGridSize = 3;    // txtRows, txtCols
inline constexpr int MaxLengthPercent = 2;     // txtTopPercent, txtBottomPercent
inline constexpr int MaxLengthPictureSize = 3; // txtImageH, txtImageW
inline constexpr int MaxLengthCutOff = 1;      // each ItemCutOff box
inline constexpr int CutOffPositions = 10;
inline constexpr int StoredCutOffPositions = 5;

// Every catalog parameter of the settings page, one member per widget, named after the widget.
// The record holds the values the widgets show; numbers stay the text the user typed, and
// each run converts them when it needs them. Members start at the page's initial values
// (before anything is loaded from the store).
//
// The record is owned by the control; the settings page binds its widgets to it, the
// persistence loads and saves it, and the runs read it at the moment they need a value.
struct CatalogSettings
{
    CatalogSettings();
    CatalogSettings(const CatalogSettings &) = delete;
    CatalogSettings &operator=(const CatalogSettings &) = delete;

    // Item range tab ("טווח הפריטים").
    CheckValue ChkCatCode = CheckValue::Unchecked; // restrict to a range of sort codes
    QString txtFromSort;
    QString txtToSort;
    CheckValue chkFilter = CheckValue::Unchecked;    // apply the cut-off pattern
    std::array<QString, CutOffPositions> ItemCutOff; // ItemCutOff[p - 1] is position p; "*" at first
    CheckValue ChkItemKey = CheckValue::Unchecked;   // restrict to a range of item keys
    QString txtFromItem;
    QString txtToItem;
    ChoiceList CmbSortBy;                                // 0 item key, 1 item name, 2 sort code
    ChoiceList CmbSortDir;                               // 0 ascending, 1 descending
    CheckValue ChkSelectAccount = CheckValue::Unchecked; // use the items marked by hand; not stored

    // Data tab ("הגדרות נתונים").
    ChoiceList CmbItemNameType; // 0 standard name, 1 foreign name
    CheckValue chkUsePriceField = CheckValue::Unchecked;
    CheckValue ChkUsePriceField2 = CheckValue::Unchecked;
    ChoiceList cmbPriceField; // filled from the accounting database; entry 0 the item's own price
    ChoiceList cmbPriceField2;
    CheckValue ChkUseExtraNote1 = CheckValue::Unchecked;
    CheckValue ChkUseExtraNote2 = CheckValue::Unchecked;
    ChoiceList cmbExtraNote1; // filled from the accounting database
    ChoiceList cmbExtraNote2;
    OptionGroup<3> OptPicSource; // see PictureSource
    ChoiceList cmbPicExtraNote;  // filled from the accounting database
    QString txtPicPath;          // folder of pictures named by item key
    QString txtPicExtension;

    // Page tab ("הגדרת עמוד בקטלוג").
    CellLines lines; // caption = txtLineCaption(i), tag = lblLine(i), format = the format table
    QString txtRows;
    QString txtCols;
    ChoiceList cmbPicLocation;                   // 0 according to the table, 1 to the right of the data
    ChoiceList cmbPageSplit;                     // 0 one file, 1 a file per page
    CheckValue chkRules = CheckValue::Unchecked; // a frame around every item
    QString txtImageH; // largest picture height in pixels; empty for no size attributes
    QString txtImageW;
    CheckValue ChkOnlyWithPic = CheckValue::Unchecked; // only items that have a picture; not stored

    // Titles tab ("כותרות לעמוד").
    QString txtTopTitle;
    QString txtTopTitle2;
    QString txtBottomTitle;
    QString txtLogo; // path of the logo picture; empty for none
    QString txtTopPercent;
    QString txtBottomPercent;

    // General tab ("כללי").
    QString txtPagingPath; // output folder; empty means the temporary folder

    // The lists filled from the accounting database, in the order the start-up fills them.
    std::array<ChoiceList *, 5> sourceLists();
};

} // namespace zorbin
