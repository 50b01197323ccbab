#pragma once

#include <QRectF>
#include <QSizeF>

namespace zorbin {

// Where the parts of a catalog page lie, in the paint device's units, from the top left corner
// of the printable area (inside the margins).
struct PdfPageGeometry
{
    QRectF printable;
    QRectF topBand;    // empty when there is no top band
    QRectF bottomBand; // empty when there is no bottom band
    QRectF grid;
    int rows = 1;
    int columns = 1;

    QSizeF cellSize() const { return {grid.width() / columns, grid.height() / rows}; }
    // The cell of a grid row and column, both from 0; column 0 is at the right.
    QRectF cell(int row, int column) const;
};

// The bands take their percent of the printable height (a band of 0 or less is left out); when
// both together would take more than 90%, they are scaled down to 90% so that the grid keeps
// a tenth of the page. The grid fills the rest.
PdfPageGeometry pageGeometry(const QSizeF &printable, int topPercent, int bottomPercent, int rows,
                             int columns);

} // namespace zorbin
