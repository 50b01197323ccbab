#include "web/SiteFile.h"

#include "output/FileNaming.h"
#include "platform/FileSystem.h"

namespace zorbin {

Result<std::unique_ptr<SiteFile>> SiteFile::create(FileSystem &files, const QString &path)
{
    auto device = files.openForWriting(path);
    if (!device)
        return device.status();
    return std::unique_ptr<SiteFile>(new SiteFile(std::move(device).value(), path));
}

SiteFile::SiteFile(std::unique_ptr<QIODevice> device, QString path)
    : m_file(std::move(device), std::move(path))
{}

void SiteFile::write(QStringView text)
{
    m_file.append(text.toUtf8());
}

void SiteFile::writeEscaped(QStringView text)
{
    write(escapeHtml(text.toString()));
}

void SiteFile::writeBytes(QByteArrayView bytes)
{
    m_file.append(bytes);
}

} // namespace zorbin
