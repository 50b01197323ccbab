#pragma once

#include "common/Status.h"
#include "platform/ValueFormat.h"

#include <QByteArray>
#include <QHash>
#include <QString>
#include <vector>

namespace zorbin {

class CatalogRows;
class ImageSizes;
class Windows1255Writer;
struct PageLayout;
struct UsedLine;

// Writes the lines of one item's grid cell: for each used cell line its caption and its value,
// or the picture. Values from the working database are escaped; captions go in as typed.
//
// `layout`, `rows` and `sizes` must outlive the writer. What is the same in every cell (the
// rows' columns, the markup and captions of each line, the image element of each picture) is
// prepared once, in the code page of the page, so that a cell costs little more than its values.
class ItemCell
{
public:
    ItemCell(const PageLayout &layout, const CatalogRows &rows, QString imagesFolder, ImageSizes &sizes,
             Separators separators);

    // The cell lines of the rows' current item. Fails when a price is not a number.
    Status write(Windows1255Writer &page);

private:
    // One used line, ready to write.
    struct Line
    {
        int value = -1;              // the rows' column of the field
        int coin = -1;               // prices only: the column of the currency
        QByteArray start;            // from the row to the opening tag of the value's cell
        QByteArray startLeftToRight; // texts without a Hebrew letter: the same, read left to right
    };

    Line prepareLine(const UsedLine &line) const;
    Status writeValue(Windows1255Writer &page, const Line &line, int field);
    const QByteArray &pictureElement(const QVariant &value);

    const PageLayout &m_layout;
    const CatalogRows &m_rows;
    QString m_imagesFolder;
    ImageSizes &m_sizes;
    Separators m_separators;
    std::vector<Line> m_lines;             // one per used line
    QHash<QString, QByteArray> m_pictures; // the image element of each picture reference
};

} // namespace zorbin
