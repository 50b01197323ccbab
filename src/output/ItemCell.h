#pragma once

#include "common/Status.h"
#include "platform/ValueFormat.h"

#include <QString>
#include <vector>

namespace zorbin {

class CatalogRows;
class ImageSizes;
class Windows1255Writer;
struct PageLayout;

// Writes the lines of one item's grid cell: for each used cell line its caption and its value,
// or the picture. Values from the working database are escaped; captions go in as typed.
//
// `layout`, `rows` and `sizes` must outlive the writer; the rows' columns are looked up once.
class ItemCell
{
public:
    ItemCell(const PageLayout &layout, const CatalogRows &rows, QString imagesFolder, ImageSizes &sizes,
             Separators separators);

    // The cell lines of the rows' current item. Fails when a price is not a number.
    Status write(Windows1255Writer &page);

private:
    struct Columns
    {
        int value = -1;
        int coin = -1; // prices only
    };

    QString pictureReference(const QVariant &value) const;
    void writePicture(Windows1255Writer &page, const QVariant &value);

    const PageLayout &m_layout;
    const CatalogRows &m_rows;
    QString m_imagesFolder;
    ImageSizes &m_sizes;
    Separators m_separators;
    std::vector<Columns> m_columns; // one per used line
    QString m_usedLineCount;
};

} // namespace zorbin
