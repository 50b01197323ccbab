#include "card/CellLineEditing.h"

#include "common/Numbers.h"
#include "model/CatalogField.h"

namespace zorbin {
namespace {

void storeByte(std::uint8_t &field, int value)
{
    if (value >= 0 && value <= 255)
        field = static_cast<std::uint8_t>(value);
}

} // namespace

void assignField(CellLine &line, int field)
{
    if (field < 0 || field >= CatalogFieldCount)
        return;
    line.field = field;
    line.caption = catalogFields()[static_cast<std::size_t>(field)].caption + QLatin1Char(':');
}

void emptyLine(CellLine &line)
{
    line.field.reset();
    line.caption.clear();
}

void applyFormat(CellFormat &format, const FormatControls &controls)
{
    storeByte(format.font, controls.font);
    storeByte(format.italic, controls.italic);
    if (const auto size = toByte(controls.size))
        format.size = *size;
    storeByte(format.underline, controls.underline);
    storeByte(format.weight, controls.weight);
    storeByte(format.align, controls.align);
}

FormatControls formatControlsOf(const CellFormat &format)
{
    return {format.font,      format.italic, QString::number(format.size),
            format.underline, format.weight, format.align};
}

} // namespace zorbin
