#include "pdf/PdfText.h"

#include <QFontMetricsF>
#include <QPainter>
#include <QRegularExpression>
#include <QTextDocumentFragment>
#include <QTextLayout>
#include <algorithm>

namespace zorbin {

QStringList familiesOf(PdfFace face)
{
    switch (face) {
    case PdfFace::David:
        return {QStringLiteral("David CLM"), QStringLiteral("David")};
    case PdfFace::Miriam:
        return {QStringLiteral("Miriam CLM"), QStringLiteral("Miriam")};
    case PdfFace::Arial:
        break;
    }
    return {QStringLiteral("Liberation Sans"), QStringLiteral("Arial")};
}

QFont pdfFont(const PdfTextFormat &format)
{
    QFont font;
    font.setFamilies(familiesOf(format.face) << FallbackFamily);
    font.setPointSizeF(std::max(1.0, format.points));
    font.setWeight(format.weight == PdfWeight::Normal ? QFont::Normal : QFont::Bold);
    font.setItalic(format.italic);
    font.setUnderline(format.underline);
    // Outlines at their designed widths: the PDF's glyph widths are the font's own.
    font.setHintingPreference(QFont::PreferNoHinting);
    font.setStyleStrategy(QFont::PreferOutline);
    return font;
}

QStringList plainLinesOfMarkup(const QString &typed)
{
    QString plain = typed;
    // Only what looks like markup goes through the HTML reader, so that plain text keeps its
    // spaces and a lone "<" or "&" as typed.
    static const QRegularExpression markup(QStringLiteral("<[A-Za-z/!]|&(#?[A-Za-z0-9]+);"));
    if (markup.match(typed).hasMatch())
        plain = QTextDocumentFragment::fromHtml(typed).toPlainText();
    plain.replace(QChar::LineSeparator, QLatin1Char('\n'));
    plain.replace(QChar::ParagraphSeparator, QLatin1Char('\n'));
    plain.replace(QChar::Nbsp, QLatin1Char(' '));
    QStringList lines;
    for (const QString &line : plain.split(QLatin1Char('\n'))) {
        const QString trimmed = line.trimmed();
        if (!trimmed.isEmpty())
            lines << trimmed;
    }
    return lines;
}

Qt::Alignment qtAlignment(PdfAlign align)
{
    switch (align) {
    case PdfAlign::Centre:
        return Qt::AlignHCenter;
    case PdfAlign::Left:
        return Qt::AlignLeft | Qt::AlignAbsolute;
    case PdfAlign::Right:
        break;
    }
    return Qt::AlignRight | Qt::AlignAbsolute;
}

PdfText::PdfText() = default;
PdfText::PdfText(PdfText &&) noexcept = default;
PdfText &PdfText::operator=(PdfText &&) noexcept = default;
PdfText::~PdfText() = default;

PdfText::PdfText(const QString &text, const QFont &font, QPaintDevice *device, Qt::LayoutDirection direction,
                 PdfAlign align, double width)
{
    if (text.isEmpty())
        return;
    m_layout = std::make_unique<QTextLayout>(text, font, device);
    QTextOption option(qtAlignment(align));
    option.setTextDirection(direction);
    option.setWrapMode(QTextOption::WrapAtWordBoundaryOrAnywhere);
    option.setUseDesignMetrics(true);
    m_layout->setTextOption(option);
    m_layout->setCacheEnabled(true);
    m_layout->beginLayout();
    double y = 0;
    for (QTextLine line = m_layout->createLine(); line.isValid(); line = m_layout->createLine()) {
        line.setLineWidth(std::max(width, 1.0));
        line.setPosition(QPointF(0, y));
        y += line.height();
        m_naturalWidth = std::max(m_naturalWidth, line.naturalTextWidth());
    }
    m_layout->endLayout();
    m_height = y;
}

void PdfText::draw(QPainter &painter, const QPointF &topLeft) const
{
    if (m_layout)
        m_layout->draw(&painter, topLeft);
}

double lineHeight(const QFont &font, QPaintDevice *device)
{
    const QFontMetricsF metrics(font, device);
    return metrics.ascent() + metrics.descent();
}

} // namespace zorbin
