#include "testutil/DamagedWorkDatabase.h"

#include "workdb/WorkDatabase.h"

#include <QSqlDatabase>
#include <QSqlDriver>
#include <sqlite3.h>

namespace zorbin::test {

Status replacePriceList(const QString &path, const QString &sql)
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

Status breakReadingAt(const QString &path, const QString &itemKey)
{
    return replacePriceList(path,
                            QStringLiteral("CREATE VIEW tItemPrice1 AS SELECT ItemKey, '$' AS Coin, CASE "
                                           "ItemKey WHEN '%1' THEN abs(-9223372036854775807 - 1) ELSE 1 "
                                           "END AS Price FROM tItems")
                                .arg(itemKey));
}

void interruptWorkDatabases()
{
    for (const QString &name : QSqlDatabase::connectionNames()) {
        const QVariant handle = QSqlDatabase::database(name, false).driver()->handle();
        if (qstrcmp(handle.typeName(), "sqlite3*") == 0)
            sqlite3_interrupt(*static_cast<sqlite3 *const *>(handle.constData()));
    }
}

} // namespace zorbin::test
