#pragma once

#include "workdb/WorkDatabase.h"

#include <QSqlDriver>
#include <sqlite3.h>

// Damage done to a working database, as a damaged or foreign file can hold it: what the
// schema and the collection never write.
namespace zorbin::test {

// Replaces the first price list by the table or view that `sql` creates.
inline Status replacePriceList(const QString &path, const QString &sql)
{
    auto work = WorkDatabase::open(path);
    if (!work)
        return work.status();
    for (const QString &statement : {QStringLiteral("DROP TABLE tItemPrice1"), sql}) {
        if (const WriteOutcome done = work.value()->exec(statement); !done)
            return Status::fault(done.description());
    }
    return Status::ok();
}

// Makes the engine fail ("integer overflow") when a statement that shows the first price
// reaches the item `itemKey`: the rows before it read well, the read of its row fails.
inline Status breakReadingAt(const QString &path, const QString &itemKey)
{
    return replacePriceList(path,
                            QStringLiteral("CREATE VIEW tItemPrice1 AS SELECT ItemKey, '$' AS Coin, CASE "
                                           "ItemKey WHEN '%1' THEN abs(-9223372036854775807 - 1) ELSE 1 "
                                           "END AS Price FROM tItems")
                                .arg(itemKey));
}

// Interrupts the statements running on every open working database, as a failing disk makes
// a read fail: the next row each of them reads fails ("interrupted").
inline void interruptWorkDatabases()
{
    for (const QString &name : QSqlDatabase::connectionNames()) {
        const QVariant handle = QSqlDatabase::database(name, false).driver()->handle();
        if (qstrcmp(handle.typeName(), "sqlite3*") == 0)
            sqlite3_interrupt(*static_cast<sqlite3 *const *>(handle.constData()));
    }
}

} // namespace zorbin::test
