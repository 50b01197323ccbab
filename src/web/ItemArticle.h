#pragma once

#include "common/Status.h"
#include "platform/ValueFormat.h"

#include <QByteArray>
#include <QHash>
#include <QString>
#include <optional>
#include <vector>

namespace zorbin {

class CatalogRows;
struct SiteLayout;
struct Thumbnail;

// Writes what one item's article holds: for each used cell line a block of the line's class
// with its caption and its value, or the picture. Values from the working database are
// escaped; captions go in as typed. A value is isolated from the text around it (<bdi>), so
// that a Latin name reads left to right and a price stays right of its currency, without
// setting any direction.
//
// `layout` and `rows` must outlive the writer; it reads the rows' current item.
class ItemArticle
{
public:
    ItemArticle(const SiteLayout &layout, const CatalogRows &rows, Separators separators);

    // The item's picture reference as the catalog holds it; empty for an item without one
    // ("?", empty or null) and when no line shows the picture.
    QString pictureReference() const;
    // The item's sort group; nothing when it has none.
    std::optional<qint64> sortGroup() const;

    // Appends the article's inside to `article` and the start of its search entry (see
    // searchEntryStart) to `entry`. `picture` is the item's thumbnail, null for none. Fails
    // when a price is not a number.
    Status write(const Thumbnail *picture, QByteArray &article, QByteArray &entry) const;

private:
    struct Line
    {
        int field = 0;
        int value = -1;   // the rows' column of the field
        int coin = -1;    // prices only: the column of the currency
        QByteArray start; // the line's opening tag and caption
    };

    void writePicture(const Thumbnail *picture, const QString &name, QByteArray &article) const;
    const QByteArray &imageAttributes(const Thumbnail &picture) const;

    const CatalogRows &m_rows;
    Separators m_separators;
    std::vector<Line> m_lines; // one per used line
    int m_key = -1;
    int m_name = -1;
    int m_sort = -1;
    int m_picture = -1;
    // What follows the alt text of each thumbnail's image element, made once a run.
    mutable QHash<QString, QByteArray> m_images;
};

} // namespace zorbin
