#pragma once

#include "common/Status.h"

#include <QByteArray>
#include <QByteArrayView>
#include <QIODevice>
#include <QString>
#include <memory>

namespace zorbin {

// The bytes of a file being written, gathered and handed to the file in large blocks, so that
// the system calls cost little next to making the text.
//
// The first failure to write is kept and every later write is dropped; close() reports it. A
// file destroyed without close() writes what it holds and closes, ignoring failures.
class BlockFile
{
public:
    BlockFile(std::unique_ptr<QIODevice> device, QString path);
    ~BlockFile();
    BlockFile(const BlockFile &) = delete;
    BlockFile &operator=(const BlockFile &) = delete;

    // The bytes not yet handed to the file, for a writer that appends to them in place; it calls
    // flushIfFull() after.
    QByteArray &pending() { return m_bytes; }
    void flushIfFull();
    void append(QByteArrayView bytes);

    // Whether every write so far reached the file.
    bool isOk() const { return m_status.isOk(); }
    bool isOpen() const { return m_device != nullptr; }
    // Writes what is held and closes the file: the first failure, if any.
    Status close();

    const QString &path() const { return m_path; }
    // Bytes handed to the file so far.
    qint64 bytesWritten() const { return m_bytesWritten; }

private:
    void flush();

    std::unique_ptr<QIODevice> m_device;
    QString m_path;
    QByteArray m_bytes;
    Status m_status;
    qint64 m_bytesWritten = 0;
};

// The message of a file that could not be written.
Status writeFailure(const QString &path, const QString &reason);

} // namespace zorbin
