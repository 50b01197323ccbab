#include "testutil/AccountingFixture.h"

#include "testutil/TestFiles.h"

#include <QDir>
#include <QFileInfo>
#include <QRegularExpression>
#include <QSqlDatabase>
#include <QSqlError>
#include <QSqlQuery>

namespace zorbin::test {

QString demoSettingsPath()
{
    return QDir(demoFolder()).filePath(QStringLiteral("demo-settings.ini"));
}

Status makeAccountingFile(const QString &path, const QStringList &statements)
{
    QFile::remove(path);
    QString schema =
        QString::fromUtf8(readFile(QStringLiteral(ZORBIN_SOURCE_DIR "/demo/accounting-schema.sql")));
    schema.remove(QRegularExpression(QStringLiteral("^\\s*--[^\\n]*"), QRegularExpression::MultilineOption));
    const QString name = QStringLiteral("accounting-fixture-") + path;
    Status status;
    {
        QSqlDatabase db = QSqlDatabase::addDatabase(QStringLiteral("QSQLITE"), name);
        db.setDatabaseName(path);
        if (!db.open())
            status = Status::fault(db.lastError().text());
        QSqlQuery query(db);
        for (const QString &statement : schema.split(QLatin1Char(';')) + statements) {
            if (status && !statement.trimmed().isEmpty() && !query.exec(statement))
                status = Status::fault(query.lastError().text() + QStringLiteral(" in: ") + statement);
        }
    }
    QSqlDatabase::removeDatabase(name);
    return status;
}

ConnectionParams fileConnection(const QString &path)
{
    const QFileInfo file(path);
    return {QDir::toNativeSeparators(file.absolutePath()), {}, {}, file.fileName(), ConnectionKind::File};
}

ConnectionParams odbcConnection(const QString &path)
{
    return {QStringLiteral("localhost"), QStringLiteral("catalog"), QStringLiteral("secret"),
            QFileInfo(path).absoluteFilePath(), ConnectionKind::Odbc};
}

} // namespace zorbin::test
