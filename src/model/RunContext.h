#pragma once

namespace zorbin {

struct CatalogSettings;
struct ConnectionParams;
struct RunState;
class FileSystem;
class UserPort;

// What every step of a run works with. All members belong to the control and outlive the run.
struct RunContext
{
    CatalogSettings &settings;
    ConnectionParams &connection;
    RunState &state;
    UserPort &user;
    FileSystem &files;
};

} // namespace zorbin
