#pragma once

#include "common/Status.h"
#include "model/ConnectionParams.h"

#include <QString>
#include <QStringList>

// Accounting databases for tests: the demo database and small SQLite files with the accounting
// tables, reached as a database file or through ODBC as a user would.
namespace zorbin::test {

// The demo's settings file (demo-settings.ini), built with the project (make-demo-db.sh).
QString demoSettingsPath();

// Creates a SQLite file at `path` (replacing one there) with the accounting tables of
// demo/accounting-schema.sql, all empty, then runs `statements` on it.
Status makeAccountingFile(const QString &path, const QStringList &statements = {});

// Connection parameters of type 3 for a database file: the folder as the server, the file name
// as the database.
ConnectionParams fileConnection(const QString &path);

// Connection parameters of type 1 for the SQLite file at `path`, through the SQLite ODBC driver
// that the test's registry (ODBCSYSINI, set by ctest) names "SQL Server".
ConnectionParams odbcConnection(const QString &path);

} // namespace zorbin::test
