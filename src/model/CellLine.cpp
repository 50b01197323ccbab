#include "model/CellLine.h"

#include "common/Numbers.h"

namespace zorbin {

std::optional<int> fieldOfTag(const QString &tag)
{
    const auto number = toWholeNumber(tag, 0, CatalogFieldCount - 1);
    if (!number)
        return std::nullopt;
    return static_cast<int>(*number);
}

QString CellLine::slotCaption() const
{
    return field ? catalogFields()[static_cast<std::size_t>(*field)].caption : QString();
}

LabelColours CellLine::slotColours() const
{
    return field ? paletteColours() : emptySlotColours();
}

} // namespace zorbin
