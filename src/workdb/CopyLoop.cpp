#include "workdb/CopyLoop.h"

#include "model/ConnectionParams.h"
#include "model/ProgressMeter.h"
#include "model/RunContext.h"
#include "model/RunState.h"
#include "model/UserPort.h"
#include "source/ConnectionString.h"
#include "workdb/RowWriter.h"
#include "workdb/SourceReadAhead.h"
#include "workdb/WorkDatabase.h"

#include <algorithm>

namespace zorbin {
namespace {

// A refusal of the row's values names the row, so that the user knows which item to mend.
QString describeRefusal(const WriteOutcome &refused, const CopyPlan &plan, const WorkValue &key)
{
    if (refused.refusal() != Refusal::TooLong && refused.refusal() != Refusal::WrongKind)
        return refused.description();
    const QString row = plan.itemLoop ? QStringLiteral("פריט %1") : QStringLiteral("קוד מיון %1");
    return row.arg(key.toText()) + QStringLiteral(": ") + refused.description();
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

// Makes a target row from a source row on the reading thread. In the item loop a row whose key
// reads as the empty text is passed over: it is marked by a Null first value (ItemKey).
// `encode`: whether the texts are encoded here or when they are written (WorkValue::from).
SourceReadAhead::Shaper shaperFor(const CopyPlan &plan, const SourceColumns &columns, bool encode)
{
    return [&plan, &columns, encode](std::span<const QVariant> read, std::span<WorkValue> row) {
        const QString key = plan.itemLoop ? read[0].toString() : QString();
        if (plan.itemLoop && key.isEmpty())
            return;
        static const QVariant none;
        for (std::size_t i = 0; i < plan.columns.size(); ++i) {
            const CopiedColumn &column = plan.columns[i];
            if (column.readsSettings)
                continue;
            const int position = columns.positions[i];
            const QVariant &value = position >= 0 ? read[static_cast<std::size_t>(position)] : none;
            row[i] = WorkValue::from(column.convert ? column.convert(value, key) : value, encode);
        }
    };
}

// The columns whose conversion reads the settings, made on the step's thread.
void completeOnStepThread(const CopyPlan &plan, std::span<WorkValue> row)
{
    const QString key = row[0].toText();
    for (std::size_t i = 0; i < plan.columns.size(); ++i) {
        if (plan.columns[i].readsSettings)
            row[i] = WorkValue::from(plan.columns[i].convert(QVariant(), key));
    }
}

QStringList targetColumns(const CopyPlan &plan)
{
    QStringList names;
    for (const CopiedColumn &column : plan.columns)
        names << column.target;
    return names;
}

} // namespace

Status runCopyLoop(RunContext &context, const QString &pDBFile, const CopyPlan &plan)
{
    const SourceColumns columns = sourceColumns(plan);
    // Encoding the texts is the costly part of shaping a row. A database file is read faster
    // than the working database is written, so the reading thread has time for it; an ODBC
    // driver reads slower, and there the step's thread encodes while it writes.
    const bool encodeWhileReading = context.connection.kind == ConnectionKind::File;
    const SourceReadAhead::Shaper shaper = shaperFor(plan, columns, encodeWhileReading);
    SourceReadAhead source(BuildConnString(context.connection), plan.statement, columns.names, plan.itemLoop,
                           plan.columns.size(), shaper);
    if (Status running = source.waitUntilRunning(); !running)
        return running;
    if (!source.next()) {
        return source.readFailure(); // no rows: the working database is not opened
    }

    ProgressMeter meter(context.user, context.state);
    const std::int64_t total = source.total();
    if (plan.itemLoop)
        meter.reset();
    Result<std::unique_ptr<WorkDatabase>> work = WorkDatabase::open(pDBFile);
    if (!work)
        return work.status();
    WorkDatabase &target = *work.value();
    // One transaction for the step, committed however the step ends: what was written stays.
    if (Status begun = target.begin(); !begun)
        return begun;
    RowWriter writer(target, plan.table, targetColumns(plan));
    if (!writer.prepareError().isEmpty())
        return Status::fault(writer.prepareError());

    const bool readsSettings = std::any_of(plan.columns.begin(), plan.columns.end(),
                                           [](const CopiedColumn &c) { return c.readsSettings; });
    static_assert(RowWriter::MaxRowsAtOnce >= ProgressMeter::Cadence);
    // Rows are written a few at a time, always before the next progress point, so that a stop
    // or a refusal leaves the working database as writing them one by one would. The rows stay
    // where the reader put them until they are written.
    std::vector<RowWriter::Row> pending;
    pending.reserve(RowWriter::MaxRowsAtOnce);
    auto writePending = [&]() -> Status {
        std::size_t failedRow = 0;
        const WriteOutcome written = writer.writeSkippingDuplicates(pending, &failedRow);
        if (!written)
            return Status::fault(describeRefusal(written, plan, pending[failedRow][0]));
        pending.clear();
        return Status::ok();
    };
    std::int64_t counter = 0;
    bool stopped = false;
    do {
        const std::span<WorkValue> row = source.row();
        if (!plan.itemLoop || !row[0].isNull()) {
            if (readsSettings)
                completeOnStepThread(plan, row);
            pending.push_back(row);
        }
        ++counter;
        if (counter % ProgressMeter::Cadence != 0)
            continue;
        if (Status written = writePending(); !written) {
            (void)target.commit();
            return written;
        }
        if (plan.itemLoop && meter.tick(counter, total)) {
            stopped = true;
            break;
        }
    } while (source.next());
    if (Status written = writePending(); !written) {
        (void)target.commit();
        return written;
    }

    if (Status committed = target.commit(); !committed)
        return committed;
    if (Status read = source.readFailure(); !stopped && !read)
        return read;
    if (plan.itemLoop)
        meter.reset();
    return Status::ok();
}

} // namespace zorbin
