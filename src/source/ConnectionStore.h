#pragma once

#include "source/ConnectionParams.h"

namespace zorbin {

class SettingsStore;

// Loads the connection parameters from the store ("ConnServer", "ConnUID", "ConnPWD",
// "ConnDataBase", "ConnType"); a value that cannot be read leaves its field as it was.
void GetRegConnParams(SettingsStore &store, ConnectionParams &params);

} // namespace zorbin
