#pragma once

#include "common/Status.h"
#include "platform/BlockFile.h"

#include <QByteArray>
#include <QIODevice>
#include <QString>
#include <memory>

namespace zorbin {

class FileSystem;

// A text file of the web catalog, in UTF-8 (every character as it is, none as a reference).
//
// Bytes are handed to the file in large blocks (see BlockFile for failures and a file destroyed
// without close()).
class SiteFile
{
public:
    // Creates the file through `files`, replacing one of that name.
    static Result<std::unique_ptr<SiteFile>> create(FileSystem &files, const QString &path);

    void write(QStringView text);
    // A working-database value: markup characters go in as their references.
    void writeEscaped(QStringView text);
    // Bytes that are already UTF-8, such as the parts of a page prepared once a run.
    void writeBytes(QByteArrayView bytes);

    // Writes what is held and closes the file: the first failure, if any.
    Status close() { return m_file.close(); }

private:
    SiteFile(std::unique_ptr<QIODevice> device, QString path);

    BlockFile m_file;
};

} // namespace zorbin
