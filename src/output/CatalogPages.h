#pragma once

#include "common/Status.h"

#include <QString>

namespace zorbin {

struct RunContext;

// Writes the catalog pages; returns the first page's file name, or the empty text when the
// catalog query has no rows (no page is written then).
Result<QString> CreateCatHTML(RunContext &context, const QString &pagePrefix, const QString &dbFile,
                              const QString &imagesFolder);

} // namespace zorbin
