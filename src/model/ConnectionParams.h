#pragma once

#include <QString>
#include <cstdint>

namespace zorbin {

// How the accounting database is reached (the `CmbConnType` list index + 1).
enum ConnectionType : std::int16_t {
    NoConnectionType = 0, // nothing chosen: every connection attempt fails
    OdbcConnection = 1,   // "MS-SQL Server Via ODBC"
    OleDbConnection = 2,  // "MS-SQL Server Via OLE-DB"
    FileConnection = 3,   // "DAO 4.0 Via OLE-DB": a database file
};

// The accounting-database connection parameters, one instance per control.
struct ConnectionParams
{
    QString server;   // SQL Server instance; for a database file, the folder that holds it
    QString user;     // login name; empty selects integrated security for OLE DB
    QString password; // kept in the settings store as plain text, as earlier versions did
    QString database; // database on the server; for a database file, the file name
    std::int16_t type = NoConnectionType;
};

} // namespace zorbin
