#pragma once

#include "common/Status.h"

#include <QIODevice>
#include <QString>
#include <QStringList>
#include <memory>
#include <optional>

namespace zorbin {

// The file operations of the catalog runs, behind an interface so that a test can make any of
// them fail. Paths are full paths in the platform's own form; failures carry a sentence that
// names the path and what went wrong.
class FileSystem
{
public:
    virtual ~FileSystem() = default;

    virtual bool fileExists(const QString &path) const = 0; // a regular file
    virtual bool folderExists(const QString &path) const = 0;
    // The file a picture reference names, taken literally (no wildcards), as the file system
    // spells it. Where names are case-sensitive a name that differs only in letter case is
    // found too, as it would be on Windows. Nothing when there is no such file.
    virtual std::optional<QString> findFile(const QString &path) const = 0;
    // Creates one folder level; the parent must exist.
    virtual Status makeFolder(const QString &path) = 0;
    virtual Status removeFile(const QString &path) = 0;
    // Copies `from` to `to`, replacing a file of that name.
    virtual Status copyFile(const QString &from, const QString &to) = 0;
    // The names (not paths) of the regular files in a folder.
    virtual QStringList fileNames(const QString &folder) const = 0;
    virtual Result<std::unique_ptr<QIODevice>> openForReading(const QString &path) const = 0;
    // Creates the file, or empties an existing one.
    virtual Result<std::unique_ptr<QIODevice>> openForWriting(const QString &path) = 0;
    // Opens the file for writing at its end, creating it when missing.
    virtual Result<std::unique_ptr<QIODevice>> openForAppending(const QString &path) = 0;
};

// The real file system of this machine.
FileSystem &localFileSystem();

} // namespace zorbin
