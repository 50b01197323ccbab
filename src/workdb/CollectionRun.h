#pragma once

#include "common/Status.h"

namespace zorbin {

struct RunContext;

// The collection run: a fresh working database, then items, sort groups, price lists and
// extra notes, with the step's text in the status line. Sets WorkDBFile.
Status BuildAndCollectData(RunContext &context);

} // namespace zorbin
