#pragma once

#include "platform/FileSystem.h"

namespace zorbin {

// A FileSystem that hands every operation to another one: the base of wrappers that watch or
// change a few operations (counting copies, failing a path) and leave the rest alone.
// The wrapped file system must outlive the wrapper.
class ForwardingFileSystem : public FileSystem
{
public:
    explicit ForwardingFileSystem(FileSystem &inner = localFileSystem()) : m_inner(inner) {}
    // Not copyable: a copy would be chosen over wrapping when the inner file system is itself
    // a ForwardingFileSystem, and would forward to what the original wraps.
    ForwardingFileSystem(const ForwardingFileSystem &) = delete;
    ForwardingFileSystem &operator=(const ForwardingFileSystem &) = delete;

    bool fileExists(const QString &path) const override { return m_inner.fileExists(path); }
    bool folderExists(const QString &path) const override { return m_inner.folderExists(path); }
    std::optional<QString> findFile(const QString &path) const override { return m_inner.findFile(path); }
    Status makeFolder(const QString &path) override { return m_inner.makeFolder(path); }
    Status removeFile(const QString &path) override { return m_inner.removeFile(path); }
    Status copyFile(const QString &from, const QString &to) override { return m_inner.copyFile(from, to); }
    QStringList fileNames(const QString &folder) const override { return m_inner.fileNames(folder); }
    Result<std::unique_ptr<QIODevice>> openForReading(const QString &path) const override
    {
        return m_inner.openForReading(path);
    }
    Result<std::unique_ptr<QIODevice>> openForWriting(const QString &path) override
    {
        return m_inner.openForWriting(path);
    }
    Result<std::unique_ptr<QIODevice>> openForAppending(const QString &path) override
    {
        return m_inner.openForAppending(path);
    }

private:
    FileSystem &m_inner;
};

} // namespace zorbin
