#pragma once

#include "Floor.h"
#include "common/Status.h"

#include <QString>
#include <QStringList>
#include <vector>

namespace zorbin::bench {

struct FetchTiming
{
    QString statement;
    long long rows = 0;
    double fetchSeconds = 0; // running the statement and reading every value of every row
    double countSeconds = 0; // the row count the progress bar needs
};

// The statements run on the accounting database and merely read, each over its own
// connection as the steps do: the rate no collection through that connection can beat.
Result<std::vector<FetchTiming>> measureFetch(const QString &connectionString, const QStringList &statements);

} // namespace zorbin::bench
