#pragma once

#include "model/CatalogField.h"

#include <QString>
#include <array>
#include <cstdint>
#include <optional>

namespace zorbin {

inline constexpr int CellLineCount = 9;

// The text format of one cell line. Each byte is the list index the editor offers:
// font 0 Arial, 1 David, 2 Miriam; weight 0 regular, 1 bold, 2 heavy; align 0 right,
// 1 centre, 2 left; underline and italic 0 or 1; size in points. The store may hold any
// byte; a writer that meets an index it has no word for treats it as the list does not
// (no font, weight or alignment of its own).
struct CellFormat
{
    std::uint8_t font = 0;
    std::uint8_t size = 9;
    std::uint8_t weight = 0;
    std::uint8_t underline = 0;
    std::uint8_t italic = 0;
    std::uint8_t align = 0;
    friend bool operator==(const CellFormat &, const CellFormat &) = default;
};

// One of the nine line slots of a catalog cell, index 0 (the top line) to 8.
struct CellLine
{
    QString caption;          // fixed text printed before the value; empty for none
    std::optional<int> field; // the CatalogField the line shows (0 to 8); none for an empty line
    CellFormat format;        // the line's record in the format table

    bool isUsed() const { return field.has_value(); }
    // What the slot label shows: the field's caption, or the empty text.
    QString slotCaption() const;
    LabelColours slotColours() const;
};

using CellLines = std::array<CellLine, CellLineCount>;

// A stored line tag as a CatalogField number: a whole number from 0 to 8, or nothing.
std::optional<int> fieldOfTag(const QString &tag);

} // namespace zorbin
