#pragma once

#include "common/Status.h"

#include <QString>

namespace zorbin {

struct RunContext;

// Writes the plain item list page.
Status CreateListHTML(RunContext &context, const QString &fileName, const QString &dbFile);

} // namespace zorbin
