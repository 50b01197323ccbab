#include "workdb/CopyLoop.h"

#include "control/ProgressMeter.h"
#include "control/RunContext.h"
#include "control/RunState.h"
#include "control/UserPort.h"
#include "source/ConnectionString.h"
#include "source/SourceConnection.h"
#include "workdb/RowWriter.h"
#include "workdb/SourceRowCount.h"
#include "workdb/WorkDatabase.h"

#include <QSqlError>
#include <QSqlRecord>

namespace zorbin {
namespace {

QString describeSourceError(const QSqlError &error)
{
    const QString text = error.text().trimmed();
    return text.isEmpty() ? QStringLiteral("שגיאה לא ידועה בקריאה מבסיס הנתונים של הנהלת החשבונות.") : text;
}

// A refusal of the row's values names the row, so that the user knows which item to mend.
QString describeRefusal(const WriteOutcome &refused, const CopyPlan &plan, const QVariant &key)
{
    if (refused.refusal() != Refusal::TooLong && refused.refusal() != Refusal::WrongKind)
        return refused.description();
    const QString row = plan.itemLoop ? QStringLiteral("פריט %1") : QStringLiteral("קוד מיון %1");
    return row.arg(key.toString()) + QStringLiteral(": ") + refused.description();
}

// The source columns of the plan by their position in the result; a fault names a missing one.
Result<std::vector<int>> sourcePositions(const QSqlRecord &record, const CopyPlan &plan)
{
    std::vector<int> positions;
    for (const CopiedColumn &column : plan.columns) {
        int position = -1;
        if (!column.source.isEmpty()) {
            position = record.indexOf(column.source); // letter case aside, as the servers differ in it
            if (position < 0)
                return Status::fault(
                    QStringLiteral("בתוצאת השאילתה על בסיס הנתונים של הנהלת החשבונות חסר השדה %1.")
                        .arg(column.source));
        }
        positions.push_back(position);
    }
    return positions;
}

QStringList targetColumns(const CopyPlan &plan)
{
    QStringList names;
    for (const CopiedColumn &column : plan.columns)
        names << column.target;
    return names;
}

} // namespace

void reportCollectFault(RunContext &context, const QString &description)
{
    context.user.tell(description, FaultTitle, MessageIcon::Information);
    context.state.CollectFailed = true;
}

void runCopyLoop(RunContext &context, const QString &pDBFile, const CopyPlan &plan)
{
    Result<std::unique_ptr<SourceConnection>> source =
        SourceConnection::open(BuildConnString(context.connection));
    if (!source)
        return reportCollectFault(context, source.status().description());
    const std::int64_t total = plan.itemLoop ? countSourceRows(*source.value(), plan.statement) : 0;
    Result<QSqlQuery> rows = source.value()->select(plan.statement);
    if (!rows)
        return reportCollectFault(context, rows.status().description());
    if (!rows->next()) {
        if (rows->lastError().isValid())
            reportCollectFault(context, describeSourceError(rows->lastError()));
        return; // no rows: the working database is not opened
    }

    ProgressMeter meter(context.user, context.state);
    if (plan.itemLoop)
        meter.reset();
    const QSqlRecord record = rows->record();
    const int keyPosition = plan.itemLoop ? record.indexOf(QStringLiteral("ItemKey")) : -1;
    Result<std::vector<int>> positions = sourcePositions(record, plan);
    if (!positions)
        return reportCollectFault(context, positions.status().description());
    if (plan.itemLoop && keyPosition < 0)
        return reportCollectFault(
            context, QStringLiteral("בתוצאת השאילתה על בסיס הנתונים של הנהלת החשבונות חסר השדה ItemKey."));

    Result<std::unique_ptr<WorkDatabase>> work = WorkDatabase::open(pDBFile);
    if (!work)
        return reportCollectFault(context, work.status().description());
    WorkDatabase &target = *work.value();
    if (Status begun = target.begin(); !begun)
        return reportCollectFault(context, begun.description());
    RowWriter writer(target, plan.table, targetColumns(plan));
    if (!writer.prepareError().isEmpty())
        return reportCollectFault(context, writer.prepareError());

    std::vector<QVariant> values(plan.columns.size());
    std::int64_t counter = 0;
    bool stopped = false;
    do {
        const QString key = plan.itemLoop ? rows->value(keyPosition).toString() : QString();
        if (!plan.itemLoop || !key.isEmpty()) {
            for (std::size_t i = 0; i < plan.columns.size(); ++i) {
                const CopiedColumn &column = plan.columns[i];
                const int position = positions.value()[i];
                const QVariant read = position >= 0 ? rows->value(position) : QVariant();
                values[i] = column.convert ? column.convert(read, key) : read;
            }
            if (const WriteOutcome written = writer.write(values); !written && !written.isDuplicateKey()) {
                (void)target.commit();
                return reportCollectFault(context, describeRefusal(written, plan, values.front()));
            }
        }
        if (plan.itemLoop && meter.tick(++counter, total)) {
            stopped = true;
            break;
        }
    } while (rows->next());

    if (Status committed = target.commit(); !committed)
        return reportCollectFault(context, committed.description());
    if (!stopped && rows->lastError().isValid())
        return reportCollectFault(context, describeSourceError(rows->lastError()));
    if (plan.itemLoop)
        meter.reset();
}

} // namespace zorbin
