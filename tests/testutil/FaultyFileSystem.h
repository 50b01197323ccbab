#pragma once

#include "platform/FileSystem.h"

#include <QSet>

namespace zorbin::test {

// The real file system, except that removing, copying to, or writing the paths in
// `failingPaths` fails as a file held open by another program would.
class FaultyFileSystem final : public FileSystem
{
public:
    bool fileExists(const QString &path) const override { return real().fileExists(path); }
    bool folderExists(const QString &path) const override { return real().folderExists(path); }
    std::optional<QString> findFile(const QString &path) const override { return real().findFile(path); }
    Status makeFolder(const QString &path) override
    {
        return fails(path) ? failure(path) : real().makeFolder(path);
    }
    Status removeFile(const QString &path) override
    {
        return fails(path) ? failure(path) : real().removeFile(path);
    }
    Status copyFile(const QString &from, const QString &to) override
    {
        return fails(to) ? failure(to) : real().copyFile(from, to);
    }
    QStringList fileNames(const QString &folder) const override { return real().fileNames(folder); }
    Result<std::unique_ptr<QIODevice>> openForReading(const QString &path) const override
    {
        return real().openForReading(path);
    }
    Result<std::unique_ptr<QIODevice>> openForWriting(const QString &path) override
    {
        return fails(path) ? failure(path) : real().openForWriting(path);
    }
    Result<std::unique_ptr<QIODevice>> openForAppending(const QString &path) override
    {
        return fails(path) ? failure(path) : real().openForAppending(path);
    }

    QSet<QString> failingPaths;

private:
    static FileSystem &real() { return localFileSystem(); }
    bool fails(const QString &path) const { return failingPaths.contains(path); }
    static Status failure(const QString &path)
    {
        return Status::fault(QStringLiteral("The file %1 is in use by another program.").arg(path));
    }
};

} // namespace zorbin::test
