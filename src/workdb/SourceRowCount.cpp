#include "workdb/SourceRowCount.h"

#include "source/SourceConnection.h"

namespace zorbin {

std::int64_t countSourceRows(SourceConnection &connection, const QString &statement)
{
    {
        Result<QSqlQuery> counted = connection.select(QStringLiteral("SELECT COUNT(*) FROM (") + statement +
                                                      QStringLiteral(") AS CollectedRows"));
        if (counted && counted->next())
            return counted->value(0).toLongLong();
    }
    Result<QSqlQuery> rows = connection.select(statement);
    std::int64_t count = 0;
    if (rows) {
        while (rows->next())
            ++count;
    }
    return count;
}

} // namespace zorbin
