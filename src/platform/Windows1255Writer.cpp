#include "platform/Windows1255Writer.h"

#include "platform/FileSystem.h"

#include <QDir>
#include <QFileDevice>

namespace zorbin {
namespace {

// Text is gathered up to this many characters before it is encoded and handed to the file.
constexpr qsizetype PendingLimit = 32 * 1024;

Status writeFailure(const QString &path, const QString &reason)
{
    return Status::fault(
        QStringLiteral("לא ניתן לכתוב את הקובץ %1: %2").arg(QDir::toNativeSeparators(path), reason));
}

} // namespace

Result<std::unique_ptr<Windows1255Writer>> Windows1255Writer::create(FileSystem &files, const QString &path)
{
    if (const Status removed = files.removeFile(path); !removed)
        return removed;
    auto device = files.openForWriting(path);
    if (!device)
        return device.status();
    std::unique_ptr<Windows1255Writer> writer(new Windows1255Writer(std::move(device).value(), path));
    if (!writer->m_encoder.isValid())
        return writeFailure(path, QStringLiteral("הממיר windows-1255 של ICU חסר במערכת"));
    return writer;
}

Windows1255Writer::Windows1255Writer(std::unique_ptr<QIODevice> device, QString path)
    : m_device(std::move(device)), m_path(std::move(path))
{
    m_pending.reserve(PendingLimit + 1024);
}

Windows1255Writer::~Windows1255Writer()
{
    if (m_device)
        (void)close();
}

void Windows1255Writer::write(QStringView text)
{
    m_pending += text;
    if (m_pending.size() >= PendingLimit)
        flushPending(false);
}

void Windows1255Writer::writeLine(QStringView text)
{
    m_pending += text;
    endLine();
}

void Windows1255Writer::endLine()
{
    m_pending += QLatin1String("\r\n");
    if (m_pending.size() >= PendingLimit)
        flushPending(false);
}

void Windows1255Writer::flushPending(bool last)
{
    m_bytes.clear();
    m_encoder.encode(m_pending, m_bytes, last);
    m_pending.clear();
    if (!m_status || !m_device || m_bytes.isEmpty())
        return;
    const qint64 written = m_device->write(m_bytes);
    if (written != m_bytes.size()) {
        m_status = writeFailure(m_path, m_device->errorString());
        return;
    }
    m_bytesWritten += written;
}

Status Windows1255Writer::close()
{
    if (!m_device)
        return m_status;
    flushPending(true);
    if (auto *file = qobject_cast<QFileDevice *>(m_device.get())) {
        if (!file->flush() && m_status)
            m_status = writeFailure(m_path, file->errorString());
    }
    m_device->close();
    m_device.reset();
    return m_status;
}

} // namespace zorbin
