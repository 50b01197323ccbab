#include "platform/Windows1255Writer.h"

#include "platform/FileSystem.h"
#include "platform/HtmlReference.h"

#include <QDir>
#include <QFileDevice>

namespace zorbin {
namespace {

// Bytes are gathered up to this many before they are handed to the file: few enough writes
// that the system calls cost little next to the encoding.
constexpr qsizetype BlockSize = 256 * 1024;

Status writeFailure(const QString &path, const QString &reason)
{
    return Status::fault(
        QStringLiteral("לא ניתן לכתוב את הקובץ %1: %2").arg(QDir::toNativeSeparators(path), reason));
}

} // namespace

Result<std::unique_ptr<Windows1255Writer>> Windows1255Writer::create(FileSystem &files, const QString &path)
{
    // Without the converter the old file would be replaced by an empty one.
    if (!Windows1255Encoder().isValid())
        return writeFailure(path, QStringLiteral("הממיר windows-1255 של ICU חסר במערכת"));
    if (const Status removed = files.removeFile(path); !removed)
        return removed;
    auto device = files.openForWriting(path);
    if (!device)
        return device.status();
    return std::unique_ptr<Windows1255Writer>(new Windows1255Writer(std::move(device).value(), path));
}

Windows1255Writer::Windows1255Writer(std::unique_ptr<QIODevice> device, QString path)
    : m_device(std::move(device)), m_path(std::move(path))
{
    m_bytes.reserve(BlockSize + 4096);
}

Windows1255Writer::~Windows1255Writer()
{
    if (m_device)
        (void)close();
}

void Windows1255Writer::write(QStringView text)
{
    m_encoder.encode(text, m_bytes);
    flushIfFull();
}

void Windows1255Writer::writeLine(QStringView text)
{
    m_encoder.encode(text, m_bytes);
    endLine();
}

void Windows1255Writer::endLine()
{
    writeEncoded("\r\n");
}

void Windows1255Writer::writeEscaped(QStringView text)
{
    const qsizetype size = text.size();
    qsizetype run = 0;
    for (qsizetype i = 0; i < size; ++i) {
        const QLatin1StringView reference = htmlReference(text[i].unicode());
        if (reference.isEmpty())
            continue;
        m_encoder.encode(text.sliced(run, i - run), m_bytes);
        m_encoder.finish(m_bytes);
        m_bytes.append(reference.data(), reference.size());
        run = i + 1;
    }
    m_encoder.encode(text.sliced(run), m_bytes);
    flushIfFull();
}

void Windows1255Writer::writeEncoded(QByteArrayView bytes)
{
    // Encoded bytes never start with the second half of a surrogate pair.
    m_encoder.finish(m_bytes);
    m_bytes.append(bytes.data(), bytes.size());
    flushIfFull();
}

void Windows1255Writer::flushIfFull()
{
    if (m_bytes.size() >= BlockSize)
        flush();
}

void Windows1255Writer::flush()
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

Status Windows1255Writer::close()
{
    if (!m_device)
        return m_status;
    m_encoder.finish(m_bytes);
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
