#pragma once

#include <QAtomicInteger>
#include <QString>

namespace zorbin {

// A name for a new Qt database connection, never used before in this process: Qt keeps its
// connections in one registry by name, and the collection opens them from more than one thread.
inline QString uniqueConnectionName(const QString &purpose)
{
    static QAtomicInteger<quint64> counter;
    return QStringLiteral("zorbin-%1-%2").arg(purpose).arg(++counter);
}

} // namespace zorbin
