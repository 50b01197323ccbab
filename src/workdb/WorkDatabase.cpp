#include "workdb/WorkDatabase.h"

#include "common/ConnectionName.h"
#include "workdb/BooleanLiterals.h"
#include "workdb/HebrewCollation.h"

#include <QDir>
#include <QFileInfo>
#include <QSqlDriver>
#include <QSqlError>
#include <sqlite3.h>

namespace zorbin {
namespace {

QString describe(const QSqlError &error)
{
    const QString text =
        error.databaseText().trimmed().isEmpty() ? error.text().trimmed() : error.databaseText().trimmed();
    return text.isEmpty() ? QStringLiteral("שגיאה לא ידועה בבסיס הנתונים הזמני.") : text;
}

sqlite3 *sqliteHandle(const QSqlDatabase &db)
{
    const QVariant handle = db.driver()->handle();
    if (!handle.isValid() || qstrcmp(handle.typeName(), "sqlite3*") != 0)
        return nullptr;
    return *static_cast<sqlite3 *const *>(handle.constData());
}

} // namespace

WorkDatabase::WorkDatabase(QString connectionName, QString path)
    : m_connectionName(std::move(connectionName)), m_path(std::move(path))
{}

Result<std::unique_ptr<WorkDatabase>> WorkDatabase::open(const QString &path)
{
    if (path.isEmpty())
        return Status::fault(
            QStringLiteral("בסיס הנתונים הזמני עדיין לא נוצר: יש לאסוף את נתוני הפריטים תחילה."));
    if (!QFileInfo(path).isFile())
        return Status::fault(
            QStringLiteral("בסיס הנתונים הזמני %1 לא נמצא.").arg(QDir::toNativeSeparators(path)));
    return connect(path);
}

// Opens (and, for a path that does not exist yet, creates) the file and registers the collation.
Result<std::unique_ptr<WorkDatabase>> WorkDatabase::connect(const QString &path)
{
    std::unique_ptr<WorkDatabase> work(new WorkDatabase(uniqueConnectionName(QStringLiteral("work")), path));
    QSqlDatabase db = QSqlDatabase::addDatabase(QStringLiteral("QSQLITE"), work->m_connectionName);
    db.setDatabaseName(path);
    if (!db.open())
        return Status::fault(QStringLiteral("לא ניתן לפתוח את בסיס הנתונים הזמני %1: %2")
                                 .arg(QDir::toNativeSeparators(path), describe(db.lastError())));
    work->m_handle = sqliteHandle(db);
    QString error = QStringLiteral("the SQLite driver gives no handle");
    if (!work->m_handle || !registerHebrewCollation(work->m_handle, &error))
        return Status::fault(
            QStringLiteral("לא ניתן להגדיר את סדר המיון העברי בבסיס הנתונים הזמני: %1").arg(error));
    return work;
}

WorkDatabase::~WorkDatabase()
{
    if (m_inTransaction)
        (void)commit();
    {
        QSqlDatabase db = QSqlDatabase::database(m_connectionName, false);
        db.close();
    }
    QSqlDatabase::removeDatabase(m_connectionName);
}

QSqlDatabase WorkDatabase::database() const
{
    return QSqlDatabase::database(m_connectionName, false);
}

Result<QSqlQuery> WorkDatabase::select(const QString &sql, bool forwardOnly)
{
    QSqlQuery query(database());
    query.setForwardOnly(forwardOnly);
    if (!query.exec(translateBooleanLiterals(sql)))
        return Status::fault(describe(query.lastError()));
    return query;
}

WriteOutcome WorkDatabase::exec(const QString &sql)
{
    QSqlQuery query(database());
    if (query.exec(translateBooleanLiterals(sql)))
        return {};
    const QSqlError error = query.lastError();
    return WriteOutcome::fromEngine(error.nativeErrorCode().toInt(), describe(error));
}

Status WorkDatabase::begin()
{
    if (m_inTransaction)
        return Status::ok();
    if (sqlite3_exec(m_handle, "BEGIN", nullptr, nullptr, nullptr) != SQLITE_OK)
        return Status::fault(QString::fromUtf8(sqlite3_errmsg(m_handle)));
    m_inTransaction = true;
    return Status::ok();
}

Status WorkDatabase::commit()
{
    if (!m_inTransaction)
        return Status::ok();
    m_inTransaction = false;
    if (sqlite3_exec(m_handle, "COMMIT", nullptr, nullptr, nullptr) == SQLITE_OK)
        return Status::ok();
    const Status failure = Status::fault(QString::fromUtf8(sqlite3_errmsg(m_handle)));
    if (!sqlite3_get_autocommit(m_handle))
        m_inTransaction = true; // still open: a later commit may succeed
    return failure;
}

} // namespace zorbin
