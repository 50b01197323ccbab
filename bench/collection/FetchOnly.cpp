#include "FetchOnly.h"

#include "source/SourceConnection.h"
#include "workdb/SourceRowCount.h"

#include <QElapsedTimer>
#include <QSqlRecord>

namespace zorbin::bench {

Result<std::vector<FetchTiming>> measureFetch(const QString &connectionString, const QStringList &statements)
{
    std::vector<FetchTiming> timings;
    for (const QString &statement : statements) {
        FetchTiming timing{statement, 0, 0, 0};
        QElapsedTimer clock;
        {
            Result<std::unique_ptr<SourceConnection>> source = SourceConnection::open(connectionString);
            if (!source)
                return source.status();
            clock.start();
            countSourceRows(*source.value(), statement);
            timing.countSeconds = static_cast<double>(clock.nsecsElapsed()) / 1e9;
        }
        clock.restart();
        Result<std::unique_ptr<SourceConnection>> source = SourceConnection::open(connectionString);
        if (!source)
            return source.status();
        Result<QSqlQuery> rows = source.value()->select(statement);
        if (!rows)
            return rows.status();
        const int columns = rows->record().count();
        QVariant value;
        while (rows->next()) {
            for (int i = 0; i < columns; ++i)
                value = rows->value(i);
            ++timing.rows;
        }
        timing.fetchSeconds = static_cast<double>(clock.nsecsElapsed()) / 1e9;
        timings.push_back(timing);
    }
    return timings;
}

} // namespace zorbin::bench
