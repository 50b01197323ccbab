// The adapter between the settings record and the PDF writer: the one file of src/pdf that
// reads CatalogSettings.
#include "pdf/PdfLayout.h"

#include "model/CatalogSettings.h"
#include "output/CatalogRows.h"
#include "output/PageLayout.h"

namespace zorbin {
namespace {

// The format bytes as the stylesheet reads them: an index the editor does not offer is the
// first choice.
PdfTextFormat formatOf(const CellFormat &format)
{
    PdfTextFormat pdf;
    pdf.face = format.font == 1 ? PdfFace::David : format.font == 2 ? PdfFace::Miriam : PdfFace::Arial;
    pdf.points = format.size;
    pdf.weight = format.weight == 1   ? PdfWeight::Bolder
                 : format.weight == 2 ? PdfWeight::Bold
                                      : PdfWeight::Normal;
    pdf.italic = format.italic == 1;
    pdf.underline = format.underline == 1;
    pdf.align = format.align == 1 ? PdfAlign::Centre : format.align == 2 ? PdfAlign::Left : PdfAlign::Right;
    return pdf;
}

} // namespace

Result<PdfLayout> readPdfLayout(const CatalogSettings &settings)
{
    // The pages' own reading: grid, picture box, bands, titles and used lines.
    const Result<PageLayout> pages = PageLayout::read(settings, QString());
    if (!pages)
        return pages.status();
    PdfLayout layout;
    layout.rows = pages->grid.rows;
    layout.columns = pages->grid.columns;
    layout.pictureWidthPx = pages->imageWidth;
    layout.pictureHeightPx = pages->imageHeight;
    layout.pictureBeside = pages->pictureBeside;
    layout.frames = settings.frameItems;
    layout.logo = settings.logo;
    layout.topPercent = pages->topPercent;
    layout.bottomPercent = pages->bottomPercent;
    layout.topTitle = pages->topTitle;
    layout.topTitle2 = pages->topTitle2;
    layout.bottomTitle = pages->bottomTitle;
    for (const UsedLine &used : pages->lines) {
        PdfLine line;
        line.field = used.field;
        line.caption = used.caption;
        line.column = used.column;
        if (used.field == 4 || used.field == 5)
            line.coinColumn = QStringLiteral("Coin") + QString::number(used.field - 3);
        line.format = formatOf(settings.lines[static_cast<std::size_t>(used.index)].format);
        layout.lines.push_back(line);
    }
    return layout;
}

Result<std::unique_ptr<CatalogRows>> openPdfRows(const QString &dbFile, const CatalogSettings &settings)
{
    return CatalogRows::open(dbFile, settings);
}

} // namespace zorbin
