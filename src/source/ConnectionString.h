#pragma once

#include "model/ConnectionParams.h"

#include <QList>
#include <QString>
#include <cstdint>

namespace zorbin {

// The connection string of the accounting database, by connection type:
//   1 "driver={SQL Server};server=S;uid=U;pwd=P;database=D"
//   2 "Provider=sqloledb;Data Source=S;Integrated Security=SSPI;Persist Security Info=False;Initial
//   Catalog=D"
//     when the user is empty (the password is then not used), otherwise
//     "Provider=sqloledb;Data Source=S;User Id=U;Password=P;Initial Catalog=D"
//   3 "Provider=Microsoft.Jet.OLEDB.4.0;Data Source=" + the file path: the server folder, a path
//     separator unless the folder already ends in one, and the database file name; an empty
//     server gives the file name alone. The separator is "\" on Windows and "/" elsewhere.
//   any other type: the empty text, which no connection accepts.
// A null password counts as empty. Values go in as typed, except that a user or password which
// would break the string is quoted (see odbcConnValue and oleDbConnValue): a server or database
// is kept as stored, since a shop may add a driver attribute there on purpose
// ("myhost;Port=1433"). Pure.
QString BuildConnString(const QString &server, const QString &user, const QString &password,
                        const QString &database, ConnectionKind kind);
QString BuildConnString(const ConnectionParams &params);

// A value as the ODBC form writes it: unchanged, or between braces with every "}" doubled when
// it holds ";", "{" or "}".
QString odbcConnValue(const QString &value);
// A value as the OLE DB forms write it: unchanged, or between double quotes with every double
// quote doubled when it holds ";", a double or a single quote.
QString oleDbConnValue(const QString &value);

// The same text with every non-empty password value ("pwd", "Password") replaced by "****", for
// printing. An empty password stays empty, so the text still shows that none was given.
QString maskConnStringPassword(const QString &connectionString);

// One "key=value" part of a connection string, with quoting removed from the value.
struct ConnectionPart
{
    QString key;               // trimmed, letter case as written
    QString value;             // unquoted
    qsizetype valueStart = 0;  // where the value, quotes included, starts in the text
    qsizetype valueLength = 0; // and its length there
};

// Splits a connection string into its parts. A text that starts with "Provider=" is read with
// the OLE DB rules (values in double or single quotes); any other with the ODBC rules (values
// in braces). Parts without "=" are left out.
QList<ConnectionPart> splitConnString(const QString &connectionString);

// The value of the first part whose key matches `key` in any letter case; the empty text when
// there is none.
QString connStringValue(const QString &connectionString, const QString &key);

// The ODBC connection string that reaches the server of an OLE DB string of type 2 through the
// SQL Server ODBC driver: "driver={SQL Server};server=S;uid=U;pwd=P;database=D", or with
// "Trusted_Connection=yes" in place of the login when the OLE DB string asks for integrated
// security. There is no OLE DB outside Windows, and Qt reaches SQL Server through ODBC everywhere.
QString odbcConnStringForOleDb(const QString &oleDbConnectionString);

// Whether a connection string is in the OLE DB form (it starts with "Provider=").
bool isOleDbConnString(const QString &connectionString);

} // namespace zorbin
