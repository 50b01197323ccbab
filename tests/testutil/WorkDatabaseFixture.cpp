#include "testutil/WorkDatabaseFixture.h"

#include "platform/FileSystem.h"
#include "workdb/RowWriter.h"
#include "workdb/WorkDatabase.h"
#include "workdb/WorkSchema.h"

#include <QSqlQuery>
#include <QSqlRecord>

namespace zorbin::test {
namespace {

Status writeRows(WorkDatabase &work, const QString &table, const QList<QVariantList> &rows)
{
    const WorkTable *definition = findWorkTable(table);
    if (!definition)
        return Status::fault(QStringLiteral("no working table %1").arg(table));
    RowWriter writer(work, table, definition->columnNames());
    for (const QVariantList &row : rows) {
        if (row.size() != static_cast<qsizetype>(definition->columns.size()))
            return Status::fault(
                QStringLiteral("a row of %1 needs %2 values").arg(table).arg(definition->columns.size()));
        if (WriteOutcome written = writer.write(row); !written)
            return Status::fault(QStringLiteral("%1: %2").arg(table, written.description()));
    }
    return Status::ok();
}

} // namespace

QVariantList WorkItem::values() const
{
    return {key, name, sort, filter, unit, price, coin, picture, include ? WorkTrue : WorkFalse};
}

Status makeWorkDatabase(const QString &path, const WorkRows &rows)
{
    if (Status created = createWorkDatabase(localFileSystem(), path); !created)
        return created;
    Result<std::unique_ptr<WorkDatabase>> work = WorkDatabase::open(path);
    if (!work)
        return work.status();
    // One transaction: a row at a time, tens of thousands of items would take minutes.
    if (Status begun = work.value()->begin(); !begun)
        return begun;
    QList<QVariantList> items;
    for (const WorkItem &item : rows.items)
        items << item.values();
    if (Status written = writeRows(*work.value(), QStringLiteral("tItems"), items); !written)
        return written;
    for (auto it = rows.other.cbegin(); it != rows.other.cend(); ++it) {
        if (Status written = writeRows(*work.value(), it.key(), it.value()); !written)
            return written;
    }
    return work.value()->commit();
}

QList<QVariantList> readWorkTable(const QString &path, const QString &table)
{
    QList<QVariantList> rows;
    const WorkTable *definition = findWorkTable(table);
    Result<std::unique_ptr<WorkDatabase>> work = WorkDatabase::open(path);
    if (!definition || !work)
        return rows;
    {
        Result<QSqlQuery> query = work.value()->select(
            QStringLiteral("SELECT %1 FROM %2 ORDER BY %3")
                .arg(definition->columnNames().join(QStringLiteral(", ")), table, definition->key().name));
        if (!query)
            return rows;
        while (query->next()) {
            QVariantList row;
            for (int i = 0; i < query->record().count(); ++i)
                row << query->value(i);
            rows << row;
        }
    }
    return rows;
}

} // namespace zorbin::test
