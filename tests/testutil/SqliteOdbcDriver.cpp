#include "testutil/SqliteOdbcDriver.h"

#include <QDir>
#include <QFile>
#include <QFileInfo>
#include <QSettings>
#include <QTemporaryDir>

namespace zorbin::test {
namespace {

// The driver library as the system's odbcinst.ini registers it under "SQLite3".
QString systemSqliteDriver()
{
    const QSettings system(QStringLiteral("/etc/odbcinst.ini"), QSettings::IniFormat);
    return system.value(QStringLiteral("SQLite3/Driver")).toString();
}

Status writeRegistry(const QString &folder, const QString &driver)
{
    QFile file(QDir(folder).filePath(QStringLiteral("odbcinst.ini")));
    if (!file.open(QIODevice::WriteOnly | QIODevice::Truncate))
        return Status::fault(QStringLiteral("cannot write %1").arg(file.fileName()));
    file.write("[SQL Server]\nDescription=SQLite3 ODBC Driver standing in for SQL Server\nDriver=");
    file.write(QFile::encodeName(driver));
    file.write("\nUsageCount=1\n");
    return Status::ok();
}

} // namespace

Status registerSqliteOdbcAsSqlServer()
{
    static QTemporaryDir folder; // lives as long as the process: the driver manager keeps reading it
    static Status registered = [] {
        const QString driver = systemSqliteDriver();
        if (driver.isEmpty())
            return Status::fault(
                QStringLiteral("The SQLite3 ODBC driver is not installed (Debian package libsqliteodbc)."));
        if (!folder.isValid())
            return Status::fault(QStringLiteral("cannot make a folder for odbcinst.ini"));
        if (Status written = writeRegistry(folder.path(), driver); !written)
            return written;
        qputenv("ODBCSYSINI", QFile::encodeName(folder.path()));
        return Status::ok();
    }();
    return registered;
}

ConnectionParams odbcConnection(const QString &path)
{
    ConnectionParams params;
    params.server = QStringLiteral("localhost");
    params.user = QStringLiteral("catalog");
    params.password = QStringLiteral("secret");
    params.database = QFileInfo(path).absoluteFilePath();
    params.kind = ConnectionKind::Odbc;
    return params;
}

} // namespace zorbin::test
