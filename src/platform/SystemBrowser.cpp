#include "platform/Browser.h"

#include <QDir>
#include <QProcess>
#include <QStandardPaths>
#include <QUrl>

#ifdef Q_OS_UNIX
#include <unistd.h>
#endif

namespace zorbin {
namespace {

QString findChromiumFamily()
{
    const QStringList candidates = {
        QStringLiteral("chromium"),       QStringLiteral("chromium-browser"),
        QStringLiteral("google-chrome"),  QStringLiteral("google-chrome-stable"),
        QStringLiteral("microsoft-edge"), QStringLiteral("msedge"),
        QStringLiteral("brave-browser"),
    };
    for (const QString &name : candidates) {
        const QString path = QStandardPaths::findExecutable(name);
        if (!path.isEmpty())
            return path;
    }
    return {};
}

class SystemBrowser final : public Browser
{
public:
    Status openWindow(const QString &file) override
    {
        const QString url = QUrl::fromLocalFile(QDir::fromNativeSeparators(file)).toString();
        QString program = qEnvironmentVariable("ZORBIN_BROWSER");
        QStringList arguments;
        if (!program.isEmpty()) {
            arguments << url;
        } else if (program = findChromiumFamily(); !program.isEmpty()) {
            arguments << QStringLiteral("--new-window") << QStringLiteral("--app=") + url;
#ifdef Q_OS_UNIX
            if (::geteuid() == 0) // Chromium refuses to start as root with its sandbox on.
                arguments << QStringLiteral("--no-sandbox");
#endif
        } else {
#if defined(Q_OS_WIN)
            program = QStringLiteral("explorer");
            arguments << QDir::toNativeSeparators(file);
#elif defined(Q_OS_MACOS)
            program = QStringLiteral("open");
            arguments << QStringLiteral("-n") << file;
#else
            program = QStandardPaths::findExecutable(QStringLiteral("xdg-open"));
            arguments << url;
#endif
        }
        if (program.isEmpty() || !QProcess::startDetached(program, arguments))
            return Status::fault(QStringLiteral("לא נמצא דפדפן להצגת %1. יש לפתוח את הקובץ בדפדפן.")
                                     .arg(QDir::toNativeSeparators(file)));
        return Status::ok();
    }
};

} // namespace

std::unique_ptr<Browser> makeSystemBrowser()
{
    return std::make_unique<SystemBrowser>();
}

} // namespace zorbin
