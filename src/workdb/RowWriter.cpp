#include "workdb/RowWriter.h"

#include "workdb/WorkDatabase.h"

#include <sqlite3.h>

namespace zorbin {
namespace {

// Binds one value. A UTF-8 text is bound where it is, so it must stay unchanged until the
// step; a UTF-16 text is encoded into `encoded`, which must live as long.
int bindValue(sqlite3_stmt *statement, int position, const WorkValue &value, QByteArray &encoded)
{
    const QByteArray *text = std::get_if<QByteArray>(&value.value);
    if (const auto *unencoded = std::get_if<QString>(&value.value)) {
        encoded = unencoded->toUtf8();
        text = &encoded;
    }
    if (text) {
        // A QByteArray ends in a zero byte. Saying so (a length of -1) spares the engine a copy
        // of the text when the length checks of the table read it; a text with a zero byte of
        // its own is bound with its length, to be stored whole.
        const int length = static_cast<int>(text->size());
        const bool terminated = qstrlen(text->constData()) == static_cast<uint>(length);
        return sqlite3_bind_text(statement, position, text->constData(), terminated ? -1 : length,
                                 SQLITE_STATIC);
    }
    if (const auto *whole = std::get_if<std::int64_t>(&value.value))
        return sqlite3_bind_int64(statement, position, *whole);
    if (const auto *real = std::get_if<double>(&value.value))
        return sqlite3_bind_double(statement, position, *real);
    return sqlite3_bind_null(statement, position);
}

} // namespace

RowWriter::RowWriter(WorkDatabase &database, const QString &table, const QStringList &columns)
    : m_handle(database.handle()), m_table(table), m_columns(columns),
      m_columnCount(static_cast<int>(columns.size()))
{
    statementFor(1);
}

RowWriter::~RowWriter()
{
    for (sqlite3_stmt *statement : m_statements)
        sqlite3_finalize(statement);
}

sqlite3_stmt *RowWriter::statementFor(std::size_t rows)
{
    sqlite3_stmt *&statement = m_statements[rows - 1];
    if (statement || !m_prepareError.isEmpty())
        return statement;
    QStringList marks;
    for (int i = 0; i < m_columnCount; ++i)
        marks << QStringLiteral("?");
    const QString row = QStringLiteral("(%1)").arg(marks.join(QStringLiteral(", ")));
    QStringList values;
    for (std::size_t i = 0; i < rows; ++i)
        values << row;
    const QByteArray sql =
        QStringLiteral("INSERT INTO %1 (%2) VALUES %3")
            .arg(m_table, m_columns.join(QStringLiteral(", ")), values.join(QStringLiteral(", ")))
            .toUtf8();
    if (sqlite3_prepare_v3(m_handle, sql.constData(), static_cast<int>(sql.size()), SQLITE_PREPARE_PERSISTENT,
                           &statement, nullptr) != SQLITE_OK) {
        m_prepareError = QString::fromUtf8(sqlite3_errmsg(m_handle));
        statement = nullptr;
    }
    return statement;
}

WriteOutcome RowWriter::step(sqlite3_stmt *statement, std::span<const Row> rows)
{
    if (!statement)
        return WriteOutcome::refused(Refusal::Other, m_prepareError);
    int position = 0;
    m_encoded.resize(rows.size() * static_cast<std::size_t>(m_columnCount));
    for (const Row &row : rows) {
        Q_ASSERT(row.size() == static_cast<std::size_t>(m_columnCount));
        for (const WorkValue &value : row) {
            if (bindValue(statement, position + 1, value, m_encoded[static_cast<std::size_t>(position)]) !=
                SQLITE_OK)
                return WriteOutcome::fromEngine(sqlite3_extended_errcode(m_handle),
                                                QString::fromUtf8(sqlite3_errmsg(m_handle)));
            ++position;
        }
    }
    const int rc = sqlite3_step(statement);
    WriteOutcome outcome;
    if (rc != SQLITE_DONE)
        outcome = WriteOutcome::fromEngine(sqlite3_extended_errcode(m_handle),
                                           QString::fromUtf8(sqlite3_errmsg(m_handle)));
    // The texts stay bound until the next rows bind their own; a statement is never stepped
    // without them.
    sqlite3_reset(statement);
    return outcome;
}

WriteOutcome RowWriter::write(std::span<const QVariant> values)
{
    m_converted.clear();
    for (const QVariant &value : values)
        m_converted.push_back(WorkValue::from(value));
    return write(std::span<const WorkValue>(m_converted));
}

WriteOutcome RowWriter::write(std::span<const WorkValue> values)
{
    const Row row = values;
    return step(statementFor(1), std::span<const Row>(&row, 1));
}

WriteOutcome RowWriter::writeSkippingDuplicates(std::span<const Row> rows, std::size_t *failedRow)
{
    Q_ASSERT(rows.size() <= MaxRowsAtOnce);
    if (rows.empty())
        return {};
    if (rows.size() > 1 && step(statementFor(rows.size()), rows))
        return {};
    for (std::size_t row = 0; row < rows.size(); ++row) {
        const WriteOutcome written = step(statementFor(1), rows.subspan(row, 1));
        if (!written && !written.isDuplicateKey()) {
            if (failedRow)
                *failedRow = row;
            return written;
        }
    }
    return {};
}

} // namespace zorbin
