#pragma once

#include "platform/ForwardingFileSystem.h"

#include <QSet>

namespace zorbin::bench {

// The local file system, counting the copies and the files opened for reading (each picture
// file opened for reading is a picture header read: the copying goes through copyFile).
class CountingFileSystem final : public ForwardingFileSystem
{
public:
    Status copyFile(const QString &from, const QString &to) override
    {
        ++copies;
        return ForwardingFileSystem::copyFile(from, to);
    }
    Result<std::unique_ptr<QIODevice>> openForReading(const QString &path) const override
    {
        ++readings;
        distinctReadings.insert(path);
        return ForwardingFileSystem::openForReading(path);
    }

    void clear()
    {
        readings = 0;
        copies = 0;
        distinctReadings.clear();
    }

    mutable int readings = 0;
    mutable QSet<QString> distinctReadings;
    int copies = 0;
};

} // namespace zorbin::bench
