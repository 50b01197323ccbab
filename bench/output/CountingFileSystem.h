#pragma once

#include "platform/FileSystem.h"

#include <QSet>

namespace zorbin::bench {

// The local file system, counting the picture files that are opened for reading (each such
// opening reads a picture header: the copying itself goes through copyFile).
class CountingFileSystem final : public FileSystem
{
public:
    bool fileExists(const QString &path) const override { return real().fileExists(path); }
    bool folderExists(const QString &path) const override { return real().folderExists(path); }
    std::optional<QString> findFile(const QString &path) const override { return real().findFile(path); }
    Status makeFolder(const QString &path) override { return real().makeFolder(path); }
    Status removeFile(const QString &path) override { return real().removeFile(path); }
    Status copyFile(const QString &from, const QString &to) override
    {
        ++copies;
        return real().copyFile(from, to);
    }
    QStringList fileNames(const QString &folder) const override { return real().fileNames(folder); }
    Result<std::unique_ptr<QIODevice>> openForReading(const QString &path) const override
    {
        ++readings;
        distinctReadings.insert(path);
        return real().openForReading(path);
    }
    Result<std::unique_ptr<QIODevice>> openForWriting(const QString &path) override
    {
        return real().openForWriting(path);
    }
    Result<std::unique_ptr<QIODevice>> openForAppending(const QString &path) override
    {
        return real().openForAppending(path);
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

private:
    static FileSystem &real() { return localFileSystem(); }
};

} // namespace zorbin::bench
