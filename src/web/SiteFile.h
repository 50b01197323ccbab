#pragma once

#include "common/Status.h"

#include <QByteArray>
#include <QIODevice>
#include <QString>
#include <memory>

namespace zorbin {

class FileSystem;

// A text file of the web catalog, in UTF-8 (every character as it is, none as a reference).
//
// Bytes are gathered and handed to the file in large blocks. The first failure to write is
// kept and every later write is dropped; close() reports it. A file destroyed without close()
// writes what it holds and closes, ignoring failures.
class SiteFile
{
public:
    // Creates the file through `files`, replacing one of that name.
    static Result<std::unique_ptr<SiteFile>> create(FileSystem &files, const QString &path);

    ~SiteFile();
    SiteFile(const SiteFile &) = delete;
    SiteFile &operator=(const SiteFile &) = delete;

    void write(QStringView text);
    // A working-database value: markup characters go in as their references.
    void writeEscaped(QStringView text);
    // Bytes that are already UTF-8, such as the parts of a page prepared once a run.
    void writeBytes(QByteArrayView bytes);

    // Writes what is held and closes the file: the first failure, if any.
    Status close();

private:
    SiteFile(std::unique_ptr<QIODevice> device, QString path);
    void flush();

    std::unique_ptr<QIODevice> m_device;
    QString m_path;
    QByteArray m_bytes; // not yet handed to the file
    Status m_status;
};

} // namespace zorbin
