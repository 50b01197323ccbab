#include "web/SiteStaging.h"

#include "platform/FileSystem.h"
#include "platform/Paths.h"
#include "web/SiteNames.h"

#include <QDir>
#include <QFile>
#include <QFileInfo>
#include <QSet>
#include <filesystem>
#include <system_error>

namespace zorbin {
namespace {

// Replaces `to` by `from` in one step, as the system's rename does; QFile::rename refuses to
// replace, and removing first would leave a moment without the page.
Status replaceFile(const QString &from, const QString &to)
{
    std::error_code error;
    std::filesystem::rename(std::filesystem::path(QFile::encodeName(from).toStdString()),
                            std::filesystem::path(QFile::encodeName(to).toStdString()), error);
    if (error)
        return Status::fault(QStringLiteral("לא ניתן להעביר את הקובץ %1 אל %2: %3")
                                 .arg(QDir::toNativeSeparators(from), QDir::toNativeSeparators(to),
                                      QString::fromLocal8Bit(error.message())));
    return Status::ok();
}

} // namespace

Result<SiteStaging> SiteStaging::prepare(const QString &siteFolder)
{
    const QString folder = withTrailingSeparator(siteFolder);
    const QString staging = folder + site::StagingFolderName;
    // A link of that name goes, not what it leads to.
    const QFileInfo leftover(staging);
    const bool removed = leftover.isSymLink() || leftover.isFile() ? QFile::remove(staging)
                         : leftover.isDir()                        ? QDir(staging).removeRecursively()
                                                                   : true;
    if (!removed)
        return Status::fault(
            QStringLiteral("לא ניתן למחוק את המחיצה %1.").arg(QDir::toNativeSeparators(staging)));
    if (!QDir().mkdir(staging))
        return Status::fault(
            QStringLiteral("לא ניתן ליצור את המחיצה %1.").arg(QDir::toNativeSeparators(staging)));
    return SiteStaging(folder, withTrailingSeparator(staging));
}

SiteStaging::SiteStaging(QString siteFolder, QString staging)
    : m_siteFolder(std::move(siteFolder)), m_staging(std::move(staging))
{}

QString SiteStaging::path(const QString &name) const
{
    return m_staging + name;
}

Status SiteStaging::publish(FileSystem &files, const QStringList &names) const
{
    for (const QString &name : names) {
        if (const Status moved = replaceFile(path(name), m_siteFolder + name); !moved)
            return moved;
    }
    const QSet<QString> written(names.cbegin(), names.cend());
    for (const QString &name : files.fileNames(m_siteFolder)) {
        if (!site::isSiteFileName(name) || written.contains(name))
            continue;
        if (const Status removed = files.removeFile(m_siteFolder + name); !removed)
            return removed;
    }
    discard();
    return Status::ok();
}

void SiteStaging::discard() const
{
    QDir(m_staging).removeRecursively();
}

} // namespace zorbin
