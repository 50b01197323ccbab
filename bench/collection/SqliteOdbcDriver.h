#pragma once

#include "common/Status.h"

namespace zorbin::bench {

// Registers the SQLite3 ODBC driver (libsqliteodbc) under the driver name "SQL Server" in a
// private odbcinst.ini whose folder ODBCSYSINI names, so that the connection text of type 1,
// "driver={SQL Server};server=...;uid=...;pwd=...;database=<file>", opens a SQLite file the way
// a user's SQL Server database is opened: through the real driver manager and a real driver.
// The driver manager reads ODBCSYSINI once, so call this before the process's first ODBC
// connection; later calls do nothing. A fault when the driver is not installed.
Status registerSqliteOdbcAsSqlServer();

} // namespace zorbin::bench
