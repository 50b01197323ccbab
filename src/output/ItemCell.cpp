#include "output/ItemCell.h"

#include "control/CatalogField.h"
#include "output/CatalogRows.h"
#include "output/FileNaming.h"
#include "output/ImageDimensions.h"
#include "output/PageLayout.h"
#include "platform/Windows1255Writer.h"

namespace zorbin {
namespace {

// The working database's mark for a missing text value; as a picture reference it means none.
const QString MissingMark = QStringLiteral("?");

bool isPrice(int field)
{
    return field == 4 || field == 5;
}

} // namespace

ItemCell::ItemCell(const PageLayout &layout, const CatalogRows &rows, QString imagesFolder, ImageSizes &sizes,
                   Separators separators)
    : m_layout(layout), m_rows(rows), m_imagesFolder(std::move(imagesFolder)), m_sizes(sizes),
      m_separators(std::move(separators)), m_usedLineCount(QString::number(layout.lines.size()))
{
    for (const UsedLine &line : layout.lines) {
        Columns columns{rows.column(line.column), -1};
        if (isPrice(line.field))
            columns.coin = rows.column(QStringLiteral("Coin") + QString::number(line.field - 3));
        m_columns.push_back(columns);
    }
}

Status ItemCell::write(Windows1255Writer &page)
{
    for (std::size_t n = 0; n < m_layout.lines.size(); ++n) {
        const UsedLine &line = m_layout.lines[n];
        const QString lineClass = QStringLiteral("L") + QString::number(line.index);
        const QVariant value = m_rows.value(m_columns[n].value);
        page.write(u"    <tr>");
        int valueSpan = 2;
        if (!line.caption.isEmpty()) {
            page.write(QStringLiteral("<td class=") + lineClass + QStringLiteral(">") + line.caption +
                       QStringLiteral("</td>"));
            valueSpan = 1;
        }
        if (line.field == PictureField) {
            if (m_layout.pictureBeside)
                page.write(QStringLiteral("<td class=") + lineClass + QStringLiteral(" rowspan=") +
                           m_usedLineCount + QStringLiteral(" colspan=") + QString::number(valueSpan + 1) +
                           QStringLiteral(">"));
            else
                page.write(QStringLiteral("<td class=") + lineClass + QStringLiteral(" colspan=") +
                           QString::number(valueSpan) + QStringLiteral(">"));
            writePicture(page, value);
        } else {
            QString text;
            bool leftToRight = false;
            if (isPrice(line.field)) {
                const auto amount = NumOrZero(value);
                if (!amount)
                    return amount.status();
                const QVariant coin = m_rows.value(m_columns[n].coin);
                text = formatAmount(amount.value(), m_separators) + QStringLiteral(" ") +
                       (coin.isNull() ? QString() : escapeHtml(coin.toString()));
            } else {
                text = HTMLText(value);
                leftToRight = !HasHebrew(text);
            }
            page.write(QStringLiteral("<td class=") + lineClass + QStringLiteral(" colspan=") +
                       QString::number(valueSpan) +
                       (leftToRight ? QStringLiteral(" dir=ltr>") : QStringLiteral(">")));
            page.write(text);
        }
        page.writeLine(u"</td>");
        page.writeLine(u"    </tr>");
    }
    return Status::ok();
}

QString ItemCell::pictureReference(const QVariant &value) const
{
    const QString reference = value.isNull() ? QString() : value.toString();
    if (reference.isEmpty() || reference == MissingMark)
        return {};
    return m_layout.filePerPage ? ImageFileName(m_imagesFolder, reference) : reference;
}

void ItemCell::writePicture(Windows1255Writer &page, const QVariant &value)
{
    const QString reference = pictureReference(value);
    // An item without a picture gets an empty cell rather than a broken image.
    if (reference.isEmpty())
        return;
    page.write(QStringLiteral("<img src='") + attributeFileReference(reference) +
               QStringLiteral("' border=0"));
    if (m_layout.pictureSizes())
        page.write(m_sizes.sizeAttr(reference, m_layout.imageWidth, m_layout.imageHeight));
    page.writeLine(u">");
}

} // namespace zorbin
