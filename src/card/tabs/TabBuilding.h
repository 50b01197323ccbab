#pragma once

#include <QLabel>
#include <QString>
#include <utility>

class QGridLayout;
class QLineEdit;

// Small helpers that keep the tabs' construction readable: every widget that stands for an
// option carries the widget name the option has always had as its objectName.
namespace zorbin::tabs {

// Entry limits of the settings page's text boxes, in characters.
inline constexpr int MaxLengthSortBound = 15;  // txtToSort; txtFromSort has no limit
inline constexpr int MaxLengthItemBound = 15;  // txtToItem; txtFromItem has no limit
inline constexpr int MaxLengthGridSize = 3;    // txtRows, txtCols
inline constexpr int MaxLengthPercent = 2;     // txtTopPercent, txtBottomPercent
inline constexpr int MaxLengthPictureSize = 3; // txtImageH, txtImageW
inline constexpr int MaxLengthCutOff = 1;      // each ItemCutOff box

template <typename Widget, typename... Args> Widget *named(const QString &objectName, Args &&...args)
{
    auto *widget = new Widget(std::forward<Args>(args)...);
    widget->setObjectName(objectName);
    return widget;
}

// A caption for a field; the field becomes the caption's buddy, so the caption's text is the
// field's accessible name too.
QLabel *captionFor(const QString &text, QWidget *field, QWidget *parent);

// Puts a caption and its field side by side on a row of `grid`: the caption in `column`, the
// field in the next one. `shown`, when given, is the widget that holds the field (a box with
// its button) and takes the field's place in the grid.
void addFieldRow(QGridLayout *grid, int row, const QString &caption, QWidget *field, QWidget *shown = nullptr,
                 Qt::Alignment alignment = {}, int column = 0);

// A text box wide enough for `characters` characters like `sample` (the box's entry limit).
void fitToCharacters(QLineEdit *box, int characters, QChar sample = QLatin1Char('W'));

// A box for a path, a file extension or another Latin text: it reads left to right even on a
// right-to-left page, so that "/" and "." stay where they were typed.
void showLeftToRight(QLineEdit *box);

} // namespace zorbin::tabs
