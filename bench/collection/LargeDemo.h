#pragma once

#include "common/Status.h"

#include <QString>

namespace zorbin::bench {

// The demo accounting database with `items` uniform items (each with prices in lists 1 and 2
// and notes of kinds 1 and 2), built once by the demo script into `folder` and reused by later
// runs. Returns the database file's path.
Result<QString> largeDemoDatabase(const QString &folder, int items);

} // namespace zorbin::bench
