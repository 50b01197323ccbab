#include "workdb/WorkDatabasePath.h"

#include "platform/Paths.h"

namespace zorbin {

QString workDatabasePath()
{
    return withTrailingSeparator(temporaryFolder()) + WorkDatabaseName;
}

} // namespace zorbin
