#include "web/SiteFile.h"

#include "output/FileNaming.h"
#include "platform/FileSystem.h"

#include <QDir>
#include <QFileDevice>

namespace zorbin {
namespace {

// Few enough writes that the system calls cost little next to making the text.
constexpr qsizetype BlockSize = 256 * 1024;

Status writeFailure(const QString &path, const QString &reason)
{
    return Status::fault(
        QStringLiteral("לא ניתן לכתוב את הקובץ %1: %2").arg(QDir::toNativeSeparators(path), reason));
}

} // namespace

Result<std::unique_ptr<SiteFile>> SiteFile::create(FileSystem &files, const QString &path)
{
    auto device = files.openForWriting(path);
    if (!device)
        return device.status();
    return std::unique_ptr<SiteFile>(new SiteFile(std::move(device).value(), path));
}

SiteFile::SiteFile(std::unique_ptr<QIODevice> device, QString path)
    : m_device(std::move(device)), m_path(std::move(path))
{
    m_bytes.reserve(BlockSize + 4096);
}

SiteFile::~SiteFile()
{
    if (m_device)
        (void)close();
}

void SiteFile::write(QStringView text)
{
    m_bytes.append(text.toUtf8());
    if (m_bytes.size() >= BlockSize)
        flush();
}

void SiteFile::writeEscaped(QStringView text)
{
    write(escapeHtml(text.toString()));
}

void SiteFile::writeBytes(QByteArrayView bytes)
{
    m_bytes.append(bytes.data(), bytes.size());
    if (m_bytes.size() >= BlockSize)
        flush();
}

void SiteFile::flush()
{
    if (m_status && m_device && !m_bytes.isEmpty() && m_device->write(m_bytes) != m_bytes.size())
        m_status = writeFailure(m_path, m_device->errorString());
    // truncate, not clear: the block keeps its room for the next bytes.
    m_bytes.truncate(0);
}

Status SiteFile::close()
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
