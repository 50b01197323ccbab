#include "pdf/PdfPage.h"

#include <algorithm>

namespace zorbin {

QRectF PdfPageGeometry::cell(int row, int column) const
{
    const QSizeF size = cellSize();
    return {grid.right() - (column + 1) * size.width(), grid.top() + row * size.height(), size.width(),
            size.height()};
}

PdfPageGeometry pageGeometry(const QSizeF &printable, int topPercent, int bottomPercent, int rows,
                             int columns)
{
    PdfPageGeometry page;
    page.printable = QRectF(QPointF(0, 0), printable);
    page.rows = std::max(rows, 1);
    page.columns = std::max(columns, 1);
    double top = std::max(topPercent, 0) / 100.0;
    double bottom = std::max(bottomPercent, 0) / 100.0;
    if (top + bottom > 0.9) {
        const double scale = 0.9 / (top + bottom);
        top *= scale;
        bottom *= scale;
    }
    const double topHeight = top * printable.height();
    const double bottomHeight = bottom * printable.height();
    if (topHeight > 0)
        page.topBand = QRectF(0, 0, printable.width(), topHeight);
    if (bottomHeight > 0)
        page.bottomBand = QRectF(0, printable.height() - bottomHeight, printable.width(), bottomHeight);
    page.grid = QRectF(0, topHeight, printable.width(), printable.height() - topHeight - bottomHeight);
    return page;
}

} // namespace zorbin
