#include "testutil/WorkDatabaseFixture.h"

#include "platform/FileSystem.h"
#include "workdb/RowWriter.h"
#include "workdb/WorkDatabase.h"

#include <QSqlRecord>

namespace zorbin::test {

Status makeWorkDatabase(const QString &path, const WorkRows &rows)
{
    if (Status created = createWorkDatabase(localFileSystem(), path); !created)
        return created;
    auto work = WorkDatabase::open(path);
    // One transaction: a row at a time, tens of thousands of items would take minutes.
    if (Status begun = work ? work.value()->begin() : work.status(); !begun)
        return begun;
    QMap<QString, QList<QVariantList>> tables = rows.other;
    for (const WorkItem &item : rows.items)
        tables[QStringLiteral("tItems")] << item.values();
    for (auto table = tables.cbegin(); table != tables.cend(); ++table) {
        const WorkTable *definition = findWorkTable(table.key());
        if (!definition)
            return Status::fault(QStringLiteral("no working table %1").arg(table.key()));
        RowWriter writer(*work.value(), table.key(), definition->columnNames());
        for (const QVariantList &row : table.value()) {
            if (row.size() != qsizetype(definition->columns.size()))
                return Status::fault(QStringLiteral("a row of %1 needs %2 values")
                                         .arg(table.key())
                                         .arg(definition->columns.size()));
            if (WriteOutcome written = writer.write(row); !written)
                return Status::fault(table.key() + QStringLiteral(": ") + written.description());
        }
    }
    return work.value()->commit();
}

QList<QVariantList> readWorkTable(const QString &path, const QString &table)
{
    QList<QVariantList> rows;
    const WorkTable *definition = findWorkTable(table);
    auto work = WorkDatabase::open(path);
    if (!definition || !work)
        return rows;
    Result<QSqlQuery> query = work.value()->select(
        QStringLiteral("SELECT %1 FROM %2 ORDER BY %3")
            .arg(definition->columnNames().join(QStringLiteral(", ")), table, definition->key().name));
    while (query && query->next()) {
        rows << QVariantList();
        for (int i = 0; i < query->record().count(); ++i)
            rows.last() << query->value(i);
    }
    return rows;
}

} // namespace zorbin::test
