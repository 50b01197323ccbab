#include "model/CatalogField.h"

namespace zorbin {

const std::array<CatalogField, CatalogFieldCount> &catalogFields()
{
    static const std::array<CatalogField, CatalogFieldCount> fields = {{
        {0, QStringLiteral("ItemPic"), QStringLiteral("תמונה")},
        {1, QStringLiteral("ItemKey"), QStringLiteral("מפתח פריט")},
        {2, QStringLiteral("ItemName"), QStringLiteral("שם פריט")},
        {3, QStringLiteral("SortName"), QStringLiteral("קטגוריה")},
        {4, QStringLiteral("Price1"), QStringLiteral("מחיר 1")},
        {5, QStringLiteral("Price2"), QStringLiteral("מחיר 2")},
        {6, QStringLiteral("Unit"), QStringLiteral("יחידת מידה")},
        {7, QStringLiteral("ExtraNote1"), QStringLiteral("נתון נוסף 1")},
        {8, QStringLiteral("ExtraNote2"), QStringLiteral("נתון נוסף 2")},
    }};
    return fields;
}

LabelColours paletteColours()
{
    return {Rgb{128, 128, 255}, Rgb{255, 255, 255}};
}

LabelColours emptySlotColours()
{
    return {Rgb{192, 192, 255}, std::nullopt};
}

} // namespace zorbin
