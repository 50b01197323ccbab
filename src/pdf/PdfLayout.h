#pragma once

#include "common/Status.h"

#include <QString>
#include <memory>
#include <vector>

namespace zorbin {

struct CatalogSettings;
class CatalogRows;

// What the PDF writer takes from the settings, in its own plain terms. Only PdfLayout.cpp reads
// the settings record; everything else in src/pdf works on these structs and on CatalogRows.

// The catalog's three faces, as the format table of the page tab names them.
enum class PdfFace { Arial, David, Miriam };
// The weights of the format table: the stylesheet's Normal, Bolder and Bold.
enum class PdfWeight { Normal, Bolder, Bold };
// Alignment of a cell line; right means the right side of the page, whatever the text's direction.
enum class PdfAlign { Right, Centre, Left };

struct PdfTextFormat
{
    PdfFace face = PdfFace::Arial;
    double points = 9;
    PdfWeight weight = PdfWeight::Normal;
    bool italic = false;
    bool underline = false;
    PdfAlign align = PdfAlign::Right;
};

// One used cell line.
struct PdfLine
{
    int field = 0;      // the CatalogField number: 0 the picture, 4 and 5 prices
    QString caption;    // as typed (it may hold markup); empty for none
    QString column;     // the catalog query's column that carries the field
    QString coinColumn; // prices only: the column of the currency ("Coin1", "Coin2")
    PdfTextFormat format;
};

struct PdfLayout
{
    int rows = 1;
    int columns = 1;
    // The largest picture in pixels of the pages (a CSS pixel is 1/96 inch); a limit only when
    // both are above 0, as the pages give size attributes only then.
    int pictureWidthPx = 0;
    int pictureHeightPx = 0;
    bool pictureBeside = false; // the picture to the right of the lines instead of in their order
    bool frames = false;        // a thin frame around every cell
    QString logo;               // the logo setting as typed; empty for none
    int topPercent = 0;         // band heights in percent of the printable height; 0 or less: no band
    int bottomPercent = 0;
    QString topTitle; // as typed (they may hold markup)
    QString topTitle2;
    QString bottomTitle;
    std::vector<PdfLine> lines; // the used lines in index order

    long long cellsPerPage() const { return static_cast<long long>(rows) * columns; }
    bool pictureSizes() const { return pictureWidthPx > 0 && pictureHeightPx > 0; }
};

// The layout of the settings. Fails, before anything is written, as the pages do: on a grid
// that is not a positive size or a used line whose tag names no field.
Result<PdfLayout> readPdfLayout(const CatalogSettings &settings);

// The catalog rows of a working database under the settings (the items, order, hand-marked and
// only-with-picture rules of the pages).
Result<std::unique_ptr<CatalogRows>> openPdfRows(const QString &dbFile, const CatalogSettings &settings);

} // namespace zorbin
