// zorbin-screenshots: pictures of the desktop program for the documentation. Run it under a
// display (scripts/screenshots.sh starts a virtual one): it opens the main window on the demo
// database's settings (the build's demo, or the settings file given as the second argument), grabs each tab
// and the dialogs, and writes PNG files into the folder given as its one argument. The collection for the
// selection dialog writes the working database into the temporary folder (TMPDIR), as every run does.
#include "card/CardWindow.h"
#include "card/MainCard.h"
#include "card/WidgetUserPort.h"
#include "control/Program.h"
#include "dialogs/ItemListModel.h"
#include "dialogs/LogonDialog.h"
#include "dialogs/SelectItemDialog.h"
#include "platform/SettingsStore.h"

#include <QApplication>
#include <QDir>
#include <QTabWidget>
#include <QTableView>
#include <QTest>
#include <cstdio>

using namespace zorbin;

namespace {

bool save(QWidget *widget, const QDir &folder, const QString &name)
{
    QTest::qWait(200); // let the window system settle, as a user would see it
    const QString path = folder.filePath(name + QStringLiteral(".png"));
    if (!widget->grab().save(path)) {
        std::fprintf(stderr, "cannot write %s\n", qPrintable(path));
        return false;
    }
    std::printf("%s\n", qPrintable(path));
    return true;
}

} // namespace

int main(int argc, char *argv[])
{
    QApplication app(argc, argv);
    QApplication::setApplicationName(QStringLiteral("Zorbin"));
    QApplication::setApplicationDisplayName(QStringLiteral("זורבין"));
    QApplication::setLayoutDirection(Qt::RightToLeft);
    if (argc != 2 && argc != 3) {
        std::fprintf(stderr, "usage: zorbin-screenshots FOLDER [SETTINGS.ini]\n");
        return 2;
    }
    const QDir folder(QString::fromLocal8Bit(argv[1]));
    if (!folder.mkpath(QStringLiteral("."))) {
        std::fprintf(stderr, "cannot create %s\n", argv[1]);
        return 1;
    }

    const QString demoSettings =
        argc == 3 ? QString::fromLocal8Bit(argv[2])
                  : QDir(QStringLiteral(ZORBIN_DEMO_BUILD_DIR)).filePath(QStringLiteral("demo-settings.ini"));
    const auto store = openIniSettingsStore(demoSettings);
    WidgetUserPort user;
    const auto control = assembleControl(user, *store);
    CardWindow window(*control, user);
    window.resize(window.sizeHint().expandedTo(QSize(860, 640)));
    window.show();
    if (!QTest::qWaitForWindowExposed(&window))
        return 1;

    bool written = save(&window, folder, QStringLiteral("main-window"));
    const QStringList tabNames = {QStringLiteral("tab-page-setup"), QStringLiteral("tab-titles"),
                                  QStringLiteral("tab-data"),       QStringLiteral("tab-item-range"),
                                  QStringLiteral("tab-about"),      QStringLiteral("tab-general")};
    QTabWidget *tabs = window.card()->tabs();
    for (int i = 0; i < tabs->count(); ++i) {
        tabs->setCurrentIndex(i);
        written = save(&window, folder, tabNames.at(i)) && written;
    }

    {
        frmLogon connection(control->store(), control->connection(), &window);
        connection.resize(
            connection.sizeHint().expandedTo(QSize(520, 0))); // as the connection button opens it
        connection.show();
        written = save(&connection, folder, QStringLiteral("connection-dialog")) && written;
    }
    {
        // The item selection dialog as a user leaves it: the items collected, a few unmarked.
        if (const RunOutcome collected = control->collectItems();
            collected.ending != RunOutcome::Ending::Complete)
            std::fprintf(stderr, "collecting the demo items: %s\n", qPrintable(collected.message));
        frmSelectItem selection(control->runState().WorkDBFile, &window);
        ItemListModel *items = selection.model();
        for (int row = 1; row < items->rowCount() && row <= 5; row += 2)
            items->setData(items->index(row, ItemListModel::IncludeColumn), Qt::Unchecked,
                           Qt::CheckStateRole);
        selection.show();
        selection.grid()->setCurrentIndex(items->index(0, ItemListModel::KeyColumn));
        written = save(&selection, folder, QStringLiteral("item-selection")) && written;
    }
    return written ? 0 : 1;
}
