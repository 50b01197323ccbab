#include "output/ItemCell.h"

#include "model/CatalogField.h"
#include "output/CatalogRows.h"
#include "output/FileNaming.h"
#include "output/ImageDimensions.h"
#include "output/PageLayout.h"
#include "platform/Windows1255Writer.h"

namespace zorbin {
namespace {

// The working database's mark for a missing text value; as a picture reference it means none.
const QString MissingMark = QStringLiteral("?");

// What follows each value: the end of its cell and of its row.
constexpr QByteArrayView LineEnd = "</td>\r\n    </tr>\r\n";

bool isPrice(int field)
{
    return field == 4 || field == 5;
}

} // namespace

ItemCell::ItemCell(const PageLayout &layout, const CatalogRows &rows, QString imagesFolder, ImageSizes &sizes,
                   Separators separators)
    : m_layout(layout), m_rows(rows), m_imagesFolder(std::move(imagesFolder)), m_sizes(sizes),
      m_separators(std::move(separators))
{
    for (const UsedLine &line : layout.lines)
        m_lines.push_back(prepareLine(line));
}

ItemCell::Line ItemCell::prepareLine(const UsedLine &line) const
{
    Line prepared;
    prepared.value = m_rows.column(line.column);
    if (isPrice(line.field))
        prepared.coin = m_rows.column(QStringLiteral("Coin") + QString::number(line.field - 3));
    const QString lineClass = QStringLiteral("L") + QString::number(line.index);
    QString start = QStringLiteral("    <tr>");
    int valueSpan = 2;
    if (!line.caption.isEmpty()) {
        start += QStringLiteral("<td class=") + lineClass + QStringLiteral(">") + line.caption +
                 QStringLiteral("</td>");
        valueSpan = 1;
    }
    start += QStringLiteral("<td class=") + lineClass;
    if (line.field == PictureField) {
        if (m_layout.pictureBeside)
            start += QStringLiteral(" rowspan=") + QString::number(m_layout.lines.size()) +
                     QStringLiteral(" colspan=") + QString::number(valueSpan + 1);
        else
            start += QStringLiteral(" colspan=") + QString::number(valueSpan);
    } else {
        start += QStringLiteral(" colspan=") + QString::number(valueSpan);
        prepared.startLeftToRight = Windows1255Encoder::encoded(start + QStringLiteral(" dir=ltr>"));
    }
    prepared.start = Windows1255Encoder::encoded(start + QStringLiteral(">"));
    return prepared;
}

Status ItemCell::write(Windows1255Writer &page)
{
    for (std::size_t n = 0; n < m_lines.size(); ++n) {
        if (const Status written = writeValue(page, m_lines[n], m_layout.lines[n].field); !written)
            return written;
        page.writeEncoded(LineEnd);
    }
    return Status::ok();
}

Status ItemCell::writeValue(Windows1255Writer &page, const Line &line, int field)
{
    const QVariant value = m_rows.value(line.value);
    if (field == PictureField) {
        page.writeEncoded(line.start);
        page.writeEncoded(pictureElement(value));
    } else if (isPrice(field)) {
        const auto amount = NumOrZero(value);
        if (!amount)
            return amount.status();
        page.writeEncoded(line.start);
        page.write(formatAmount(amount.value(), m_separators));
        page.write(u" ");
        if (const QVariant coin = m_rows.value(line.coin); !coin.isNull())
            page.writeEscaped(coin.toString());
    } else if (value.isNull()) {
        page.writeEncoded(line.startLeftToRight);
        page.write(u"&nbsp;");
    } else {
        const QString text = value.toString();
        page.writeEncoded(HasHebrew(text) ? line.start : line.startLeftToRight);
        page.writeEscaped(text);
    }
    return Status::ok();
}

// The element with its line end; nothing for an item without a picture, which gets an empty
// cell rather than a broken image.
const QByteArray &ItemCell::pictureElement(const QVariant &value)
{
    static const QByteArray none;
    const QString reference = value.isNull() ? QString() : value.toString();
    if (reference.isEmpty() || reference == MissingMark)
        return none;
    if (const auto known = m_pictures.constFind(reference); known != m_pictures.cend())
        return known.value();
    const QString file = m_layout.filePerPage ? ImageFileName(m_imagesFolder, reference) : reference;
    QString element =
        QStringLiteral("<img src='") + attributeFileReference(file) + QStringLiteral("' border=0");
    if (m_layout.pictureSizes())
        element += m_sizes.sizeAttr(file, m_layout.imageWidth, m_layout.imageHeight);
    element += QStringLiteral(">\r\n");
    return m_pictures.insert(reference, Windows1255Encoder::encoded(element)).value();
}

} // namespace zorbin
