#include "output/CopiedPictures.h"

#include "platform/FileSystem.h"
#include "platform/Paths.h"

namespace zorbin {

QString CopiedPictures::recordPath(const QString &imagesFolder)
{
    return withTrailingSeparator(imagesFolder) + RecordName;
}

QStringList CopiedPictures::read(const FileSystem &files, const QString &imagesFolder)
{
    auto record = files.openForReading(recordPath(imagesFolder));
    if (!record)
        return {};
    QStringList names;
    const QString content = QString::fromUtf8(record.value()->readAll());
    for (const QString &line : content.split(QLatin1Char('\n'), Qt::SkipEmptyParts)) {
        const QString name = line.trimmed();
        // Only bare names: a damaged record must not send the clean-up out of the folder.
        if (!name.isEmpty() && !name.contains(QLatin1Char('/')) && !name.contains(QLatin1Char('\\')) &&
            name != QLatin1String(".") && name != QLatin1String("..") && !names.contains(name))
            names << name;
    }
    return names;
}

Status CopiedPictures::removeAll(FileSystem &files, const QString &imagesFolder)
{
    const QString folder = withTrailingSeparator(imagesFolder);
    for (const QString &name : read(files, imagesFolder)) {
        // A name that is now a folder is not one of our copies; failing on it would end every
        // later catalog run, since the record would never be cleared.
        if (!files.fileExists(folder + name))
            continue;
        if (const Status removed = files.removeFile(folder + name); !removed)
            return removed;
    }
    return files.removeFile(recordPath(imagesFolder));
}

CopiedPictures::CopiedPictures(FileSystem &files, QString imagesFolder)
    : m_files(files), m_imagesFolder(std::move(imagesFolder))
{}

Status CopiedPictures::add(const QString &fileName)
{
    if (!m_record) {
        auto opened = m_files.openForAppending(recordPath(m_imagesFolder));
        if (!opened)
            return opened.status();
        m_record = std::move(opened).value();
    }
    const QByteArray line = fileName.toUtf8() + '\n';
    if (m_record->write(line) != line.size())
        return Status::fault(QStringLiteral("לא ניתן לכתוב את הקובץ %1.").arg(recordPath(m_imagesFolder)));
    return Status::ok();
}

} // namespace zorbin
