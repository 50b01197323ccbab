#pragma once

#include "control/CatalogStages.h"

#include <memory>

namespace zorbin {

struct RunContext;
class SettingsStore;

// The stages of a real run: the accounting database, the working database and the output
// writers. `context` and `store` must outlive the stages.
std::unique_ptr<CatalogStages> makeStandardStages(RunContext &context, SettingsStore &store);

} // namespace zorbin
