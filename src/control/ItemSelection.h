#pragma once

#include "common/Status.h"

#include <QString>
#include <QStringList>
#include <QVector>

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

// The items of the list query, in its order. A failure's description is the engine's.
Result<QVector<SelectableItem>> readSelectableItems(WorkDatabase &database, bool onlyMarked);

// Writes the mark of each of `keys` into tItems.Include at once (in one transaction when there
// are several). A key that no item has changes nothing.
Status writeItemMarks(WorkDatabase &database, const QStringList &keys, bool include);

// Which column of the list a search looks at.
enum class ItemSearchColumn { Key, Name };

// The first item, counted from the top, whose key or name begins with `text`, letter case
// ignored; -1 when none does or when `text` is empty.
int findItemRow(const QVector<SelectableItem> &items, ItemSearchColumn column, const QString &text);

} // namespace zorbin
