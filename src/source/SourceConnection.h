#pragma once

#include "common/Status.h"

#include <QSqlDatabase>
#include <QSqlQuery>
#include <QString>

#include <memory>

namespace zorbin {

// One open, read-only connection to the accounting database, made from the text that
// BuildConnString returns. No connection is kept between steps: each step opens its own,
// reads, and lets it go.
//
// Opening waits at most 60 seconds for the server to log the user in. Only SELECT statements
// are sent; a database file is opened read-only.
class SourceConnection
{
public:
    static constexpr int LoginTimeoutSeconds = 60;

    // The fault's description says what could not be opened and why, in the driver's words.
    static Result<std::unique_ptr<SourceConnection>> open(const QString &connectionString);
    ~SourceConnection();

    SourceConnection(const SourceConnection &) = delete;
    SourceConnection &operator=(const SourceConnection &) = delete;

    // Runs one SELECT statement; its rows are read forward from the first, fields by name or
    // position, a Null as a null QVariant. The query must be destroyed before the connection.
    Result<QSqlQuery> select(const QString &sql);

    QSqlDatabase database() const;

private:
    explicit SourceConnection(QString connectionName);

    QString m_connectionName;
};

} // namespace zorbin
