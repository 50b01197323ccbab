// The settings page over recording stages: the stored options in its widgets and back, the
// entry limits and number checks, a run's effect on the commands, the choosers, the layout.
#include "card/CardWindow.h"
#include "card/CellLineEditor.h"
#include "card/tabs/PageSetupTab.h"
#include "model/ProgressMeter.h"
#include "model/UserPort.h"
#include "tests/card/CardRig.h"
#include "testutil/TestFiles.h"
#include "testutil/TestMain.h"

#include <QBuffer>
#include <QCheckBox>
#include <QComboBox>
#include <QImage>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QTabWidget>
#include <QTemporaryDir>

using namespace zorbin;
using namespace zorbin::test;

namespace {

// What a widget shows: a box or label its text, a list its entry, a button "1" when it is on.
QString shown(QWidget *widget)
{
    if (auto *box = qobject_cast<QLineEdit *>(widget))
        return box->text();
    if (auto *list = qobject_cast<QComboBox *>(widget))
        return list->currentText();
    if (auto *label = qobject_cast<QLabel *>(widget))
        return label->text();
    return qobject_cast<QAbstractButton *>(widget)->isChecked() ? QStringLiteral("1") : QStringLiteral("0");
}

// Edits a widget as a user does: types over a box's text key by key (QTest's own key clicks take
// Latin-1 only), picks a list's entry by its number, clicks a button.
void edit(QWidget *widget, const QString &input)
{
    if (auto *box = qobject_cast<QLineEdit *>(widget)) {
        box->selectAll();
        QTest::keyClick(box, Qt::Key_Backspace);
        for (const QChar character : input)
            QTest::sendKeyEvent(QTest::Click, box, Qt::Key_unknown, QString(character), Qt::NoModifier);
    } else if (auto *list = qobject_cast<QComboBox *>(widget)) {
        list->setCurrentIndex(input.toInt());
    } else if (auto *button = qobject_cast<QAbstractButton *>(widget)) {
        button->click();
    }
}

// A 40 x 20 JPEG picture whose Exif orientation (6) says that it is to be turned a quarter to
// the right, as a telephone camera stores a picture taken upright.
QByteArray uprightPhoto()
{
    QImage image(40, 20, QImage::Format_RGB32);
    image.fill(Qt::red);
    QByteArray jpeg;
    QBuffer buffer(&jpeg);
    buffer.open(QIODevice::WriteOnly);
    image.save(&buffer, "JPG");
    // An APP1 segment after the start marker: "Exif", a big-endian TIFF header, one entry.
    return jpeg.insert(2, QByteArray("\xFF\xE1\x00\x22"
                                     "Exif\0\0MM\0\x2A\0\0\0\x08\0\x01"
                                     "\x01\x12\0\x03\0\0\0\x01\0\x06\0\0\0\0\0\0",
                                     36));
}

} // namespace

class MainCardTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void initTestCase() { qputenv("ZORBIN_BROWSER", "true"); }

    // Each kind of widget shows its stored option at start-up, and a user's edit is what the
    // save button writes back.
    void storedOptionsShowAndEditsSaveBack_data()
    {
        QTest::addColumn<QString>("widget");
        QTest::addColumn<QString>("key");
        QTest::addColumn<QString>("stored");
        QTest::addColumn<QString>("shows");
        QTest::addColumn<QString>("input");
        QTest::addColumn<QString>("saved");
        auto row = [](const char *name, const char *widget, const char *key, const QString &stored,
                      const QString &shows, const QString &input, const QString &saved) {
            QTest::newRow(name) << QString::fromLatin1(widget) << QString::fromLatin1(key) << stored << shows
                                << input << saved;
        };
        const QString on = QStringLiteral("1");
        const QString off = QStringLiteral("0");
        row("text", "txtTopTitle", "TopTitle", QStringLiteral("מבצעי קיץ"), QStringLiteral("מבצעי קיץ"),
            QStringLiteral("חורף"), QStringLiteral("חורף"));
        row("number", "txtRows", "Rows", QStringLiteral("12"), QStringLiteral("12"), QStringLiteral("5x"),
            QStringLiteral("5"));
        row("cut-off position", "ItemCutOff(2)", "CutOff2", QStringLiteral("A"), QStringLiteral("A"),
            QStringLiteral("Z"), QStringLiteral("Z"));
        row("line caption", "txtLineCaption(3)", "LineCaption3", QStringLiteral("יח':"),
            QStringLiteral("יח':"), QStringLiteral("מידה"), QStringLiteral("מידה"));
        row("line field", "lblLine(3)", "LineTag3", QStringLiteral("6"), QStringLiteral("יחידת מידה"), {},
            QStringLiteral("6"));
        row("check box", "ChkCatCode", "UseCatCode", on, on, {}, off);
        row("check box set by default", "chkWebSections", "WebSections", on, on, {}, off);
        row("list from the database", "cmbPriceField", "PriceField", QStringLiteral("2"),
            QStringLiteral("קמעונאי"), off, off);
        row("fixed list", "CmbSortDir", "SortDir", on, QStringLiteral("יורד"), off, off);
        row("option button", "OptPicSource(1)", "PicSource1", QStringLiteral("True"), on, {},
            QStringLiteral("True"));
        row("another option button", "OptPicSource(2)", "PicSource1", QStringLiteral("True"), off, {},
            QStringLiteral("False"));
    }
    void storedOptionsShowAndEditsSaveBack()
    {
        QFETCH(QString, widget);
        QFETCH(QString, key);
        QFETCH(QString, stored);
        QFETCH(QString, shows);
        QFETCH(QString, input);
        QFETCH(QString, saved);
        CardRig rig;
        rig.fillLists = fillDemoLists;
        rig.store.set(key, stored);
        rig.start();
        QWidget *shownIn = rig.find(widget);
        QCOMPARE(shown(shownIn), shows);
        edit(shownIn, input);
        rig.find<QPushButton>(QStringLiteral("CmdDef"))->click();
        QCOMPARE(rig.store.get(key), saved);
    }

    // A list whose stored choice is "no entry" keeps it when entries arrive later (a combo box
    // selects its first entry by itself); the box and the list follow each other.
    void noEntryStaysNoEntryWhenEntriesArrive()
    {
        CardRig rig;
        rig.fillLists = fillDemoLists;
        rig.store.set(QStringLiteral("PriceField"), QStringLiteral("-1"));
        rig.start();
        ChoiceList &prices = rig.settings().priceList1;
        auto *box = rig.find<QComboBox>(QStringLiteral("cmbPriceField"));
        QCOMPARE(box->count(), 3);
        QCOMPARE(box->currentIndex(), -1);
        prices.clear();
        prices.addEntry(QStringLiteral("מבצע"), 9);
        QCOMPARE(box->currentIndex(), -1);
        QCOMPARE(prices.currentIndex(), -1);
        box->setCurrentIndex(0);
        QCOMPARE(prices.currentIndex(), 0);
        prices.setCurrentIndex(-1);
        QCOMPARE(box->currentIndex(), -1);
    }

    void entryLimitsHoldWhileTyping_data()
    {
        QTest::addColumn<QString>("name");
        QTest::addColumn<int>("limit");
        QTest::newRow("last sort code") << QStringLiteral("txtToSort") << 15;
        QTest::newRow("first sort code, no limit") << QStringLiteral("txtFromSort") << 20;
        QTest::newRow("first item key, no limit") << QStringLiteral("txtFromItem") << 20;
        QTest::newRow("rows") << QStringLiteral("txtRows") << 3;
        QTest::newRow("top band") << QStringLiteral("txtTopPercent") << 2;
        QTest::newRow("cut-off beyond the stored positions") << QStringLiteral("ItemCutOff(7)") << 1;
    }
    void entryLimitsHoldWhileTyping()
    {
        QFETCH(QString, name);
        QFETCH(int, limit);
        CardRig rig;
        rig.start();
        auto *box = rig.find<QLineEdit>(name);
        box->clear();
        QTest::keyClicks(box, QStringLiteral("12345678901234567890"));
        QCOMPARE(box->text().size(), limit);
    }

    // Written by hand or by an older version: the run uses what the user sees, and a save keeps it.
    void aLongerStoredTextIsShownWholeAndKept()
    {
        CardRig rig;
        const QString longBound = QStringLiteral("ABCDEFGHIJKLMNOPQRST"); // typing allows 15
        rig.store.set(QStringLiteral("ToSort"), longBound);
        rig.start();
        auto *box = rig.find<QLineEdit>(QStringLiteral("txtToSort"));
        QCOMPARE(box->text(), longBound);
        QTest::keyClicks(box, QStringLiteral("UVW"));
        QCOMPARE(box->text(), longBound); // no longer than it already is
        rig.find<QPushButton>(QStringLiteral("CmdDef"))->click();
        QCOMPARE(rig.store.get(QStringLiteral("ToSort")), longBound);
    }

    void gridNumbersAreCheckedAsTypedAndBeforeARun_data()
    {
        QTest::addColumn<QString>("name");
        QTest::addColumn<QString>("typed");
        QTest::addColumn<QString>("field");
        QTest::newRow("no rows") << QStringLiteral("txtRows") << QStringLiteral("0")
                                 << QStringLiteral("שורות");
        QTest::newRow("empty columns") << QStringLiteral("txtCols") << QString() << QStringLiteral("עמודות");
    }
    void gridNumbersAreCheckedAsTypedAndBeforeARun()
    {
        QFETCH(QString, name);
        QFETCH(QString, typed);
        QFETCH(QString, field);
        CardRig rig;
        rig.start();
        auto *box = rig.find<QLineEdit>(name);
        edit(box, typed);
        QVERIFY(box->toolTip().contains(field));
        QVERIFY(box->property("invalid").toBool());

        ModalAnswerer answerer;
        answerer.buttons = {QMessageBox::Yes};
        rig.find<QPushButton>(QStringLiteral("cmdRunMailing"))->click();
        QCOMPARE(answerer.texts.size(), 2);
        QVERIFY(answerer.texts.at(1).contains(field));
        QCOMPARE(answerer.icons.at(1), QMessageBox::Critical);
        QVERIFY(!rig.stages->names().contains(QStringLiteral("BuildAndCollectData")));

        QTest::keyClicks(box, QStringLiteral("5"));
        QVERIFY(!box->property("invalid").toBool());
        QVERIFY(box->toolTip().isEmpty());
    }

    // While a run goes on, only the stop button can be pressed (it is honoured at the next
    // progress point), and the tabs hold still; when it ends, the page shows the options as the
    // run left them.
    void aRunDisablesTheCommandsAndHonoursStop()
    {
        QTemporaryDir output;
        CardRig rig;
        rig.start();
        rig.settings().outputFolder = output.path();
        const QStringList names = {QStringLiteral("cmdRunMailing"), QStringLiteral("CmdPreview"),
                                   QStringLiteral("CmdDef"),        QStringLiteral("cmdStop"),
                                   QStringLiteral("PageSetupTab"),  QStringLiteral("GeneralTab")};
        auto enabled = [&] {
            QList<bool> states;
            for (const QString &name : names)
                states << rig.find(name)->isEnabled();
            return states;
        };
        QList<bool> enabledDuringRun;
        int rowsCollected = 0;
        rig.during = [&](const QString &stage) {
            if (stage != QLatin1String("BuildAndCollectData"))
                return;
            enabledDuringRun = enabled();
            rig.settings().useMarkedItems = true;
            QTimer::singleShot(0, rig.find(QStringLiteral("cmdStop")), [&] {
                qobject_cast<QPushButton *>(rig.find(QStringLiteral("cmdStop")))->click();
            });
            ProgressMeter meter(rig.control->context().user, rig.control->context().state);
            while (rowsCollected < 1000 && !meter.tick(++rowsCollected, 1000))
                ;
        };
        for (const char *button : {"cmdRunMailing", "CmdPreview"}) {
            rowsCollected = 0;
            rig.settings().useMarkedItems = false;
            ModalAnswerer answerer;
            answerer.buttons = {QMessageBox::Yes};
            rig.find<QPushButton>(QLatin1String(button))->click();
            QCOMPARE(enabledDuringRun, (QList<bool>{false, false, false, true, false, false}));
            QCOMPARE(rowsCollected, 5); // the click was delivered at the first progress point
            QCOMPARE(enabled(), (QList<bool>{true, true, true, false, true, true}));
            QVERIFY(rig.find<QCheckBox>(QStringLiteral("ChkSelectAccount"))->isChecked());
        }
        QCOMPARE(rig.stages->names().constLast(), QStringLiteral("CreateListHTML")); // the runs went on
    }

    // Closing the window during a run stops the run first; the window closes once it has ended.
    void closingDuringARunStopsItFirst()
    {
        QTemporaryDir output;
        CardRig rig;
        rig.settings().outputFolder = output.path();
        CardWindow window(*rig.control, rig.user);
        window.show();
        bool closedAtOnce = true;
        int rows = 0;
        rig.during = [&](const QString &stage) {
            if (stage != QLatin1String("BuildAndCollectData"))
                return;
            closedAtOnce = window.close();
            ProgressMeter meter(rig.control->context().user, rig.control->context().state);
            while (rows < 100 && !meter.tick(++rows, 100))
                ;
        };
        QCOMPARE(rig.control->makeCatalog().ending, RunOutcome::Ending::Stopped);
        QVERIFY(!closedAtOnce);
        QCOMPARE(rows, 5);
        QCOMPARE(rig.stages->names().constLast(), QStringLiteral("CreateCSS")); // the run ended in order
        QTRY_VERIFY(!window.isVisible());
        window.show();
        QVERIFY(window.close()); // while idle, at once
    }

    void choosersFillTheirBoxes()
    {
        QTemporaryDir folder;
        CardRig rig;
        rig.start();
        auto *logo = rig.find<QLineEdit>(QStringLiteral("txtLogo"));
        auto *chooser = rig.find<QAbstractButton>(QStringLiteral("imgLogo"));
        chooser->click(); // Cancel
        QCOMPARE(logo->text(), QString());
        rig.files.answer = folder.filePath(QStringLiteral("logo.jpg"));
        writeFile(*rig.files.answer, uprightPhoto());
        chooser->click();
        QCOMPARE(rig.settings().logo, *rig.files.answer);
        chooser->click();
        QCOMPARE(rig.files.fileRequests.constLast().startPath, *rig.files.answer);
        // The button shows the logo as it will stand on the page: upright.
        QCOMPARE(chooser->icon().actualSize(QSize(24, 24)), QSize(12, 24));

        // A picture name is joined straight onto its folder: the folder keeps its separator.
        rig.files.answer = QStringLiteral("/srv/pictures");
        rig.find<QAbstractButton>(QStringLiteral("cmdPicPath"))->click();
        QCOMPARE(rig.settings().pictureFolder, QStringLiteral("/srv/pictures/"));
        rig.find<QAbstractButton>(QStringLiteral("cmdPagingPath"))->click();
        QCOMPARE(rig.settings().outputFolder, QStringLiteral("/srv/pictures"));
        rig.files.answer = std::nullopt;
        rig.find<QAbstractButton>(QStringLiteral("cmdPagingPath"))->click();
        QCOMPARE(rig.settings().outputFolder, QStringLiteral("/srv/pictures"));
    }

    // Right to left, each field stands just left of its caption, on the same line.
    void fieldsStandBesideTheirCaptions()
    {
        CardRig rig;
        rig.start();
        rig.card->show();
        QVERIFY(QTest::qWaitForWindowExposed(rig.card.get()));
        int checked = 0;
        for (int tab = 0; tab < rig.card->tabs()->count(); ++tab) {
            rig.card->tabs()->setCurrentIndex(tab);
            QCoreApplication::processEvents();
            for (const QLabel *caption : rig.card->tabs()->widget(tab)->findChildren<QLabel *>()) {
                const QWidget *field = caption->buddy();
                if (!field)
                    continue;
                const QRect c(caption->mapTo(rig.card.get(), QPoint()), caption->size());
                const QRect f(field->mapTo(rig.card.get(), QPoint()), field->size());
                const QString where = caption->text() + QStringLiteral(" %1 %2").arg(f.right()).arg(c.left());
                QVERIFY2(f.right() < c.left() && c.left() - f.right() < 20, qPrintable(where));
                QVERIFY2(qAbs(f.center().y() - c.center().y()) < c.height(), qPrintable(where));
                ++checked;
            }
        }
        QVERIFY(checked >= 20);
    }

    void bringingThePageTabForwardClearsTheSelectedLine()
    {
        CardRig rig;
        rig.start();
        CellLineEditor *editor = rig.card->pageSetupTab()->editor();
        rig.card->tabs()->setCurrentIndex(MainCard::PageSetupPage);
        editor->lblLine_Click(2);
        rig.card->tabs()->setCurrentIndex(MainCard::TitlesPage);
        QCOMPARE(editor->selectedLine(), 2);
        rig.card->tabs()->setCurrentIndex(MainCard::PageSetupPage);
        QCOMPARE(editor->selectedLine(), -1);
    }
};

ZORBIN_TEST_CLASS(MainCardTest)
#include "MainCardTest.moc"
