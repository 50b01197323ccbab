#include "workdb/SqliteEngine.h"

#include <sqlite3.h>

namespace zorbin {

bool setUpSqliteEngine()
{
    return sqlite3_config(SQLITE_CONFIG_MEMSTATUS, 0) == SQLITE_OK;
}

} // namespace zorbin
