#pragma once

#include "common/Status.h"
#include "workdb/WriteOutcome.h"

#include <QSqlDatabase>
#include <QSqlQuery>
#include <QString>
#include <memory>

struct sqlite3;

namespace zorbin {

class FileSystem;
struct RunContext;

// Creates the working database at workDatabasePath(): deletes the file of the previous run
// (and a journal it may have left), then creates the six tables of workTables(), each with
// its primary key and no other index, and closes the file. Returns the path, or the failure;
// whatever was made before a failure stays for the next call to delete.
Result<QString> CreateWorkDB(RunContext &context);
// The same at a given path, without a message: the failure's description.
Status createWorkDatabase(FileSystem &files, const QString &path);

// One open connection to an existing working database, with the Hebrew collation registered,
// so that keys, joins and ORDER BY compare text the way the schema says. Every module that
// reads or writes the working database goes through one of these; the sqlite3 command-line
// tool cannot read its tables (it does not know the collation).
//
// Queries returned by select() and the QSqlDatabase from database() must be destroyed before
// the WorkDatabase. Not for use from more than one thread.
class WorkDatabase
{
public:
    // Opens the file at `path`; a missing file (or an empty path, before any collection) is a
    // fault with a Hebrew description, not a new database.
    static Result<std::unique_ptr<WorkDatabase>> open(const QString &path);
    ~WorkDatabase();

    WorkDatabase(const WorkDatabase &) = delete;
    WorkDatabase &operator=(const WorkDatabase &) = delete;

    QSqlDatabase database() const;
    // The engine's own handle, for writers that bypass Qt (RowWriter). Owned by the connection.
    sqlite3 *handle() const { return m_handle; }
    const QString &path() const { return m_path; }

    // Runs a statement as its builder returns it (the catalog query, the selection list),
    // after translateBooleanLiterals(). A refusal's description is the engine's.
    Result<QSqlQuery> select(const QString &sql, bool forwardOnly = true);
    // Runs a statement of our own that writes (an update of Include, an insert), with the
    // Boolean literals translated likewise. The outcome tells a duplicate key from the rest.
    WriteOutcome exec(const QString &sql);

    // A transaction around many writes: rows written one by one are a thousand times slower.
    // commit() makes everything since begin() permanent; a WorkDatabase destroyed inside a
    // transaction commits it, so that nothing already written is lost.
    Status begin();
    Status commit();
    bool inTransaction() const { return m_inTransaction; }

private:
    WorkDatabase(QString connectionName, QString path);
    static Result<std::unique_ptr<WorkDatabase>> connect(const QString &path);
    friend Status createWorkDatabase(FileSystem &files, const QString &path);

    QString m_connectionName;
    QString m_path;
    sqlite3 *m_handle = nullptr;
    bool m_inTransaction = false;
};

} // namespace zorbin
