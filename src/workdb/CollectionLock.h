#pragma once

#include "common/Status.h"

#include <QString>
#include <memory>

class QLockFile;

namespace zorbin {

// Keeps a second collection away from the working database while one runs: two catalog
// programs of one user (or two controls in one program) would otherwise delete and rewrite
// the same file under each other. The lock is a file beside the database (its name + ".lock"),
// held from acquire() until the object is destroyed. A lock left by a program that ended
// without releasing it is taken over.
class CollectionLock
{
public:
    // The lock on the working database at `databasePath`, or a fault in Hebrew that says a
    // collection is already running, when it is held elsewhere.
    static Result<std::unique_ptr<CollectionLock>> acquire(const QString &databasePath);
    ~CollectionLock();

    CollectionLock(const CollectionLock &) = delete;
    CollectionLock &operator=(const CollectionLock &) = delete;

private:
    explicit CollectionLock(std::unique_ptr<QLockFile> file);

    std::unique_ptr<QLockFile> m_file;
};

} // namespace zorbin
