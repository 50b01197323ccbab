#pragma once

#include <QString>
#include <QStringList>

namespace zorbin::cli {

enum ExitCode : int {
    Success = 0,
    Failure = 1,      // a fault ended the run; its text is on standard error
    UsageError = 2,   // the command line itself is wrong
    EmptyCatalog = 3, // nothing matched the settings: no page was written
};

QString overview();
// Runs one subcommand; `arguments` starts with the program name, then the subcommand's options.
int run(const QString &command, const QStringList &arguments);

} // namespace zorbin::cli
