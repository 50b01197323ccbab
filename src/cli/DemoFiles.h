#pragma once

#include "common/Status.h"

#include <QString>

namespace zorbin::cli {

// The bundled demo: its accounting database and the settings that make its catalog.
struct DemoFiles
{
    QString folder;
    QString settingsFile; // an INI settings file whose connection points at the demo database
};

// Looks for the demo in ZORBIN_DEMO_DIR, the build tree, then the installed data folder.
Result<DemoFiles> findDemoFiles();

} // namespace zorbin::cli
