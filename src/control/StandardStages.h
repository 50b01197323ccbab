#pragma once

#include "control/CatalogStages.h"

#include <memory>

namespace zorbin {

class SettingsStore;

// The stages of a real run: the accounting database, the working database and the writers.
// `store`, where the connection parameters are kept, must outlive the stages.
std::unique_ptr<CatalogStages> makeStandardStages(SettingsStore &store);

} // namespace zorbin
