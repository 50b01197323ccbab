#include "SqliteOdbcDriver.h"

#include <QSettings>
#include <QTemporaryDir>

namespace zorbin::bench {

Status registerSqliteOdbcAsSqlServer()
{
    static QTemporaryDir folder; // lives as long as the process: the driver manager keeps reading it
    static Status registered = [] {
        // The driver library as the system's odbcinst.ini registers it under "SQLite3".
        const QString driver = QSettings(QStringLiteral("/etc/odbcinst.ini"), QSettings::IniFormat)
                                   .value("SQLite3/Driver")
                                   .toString();
        if (driver.isEmpty())
            return Status::fault(
                QStringLiteral("The SQLite3 ODBC driver is not installed (Debian package libsqliteodbc)."));
        QFile registry(folder.filePath(QStringLiteral("odbcinst.ini")));
        if (!registry.open(QIODevice::WriteOnly) ||
            registry.write("[SQL Server]\nDriver=" + QFile::encodeName(driver) + "\n") < 0)
            return Status::fault(QStringLiteral("cannot write %1").arg(registry.fileName()));
        qputenv("ODBCSYSINI", QFile::encodeName(folder.path()));
        return Status::ok();
    }();
    return registered;
}

} // namespace zorbin::bench
