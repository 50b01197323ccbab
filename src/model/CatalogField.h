#pragma once

#include <QString>
#include <array>
#include <cstdint>
#include <optional>

namespace zorbin {

// An RGB colour of the settings page (the core has no GUI types).
struct Rgb
{
    std::uint8_t red = 0;
    std::uint8_t green = 0;
    std::uint8_t blue = 0;
    friend bool operator==(const Rgb &, const Rgb &) = default;
};

// The colours a label of the cell-line editor shows. No foreground means the system's
// window-text colour.
struct LabelColours
{
    Rgb back;
    std::optional<Rgb> fore;
    friend bool operator==(const LabelColours &, const LabelColours &) = default;
};

// One of the nine data fields a cell line can show (the palette `LblTitle` of the page tab).
struct CatalogField
{
    int number;      // 0 to 8, the line tag that selects it
    QString column;  // the column of the catalog query that carries it, e.g. "ItemPic"
    QString caption; // what the palette and an assigned slot show, e.g. "תמונה"
};

inline constexpr int CatalogFieldCount = 9;
inline constexpr int PictureField = 0;

const std::array<CatalogField, CatalogFieldCount> &catalogFields();

// Colours of every palette label, and of an assigned slot: white on RGB(128, 128, 255).
LabelColours paletteColours();
// Colours of an empty slot: window text on RGB(192, 192, 255).
LabelColours emptySlotColours();

} // namespace zorbin
