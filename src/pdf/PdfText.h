#pragma once

#include "pdf/PdfLayout.h"

#include <QFont>
#include <QString>
#include <QStringList>
#include <memory>

class QPainter;
class QPaintDevice;
class QPointF;
class QTextLayout;

namespace zorbin {

// The families that draw each of the catalog's faces, the first installed one drawing. The pages
// name "Arial (Hebrew)", "David" and "Miriam"; on Debian these are Liberation Sans (metric-
// compatible with Arial, with Hebrew letters; package fonts-liberation2), David CLM and Miriam CLM
// (package culmus); where those are missing (Windows), Arial, David and Miriam themselves.
QStringList familiesOf(PdfFace face);
// The family that every line falls back to for characters its own face lacks (the culmus faces
// have few Latin letters and no Latin punctuation of some kinds): DejaVu Sans, which has them.
inline const QString FallbackFamily = QStringLiteral("DejaVu Sans");

// The font of a format: its families, then the fallback; the weights Bolder and Bold both draw bold
// (as a browser draws "bolder" on normal text); sizes below 1 point are drawn at 1 point.
QFont pdfFont(const PdfTextFormat &format);

// The text of a title or caption as it reads in a browser, where they go in as typed: markup
// is dropped (character references decoded, white space collapsed), each line break or block
// a line of its own. Plain text stays as it is, trimmed.
QStringList plainLinesOfMarkup(const QString &typed);

// A text laid out for a box of a given width: right to left or left to right as a paragraph of
// its own (bidirectional by the Unicode algorithm), aligned absolutely (right is the right
// side of the page), wrapped at word boundaries (anywhere in a word longer than the box).
// Measurements are in the paint device's units.
class PdfText
{
public:
    PdfText();
    PdfText(const QString &text, const QFont &font, QPaintDevice *device, Qt::LayoutDirection direction,
            PdfAlign align, double width);
    PdfText(PdfText &&) noexcept;
    PdfText &operator=(PdfText &&) noexcept;
    ~PdfText();

    bool isEmpty() const { return !m_layout; }
    double height() const { return m_height; }
    // The width of the widest line as drawn (without trailing spaces).
    double naturalWidth() const { return m_naturalWidth; }
    // Draws the box with its top left corner at `topLeft`.
    void draw(QPainter &painter, const QPointF &topLeft) const;

private:
    std::unique_ptr<QTextLayout> m_layout;
    double m_height = 0;
    double m_naturalWidth = 0;
};

// The height of one line of a font on a device, as a PdfText of one line has it.
double lineHeight(const QFont &font, QPaintDevice *device);

Qt::Alignment qtAlignment(PdfAlign align);

} // namespace zorbin
