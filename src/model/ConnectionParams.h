#pragma once

#include <QString>
#include <cstdint>

namespace zorbin {

// How the accounting database is reached: the connection dialog's list index + 1. A stored
// number that is none of these connects to nothing.
enum class ConnectionKind : std::int16_t {
    None = 0,  // nothing chosen: every connection attempt fails
    Odbc = 1,  // "MS-SQL Server Via ODBC"
    OleDb = 2, // "MS-SQL Server Via OLE-DB"
    File = 3,  // "DAO 4.0 Via OLE-DB": a database file
};

// The accounting-database connection parameters, one instance per control.
struct ConnectionParams
{
    QString server;   // SQL Server instance; for a database file, the folder that holds it
    QString user;     // login name; empty selects integrated security for OLE DB
    QString password; // kept in the settings store as plain text, as earlier versions did
    QString database; // database on the server; for a database file, the file name
    ConnectionKind kind = ConnectionKind::None;
};

} // namespace zorbin
