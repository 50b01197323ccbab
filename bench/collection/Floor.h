#pragma once

#include "common/Status.h"

#include <QString>
#include <vector>

namespace zorbin {
struct CatalogSettings;
}

namespace zorbin::bench {

struct TableTiming
{
    QString name;
    long long rows = 0;
    double seconds = 0;
};

// The floor of a collection: a fresh working database at `workPath` (schema, collation and
// all) filled inside SQLite by one INSERT ... SELECT per table from the source file attached,
// with the collection's own statements, defaults and duplicate rule. The first entry is the
// creation of the database.
Result<std::vector<TableTiming>> measureFloor(const CatalogSettings &settings, const QString &sourcePath,
                                              const QString &workPath);

} // namespace zorbin::bench
