#pragma once

#include "common/Status.h"

#include <QList>
#include <QString>
#include <QStringList>
#include <QVariant>
#include <functional>
#include <memory>

namespace zorbin {

// A read-only connection through the ODBC driver manager's own interface, for drivers that Qt's
// ODBC plugin cannot drive: mdbtools (Jet and Access files on Linux) has no SQLSetStmtAttr, which
// the plugin needs for every statement. It reads whole tables, one at a time, since mdbtools
// answers only single-table queries.
class OdbcTableReader
{
public:
    // What a column holds, by its ODBC type.
    enum class ColumnKind { Integer, Real, Text, Binary };

    struct Column
    {
        QString name;
        ColumnKind kind = ColumnKind::Text;
    };

    // Connects with the given ODBC connection text, waiting at most `loginTimeoutSeconds`.
    // The fault's description is the driver manager's or the driver's own text.
    static Result<std::unique_ptr<OdbcTableReader>> connect(const QString &connectionText,
                                                            int loginTimeoutSeconds);
    ~OdbcTableReader();

    OdbcTableReader(const OdbcTableReader &) = delete;
    OdbcTableReader &operator=(const OdbcTableReader &) = delete;

    // The names of the tables (not views or system tables) the database holds.
    Result<QStringList> tableNames();

    // Reads every row of one table with "SELECT * FROM [table]": `columns` first, then `row` once
    // per row with one value per column (a Null as a null QVariant; integers as qint64, reals as
    // double, texts as QString, binaries as QByteArray). A failing `row` ends the reading.
    Status readTable(const QString &table, const std::function<Status(const QList<Column> &)> &columns,
                     const std::function<Status(const QVariantList &)> &row);

private:
    struct Handles;
    explicit OdbcTableReader(std::unique_ptr<Handles> handles);

    std::unique_ptr<Handles> m_handles;
};

// The driver names registered with the ODBC driver manager (odbcinst.ini on Linux).
QStringList registeredOdbcDrivers();

} // namespace zorbin
