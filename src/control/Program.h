#pragma once

#include "control/CatalogControl.h"

#include <memory>

namespace zorbin {

class SettingsStore;
class UserPort;

// Sets the process up for the runs before any database is opened; the first call in main().
void prepareProcess();

// The catalog control of a program, with the stages of a real run (the accounting database,
// the working database, the writers) and the platform's file system. Both programs build their
// control here and hand it to their front end. `user` and `store` must outlive the control.
std::unique_ptr<CatalogControl> assembleControl(UserPort &user, SettingsStore &store);

} // namespace zorbin
