#pragma once

#include "common/Status.h"
#include "workdb/WorkSchema.h"

#include <QMap>
#include <QVariantList>

namespace zorbin::test {

// A row of tItems as the item collection writes it: "?" for a missing name, unit, currency or
// picture, Null for a missing sort group, filter or price, and marked for the catalog.
struct WorkItem
{
    QString key;
    QVariant name = QStringLiteral("?");
    QVariant sort{};
    QVariant filter{};
    QVariant unit = QStringLiteral("?");
    QVariant price{};
    QVariant coin = QStringLiteral("?");
    QVariant picture = QStringLiteral("?");
    bool include = true;

    // The values in the column order of tItems.
    QVariantList values() const
    {
        return {key, name, sort, filter, unit, price, coin, picture, include ? WorkTrue : WorkFalse};
    }
};

// What goes into a working database: per table, rows of values in the table's column order
// (tItems: ItemKey, ItemName, ItemSort, Filter, Unit, SellPrice, SellCoin, ItemPic, Include;
// tItemPrice1/2: ItemKey, Coin, Price; tExtraNote1/2: ItemKey, ExtraNote; tItemSort:
// ItemSort, SortName).
struct WorkRows
{
    QList<WorkItem> items;
    QMap<QString, QList<QVariantList>> other; // table name -> rows, for the five other tables
};

// Creates a fresh working database at `path` (replacing a file there) through the program's
// own creation, and writes the rows; any refusal is returned as a fault.
Status makeWorkDatabase(const QString &path, const WorkRows &rows = {});

// Every row of a table, each in the table's column order, ordered by its primary key.
QList<QVariantList> readWorkTable(const QString &path, const QString &table);

} // namespace zorbin::test
