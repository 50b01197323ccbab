#pragma once

#include "common/Status.h"

#include <QSqlQuery>
#include <QString>
#include <QVariant>
#include <memory>

namespace zorbin {

struct CatalogSettings;
class WorkDatabase;

// The catalog items of a working database, in catalog order (BuildFinalSQL of the settings),
// read forward once without holding the rows in memory. The number of rows is counted by the
// engine over the same statement before the first row is read.
class CatalogRows
{
public:
    // Opens the working database file and runs the catalog statement. Fails with the
    // engine's description when the file or the statement cannot be opened.
    static Result<std::unique_ptr<CatalogRows>> open(const QString &dbFile, const CatalogSettings &settings);
    ~CatalogRows();
    CatalogRows(const CatalogRows &) = delete;
    CatalogRows &operator=(const CatalogRows &) = delete;

    long long count() const { return m_count; }

    // Moves to the next row (the first at the first call). False after the last row and when
    // reading failed; status() tells the two apart.
    bool next();
    Status status() const { return m_status; }

    // The position of a result column, or -1 when the statement has no column of that name.
    int column(const QString &name) const;
    // A value of the current row; null for a null value or a column of -1.
    QVariant value(int column) const;

private:
    CatalogRows(std::unique_ptr<WorkDatabase> database, QSqlQuery query, long long count);

    std::unique_ptr<WorkDatabase> m_database; // declared first: the query goes before it
    QSqlQuery m_query;
    long long m_count = 0;
    Status m_status;
};

} // namespace zorbin
