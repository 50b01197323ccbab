#pragma once

namespace zorbin {

// Sets up the SQLite library for this program before any database is opened: a collection
// reads the accounting database on one thread while it writes the working database on another,
// and SQLite's memory statistics, which this program never reads, would make both threads take
// one process-wide lock at every allocation (a third of a large collection's time). Called first
// thing in main(); false when a database was opened before, and the engine stays as it was.
bool setUpSqliteEngine();

} // namespace zorbin
