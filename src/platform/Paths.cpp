#include "platform/Paths.h"

#include <QDir>

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
