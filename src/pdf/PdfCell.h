#pragma once

#include "common/Status.h"
#include "pdf/PdfLayout.h"
#include "pdf/PdfPictures.h"
#include "pdf/PdfText.h"
#include "platform/ValueFormat.h"

#include <QFont>
#include <QRectF>
#include <optional>
#include <vector>

class QPainter;
class QPaintDevice;

namespace zorbin {

class CatalogRows;
class FileSystem;

// Draws the item cells of a PDF run: each used line in its order, its caption in a column at the
// right of the lines (as the pages put captions in a table column of their own) and its value
// beside it, or the picture, either as a line or to the right of the lines. The lines are
// centred vertically in the cell, as the pages centre them; what does not fit is cut at the cell.
//
// Everything that is the same in every cell (fonts, captions, the columns and boxes) is worked
// out once. All lengths are in the paint device's units.
class PdfCell
{
public:
    // `layout`, `rows`, `device` and `files` must outlive the object. `cellSize` is the size of
    // every grid cell; `unitsPerPoint` the device's units in a point. `pictureUses` says how many
    // items show each picture reference, so that a picture is let go after its last item; when
    // it is empty, every picture is kept to the end of the run.
    PdfCell(const PdfLayout &layout, const CatalogRows &rows, QPaintDevice &device, const FileSystem &files,
            const QSizeF &cellSize, double unitsPerPoint, Separators separators,
            QHash<QString, int> pictureUses = {});

    // Draws the rows' current item into `cell`. Fails when a price is not a number.
    Status draw(QPainter &painter, const QRectF &cell);

    int picturesDecoded() const { return m_pictures->decoded(); }
    int picturesHeldAtMost() const { return m_pictures->heldAtMost(); }

private:
    struct Line
    {
        const PdfLine *line = nullptr;
        int value = -1; // the rows' column of the field
        int coin = -1;  // prices: the column of the currency
        QFont font;
        PdfText caption;      // laid out for the caption column
        double minHeight = 0; // one line of the font, or the caption when taller
        bool picture = false; // the picture line drawn as a picture in its order
        bool beside = false;  // the picture line when the picture is beside the lines
    };
    struct Drawn
    {
        PdfText value;
        double height = 0;
    };

    Result<QString> valueText(const Line &line) const;
    QString pictureFile(const Line &line);
    void drawnOnce(const QString &file);
    double alignedX(PdfAlign align, double left, double width, double drawn) const;
    double valueWidth(const Line &line) const;

    const PdfLayout &m_layout;
    const CatalogRows &m_rows;
    QPaintDevice &m_device;
    const FileSystem &m_files;
    double m_units;
    Separators m_separators;
    double m_padding = 0;
    QSizeF m_content;          // the cell less its padding
    double m_linesWidth = 0;   // the lines' part of the content, at its left
    double m_captionWidth = 0; // the caption column at the right of the lines' part; 0 for none
    double m_captionGap = 0;
    QSizeF m_pictureBox; // the largest picture box
    bool m_pictureBeside = false;
    int m_pictureRows = 0; // lines that show the picture in their order (a field may be on several)
    std::vector<Line> m_lines;
    std::vector<Drawn> m_drawn; // per line, reused from cell to cell
    std::optional<PdfPictures> m_pictures;
    QHash<QString, QString> m_references; // picture reference -> its file (empty: none)
    QHash<QString, int> m_pictureUses;    // picture reference -> items that show it
    QHash<QString, int> m_fileUses;       // picture file -> items still to show it
};

} // namespace zorbin
