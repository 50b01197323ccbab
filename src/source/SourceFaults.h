#pragma once

#include <QString>

class QSqlError;

// The texts of the faults met while opening and reading the accounting database. The user sees
// them in the fault box as they are: what went wrong, in the driver's words where it has some,
// and what to do about it.
namespace zorbin {

QString noConnectionTypeFault();
QString unknownProviderFault(const QString &provider);
QString missingFileFault(const QString &path);
QString unknownFileFault(const QString &path);
QString notSelectFault();
QString missingJetTableFault(const QString &path, const QString &table);

// The driver's own description of an error (Qt's generic words only when the driver gave none).
QString sqlErrorText(const QSqlError &error);

// The failure to open an ODBC connection: the driver's description, followed, when the driver
// that the connection text names is not registered with the driver manager, by how to register it.
QString odbcOpenFault(const QString &driverText, const QString &odbcConnectionString);

// The name of the table that a SQLite "no such table" error names; empty for any other error.
QString missingTableOf(const QSqlError &error);

} // namespace zorbin
