// zorbin: the desktop program, a window that hosts the catalog control.
#include "card/CardWindow.h"
#include "card/WidgetUserPort.h"
#include "control/Program.h"
#include "platform/SettingsStore.h"

#include <QApplication>
#include <QIcon>

int main(int argc, char *argv[])
{
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
