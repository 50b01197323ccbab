#include "cli/Statements.h"

namespace zorbin::cli {

Result<std::vector<std::pair<QString, QString>>> runStatements(RunContext &)
{
    return Status::fault(
        QStringLiteral("The statements of a run cannot be listed yet: the source queries are "
                       "not part of this build."));
}

} // namespace zorbin::cli
