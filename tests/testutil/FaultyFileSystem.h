#pragma once

#include "platform/ForwardingFileSystem.h"

#include <QSet>

namespace zorbin::test {

// The real file system, except that removing, copying to, or writing the paths in
// `failingPaths` fails as a file held open by another program would.
class FaultyFileSystem final : public ForwardingFileSystem
{
public:
    Status makeFolder(const QString &path) override
    {
        return fails(path) ? failure(path) : ForwardingFileSystem::makeFolder(path);
    }
    Status removeFile(const QString &path) override
    {
        return fails(path) ? failure(path) : ForwardingFileSystem::removeFile(path);
    }
    Status copyFile(const QString &from, const QString &to) override
    {
        return fails(to) ? failure(to) : ForwardingFileSystem::copyFile(from, to);
    }
    Result<std::unique_ptr<QIODevice>> openForWriting(const QString &path) override
    {
        return fails(path) ? failure(path) : ForwardingFileSystem::openForWriting(path);
    }
    Result<std::unique_ptr<QIODevice>> openForAppending(const QString &path) override
    {
        return fails(path) ? failure(path) : ForwardingFileSystem::openForAppending(path);
    }

    QSet<QString> failingPaths;

private:
    bool fails(const QString &path) const { return failingPaths.contains(path); }
    static Status failure(const QString &path)
    {
        return Status::fault(QStringLiteral("The file %1 is in use by another program.").arg(path));
    }
};

} // namespace zorbin::test
