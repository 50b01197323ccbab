#include "platform/Windows1255Writer.h"

#include "platform/FileSystem.h"
#include "platform/HtmlReference.h"

namespace zorbin {

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
    : m_file(std::move(device), std::move(path))
{}

Windows1255Writer::~Windows1255Writer()
{
    if (m_file.isOpen())
        (void)close();
}

void Windows1255Writer::write(QStringView text)
{
    m_encoder.encode(text, m_file.pending());
    m_file.flushIfFull();
}

void Windows1255Writer::writeLine(QStringView text)
{
    m_encoder.encode(text, m_file.pending());
    endLine();
}

void Windows1255Writer::endLine()
{
    writeEncoded("\r\n");
}

void Windows1255Writer::writeEscaped(QStringView text)
{
    QByteArray &bytes = m_file.pending();
    const qsizetype size = text.size();
    qsizetype run = 0;
    for (qsizetype i = 0; i < size; ++i) {
        const QLatin1StringView reference = htmlReference(text[i].unicode());
        if (reference.isEmpty())
            continue;
        m_encoder.encode(text.sliced(run, i - run), bytes);
        m_encoder.finish(bytes);
        bytes.append(reference.data(), reference.size());
        run = i + 1;
    }
    m_encoder.encode(text.sliced(run), bytes);
    m_file.flushIfFull();
}

void Windows1255Writer::writeEncoded(QByteArrayView bytes)
{
    // Encoded bytes never start with the second half of a surrogate pair.
    m_encoder.finish(m_file.pending());
    m_file.append(bytes);
}

Status Windows1255Writer::close()
{
    if (m_file.isOpen())
        m_encoder.finish(m_file.pending());
    return m_file.close();
}

} // namespace zorbin
