#include "control/Program.h"

#include "control/StandardStages.h"
#include "platform/FileSystem.h"
#include "workdb/SqliteEngine.h"

namespace zorbin {

void prepareProcess()
{
    setUpSqliteEngine();
}

std::unique_ptr<CatalogControl> assembleControl(UserPort &user, SettingsStore &store)
{
    return std::make_unique<CatalogControl>(user, store, localFileSystem(), makeStandardStages(store));
}

} // namespace zorbin
