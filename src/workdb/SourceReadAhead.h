#pragma once

#include "common/Status.h"
#include "workdb/WorkValue.h"

#include <QString>
#include <QStringList>
#include <QVariant>
#include <condition_variable>
#include <cstdint>
#include <deque>
#include <functional>
#include <mutex>
#include <span>
#include <thread>
#include <vector>

namespace zorbin {

// Reads one statement's rows from the accounting database on a thread of its own, ahead of the
// collection step that writes them, so that reading the source and writing the working
// database overlap on two processor cores. Each row is shaped into the values of a target row
// on the reading thread as well (see Shaper). The step still sees the rows one by one, in the
// source's order, and everything it does with them (writing, progress, stop, messages) stays
// on its own thread. The connection is opened, used and closed on the reading thread.
//
// At most a few thousand rows are held ahead; the reading thread is stopped and joined when the
// object is destroyed, whether or not every row was taken.
class SourceReadAhead
{
public:
    // Makes the `width` values of a target row from the values read, in the order of `columns`.
    // Runs on the reading thread: it must not touch anything the step's thread changes.
    using Shaper = std::function<void(std::span<const QVariant> read, std::span<WorkValue> row)>;

    // Starts reading: opens a connection from `connectionString`, counts the statement's rows
    // first when `countRows` is set (see countSourceRows), runs the statement, reads the
    // `columns` (by name, letter case aside) of every row and shapes them. The shaper must
    // outlive the object.
    SourceReadAhead(QString connectionString, QString statement, QStringList columns, bool countRows,
                    std::size_t width, const Shaper &shaper);
    ~SourceReadAhead();

    SourceReadAhead(const SourceReadAhead &) = delete;
    SourceReadAhead &operator=(const SourceReadAhead &) = delete;

    // Waits until the statement has run: a fault when the connection or the statement was
    // refused or a column is missing from its result.
    Status waitUntilRunning();
    // The number of rows counted (0 when not asked or not countable). After waitUntilRunning().
    std::int64_t total() const { return m_total; }

    // Moves to the next row; false at the end of the rows or when reading failed.
    bool next();
    // The current row, as the shaper made it; the step may change it. It stays where it is
    // until the row after next has been taken.
    std::span<WorkValue> row();
    // Why reading ended before the last row; ok when it reached the end.
    Status readFailure();

private:
    void read();
    void refuse(Status failure);
    void publish(std::vector<WorkValue> &batch, bool last, Status failure);

    const QString m_connectionString;
    const QString m_statement;
    const QStringList m_columns;
    const bool m_countRows;
    const std::size_t m_width;
    const Shaper &m_shaper;

    std::mutex m_mutex;
    std::condition_variable m_changed;
    bool m_running = false;   // the statement has run (or failed to)
    bool m_finished = false;  // no more batches will come
    bool m_cancelled = false; // the step no longer wants rows
    Status m_refusal;         // why the statement did not run
    Status m_failure;         // why reading ended early
    std::deque<std::vector<WorkValue>> m_batches;
    // Batches the step has read, handed back so that the thread that made their values frees
    // them: freeing memory of another thread's heap makes the two threads wait for each other.
    std::vector<std::vector<WorkValue>> m_spent;
    std::int64_t m_total = 0;

    std::vector<WorkValue> m_current;  // the batch the step is reading
    std::vector<WorkValue> m_previous; // the batch before it, whose rows may still be in use
    std::size_t m_position = 0;        // of the current row in m_current, in values
    bool m_started = false;

    std::thread m_thread;
};

} // namespace zorbin
