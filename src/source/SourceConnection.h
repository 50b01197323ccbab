#pragma once

#include "common/Status.h"

#include <QSet>
#include <QSqlDatabase>
#include <QSqlQuery>
#include <QString>
#include <memory>

namespace zorbin {

class OdbcTableReader;

// One open, read-only connection to the accounting database, made from the text that
// BuildConnString returns. No connection is kept between steps: each step opens its own,
// reads, and lets it go.
//
// How each connection type is reached:
//  - an ODBC text (type 1) goes to the ODBC driver manager as it is; on Linux the driver name
//    "SQL Server" must be registered in odbcinst.ini (FreeTDS under that name);
//  - an OLE DB text for SQL Server (type 2) reaches the same server, login (or integrated
//    security) and database through that ODBC driver;
//  - a database file (type 3) is recognised by its content: a SQLite file is opened with Qt's
//    SQLite driver; a Jet or Access file is read through the mdbtools ODBC driver ("MDBTools";
//    the Access driver on Windows), which answers only single-table queries, so the tables a
//    statement names are copied into an in-memory SQLite database and the statement runs there.
//
// Opening waits at most 60 seconds for the server to log the user in. Only SELECT statements
// are sent; a database file is opened read-only.
class SourceConnection
{
public:
    static constexpr int LoginTimeoutSeconds = 60;

    // The fault's description says what could not be opened and why, in the driver's words,
    // with what to do when the driver is not installed.
    static Result<std::unique_ptr<SourceConnection>> open(const QString &connectionString);
    ~SourceConnection();

    SourceConnection(const SourceConnection &) = delete;
    SourceConnection &operator=(const SourceConnection &) = delete;

    // Runs one SELECT statement; anything else is refused, and so are a second statement after
    // ";" and a block comment (servers differ on where one ends). Its rows are read forward
    // from the first, fields by name or position, a Null as a null QVariant. The query must be
    // destroyed before the connection.
    Result<QSqlQuery> select(const QString &sql);

    // The database the statements run on (for a Jet file, the in-memory copy of its tables).
    QSqlDatabase database() const;

private:
    explicit SourceConnection(QString connectionName);

    Status openOdbc(const QString &odbcConnectionString);
    Status openFile(const QString &path);
    Status openJetFile(const QString &path);
    // Copies one table of the Jet file into the in-memory database, under the name `table`.
    Status copyJetTable(const QString &table);

    QString m_connectionName;
    QString m_filePath;                         // the database file of type 3
    std::unique_ptr<OdbcTableReader> m_jetFile; // set for a Jet or Access file
    QSet<QString> m_copiedTables;               // lower-case names already in the in-memory copy
};

} // namespace zorbin
