#include "source/ConnectionString.h"

#include "platform/Paths.h"

namespace zorbin {
namespace {

const QString Masked = QStringLiteral("****");

// The data source of a database file: folder, separator, file name.
QString databaseFilePath(const QString &server, const QString &database)
{
    if (server.isEmpty())
        return database;
    return withTrailingSeparator(server) + database;
}

// Reads a value that starts at `from` (just after "="); returns the unquoted value and moves
// `from` past it, onto the ";" that ends the part or the end of the text.
QString readValue(const QString &text, qsizetype &from, bool oleDb)
{
    const qsizetype size = text.size();
    qsizetype start = from;
    if (oleDb) {
        while (start < size && text.at(start) == QLatin1Char(' '))
            ++start;
    }
    const QChar opening = start < size ? text.at(start) : QChar();
    const bool braced = !oleDb && opening == QLatin1Char('{');
    const bool quoted = oleDb && (opening == QLatin1Char('"') || opening == QLatin1Char('\''));
    if (!braced && !quoted) {
        qsizetype end = text.indexOf(QLatin1Char(';'), from);
        if (end < 0)
            end = size;
        QString value = text.mid(from, end - from);
        from = end;
        return oleDb ? value.trimmed() : value;
    }
    const QChar closing = braced ? QLatin1Char('}') : opening;
    QString value;
    qsizetype i = start + 1;
    while (i < size) {
        const QChar c = text.at(i);
        if (c == closing) {
            if (i + 1 < size && text.at(i + 1) == closing) { // a doubled closing mark stands for itself
                value += c;
                i += 2;
                continue;
            }
            ++i;
            break;
        }
        value += c;
        ++i;
    }
    // Anything between the closing mark and the next ";" is not part of the value.
    const qsizetype end = text.indexOf(QLatin1Char(';'), i);
    from = end < 0 ? size : end;
    return value;
}

} // namespace

QString odbcConnValue(const QString &value)
{
    if (!value.contains(QLatin1Char(';')) && !value.contains(QLatin1Char('{')) &&
        !value.contains(QLatin1Char('}')))
        return value;
    QString escaped = value;
    escaped.replace(QLatin1Char('}'), QStringLiteral("}}"));
    return QLatin1Char('{') + escaped + QLatin1Char('}');
}

QString oleDbConnValue(const QString &value)
{
    if (!value.contains(QLatin1Char(';')) && !value.contains(QLatin1Char('"')) &&
        !value.contains(QLatin1Char('\'')))
        return value;
    QString escaped = value;
    escaped.replace(QLatin1Char('"'), QStringLiteral("\"\""));
    return QLatin1Char('"') + escaped + QLatin1Char('"');
}

namespace {

// The SQL Server ODBC form, with `login` (";uid=U;pwd=P" or ";Trusted_Connection=yes") between
// the server and the database.
QString sqlServerOdbc(const QString &server, const QString &login, const QString &database)
{
    return QStringLiteral("driver={SQL Server};server=") + server + login + QStringLiteral(";database=") +
           database;
}

QString odbcLogin(const QString &user, const QString &password)
{
    return QStringLiteral(";uid=") + odbcConnValue(user) + QStringLiteral(";pwd=") + odbcConnValue(password);
}

} // namespace

QString BuildConnString(const QString &server, const QString &user, const QString &password,
                        const QString &database, ConnectionKind kind)
{
    switch (kind) {
    case ConnectionKind::Odbc:
        return sqlServerOdbc(server, odbcLogin(user, password), database);
    case ConnectionKind::OleDb:
        if (user.isEmpty())
            return QStringLiteral("Provider=sqloledb;Data Source=") + server +
                   QStringLiteral(";Integrated Security=SSPI") +
                   QStringLiteral(";Persist Security Info=False") + QStringLiteral(";Initial Catalog=") +
                   database;
        return QStringLiteral("Provider=sqloledb;Data Source=") + server + QStringLiteral(";User Id=") +
               oleDbConnValue(user) + QStringLiteral(";Password=") + oleDbConnValue(password) +
               QStringLiteral(";Initial Catalog=") + database;
    case ConnectionKind::File:
        return QStringLiteral("Provider=Microsoft.Jet.OLEDB.4.0;Data Source=") +
               databaseFilePath(server, database);
    case ConnectionKind::None:
        break;
    }
    return {};
}

QString BuildConnString(const ConnectionParams &params)
{
    return BuildConnString(params.server, params.user, params.password, params.database, params.kind);
}

bool isOleDbConnString(const QString &connectionString)
{
    return connectionString.trimmed().startsWith(QLatin1String("Provider="), Qt::CaseInsensitive);
}

QList<ConnectionPart> splitConnString(const QString &connectionString)
{
    const bool oleDb = isOleDbConnString(connectionString);
    QList<ConnectionPart> parts;
    qsizetype from = 0;
    const qsizetype size = connectionString.size();
    while (from < size) {
        const qsizetype equals = connectionString.indexOf(QLatin1Char('='), from);
        const qsizetype semicolon = connectionString.indexOf(QLatin1Char(';'), from);
        if (equals < 0 || (semicolon >= 0 && semicolon < equals)) { // a part without "="
            if (semicolon < 0)
                break;
            from = semicolon + 1;
            continue;
        }
        ConnectionPart part;
        part.key = connectionString.mid(from, equals - from).trimmed();
        qsizetype valueEnd = equals + 1;
        part.value = readValue(connectionString, valueEnd, oleDb);
        part.valueStart = equals + 1;
        part.valueLength = valueEnd - part.valueStart;
        parts << part;
        from = valueEnd + 1;
    }
    return parts;
}

QString odbcConnStringForOleDb(const QString &oleDb)
{
    const QString security = connStringValue(oleDb, QStringLiteral("Integrated Security"));
    const bool integrated = security.compare(QLatin1String("SSPI"), Qt::CaseInsensitive) == 0 ||
                            security.compare(QLatin1String("true"), Qt::CaseInsensitive) == 0 ||
                            security.compare(QLatin1String("yes"), Qt::CaseInsensitive) == 0;
    const QString login = integrated ? QStringLiteral(";Trusted_Connection=yes")
                                     : odbcLogin(connStringValue(oleDb, QStringLiteral("User Id")),
                                                 connStringValue(oleDb, QStringLiteral("Password")));
    return sqlServerOdbc(connStringValue(oleDb, QStringLiteral("Data Source")), login,
                         connStringValue(oleDb, QStringLiteral("Initial Catalog")));
}

QString connStringValue(const QString &connectionString, const QString &key)
{
    for (const ConnectionPart &part : splitConnString(connectionString)) {
        if (part.key.compare(key, Qt::CaseInsensitive) == 0)
            return part.value;
    }
    return {};
}

QString maskConnStringPassword(const QString &connectionString)
{
    QString masked = connectionString;
    const QList<ConnectionPart> parts = splitConnString(connectionString);
    // From the end, so that the positions of earlier parts stay valid.
    for (auto it = parts.crbegin(); it != parts.crend(); ++it) {
        const bool password = it->key.compare(QLatin1String("pwd"), Qt::CaseInsensitive) == 0 ||
                              it->key.compare(QLatin1String("Password"), Qt::CaseInsensitive) == 0;
        if (password && !it->value.isEmpty())
            masked.replace(it->valueStart, it->valueLength, Masked);
    }
    return masked;
}

} // namespace zorbin
