#include "source/SourceConnection.h"

#include "common/ConnectionName.h"
#include "source/ConnectionString.h"
#include "source/DatabaseFile.h"
#include "source/OdbcTableReader.h"
#include "source/SourceFaults.h"

#include <QSqlError>

namespace zorbin {
namespace {

bool isJetProvider(const QString &provider)
{
    return provider.startsWith(QLatin1String("Microsoft.Jet"), Qt::CaseInsensitive) ||
           provider.startsWith(QLatin1String("Microsoft.ACE"), Qt::CaseInsensitive);
}

bool isSqlServerProvider(const QString &provider)
{
    for (const char *name : {"sqloledb", "sqlncli", "msoledbsql"}) {
        if (provider.startsWith(QLatin1String(name), Qt::CaseInsensitive))
            return true;
    }
    return false;
}

// Whether a line comment ends at `c`. Any line break counts, even where a server reads on:
// ending too early only makes the guard below stricter, never blind.
bool endsLineComment(QChar c)
{
    return c == QLatin1Char('\n') || c == QLatin1Char('\r') || c == QLatin1Char('\v') ||
           c == QLatin1Char('\f') || c == QChar(0x85) || c == QChar(QChar::LineSeparator) ||
           c == QChar(QChar::ParagraphSeparator);
}

// One SELECT statement: it starts with SELECT, and no ";" outside a quoted text, a quoted name
// or a "--" comment is followed by anything but blanks. A second statement could change the
// accounting data. A quote mark inside a comment quotes nothing. A block comment is refused:
// servers do not agree on whether one nests, so where it ends cannot be known here.
bool isSingleSelect(const QString &sql)
{
    const QString text = sql.trimmed();
    if (!text.startsWith(QLatin1String("SELECT"), Qt::CaseInsensitive))
        return false;
    QChar closing;            // the mark that ends the quoted text or name we are in, or none
    bool lineComment = false; // inside a "--" comment
    for (qsizetype i = 0; i < text.size(); ++i) {
        const QChar c = text.at(i);
        if (lineComment) {
            lineComment = !endsLineComment(c);
        } else if (!closing.isNull()) {
            if (c == closing)
                closing = QChar(); // a doubled mark closes and reopens: the same result
        } else if (c == QLatin1Char('\'') || c == QLatin1Char('"')) {
            closing = c;
        } else if (c == QLatin1Char('[')) {
            closing = QLatin1Char(']');
        } else if (text.mid(i, 2) == QLatin1String("--")) {
            lineComment = true;
            ++i;
        } else if (text.mid(i, 2) == QLatin1String("/*")) {
            return false;
        } else if (c == QLatin1Char(';') && !text.mid(i + 1).trimmed().isEmpty()) {
            return false;
        }
    }
    return true;
}

} // namespace

Result<std::unique_ptr<SourceConnection>> SourceConnection::open(const QString &connectionString)
{
    if (connectionString.isEmpty())
        return Status::fault(noConnectionTypeFault());

    std::unique_ptr<SourceConnection> connection(
        new SourceConnection(uniqueConnectionName(QStringLiteral("source"))));
    Status opened;
    if (!isOleDbConnString(connectionString)) {
        opened = connection->openOdbc(connectionString);
    } else {
        const QString provider = connStringValue(connectionString, QStringLiteral("Provider"));
        if (isJetProvider(provider))
            opened = connection->openFile(connStringValue(connectionString, QStringLiteral("Data Source")));
        else if (isSqlServerProvider(provider))
            opened = connection->openOdbc(odbcConnStringForOleDb(connectionString));
        else
            opened = Status::fault(unknownProviderFault(provider));
    }
    if (!opened)
        return opened;
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

Status SourceConnection::openOdbc(const QString &odbcConnectionString)
{
    QSqlDatabase db = QSqlDatabase::addDatabase(QStringLiteral("QODBC"), m_connectionName);
    db.setDatabaseName(odbcConnectionString);
    db.setConnectOptions(QStringLiteral("SQL_ATTR_LOGIN_TIMEOUT=%1;SQL_ATTR_ACCESS_MODE=SQL_MODE_READ_ONLY")
                             .arg(LoginTimeoutSeconds));
    if (db.open())
        return Status::ok();
    return Status::fault(odbcOpenFault(sqlErrorText(db.lastError()), odbcConnectionString));
}

Status SourceConnection::openFile(const QString &path)
{
    m_filePath = path;
    switch (databaseFileKind(path)) {
    case DatabaseFileKind::Missing:
        return Status::fault(missingFileFault(path));
    case DatabaseFileKind::Other:
        return Status::fault(unknownFileFault(path));
    case DatabaseFileKind::Jet:
        return openJetFile(path);
    case DatabaseFileKind::Sqlite:
        break;
    }
    QSqlDatabase db = QSqlDatabase::addDatabase(QStringLiteral("QSQLITE"), m_connectionName);
    db.setDatabaseName(path);
    db.setConnectOptions(QStringLiteral("QSQLITE_OPEN_READONLY"));
    if (db.open())
        return Status::ok();
    return Status::fault(sqlErrorText(db.lastError()));
}

Result<QSqlQuery> SourceConnection::select(const QString &sql)
{
    if (!isSingleSelect(sql))
        return Status::fault(notSelectFault());
    for (;;) {
        QSqlQuery query(database());
        query.setForwardOnly(true);
        if (query.exec(sql))
            return query;
        // A Jet file's tables are copied when a statement first names them.
        const QString missing = m_jetFile ? missingTableOf(query.lastError()) : QString();
        if (missing.isEmpty() || m_copiedTables.contains(missing.toLower()))
            return Status::fault(sqlErrorText(query.lastError()));
        if (Status copied = copyJetTable(missing); !copied)
            return copied;
    }
}

} // namespace zorbin
