#include "workdb/RowWriter.h"

#include "workdb/WorkDatabase.h"
#include "workdb/WorkSchema.h"

#include <limits>
#include <sqlite3.h>

namespace zorbin {
namespace {

// Binds one value; a text is bound as UTF-8 from `text`, which must live until the step.
int bindValue(sqlite3_stmt *statement, int position, const QVariant &value, QByteArray &text)
{
    if (value.isNull())
        return sqlite3_bind_null(statement, position);
    switch (value.typeId()) {
    case QMetaType::Bool:
        return sqlite3_bind_int(statement, position, value.toBool() ? WorkTrue : WorkFalse);
    case QMetaType::Int:
    case QMetaType::Short:
    case QMetaType::Char:
    case QMetaType::SChar:
    case QMetaType::UChar:
    case QMetaType::UShort:
    case QMetaType::UInt:
    case QMetaType::Long:
    case QMetaType::LongLong:
        return sqlite3_bind_int64(statement, position, value.toLongLong());
    case QMetaType::ULong:
    case QMetaType::ULongLong:
        if (value.toULongLong() <= static_cast<qulonglong>(std::numeric_limits<sqlite3_int64>::max()))
            return sqlite3_bind_int64(statement, position, value.toLongLong());
        return sqlite3_bind_double(statement, position, value.toDouble());
    case QMetaType::Double:
    case QMetaType::Float:
        return sqlite3_bind_double(statement, position, value.toDouble());
    case QMetaType::QString:
        text = static_cast<const QString *>(value.constData())->toUtf8();
        break;
    default:
        text = value.toString().toUtf8();
        break;
    }
    // SQLite keeps text as UTF-8: converting here, in one pass, is cheaper than letting it convert.
    return sqlite3_bind_text(statement, position, text.constData(), static_cast<int>(text.size()),
                             SQLITE_STATIC);
}

} // namespace

RowWriter::RowWriter(WorkDatabase &database, const QString &table, const QStringList &columns)
    : m_handle(database.handle()), m_columnCount(static_cast<int>(columns.size())),
      m_texts(static_cast<std::size_t>(m_columnCount))
{
    QStringList marks;
    for (int i = 0; i < m_columnCount; ++i)
        marks << QStringLiteral("?");
    const QByteArray sql =
        QStringLiteral("INSERT INTO %1 (%2) VALUES (%3)")
            .arg(table, columns.join(QStringLiteral(", ")), marks.join(QStringLiteral(", ")))
            .toUtf8();
    if (sqlite3_prepare_v3(m_handle, sql.constData(), static_cast<int>(sql.size()), SQLITE_PREPARE_PERSISTENT,
                           &m_statement, nullptr) != SQLITE_OK) {
        m_prepareError = QString::fromUtf8(sqlite3_errmsg(m_handle));
        m_statement = nullptr;
    }
}

RowWriter::~RowWriter()
{
    sqlite3_finalize(m_statement);
}

WriteOutcome RowWriter::write(std::span<const QVariant> values)
{
    if (!m_statement)
        return WriteOutcome::refused(Refusal::Other, m_prepareError);
    Q_ASSERT(values.size() == static_cast<std::size_t>(m_columnCount));
    for (int i = 0; i < m_columnCount; ++i) {
        const auto at = static_cast<std::size_t>(i);
        if (bindValue(m_statement, i + 1, values[at], m_texts[at]) != SQLITE_OK)
            return WriteOutcome::fromEngine(sqlite3_extended_errcode(m_handle),
                                            QString::fromUtf8(sqlite3_errmsg(m_handle)));
    }
    const int rc = sqlite3_step(m_statement);
    WriteOutcome outcome;
    if (rc != SQLITE_DONE)
        outcome = WriteOutcome::fromEngine(sqlite3_extended_errcode(m_handle),
                                           QString::fromUtf8(sqlite3_errmsg(m_handle)));
    sqlite3_reset(m_statement);
    sqlite3_clear_bindings(m_statement); // before the texts they point into change
    return outcome;
}

} // namespace zorbin
