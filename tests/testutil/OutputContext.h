#pragma once

#include "model/CatalogSettings.h"
#include "model/ConnectionParams.h"
#include "model/RunContext.h"
#include "model/RunState.h"
#include "platform/FileSystem.h"
#include "testutil/RecordingUserPort.h"

namespace zorbin::test {

// Everything an output writer is called with: fresh settings, a user port that records, and
// the local file system (or another one given).
struct OutputContext
{
    explicit OutputContext(FileSystem &fileSystem = localFileSystem())
        : context{settings, connection, state, user, fileSystem}
    {}

    CatalogSettings settings;
    ConnectionParams connection;
    RunState state;
    RecordingUserPort user;
    RunContext context;
};

} // namespace zorbin::test
