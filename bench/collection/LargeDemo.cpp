#include "LargeDemo.h"

#include <QDir>
#include <QFileInfo>
#include <QProcess>
#include <cstdio>

namespace zorbin::bench {

Result<QString> largeDemoDatabase(const QString &folder, int items)
{
    const QString target = QDir(folder).filePath(QStringLiteral("demo-%1").arg(items));
    const QString database = QDir(target).filePath(QStringLiteral("demo-accounting.db"));
    const QString done = database + QStringLiteral(".complete");
    if (QFileInfo::exists(done))
        return database;
    std::fprintf(stderr, "Building the demo database with %d items in %s ...\n", items, qPrintable(target));
    QProcess script;
    script.setProcessChannelMode(QProcess::ForwardedChannels);
    script.start(QStringLiteral("bash"), {QStringLiteral(ZORBIN_DEMO_SCRIPT), QStringLiteral("--items"),
                                          QString::number(items), target});
    if (!script.waitForFinished(-1) || script.exitStatus() != QProcess::NormalExit || script.exitCode() != 0)
        return Status::fault(QStringLiteral("The demo script failed: %1").arg(script.errorString()));
    QFile marker(done);
    if (!marker.open(QIODevice::WriteOnly))
        return Status::fault(QStringLiteral("cannot write %1").arg(done));
    return database;
}

} // namespace zorbin::bench
