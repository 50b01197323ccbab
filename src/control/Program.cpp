#include "control/Program.h"

#include "platform/FileSystem.h"
#include "workdb/SqliteEngine.h"
#include "workdb/WorkDatabasePath.h"

#include <QFileInfo>

namespace zorbin {

void prepareProcess()
{
    setUpSqliteEngine();
}

std::unique_ptr<CatalogControl> assembleControl(UserPort &user, SettingsStore &store)
{
    return std::make_unique<CatalogControl>(user, store, localFileSystem());
}

QString lastWorkDatabase()
{
    const QString path = workDatabasePath();
    return QFileInfo(path).isFile() ? path : QString();
}

} // namespace zorbin
