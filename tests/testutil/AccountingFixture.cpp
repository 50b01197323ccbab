#include "testutil/AccountingFixture.h"

#include "platform/SettingsStore.h"
#include "testutil/TestFiles.h"

#include <QDir>
#include <QFile>
#include <QFileInfo>
#include <QSqlDatabase>
#include <QSqlError>
#include <QSqlQuery>
#include <QTest>

namespace zorbin::test {
namespace {

Status runStatements(QSqlDatabase &db, const QStringList &statements)
{
    QSqlQuery query(db);
    for (const QString &statement : statements) {
        if (statement.trimmed().isEmpty())
            continue;
        if (!query.exec(statement))
            return Status::fault(query.lastError().text() + QStringLiteral(" in: ") + statement);
    }
    return Status::ok();
}

QStringList schemaStatements()
{
    const QString schema =
        QString::fromUtf8(readFile(QStringLiteral(ZORBIN_SOURCE_DIR "/demo/accounting-schema.sql")));
    QStringList statements;
    for (QString statement : schema.split(QLatin1Char(';'))) {
        QStringList lines = statement.split(QLatin1Char('\n'));
        lines.removeIf([](const QString &line) { return line.trimmed().startsWith(QLatin1String("--")); });
        statements << lines.join(QLatin1Char('\n'));
    }
    return statements;
}

} // namespace

QString demoDatabasePath()
{
    return QDir(demoFolder()).filePath(QStringLiteral("demo-accounting.db"));
}

QString demoSettingsPath()
{
    return QDir(demoFolder()).filePath(QStringLiteral("demo-settings.ini"));
}

QString copyDemoDatabase(const QString &folder, const QString &name)
{
    const QString copy = QDir(folder).filePath(name);
    QFile::remove(copy);
    if (!QFile::copy(demoDatabasePath(), copy)) {
        QTest::qFail(qPrintable(QStringLiteral("cannot copy the demo database %1 (is the project built?)")
                                    .arg(demoDatabasePath())),
                     __FILE__, __LINE__);
        return {};
    }
    QFile::setPermissions(copy, QFileDevice::ReadOwner | QFileDevice::WriteOwner);
    return copy;
}

Status makeAccountingFile(const QString &path, const QStringList &statements)
{
    QFile::remove(path);
    const QString name = QStringLiteral("accounting-fixture-") + path;
    Status status;
    {
        QSqlDatabase db = QSqlDatabase::addDatabase(QStringLiteral("QSQLITE"), name);
        db.setDatabaseName(path);
        if (!db.open())
            status = Status::fault(db.lastError().text());
        if (status)
            status = runStatements(db, schemaStatements());
        if (status)
            status = runStatements(db, statements);
        db.close();
    }
    QSqlDatabase::removeDatabase(name);
    return status;
}

std::unique_ptr<SettingsStore> copyDemoSettings(const QString &folder)
{
    const QString copy = QDir(folder).filePath(QStringLiteral("demo-settings.ini"));
    QFile::remove(copy);
    if (!QFile::copy(demoSettingsPath(), copy))
        QTest::qFail(
            qPrintable(QStringLiteral("cannot copy %1 (is the project built?)").arg(demoSettingsPath())),
            __FILE__, __LINE__);
    QFile::setPermissions(copy, QFileDevice::ReadOwner | QFileDevice::WriteOwner);
    return openIniSettingsStore(copy);
}

ConnectionParams fileConnection(const QString &path)
{
    const QFileInfo file(path);
    ConnectionParams params;
    params.server = QDir::toNativeSeparators(file.absolutePath());
    params.database = file.fileName();
    params.kind = ConnectionKind::File;
    return params;
}

} // namespace zorbin::test
