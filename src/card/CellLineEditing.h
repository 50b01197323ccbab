#pragma once

#include "model/CellLine.h"

#include <QString>

namespace zorbin {

// What the format row of the cell-line editor holds at the moment the user applies it: list
// indexes (-1 for no entry selected), check values (0 unchecked, 1 checked, 2 grey) and the
// size as typed.
struct FormatControls
{
    int font = -1;     // CmbFontAll
    int italic = 0;    // ChkItalicAll
    QString size;      // txtFontSizeAll
    int underline = 0; // ChkULAll
    int weight = -1;   // CmbWeightAll
    int align = -1;    // CmbAlignAll
};

// Puts field `field` (0 to 8) on a line: its tag becomes the field number and its caption
// box the field's caption followed by ":". The line's format is kept.
void assignField(CellLine &line, int field);

// Takes the field off a line: no tag, an empty caption box. The line's format is kept.
void emptyLine(CellLine &line);

// Stores the format row into a line's format, field by field: a value that is not a byte
// (no entry selected, a size that is empty, not a number or outside 0 to 255) leaves its field
// as it was, and the other fields are still stored. A fractional size is rounded to the
// nearest whole number, a half to the even neighbour ("12.5" stores 12, "13.5" stores 14).
void applyFormat(CellFormat &format, const FormatControls &controls);

// The format row that shows a line's format.
FormatControls formatControlsOf(const CellFormat &format);

} // namespace zorbin
