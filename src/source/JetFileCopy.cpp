// The Jet and Access files of connection type 3: mdbtools reads one table at a time, so each
// table that a statement names is copied into an in-memory SQLite database first.
#include "source/ConnectionString.h"
#include "source/OdbcTableReader.h"
#include "source/SourceConnection.h"
#include "source/SourceFaults.h"

#include <QDir>
#include <QSqlError>

namespace zorbin {
namespace {

#ifdef Q_OS_WIN
const QString JetDriver = QStringLiteral("Microsoft Access Driver (*.mdb, *.accdb)");
#else
const QString JetDriver = QStringLiteral("MDBTools");
#endif

QString quotedName(const QString &name)
{
    QString escaped = name;
    escaped.replace(QLatin1Char('"'), QStringLiteral("\"\""));
    return QLatin1Char('"') + escaped + QLatin1Char('"');
}

QString columnType(OdbcTableReader::ColumnKind kind)
{
    switch (kind) {
    case OdbcTableReader::ColumnKind::Integer:
        return QStringLiteral("INTEGER");
    case OdbcTableReader::ColumnKind::Real:
        return QStringLiteral("REAL");
    case OdbcTableReader::ColumnKind::Binary:
        return QStringLiteral("BLOB");
    case OdbcTableReader::ColumnKind::Text:
        break;
    }
    // Jet compares texts without regard to letter case; so does the copy.
    return QStringLiteral("TEXT COLLATE NOCASE");
}

Status queryFault(const QSqlQuery &query)
{
    return Status::fault(sqlErrorText(query.lastError()));
}

} // namespace

Status SourceConnection::openJetFile(const QString &path)
{
    // mdbtools does not read a braced value, so the path goes in as it is.
    const QString text = QStringLiteral("Driver={%1};DBQ=%2").arg(JetDriver, QDir::toNativeSeparators(path));
    auto reader = OdbcTableReader::connect(text, LoginTimeoutSeconds);
    if (!reader)
        return Status::fault(odbcOpenFault(reader.status().description(), text));
    m_jetFile = std::move(reader).value();

    QSqlDatabase db = QSqlDatabase::addDatabase(QStringLiteral("QSQLITE"), m_connectionName);
    db.setDatabaseName(QStringLiteral(":memory:"));
    if (!db.open())
        return Status::fault(sqlErrorText(db.lastError()));
    return Status::ok();
}

Status SourceConnection::copyJetTable(const QString &table)
{
    const auto names = m_jetFile->tableNames();
    if (!names)
        return names.status();
    QString fileName; // the table's name as the file spells it
    for (const QString &name : names.value()) {
        if (name.compare(table, Qt::CaseInsensitive) == 0)
            fileName = name;
    }
    if (fileName.isEmpty())
        return Status::fault(missingJetTableFault(m_filePath, table));

    QSqlDatabase db = database();
    QSqlQuery insert(db);
    db.transaction();
    const Status read = m_jetFile->readTable(
        fileName,
        [&](const QList<OdbcTableReader::Column> &columns) {
            QStringList definitions;
            QStringList placeholders;
            for (const auto &column : columns) {
                definitions << quotedName(column.name) + QLatin1Char(' ') + columnType(column.kind);
                placeholders << QStringLiteral("?");
            }
            QSqlQuery create(db);
            if (!create.exec(QStringLiteral("CREATE TABLE %1 (%2)")
                                 .arg(quotedName(table), definitions.join(QStringLiteral(", ")))))
                return queryFault(create);
            if (!insert.prepare(QStringLiteral("INSERT INTO %1 VALUES (%2)")
                                    .arg(quotedName(table), placeholders.join(QStringLiteral(", ")))))
                return queryFault(insert);
            return Status::ok();
        },
        [&](const QVariantList &values) {
            for (qsizetype i = 0; i < values.size(); ++i)
                insert.bindValue(static_cast<int>(i), values.at(i));
            return insert.exec() ? Status::ok() : queryFault(insert);
        });
    if (!read) {
        db.rollback();
        return read;
    }
    db.commit();
    m_copiedTables.insert(table.toLower());
    return Status::ok();
}

} // namespace zorbin
