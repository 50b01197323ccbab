#pragma once

#include "common/Status.h"

#include <QString>
#include <utility>
#include <vector>

namespace zorbin {

struct RunContext;

// Every statement a catalog run with these settings would send, labelled: "connection" (the
// connection text, password masked), "items", "sort-groups", "price1", "price2", "note1",
// "note2", "catalog"; only the steps the settings enable.
Result<std::vector<std::pair<QString, QString>>> runStatements(RunContext &context);

} // namespace zorbin
