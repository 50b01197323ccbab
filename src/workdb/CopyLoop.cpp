#include "workdb/CopyLoop.h"

#include "control/ProgressMeter.h"
#include "control/RunContext.h"
#include "control/RunState.h"
#include "control/UserPort.h"
#include "source/ConnectionString.h"
#include "workdb/RowWriter.h"
#include "workdb/SourceReadAhead.h"
#include "workdb/WorkDatabase.h"

namespace zorbin {
namespace {

// A refusal of the row's values names the row, so that the user knows which item to mend.
QString describeRefusal(const WriteOutcome &refused, const CopyPlan &plan, const QVariant &key)
{
    if (refused.refusal() != Refusal::TooLong && refused.refusal() != Refusal::WrongKind)
        return refused.description();
    const QString row = plan.itemLoop ? QStringLiteral("פריט %1") : QStringLiteral("קוד מיון %1");
    return row.arg(key.toString()) + QStringLiteral(": ") + refused.description();
}

// The source columns the plan reads, ItemKey first in the item loop, and for each target
// column the position of its source among them (-1 for none).
struct SourceColumns
{
    QStringList names;
    std::vector<int> positions;
};

SourceColumns sourceColumns(const CopyPlan &plan)
{
    SourceColumns columns;
    if (plan.itemLoop)
        columns.names << QStringLiteral("ItemKey");
    for (const CopiedColumn &column : plan.columns) {
        if (column.source.isEmpty()) {
            columns.positions.push_back(-1);
        } else {
            columns.positions.push_back(static_cast<int>(columns.names.size()));
            columns.names << column.source;
        }
    }
    return columns;
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
    const SourceColumns columns = sourceColumns(plan);
    SourceReadAhead source(BuildConnString(context.connection), plan.statement, columns.names, plan.itemLoop);
    if (Status running = source.waitUntilRunning(); !running)
        return reportCollectFault(context, running.description());
    if (!source.next()) {
        if (Status read = source.readFailure(); !read)
            reportCollectFault(context, read.description());
        return; // no rows: the working database is not opened
    }

    ProgressMeter meter(context.user, context.state);
    const std::int64_t total = source.total();
    if (plan.itemLoop)
        meter.reset();
    Result<std::unique_ptr<WorkDatabase>> work = WorkDatabase::open(pDBFile);
    if (!work)
        return reportCollectFault(context, work.status().description());
    WorkDatabase &target = *work.value();
    // One transaction for the step, committed however the step ends: what was written stays.
    if (Status begun = target.begin(); !begun)
        return reportCollectFault(context, begun.description());
    RowWriter writer(target, plan.table, targetColumns(plan));
    if (!writer.prepareError().isEmpty())
        return reportCollectFault(context, writer.prepareError());

    std::vector<QVariant> values(plan.columns.size());
    const QVariant none;
    std::int64_t counter = 0;
    bool stopped = false;
    do {
        const std::span<const QVariant> read = source.row();
        const QString key = plan.itemLoop ? read[0].toString() : QString();
        if (!plan.itemLoop || !key.isEmpty()) {
            for (std::size_t i = 0; i < plan.columns.size(); ++i) {
                const int position = columns.positions[i];
                const QVariant &value = position >= 0 ? read[static_cast<std::size_t>(position)] : none;
                values[i] = plan.columns[i].convert ? plan.columns[i].convert(value, key) : value;
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
    } while (source.next());

    if (Status committed = target.commit(); !committed)
        return reportCollectFault(context, committed.description());
    if (Status read = source.readFailure(); !stopped && !read)
        return reportCollectFault(context, read.description());
    if (plan.itemLoop)
        meter.reset();
}

} // namespace zorbin
