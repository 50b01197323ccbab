#include "pdf/PdfCell.h"

#include "model/CatalogField.h"
#include "output/CatalogRows.h"
#include "output/FileNaming.h"
#include "output/PictureReference.h"

#include <QPaintDevice>
#include <QPainter>
#include <algorithm>
#include <cmath>

namespace zorbin {
namespace {

constexpr double PaddingPoints = 2;    // inside each cell, on every side
constexpr double CaptionGapPoints = 3; // between a caption and its value
constexpr double BesideGapPoints = 4;  // between the picture beside the lines and the lines
constexpr double PointsPerCssPixel = 72.0 / 96.0;

bool isPrice(int field)
{
    return field == 4 || field == 5;
}

QString captionText(const QString &typed)
{
    return plainLinesOfMarkup(typed).join(QChar::LineSeparator);
}

} // namespace

PdfCell::PdfCell(const PdfLayout &layout, const CatalogRows &rows, QPaintDevice &device,
                 const FileSystem &files, const QSizeF &cellSize, double unitsPerPoint, Separators separators,
                 QHash<QString, int> pictureUses)
    : m_layout(layout), m_rows(rows), m_device(device), m_files(files), m_units(unitsPerPoint),
      m_separators(std::move(separators)), m_pictureUses(std::move(pictureUses))
{
    m_padding = PaddingPoints * m_units;
    m_content = QSizeF(std::max(cellSize.width() - 2 * m_padding, m_units),
                       std::max(cellSize.height() - 2 * m_padding, m_units));
    const double limitW = layout.pictureSizes() ? layout.pictureWidthPx * PointsPerCssPixel * m_units : 0;
    const double limitH = layout.pictureSizes() ? layout.pictureHeightPx * PointsPerCssPixel * m_units : 0;

    // The picture beside the lines takes a column at the right of the cell.
    double besideWidth = 0;
    for (const PdfLine &line : layout.lines) {
        if (line.field == PictureField && layout.pictureBeside) {
            besideWidth = limitW > 0 ? std::min(limitW, m_content.width() / 2) : m_content.width() * 0.4;
            break;
        }
    }
    m_linesWidth = besideWidth > 0
                       ? std::max(m_content.width() - besideWidth - BesideGapPoints * m_units, m_units)
                       : m_content.width();

    // Captions: one column as wide as the widest caption, at most 45% of the lines' width. They
    // are measured on a line far wider than any page (and within Qt's fixed-point range).
    const double unbounded = 1e6;
    double widest = 0;
    for (const PdfLine &line : layout.lines) {
        Line prepared;
        prepared.line = &line;
        prepared.value = rows.column(line.column);
        if (!line.coinColumn.isEmpty())
            prepared.coin = rows.column(line.coinColumn);
        prepared.font = pdfFont(line.format);
        prepared.picture = line.field == PictureField && !layout.pictureBeside;
        prepared.beside = line.field == PictureField && layout.pictureBeside;
        const QString caption = captionText(line.caption);
        if (!caption.isEmpty())
            widest = std::max(widest, PdfText(caption, prepared.font, &device, Qt::RightToLeft,
                                              line.format.align, unbounded)
                                          .naturalWidth());
        m_lines.push_back(std::move(prepared));
    }
    if (widest > 0) {
        m_captionWidth = std::min(std::ceil(widest) + 1, m_linesWidth * 0.45);
        m_captionGap = CaptionGapPoints * m_units;
    }
    double textHeight = 0;
    for (Line &line : m_lines) {
        const QString caption = captionText(line.line->caption);
        if (!caption.isEmpty())
            line.caption = PdfText(caption, line.font, &device, Qt::RightToLeft, line.line->format.align,
                                   m_captionWidth);
        line.minHeight = std::max(lineHeight(line.font, &device), line.caption.height());
        m_pictureBeside = m_pictureBeside || line.beside;
        if (line.picture)
            ++m_pictureRows;
        // The picture beside the lines leaves its caption, if any, as a line in its place.
        if (!line.picture && !(line.beside && line.caption.isEmpty()))
            textHeight += line.minHeight;
    }

    // The largest picture box: beside, the column; as a line, the value's width and what the
    // text lines leave of the height; within the pages' largest picture when they give one.
    double boxW = besideWidth;
    double boxH = m_content.height();
    for (const Line &line : m_lines) {
        if (line.picture) {
            boxW = valueWidth(line);
            boxH = std::max((m_content.height() - textHeight) / m_pictureRows, m_units);
        }
    }
    if (limitW > 0) {
        boxW = std::min(boxW, limitW);
        boxH = std::min(boxH, limitH);
    }
    m_pictureBox = QSizeF(std::max(boxW, m_units), std::max(boxH, m_units));
    m_pictures.emplace(files, m_pictureBox / m_units);
    m_drawn.resize(m_lines.size());
}

Result<QString> PdfCell::valueText(const Line &line) const
{
    const QVariant value = m_rows.value(line.value);
    if (isPrice(line.line->field)) {
        const Result<double> amount = NumOrZero(value);
        if (!amount)
            return amount.status();
        QString text = formatAmount(amount.value(), m_separators);
        if (const QVariant coin = m_rows.value(line.coin); !coin.isNull())
            text += QLatin1Char(' ') + coin.toString();
        return text;
    }
    return value.isNull() ? QString() : value.toString();
}

QString PdfCell::pictureFile(const Line &line)
{
    const QVariant value = m_rows.value(line.value);
    const QString reference = value.isNull() ? QString() : value.toString();
    if (!namesPicture(reference))
        return {};
    auto known = m_references.constFind(reference);
    if (known == m_references.cend()) {
        const QString file = pictureSourceFile(m_files, reference).value_or(QString());
        known = m_references.insert(reference, file);
        if (!file.isEmpty())
            m_fileUses[file] += m_pictureUses.value(reference, 1);
    }
    return known.value();
}

// After the last item that shows it, a picture is let go. (Two spellings of one file that are
// far apart may have it decoded, and stored, a second time.)
void PdfCell::drawnOnce(const QString &file)
{
    if (file.isEmpty() || m_pictureUses.isEmpty())
        return;
    if (--m_fileUses[file] <= 0) {
        m_fileUses.remove(file);
        m_pictures->release(file);
    }
}

double PdfCell::alignedX(PdfAlign align, double left, double width, double drawn) const
{
    switch (align) {
    case PdfAlign::Left:
        return left;
    case PdfAlign::Centre:
        return left + (width - drawn) / 2;
    case PdfAlign::Right:
        break;
    }
    return left + width - drawn;
}

Status PdfCell::draw(QPainter &painter, const QRectF &cell)
{
    const QRectF content(cell.left() + m_padding, cell.top() + m_padding, m_content.width(),
                         m_content.height());
    const double linesLeft = content.left();
    const double captionLeft = linesLeft + m_linesWidth - m_captionWidth;

    // Lay the values out first: the picture gets what the text leaves.
    double textHeight = 0;
    QString file; // the picture's
    const PdfPicture *picture = nullptr;
    const Line *pictureLine = nullptr;
    for (std::size_t n = 0; n < m_lines.size(); ++n) {
        const Line &line = m_lines[n];
        Drawn &drawn = m_drawn[n];
        drawn.value = PdfText();
        drawn.height = 0;
        if (line.picture || line.beside) {
            if (!pictureLine) {
                file = pictureFile(line);
                picture = file.isEmpty() ? nullptr : m_pictures->picture(file);
            }
            pictureLine = &line;
            if (line.beside && !line.caption.isEmpty())
                drawn.height = line.minHeight;
            textHeight += drawn.height;
            continue;
        }
        const Result<QString> text = valueText(line);
        if (!text)
            return text.status();
        const bool rightToLeft = isPrice(line.line->field) || HasHebrew(text.value());
        drawn.value =
            PdfText(text.value(), line.font, &m_device, rightToLeft ? Qt::RightToLeft : Qt::LeftToRight,
                    line.line->format.align, valueWidth(line));
        drawn.height = std::max(line.minHeight, drawn.value.height());
        textHeight += drawn.height;
    }

    QSizeF pictureSize;
    if (picture) {
        const double room = m_pictureBeside
                                ? m_pictureBox.height()
                                : std::max(content.height() - textHeight, 0.0) / std::max(m_pictureRows, 1);
        pictureSize = fittedSize(picture->natural * m_units,
                                 QSizeF(m_pictureBox.width(), std::min(m_pictureBox.height(), room)));
    }
    double pictureRow = 0;
    if (pictureLine && pictureLine->picture)
        pictureRow = std::max(pictureSize.height(), pictureLine->caption.height());
    const double blockHeight = textHeight + pictureRow * m_pictureRows;
    const bool overflows = blockHeight > content.height() + m_units;
    if (overflows) {
        painter.save();
        painter.setClipRect(cell);
    }

    if (picture && m_pictureBeside && !pictureSize.isEmpty()) {
        const double columnLeft = content.right() - m_pictureBox.width();
        const QRectF target(
            alignedX(pictureLine->line->format.align, columnLeft, m_pictureBox.width(), pictureSize.width()),
            content.top() + (content.height() - pictureSize.height()) / 2, pictureSize.width(),
            pictureSize.height());
        painter.drawImage(target, picture->image);
    }

    double y = content.top() + std::max(0.0, (content.height() - blockHeight) / 2);
    for (std::size_t n = 0; n < m_lines.size(); ++n) {
        const Line &line = m_lines[n];
        if (line.picture) {
            line.caption.draw(painter, QPointF(captionLeft, y));
            if (picture && !pictureSize.isEmpty()) {
                const double width = valueWidth(line);
                painter.drawImage(
                    QRectF(alignedX(line.line->format.align, linesLeft, width, pictureSize.width()), y,
                           pictureSize.width(), pictureSize.height()),
                    picture->image);
            }
            y += pictureRow;
            continue;
        }
        const Drawn &drawn = m_drawn[n];
        if (drawn.height <= 0)
            continue;
        line.caption.draw(painter, QPointF(captionLeft, y));
        drawn.value.draw(painter, QPointF(linesLeft, y));
        y += drawn.height;
    }

    if (overflows)
        painter.restore();
    drawnOnce(file);
    return Status::ok();
}

double PdfCell::valueWidth(const Line &line) const
{
    return line.caption.isEmpty() ? m_linesWidth
                                  : std::max(m_linesWidth - m_captionWidth - m_captionGap, m_units);
}

} // namespace zorbin
