#pragma once

#include "common/Status.h"

#include <QString>

namespace zorbin {

struct RunContext;

// Writes "tarnik.css" into the output folder; an existing file is kept unless `replace`.
Status CreateCSS(RunContext &context, const QString &outputFolder, bool replace);

} // namespace zorbin
