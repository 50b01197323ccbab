#include "source/SourceFaults.h"

#include "source/ConnectionString.h"
#include "source/OdbcTableReader.h"

#include <QSqlError>

namespace zorbin {

QString noConnectionTypeFault()
{
    return QStringLiteral("לא נבחר סוג בסיס הנתונים בהגדרות ההתחברות. יש לבחור סוג בחלון ההתחברות ולשמור.");
}

QString unknownProviderFault(const QString &provider)
{
    return QStringLiteral("ספק הנתונים \"%1\" אינו נתמך. יש לבחור סוג בסיס נתונים בחלון ההתחברות.")
        .arg(provider);
}

QString missingFileFault(const QString &path)
{
    return QStringLiteral(
               "קובץ בסיס הנתונים \"%1\" לא נמצא. יש לבדוק בחלון ההתחברות את התיקייה (שרת הנתונים) "
               "ואת שם הקובץ (בסיס נתונים).")
        .arg(path);
}

QString unknownFileFault(const QString &path)
{
    return QStringLiteral(
               "הקובץ \"%1\" אינו בסיס נתונים מוכר: צפוי קובץ Access או Jet (‎.mdb‎ או ‎.accdb‎) "
               "או קובץ SQLite. יש לבדוק בחלון ההתחברות את שם הקובץ.")
        .arg(path);
}

QString notSelectFault()
{
    return QStringLiteral("לבסיס הנתונים של הנהלת החשבונות נשלחת רק שאילתת SELECT אחת בכל פעם.");
}

QString missingJetTableFault(const QString &path, const QString &table)
{
    return QStringLiteral("בקובץ \"%1\" אין טבלה בשם \"%2\".").arg(path, table);
}

QString sqlErrorText(const QSqlError &error)
{
    QString text = error.databaseText().trimmed();
    if (text.isEmpty())
        text = error.text().trimmed();
    return text.isEmpty() ? QStringLiteral("שגיאה לא ידועה בגישה לבסיס הנתונים.") : text;
}

QString odbcOpenFault(const QString &driverText, const QString &odbcConnectionString)
{
    const QString driver = connStringValue(odbcConnectionString, QStringLiteral("driver"));
    // A driver given by its library's path is not looked up in the registry.
    if (driver.isEmpty() || driver.contains(QLatin1Char('/')) || driver.contains(QLatin1Char('\\')) ||
        registeredOdbcDrivers().contains(driver, Qt::CaseInsensitive))
        return driverText;
    return driverText +
           QStringLiteral("\n\nמנהל ההתקן \"%1\" אינו רשום במנהל ההתקנים של ODBC. ב-Linux יש לרשום "
                          "אותו בקובץ odbcinst.ini: לחיבור ל-SQL Server את FreeTDS (libtdsodbc.so) "
                          "בשם \"%1\", כמתואר בקובץ docs/connecting.md.")
               .arg(driver);
}

QString missingTableOf(const QSqlError &error)
{
    const QString prefix = QStringLiteral("no such table:");
    const QString text = error.databaseText().trimmed();
    if (!text.startsWith(prefix))
        return {};
    QString table = text.mid(prefix.size()).trimmed();
    if (table.startsWith(QLatin1String("main."), Qt::CaseInsensitive))
        table = table.mid(5);
    return table;
}

} // namespace zorbin
