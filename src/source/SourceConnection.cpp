#include "source/SourceConnection.h"

#include <QAtomicInteger>
#include <QFile>
#include <QSqlError>

namespace zorbin {
namespace {

QString nextConnectionName()
{
    static QAtomicInteger<quint64> counter;
    return QStringLiteral("zorbin-source-%1").arg(++counter);
}

QString describe(const QSqlError &error)
{
    QString text = error.text().trimmed();
    return text.isEmpty() ? QStringLiteral("שגיאה לא ידועה בגישה לבסיס הנתונים.") : text;
}

// The value of one "name=value" part of a connection text, or the empty text.
QString connectionPart(const QString &connectionString, const QString &name)
{
    for (const QString &part : connectionString.split(QLatin1Char(';'))) {
        const qsizetype equals = part.indexOf(QLatin1Char('='));
        if (equals > 0 && part.left(equals).trimmed().compare(name, Qt::CaseInsensitive) == 0)
            return part.mid(equals + 1).trimmed();
    }
    return {};
}

bool isSqliteFile(const QString &path)
{
    QFile file(path);
    return file.open(QIODevice::ReadOnly) && file.read(16) == QByteArray("SQLite format 3\0", 16);
}

bool isSelectStatement(const QString &sql)
{
    return sql.trimmed().startsWith(QLatin1String("SELECT"), Qt::CaseInsensitive);
}

} // namespace

Result<std::unique_ptr<SourceConnection>> SourceConnection::open(const QString &connectionString)
{
    if (connectionString.isEmpty())
        return Status::fault(QStringLiteral("לא נבחר סוג בסיס הנתונים בהגדרות ההתחברות."));

    const QString name = nextConnectionName();
    std::unique_ptr<SourceConnection> connection(new SourceConnection(name));
    QSqlDatabase db;
    if (connectionString.startsWith(QLatin1String("Provider=Microsoft.Jet.OLEDB"), Qt::CaseInsensitive)) {
        const QString path = connectionPart(connectionString, QStringLiteral("Data Source"));
        if (!isSqliteFile(path))
            return Status::fault(QStringLiteral("הקובץ %1 אינו בסיס נתונים מוכר.").arg(path));
        db = QSqlDatabase::addDatabase(QStringLiteral("QSQLITE"), name);
        db.setDatabaseName(path);
        db.setConnectOptions(QStringLiteral("QSQLITE_OPEN_READONLY"));
    } else {
        db = QSqlDatabase::addDatabase(QStringLiteral("QODBC"), name);
        db.setDatabaseName(connectionString);
        db.setConnectOptions(QStringLiteral("SQL_ATTR_LOGIN_TIMEOUT=%1;SQL_ATTR_ACCESS_MODE=SQL_MODE_READ_ONLY")
                                 .arg(LoginTimeoutSeconds));
    }
    if (!db.open())
        return Status::fault(describe(db.lastError()));
    return connection;
}

SourceConnection::SourceConnection(QString connectionName) : m_connectionName(std::move(connectionName)) {}

SourceConnection::~SourceConnection()
{
    {
        QSqlDatabase db = QSqlDatabase::database(m_connectionName, false);
        db.close();
    }
    QSqlDatabase::removeDatabase(m_connectionName);
}

QSqlDatabase SourceConnection::database() const
{
    return QSqlDatabase::database(m_connectionName, false);
}

Result<QSqlQuery> SourceConnection::select(const QString &sql)
{
    if (!isSelectStatement(sql))
        return Status::fault(QStringLiteral("רק שאילתות SELECT נשלחות לבסיס הנתונים של הנהלת החשבונות."));
    QSqlQuery query(database());
    query.setForwardOnly(true);
    if (!query.exec(sql))
        return Status::fault(describe(query.lastError()));
    return query;
}

} // namespace zorbin
