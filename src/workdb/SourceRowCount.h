#pragma once

#include <QString>
#include <cstdint>

namespace zorbin {

class SourceConnection;

// How many rows a SELECT on the accounting database yields, for the progress bar: neither
// Qt's ODBC nor its SQLite driver reports the size of a result. Asks the database with
// "SELECT COUNT(*) FROM (statement) AS CollectedRows" (the statement itself unchanged inside);
// when the database refuses that, runs the statement and counts its rows. 0 when even that
// fails (the caller's own run of the statement then reports the fault).
//
// Must be called while no other query of the connection is open: some servers allow only one
// active result per connection.
std::int64_t countSourceRows(SourceConnection &connection, const QString &statement);

} // namespace zorbin
