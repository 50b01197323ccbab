#pragma once

#include "common/Status.h"

#include <QString>
#include <QStringList>
#include <QVector>
#include <memory>

namespace zorbin {

class WorkDatabase;

// One item of the working database as the item selection dialog lists it.
struct SelectableItem
{
    QString key;         // tItems.ItemKey
    QString name;        // tItems.ItemName
    bool include = true; // tItems.Include: the item enters the catalog
};

// The list query of the item selection dialog over the working database: every item, or only
// the marked ones, marked items first and then by key.
QString BuildItemListSQL(bool onlyMarked);

// The items of a working database and their marks, open for the item selection dialog.
// A failure's description is the engine's.
class MarkedItems
{
public:
    static Result<std::unique_ptr<MarkedItems>> open(const QString &workDbFile);
    ~MarkedItems();
    MarkedItems(const MarkedItems &) = delete;
    MarkedItems &operator=(const MarkedItems &) = delete;

    // The items of the list query, in its order.
    Result<QVector<SelectableItem>> read(bool onlyMarked);
    // Writes the mark of each of `keys` into tItems.Include at once (in one transaction when
    // there are several). A key that no item has changes nothing.
    Status write(const QStringList &keys, bool include);

private:
    explicit MarkedItems(std::unique_ptr<WorkDatabase> database);

    std::unique_ptr<WorkDatabase> m_database;
};

// Which column of the list a search looks at.
enum class ItemSearchColumn { Key, Name };

// The first item, counted from the top, whose key or name begins with `text`, letter case
// ignored; -1 when none does or when `text` is empty.
int findItemRow(const QVector<SelectableItem> &items, ItemSearchColumn column, const QString &text);

} // namespace zorbin
