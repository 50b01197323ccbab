#include "output/CatalogRows.h"

#include "output/CatalogQuery.h"
#include "workdb/WorkDatabase.h"

#include <QSqlError>
#include <QSqlRecord>

namespace zorbin {

Result<std::unique_ptr<CatalogRows>> CatalogRows::open(const QString &dbFile, const CatalogSettings &settings)
{
    const QString sql = BuildFinalSQL(settings);
    auto database = WorkDatabase::open(dbFile);
    if (!database)
        return database.status();
    long long count = 0;
    {
        auto counted =
            database.value()->select(QStringLiteral("SELECT COUNT(*) FROM (") + sql + QStringLiteral(")"));
        if (!counted)
            return counted.status();
        if (!counted.value().next())
            return Status::fault(counted.value().lastError().text());
        count = counted.value().value(0).toLongLong();
    }
    auto rows = database.value()->select(sql);
    if (!rows)
        return rows.status();
    return std::unique_ptr<CatalogRows>(
        new CatalogRows(std::move(database).value(), std::move(rows).value(), count));
}

CatalogRows::CatalogRows(std::unique_ptr<WorkDatabase> database, QSqlQuery query, long long count)
    : m_database(std::move(database)), m_query(std::move(query)), m_count(count)
{}

CatalogRows::~CatalogRows() = default;

bool CatalogRows::next()
{
    if (!m_status)
        return false;
    if (m_query.next())
        return true;
    if (const QSqlError error = m_query.lastError(); error.isValid())
        m_status = Status::fault(error.text());
    return false;
}

int CatalogRows::column(const QString &name) const
{
    return m_query.record().indexOf(name);
}

QVariant CatalogRows::value(int column) const
{
    if (column < 0)
        return {};
    return m_query.value(column);
}

} // namespace zorbin
