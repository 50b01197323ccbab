#include "model/RunContext.h"
#include "platform/FileSystem.h"
#include "workdb/WorkDatabase.h"
#include "workdb/WorkDatabasePath.h"
#include "workdb/WorkSchema.h"

namespace zorbin {
namespace {

// The database file and the files SQLite may have left beside it: a journal that an ended
// program left behind would otherwise be played back into the new file.
QStringList filesOfDatabase(const QString &path)
{
    return {path, path + QStringLiteral("-journal"), path + QStringLiteral("-wal"),
            path + QStringLiteral("-shm")};
}

} // namespace

Status createWorkDatabase(FileSystem &files, const QString &path)
{
    for (const QString &file : filesOfDatabase(path)) {
        if (!files.fileExists(file))
            continue;
        if (Status removed = files.removeFile(file); !removed)
            return removed;
    }
    Result<std::unique_ptr<WorkDatabase>> work = WorkDatabase::connect(path);
    if (!work)
        return work.status();
    if (Status begun = work.value()->begin(); !begun)
        return begun;
    for (const WorkTable &table : workTables()) {
        if (WriteOutcome created = work.value()->exec(createTableStatement(table)); !created)
            return created.status();
    }
    return work.value()->commit();
}

Result<QString> CreateWorkDB(RunContext &context)
{
    const QString path = workDatabasePath();
    if (Status created = createWorkDatabase(context.files, path); !created)
        return created;
    return path;
}

} // namespace zorbin
