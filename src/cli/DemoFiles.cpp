#include "cli/DemoFiles.h"

#include <QCoreApplication>
#include <QDir>
#include <QFileInfo>

namespace zorbin::cli {

namespace {
const QString DemoSettingsName = QStringLiteral("demo-settings.ini");

// The build tree's demo serves only a program run from that build tree: an installed program
// reads the installed demo, whose settings and pictures name the installed folder, even when
// the tree it was built in is still there.
bool runsFromBuildTree()
{
    const QString tree = QFileInfo(QStringLiteral(ZORBIN_DEMO_BUILD_DIR "/..")).canonicalFilePath();
    const QString program = QFileInfo(QCoreApplication::applicationDirPath()).canonicalFilePath();
    return !tree.isEmpty() && (program == tree || program.startsWith(tree + QLatin1Char('/')));
}
} // namespace

Result<DemoFiles> findDemoFiles()
{
    QStringList candidates;
    if (const QString fromEnvironment = qEnvironmentVariable("ZORBIN_DEMO_DIR"); !fromEnvironment.isEmpty())
        candidates << fromEnvironment;
    if (runsFromBuildTree())
        candidates << QStringLiteral(ZORBIN_DEMO_BUILD_DIR);
    candidates << QStringLiteral(ZORBIN_DEMO_INSTALL_DIR)
               << QCoreApplication::applicationDirPath() + QStringLiteral("/../share/zorbin/demo");
    for (const QString &folder : candidates) {
        const QString settings = QDir(folder).filePath(DemoSettingsName);
        if (QFileInfo(settings).isFile())
            return DemoFiles{QDir(folder).absolutePath(), settings};
    }
    return Status::fault(QStringLiteral("The demo database was not found (looked in: %1). Build the project "
                                        "first, or set ZORBIN_DEMO_DIR to the folder that holds %2.")
                             .arg(candidates.join(QStringLiteral(", ")), DemoSettingsName));
}

} // namespace zorbin::cli
