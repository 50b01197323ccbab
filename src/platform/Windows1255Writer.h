#pragma once

#include "common/Status.h"
#include "platform/BlockFile.h"
#include "platform/Windows1255Encoder.h"

#include <QByteArrayView>
#include <QIODevice>
#include <QString>
#include <memory>

namespace zorbin {

class FileSystem;

// A text file of the catalog, written line by line in windows-1255, every line ended by
// carriage return and line feed (see Windows1255Encoder for characters the code page lacks).
//
// Text is encoded as it comes and the bytes handed to the file in large blocks (see BlockFile for
// failures and a writer destroyed without close()).
class Windows1255Writer
{
public:
    // Deletes a file of that name and creates it anew through `files`.
    static Result<std::unique_ptr<Windows1255Writer>> create(FileSystem &files, const QString &path);

    ~Windows1255Writer();
    Windows1255Writer(const Windows1255Writer &) = delete;
    Windows1255Writer &operator=(const Windows1255Writer &) = delete;

    // Text without a line end.
    void write(QStringView text);
    // Text and a line end.
    void writeLine(QStringView text);
    // A line end.
    void endLine();
    // Text of a working-database value: markup characters go in as their references (see
    // htmlReference), so that the value can neither break the page nor add markup to it.
    void writeEscaped(QStringView text);
    // Bytes already in the code page, such as the fixed parts of a page encoded once a run.
    void writeEncoded(QByteArrayView bytes);

    // Whether every write so far reached the file.
    bool isOk() const { return m_file.isOk(); }
    // Writes what is held and closes the file: the first failure, if any.
    Status close();

    const QString &path() const { return m_file.path(); }
    // Bytes handed to the file so far.
    qint64 bytesWritten() const { return m_file.bytesWritten(); }

private:
    Windows1255Writer(std::unique_ptr<QIODevice> device, QString path);
    Windows1255Encoder m_encoder;
    BlockFile m_file;
};

} // namespace zorbin
