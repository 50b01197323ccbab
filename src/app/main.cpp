// zorbin: the desktop program, a window that hosts the catalog control.
#include "card/MainCard.h"
#include "platform/SettingsStore.h"

#include <QApplication>
#include <QMainWindow>

int main(int argc, char *argv[])
{
    QApplication app(argc, argv);
    QApplication::setApplicationName(QStringLiteral("Zorbin"));
    QApplication::setApplicationDisplayName(QStringLiteral("זורבין"));
    QApplication::setApplicationVersion(QStringLiteral(ZORBIN_VERSION));
    QApplication::setDesktopFileName(QStringLiteral("zorbin"));
    QApplication::setLayoutDirection(Qt::RightToLeft);

    const auto store = zorbin::openUserSettingsStore();
    QMainWindow window;
    window.setWindowTitle(QStringLiteral("זורבין - קטלוג מוצרים"));
    window.setCentralWidget(new zorbin::MainCard(*store, {}, &window));
    window.resize(820, 640);
    window.show();
    return QApplication::exec();
}
