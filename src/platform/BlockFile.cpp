#include "platform/BlockFile.h"

#include <QDir>
#include <QFileDevice>

namespace zorbin {
namespace {

constexpr qsizetype BlockSize = 256 * 1024;

} // namespace

Status writeFailure(const QString &path, const QString &reason)
{
    return Status::fault(
        QStringLiteral("לא ניתן לכתוב את הקובץ %1: %2").arg(QDir::toNativeSeparators(path), reason));
}

BlockFile::BlockFile(std::unique_ptr<QIODevice> device, QString path)
    : m_device(std::move(device)), m_path(std::move(path))
{
    m_bytes.reserve(BlockSize + 4096);
}

BlockFile::~BlockFile()
{
    if (m_device)
        (void)close();
}

void BlockFile::append(QByteArrayView bytes)
{
    m_bytes.append(bytes.data(), bytes.size());
    flushIfFull();
}

void BlockFile::flushIfFull()
{
    if (m_bytes.size() >= BlockSize)
        flush();
}

void BlockFile::flush()
{
    if (m_status && m_device && !m_bytes.isEmpty()) {
        const qint64 written = m_device->write(m_bytes);
        if (written == m_bytes.size())
            m_bytesWritten += written;
        else
            m_status = writeFailure(m_path, m_device->errorString());
    }
    // truncate, not clear: the block keeps its room for the next bytes.
    m_bytes.truncate(0);
}

Status BlockFile::close()
{
    if (!m_device)
        return m_status;
    flush();
    if (auto *file = qobject_cast<QFileDevice *>(m_device.get())) {
        if (!file->flush() && m_status)
            m_status = writeFailure(m_path, file->errorString());
    }
    m_device->close();
    m_device.reset();
    return m_status;
}

} // namespace zorbin
