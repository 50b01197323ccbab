#include "workdb/SourceReadAhead.h"

#include "source/SourceConnection.h"
#include "workdb/SourceRowCount.h"

#include <QSqlError>
#include <QSqlRecord>

namespace zorbin {
namespace {

constexpr std::size_t RowsPerBatch = 256;
constexpr std::size_t BatchesAhead = 16;

QString describeReadError(const QSqlError &error)
{
    const QString text = error.text().trimmed();
    return text.isEmpty() ? QStringLiteral("שגיאה לא ידועה בקריאה מבסיס הנתונים של הנהלת החשבונות.") : text;
}

} // namespace

SourceReadAhead::SourceReadAhead(QString connectionString, QString statement, QStringList columns,
                                 bool countRows, std::size_t width, const Shaper &shaper)
    : m_connectionString(std::move(connectionString)), m_statement(std::move(statement)),
      m_columns(std::move(columns)), m_countRows(countRows), m_width(width), m_shaper(shaper)
{
    m_thread = std::thread([this] { read(); });
}

SourceReadAhead::~SourceReadAhead()
{
    {
        std::lock_guard lock(m_mutex);
        m_cancelled = true;
    }
    m_changed.notify_all();
    m_thread.join();
}

// The reading thread. The connection and its query live and die here.
void SourceReadAhead::read()
{
    std::vector<WorkValue> batch;
    Result<std::unique_ptr<SourceConnection>> source = SourceConnection::open(m_connectionString);
    if (!source)
        return refuse(source.status());
    const std::int64_t total = m_countRows ? countSourceRows(*source.value(), m_statement) : 0;
    Result<QSqlQuery> rows = source.value()->select(m_statement);
    if (!rows)
        return refuse(rows.status());
    std::vector<int> positions;
    const QSqlRecord record = rows->record();
    for (const QString &column : m_columns) {
        positions.push_back(record.indexOf(column));
        if (positions.back() < 0)
            return refuse(Status::fault(
                QStringLiteral("בתוצאת השאילתה על בסיס הנתונים של הנהלת החשבונות חסר השדה %1.").arg(column)));
    }
    {
        std::lock_guard lock(m_mutex);
        m_total = total;
        m_running = true;
    }
    m_changed.notify_all();

    batch.reserve(RowsPerBatch * m_width);
    std::vector<QVariant> read(positions.size());
    while (rows->next()) {
        for (std::size_t i = 0; i < positions.size(); ++i)
            read[i] = rows->value(positions[i]);
        batch.resize(batch.size() + m_width);
        m_shaper(read, std::span<WorkValue>(batch).last(m_width));
        if (batch.size() < RowsPerBatch * m_width)
            continue;
        publish(batch, false, Status::ok());
        std::lock_guard lock(m_mutex);
        if (m_cancelled)
            return;
    }
    const QSqlError error = rows->lastError();
    publish(batch, true, error.isValid() ? Status::fault(describeReadError(error)) : Status::ok());
}

// The statement did not run: the connection, the statement or a column was refused.
void SourceReadAhead::refuse(Status failure)
{
    {
        std::lock_guard lock(m_mutex);
        m_refusal = std::move(failure);
        m_running = true;
        m_finished = true;
    }
    m_changed.notify_all();
}

// Hands a batch to the step (waiting while enough are ahead), and with `last` the end.
void SourceReadAhead::publish(std::vector<WorkValue> &batch, bool last, Status failure)
{
    std::unique_lock lock(m_mutex);
    m_changed.wait(lock, [this] { return m_cancelled || m_batches.size() < BatchesAhead; });
    if (!batch.empty() && !m_cancelled)
        m_batches.push_back(std::move(batch));
    std::vector<std::vector<WorkValue>> spent;
    spent.swap(m_spent);
    if (last) {
        m_finished = true;
        m_failure = std::move(failure);
    }
    lock.unlock();
    m_changed.notify_all();
    // The spent batches' values are freed here; one of them is filled anew.
    batch = spent.empty() ? std::vector<WorkValue>() : std::move(spent.back());
    batch.clear();
    batch.reserve(RowsPerBatch * m_width);
}

Status SourceReadAhead::waitUntilRunning()
{
    std::unique_lock lock(m_mutex);
    m_changed.wait(lock, [this] { return m_running; });
    return m_refusal;
}

bool SourceReadAhead::next()
{
    if (m_started)
        m_position += m_width;
    m_started = true;
    if (m_position < m_current.size())
        return true;
    std::unique_lock lock(m_mutex);
    m_changed.wait(lock, [this] { return !m_batches.empty() || m_finished; });
    if (m_batches.empty())
        return false;
    if (!m_previous.empty())
        m_spent.push_back(std::move(m_previous));
    m_previous = std::move(m_current);
    m_current = std::move(m_batches.front());
    m_batches.pop_front();
    m_position = 0;
    lock.unlock();
    m_changed.notify_all();
    return true;
}

std::span<WorkValue> SourceReadAhead::row()
{
    return std::span<WorkValue>(m_current).subspan(m_position, m_width);
}

Status SourceReadAhead::readFailure()
{
    std::lock_guard lock(m_mutex);
    return m_failure;
}

} // namespace zorbin
