#pragma once

#include <QString>

namespace zorbin {

// The control-wide state that the runs and their steps share.
struct RunState
{
    // Full path of the current working database: empty from start-up until the first
    // collection, then the path that collection created; passed to every step as pDBFile.
    QString WorkDBFile;
    // Set by the stop button; the long steps test it at each progress point and end early.
    bool StopRequested = false;
};

} // namespace zorbin
