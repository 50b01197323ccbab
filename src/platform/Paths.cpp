#include "platform/Paths.h"

#include <QDir>
#include <QFile>
#include <QFileInfo>
#include <QStandardPaths>

namespace zorbin {

QChar pathSeparator()
{
    return QDir::separator();
}

QString withTrailingSeparator(const QString &folder)
{
    if (folder.isEmpty() || folder.endsWith(pathSeparator()))
        return folder;
    return folder + pathSeparator();
}

QString temporaryFolder()
{
#ifdef Q_OS_WIN
    const QString temp = qEnvironmentVariable("Temp");
    if (!temp.isEmpty())
        return QDir::toNativeSeparators(temp);
#else
    // The system's temporary folder is shared by every user, and the working database has one
    // name in it: another user's run could neither replace nor lock it, and a name that others
    // can create is no place for a file that is deleted and made anew. Without TMPDIR each user
    // has a folder of their own, in their cache folder.
    if (qEnvironmentVariableIsEmpty("TMPDIR")) {
        const QString cache = QStandardPaths::writableLocation(QStandardPaths::GenericCacheLocation);
        if (!cache.isEmpty()) {
            const QString own = cache + QStringLiteral("/zorbin");
            const bool existed = QFileInfo::exists(own);
            if (QDir().mkpath(own)) {
                if (!existed)
                    QFile::setPermissions(own, QFileDevice::ReadOwner | QFileDevice::WriteOwner |
                                                   QFileDevice::ExeOwner);
                return own;
            }
        }
    }
#endif
    // TMPDIR on Unix, the system's choice on Windows; never empty.
    QString folder = QDir::toNativeSeparators(QDir::tempPath());
    while (folder.size() > 1 && folder.endsWith(pathSeparator()))
        folder.chop(1);
    return folder;
}

QString defaultPictureFolder()
{
#ifdef Q_OS_WIN
    return QStringLiteral("c:\\photos\\");
#else
    return withTrailingSeparator(QDir::homePath() + QStringLiteral("/photos"));
#endif
}

QString defaultOutputFolder()
{
#ifdef Q_OS_WIN
    return QStringLiteral("c:\\output");
#else
    return QDir::homePath() + QStringLiteral("/output");
#endif
}

} // namespace zorbin
