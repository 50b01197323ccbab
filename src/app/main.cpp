// zorbin: the desktop program, a window that hosts the catalog control.
#include "card/CardWindow.h"
#include "card/WidgetUserPort.h"
#include "control/Program.h"
#include "platform/SettingsStore.h"

#include <QApplication>
#include <QIcon>
#include <cstdio>
#include <cstring>

int main(int argc, char *argv[])
{
    // Answered before QApplication opens the window system, so that they work without a display.
    for (int i = 1; i < argc; ++i) {
        if (std::strcmp(argv[i], "--version") == 0) {
            std::printf("zorbin %s\n", ZORBIN_VERSION);
            return 0;
        }
        if (std::strcmp(argv[i], "--help") == 0 || std::strcmp(argv[i], "-h") == 0) {
            std::printf("Usage: zorbin [--help | --version] [Qt options]\n\n"
                        "Opens the window that makes the HTML product catalog of the accounting database.\n"
                        "zorbin-cli runs the same without a window; see zorbin(1) and zorbin-cli(1).\n");
            return 0;
        }
    }
    zorbin::prepareProcess();
    QApplication app(argc, argv);
    QApplication::setApplicationName(QStringLiteral("Zorbin"));
    QApplication::setApplicationDisplayName(QStringLiteral("זורבין"));
    QApplication::setApplicationVersion(QStringLiteral(ZORBIN_VERSION));
    QApplication::setDesktopFileName(QStringLiteral("zorbin"));
    QApplication::setLayoutDirection(Qt::RightToLeft);
    QApplication::setWindowIcon(
        QIcon::fromTheme(QStringLiteral("zorbin"), QIcon(QStringLiteral(":/zorbin.png"))));

    // The window goes before the control it shows, and the control before its port and store.
    const auto store = zorbin::openUserSettingsStore();
    zorbin::WidgetUserPort user;
    const auto control = zorbin::assembleControl(user, *store);
    zorbin::CardWindow window(*control, user);
    window.resize(window.sizeHint().expandedTo(QSize(860, 640)));
    window.show();
    return QApplication::exec();
}
