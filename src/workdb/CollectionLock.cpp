#include "workdb/CollectionLock.h"

#include <QDir>
#include <QLockFile>

namespace zorbin {

CollectionLock::CollectionLock(std::unique_ptr<QLockFile> file) : m_file(std::move(file)) {}

CollectionLock::~CollectionLock() = default;

Result<std::unique_ptr<CollectionLock>> CollectionLock::acquire(const QString &databasePath)
{
    auto file = std::make_unique<QLockFile>(databasePath + QStringLiteral(".lock"));
    // Never stale by age: a collection of a large catalog takes minutes. A lock whose program
    // is no longer running is still recognised as stale.
    file->setStaleLockTime(0);
    if (file->tryLock(0))
        return std::unique_ptr<CollectionLock>(new CollectionLock(std::move(file)));
    if (file->error() == QLockFile::LockFailedError)
        return Status::fault(QStringLiteral("איסוף נתונים אחר כבר פועל על בסיס הנתונים הזמני %1 "
                                            "(בחלון אחר של התוכנה או בתוכנה אחרת). "
                                            "יש להמתין לסיומו ולנסות שוב.")
                                 .arg(QDir::toNativeSeparators(databasePath)));
    return Status::fault(QStringLiteral("לא ניתן ליצור את קובץ הנעילה של בסיס הנתונים הזמני %1.lock.")
                             .arg(QDir::toNativeSeparators(databasePath)));
}

} // namespace zorbin
