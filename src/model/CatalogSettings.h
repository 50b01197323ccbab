#pragma once

#include "model/CellLine.h"
#include "model/ChoiceList.h"

#include <QString>
#include <array>
#include <optional>

namespace zorbin {

// The catalog order (`CmbSortBy`).
enum class SortKey { ItemKey = 0, ItemName = 1, SortCode = 2 };
// The direction of the catalog order (`CmbSortDir`).
enum class SortDirection { Ascending = 0, Descending = 1 };
// Which name of an item the catalog shows (`CmbItemNameType`).
enum class ItemNameSource { Standard = 0, Foreign = 1 };
// Where the picture file name of an item comes from (`OptPicSource`).
enum class PictureSource { FileField = 0, ItemKey = 1, ExtraNote = 2 };
// Where the picture stands in an item's cell (`cmbPicLocation`).
enum class PictureLocation { AsLine = 0, BesideLines = 1 };
// Which files the pages go into (`cmbPageSplit`).
enum class PageSplit { OneFile = 0, FilePerPage = 1 };

inline constexpr int CutOffPositions = 10;
inline constexpr int StoredCutOffPositions = 5;

// Every catalog option, typed as the runs read it. The settings page shows and edits it, the
// settings store keeps it (catalogOptionTable(), in OptionTable.h, says under which key and in
// which text form), and the runs read it at the moment they need a value.
//
// A list choice is empty when the page's list has no entry selected; its comment says how the
// runs read that. A number is empty when its box is empty or holds no number.
//
// A new record holds the stored defaults, as a first start with an empty store shows them. It
// is owned by the control; the settings page binds its widgets to it.
struct CatalogSettings
{
    CatalogSettings();
    CatalogSettings(const CatalogSettings &) = delete;
    CatalogSettings &operator=(const CatalogSettings &) = delete;

    // The items: ranges, pattern and order ("טווח הפריטים").
    bool sortCodeRange = false; // only the items whose sort code lies from sortCodeFrom to sortCodeTo
    QString sortCodeFrom;       // as typed: a whole number, or empty for no bound
    QString sortCodeTo;
    bool cutOffFilter = false;                   // only the items whose filter field fits cutOff
    std::array<QString, CutOffPositions> cutOff; // one character a position; "*" or empty for any
    bool itemKeyRange = false; // only the items whose key lies from itemKeyFrom to itemKeyTo
    QString itemKeyFrom;       // as typed; empty for no bound
    QString itemKeyTo;
    std::optional<SortKey> sortKey;             // empty: by item key
    std::optional<SortDirection> sortDirection; // empty: the engine's own order, ascending
    bool useMarkedItems = false; // the items marked by hand in the last working database; not stored

    // The data of each item ("הגדרות נתונים").
    std::optional<ItemNameSource> itemName; // empty: the standard name
    bool collectPrice1 = false;
    bool collectPrice2 = false;
    ChoiceList priceList1; // the price lists of the accounting database; entry 0 the item's own price
    ChoiceList priceList2;
    bool collectNote1 = false;
    bool collectNote2 = false;
    ChoiceList extraNote1; // the extra-note kinds of the accounting database
    ChoiceList extraNote2;
    std::optional<PictureSource> pictureSource; // empty: the item's file field
    ChoiceList pictureNote;                     // the extra note that names the picture
    QString pictureFolder;                      // the folder of the pictures named by item key, as typed
    QString pictureExtension;                   // appended to the item key, as typed

    // The page ("הגדרת עמוד בקטלוג").
    CellLines lines;
    std::optional<int> rows; // cells per page, down and across; a run refuses empty or below 1
    std::optional<int> columns;
    std::optional<PictureLocation> pictureLocation; // empty: as a line
    std::optional<PageSplit> pageSplit;             // empty: one file
    bool frameItems = false;                        // a frame around every item
    std::optional<int> pictureHeight; // the largest picture in pixels; pictures get sizes only when
    std::optional<int> pictureWidth;  // both are above 0, an empty one counts as 0
    bool onlyWithPicture = false;     // only the items that have a picture; not stored

    // The titles ("כותרות לעמוד").
    QString topTitle; // as typed: it may hold markup on purpose
    QString topTitle2;
    QString bottomTitle;
    QString logo;                     // the logo picture's path; empty for none
    std::optional<int> topPercent;    // band heights in percent of the page; 0 or less, or
    std::optional<int> bottomPercent; // empty, leaves the band out
    bool webSections = true;          // the web catalog groups its items by sort group

    // General ("כללי").
    QString outputFolder; // empty: the temporary folder

    // The lists filled from the accounting database, in the order the start-up fills them.
    std::array<ChoiceList *, 5> sourceLists();
};

} // namespace zorbin
