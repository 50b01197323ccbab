#include "card/CellLineEditor.h"
#include "card/tabs/PageSetupTab.h"
#include "card/tabs/RangeTab.h"
#include "dialogs/ItemListModel.h"
#include "dialogs/SelectItemDialog.h"
#include "model/ProgressMeter.h"
#include "model/UserPort.h"
#include "tests/card/CardRig.h"
#include "testutil/TestMain.h"
#include "testutil/WorkDatabaseFixture.h"

#include <QCheckBox>
#include <QComboBox>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QRadioButton>
#include <QTabWidget>

using namespace zorbin;
using namespace zorbin::test;

class MainCardTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void firstStartOpensOnTheItemRangeTabWithEveryCaption()
    {
        CardRig rig;
        rig.start();
        QTabWidget *tabs = rig.card->tabs();
        QCOMPARE(tabs->objectName(), QStringLiteral("SSTab1"));
        QCOMPARE(tabs->currentIndex(), 3);
        const QStringList captions = {QStringLiteral("הגדרת עמוד בקטלוג"),
                                      QStringLiteral("כותרות לעמוד"),
                                      QStringLiteral("הגדרות נתונים"),
                                      QStringLiteral("טווח הפריטים"),
                                      QStringLiteral("אודות"),
                                      QStringLiteral("כללי")};
        QCOMPARE(tabs->count(), captions.size());
        for (int i = 0; i < captions.size(); ++i)
            QCOMPARE(tabs->tabText(i), captions.at(i));

        const QList<std::pair<QString, QString>> buttons = {
            {QStringLiteral("cmdRunMailing"), QStringLiteral("הצג קטלוג")},
            {QStringLiteral("CmdPreview"), QStringLiteral("הצג רשימה")},
            {QStringLiteral("cmdStop"), QStringLiteral("עצור")},
            {QStringLiteral("CmdDef"), QStringLiteral("שמור הגדרות")},
            {QStringLiteral("cmdSelectAccount"), QStringLiteral("בחירת פריטים...")},
            {QStringLiteral("CmdConnect"), QStringLiteral("הגדרות התחברות לויזקאונט")},
            {QStringLiteral("cmdSetLabDef"), QStringLiteral("החל")},
        };
        for (const auto &[name, caption] : buttons) {
            auto *button = rig.find<QPushButton>(name);
            QVERIFY2(button, qPrintable(name));
            QCOMPARE(button->text(), caption);
        }
        QVERIFY(!rig.find<QPushButton>(QStringLiteral("cmdStop"))->isEnabled());
        QCOMPARE(rig.find<QLabel>(QStringLiteral("Message1"))->text(), QString());
        QCOMPARE(rig.card->layoutDirection(), Qt::RightToLeft);
    }

    void firstStartShowsEveryDefault()
    {
        CardRig rig;
        rig.fillLists = fillDemoLists;
        rig.start();
        const QList<std::pair<QString, QString>> texts = {
            {QStringLiteral("txtTopTitle"), QStringLiteral("קטלוג פריטים")},
            {QStringLiteral("txtTopTitle2"), QStringLiteral("טרניק מערכות מידע")},
            {QStringLiteral("txtRows"), QStringLiteral("8")},
            {QStringLiteral("txtCols"), QStringLiteral("3")},
            {QStringLiteral("txtTopPercent"), QStringLiteral("10")},
            {QStringLiteral("txtBottomPercent"), QStringLiteral("10")},
            {QStringLiteral("txtPicExtension"), QStringLiteral(".JPG")},
            {QStringLiteral("txtImageH"), QString()},
            {QStringLiteral("txtFromSort"), QString()},
            {QStringLiteral("txtFontSizeAll"), QStringLiteral("10")},
            {QStringLiteral("ItemCutOff(1)"), QStringLiteral("*")},
            {QStringLiteral("ItemCutOff(10)"), QStringLiteral("*")},
        };
        for (const auto &[name, text] : texts) {
            auto *box = rig.find<QLineEdit>(name);
            QVERIFY2(box, qPrintable(name));
            QCOMPARE(box->text(), text);
        }
        QVERIFY(rig.find<QLineEdit>(QStringLiteral("txtBottomTitle"))
                    ->text()
                    .startsWith(QStringLiteral("טלפון: ")));
        QCOMPARE(rig.find<QLineEdit>(QStringLiteral("txtPagingPath"))->text(),
                 rig.card->control().settings().outputFolder);
        for (const QString &name : {QStringLiteral("CmbSortBy"), QStringLiteral("CmbSortDir"),
                                    QStringLiteral("CmbItemNameType"), QStringLiteral("cmbPriceField"),
                                    QStringLiteral("cmbPriceField2"), QStringLiteral("cmbExtraNote1"),
                                    QStringLiteral("cmbExtraNote2"), QStringLiteral("cmbPicExtraNote"),
                                    QStringLiteral("cmbPicLocation"), QStringLiteral("cmbPageSplit")}) {
            auto *list = rig.find<QComboBox>(name);
            QVERIFY2(list, qPrintable(name));
            QCOMPARE(list->currentIndex(), 0);
        }
        QVERIFY(rig.find<QRadioButton>(QStringLiteral("OptPicSource(0)"))->isChecked());
        QVERIFY(!rig.find<QRadioButton>(QStringLiteral("OptPicSource(1)"))->isChecked());
        for (const QString &name : {QStringLiteral("ChkCatCode"), QStringLiteral("chkFilter"),
                                    QStringLiteral("ChkItemKey"), QStringLiteral("chkUsePriceField"),
                                    QStringLiteral("ChkUsePriceField2"), QStringLiteral("ChkUseExtraNote1"),
                                    QStringLiteral("ChkUseExtraNote2"), QStringLiteral("chkRules"),
                                    QStringLiteral("ChkOnlyWithPic"), QStringLiteral("ChkSelectAccount")}) {
            auto *box = rig.find<QCheckBox>(name);
            QVERIFY2(box, qPrintable(name));
            QVERIFY(!box->isChecked());
        }
        // The format row starts with no entry, so nothing is applied by mistake.
        QCOMPARE(rig.find<QComboBox>(QStringLiteral("CmbFontAll"))->currentIndex(), -1);
    }

    void entryLimitsHoldWhileTyping_data()
    {
        QTest::addColumn<QString>("name");
        QTest::addColumn<int>("limit");
        QTest::newRow("last sort code") << QStringLiteral("txtToSort") << 15;
        QTest::newRow("last item key") << QStringLiteral("txtToItem") << 15;
        QTest::newRow("first sort code, no limit") << QStringLiteral("txtFromSort") << 20;
        QTest::newRow("first item key, no limit") << QStringLiteral("txtFromItem") << 20;
        QTest::newRow("rows") << QStringLiteral("txtRows") << 3;
        QTest::newRow("columns") << QStringLiteral("txtCols") << 3;
        QTest::newRow("top band") << QStringLiteral("txtTopPercent") << 2;
        QTest::newRow("picture height") << QStringLiteral("txtImageH") << 3;
        QTest::newRow("cut-off") << QStringLiteral("ItemCutOff(7)") << 1;
    }
    void entryLimitsHoldWhileTyping()
    {
        QFETCH(QString, name);
        QFETCH(int, limit);
        CardRig rig;
        rig.start();
        auto *box = rig.find<QLineEdit>(name);
        QVERIFY(box);
        box->clear();
        QTest::keyClicks(box, QStringLiteral("12345678901234567890"));
        QCOMPARE(box->text().size(), limit);
    }

    void aLongerStoredTextIsShownWholeAndKept()
    {
        CardRig rig;
        const QString longBound = QStringLiteral("ABCDEFGHIJKLMNOPQRST"); // 20 characters; typing allows 15
        rig.store.set(QStringLiteral("ToSort"), longBound);
        rig.start();
        auto *box = rig.find<QLineEdit>(QStringLiteral("txtToSort"));
        QCOMPARE(box->text(), longBound);
        rig.find<QPushButton>(QStringLiteral("CmdDef"))->click();
        QCOMPARE(rig.store.get(QStringLiteral("ToSort")), longBound);
        QTest::keyClicks(box, QStringLiteral("UVW"));
        QCOMPARE(box->text(), longBound); // no longer than it already is
    }

    void storedSettingsShowAndEditsSaveBack()
    {
        CardRig rig;
        rig.fillLists = fillDemoLists;
        rig.store.set(QStringLiteral("TopTitle"), QStringLiteral("מבצעי קיץ"));
        rig.store.set(QStringLiteral("UseCatCode"), QStringLiteral("1"));
        rig.store.set(QStringLiteral("PriceField"), QStringLiteral("2"));
        rig.store.set(QStringLiteral("SortDir"), QStringLiteral("1"));
        rig.store.set(QStringLiteral("PicSource0"), QStringLiteral("False"));
        rig.store.set(QStringLiteral("PicSource1"), QStringLiteral("True"));
        rig.store.set(QStringLiteral("CutOff2"), QStringLiteral("A"));
        rig.store.set(QStringLiteral("LineTag3"), QStringLiteral("6"));
        rig.store.set(QStringLiteral("LineCaption3"), QStringLiteral("יח':"));
        rig.start();

        QCOMPARE(rig.find<QLineEdit>(QStringLiteral("txtTopTitle"))->text(), QStringLiteral("מבצעי קיץ"));
        QVERIFY(rig.find<QCheckBox>(QStringLiteral("ChkCatCode"))->isChecked());
        QCOMPARE(rig.find<QComboBox>(QStringLiteral("cmbPriceField"))->currentText(),
                 QStringLiteral("קמעונאי"));
        QCOMPARE(rig.find<QComboBox>(QStringLiteral("CmbSortDir"))->currentText(), QStringLiteral("יורד"));
        QVERIFY(rig.find<QRadioButton>(QStringLiteral("OptPicSource(1)"))->isChecked());
        QVERIFY(!rig.find<QRadioButton>(QStringLiteral("OptPicSource(0)"))->isChecked());
        QCOMPARE(rig.find<QLineEdit>(QStringLiteral("ItemCutOff(2)"))->text(), QStringLiteral("A"));
        auto *slot = rig.find<QLabel>(QStringLiteral("lblLine(3)"));
        QCOMPARE(slot->text(), QStringLiteral("יחידת מידה"));
        QCOMPARE(slot->palette().color(QPalette::Window), QColor(128, 128, 255));
        QCOMPARE(slot->palette().color(QPalette::WindowText), QColor(255, 255, 255));
        QCOMPARE(rig.find<QLineEdit>(QStringLiteral("txtLineCaption(3)"))->text(), QStringLiteral("יח':"));

        // Edits go through the widgets as a user makes them.
        auto *top = rig.find<QLineEdit>(QStringLiteral("txtTopTitle"));
        top->selectAll();
        typeText(top, QStringLiteral("חורף"));
        rig.find<QCheckBox>(QStringLiteral("ChkCatCode"))->click();
        rig.find<QCheckBox>(QStringLiteral("chkRules"))->click();
        rig.find<QComboBox>(QStringLiteral("cmbExtraNote2"))->setCurrentIndex(1);
        rig.find<QComboBox>(QStringLiteral("CmbSortBy"))->setCurrentIndex(2);
        rig.find<QRadioButton>(QStringLiteral("OptPicSource(2)"))->click();
        auto *cutOff = rig.find<QLineEdit>(QStringLiteral("ItemCutOff(5)"));
        cutOff->selectAll();
        QTest::keyClicks(cutOff, QStringLiteral("Z"));
        auto *rows = rig.find<QLineEdit>(QStringLiteral("txtRows"));
        rows->selectAll();
        QTest::keyClicks(rows, QStringLiteral("12"));
        rig.find<QPushButton>(QStringLiteral("CmdDef"))->click();

        QCOMPARE(rig.store.get(QStringLiteral("TopTitle")), QStringLiteral("חורף"));
        QCOMPARE(rig.store.get(QStringLiteral("UseCatCode")), QStringLiteral("0"));
        QCOMPARE(rig.store.get(QStringLiteral("Rules")), QStringLiteral("1"));
        QCOMPARE(rig.store.get(QStringLiteral("ExtraNote2")), QStringLiteral("1"));
        QCOMPARE(rig.store.get(QStringLiteral("SortBy")), QStringLiteral("2"));
        QCOMPARE(rig.store.get(QStringLiteral("PicSource1")), QStringLiteral("False"));
        QCOMPARE(rig.store.get(QStringLiteral("PicSource2")), QStringLiteral("True"));
        QCOMPARE(rig.store.get(QStringLiteral("CutOff5")), QStringLiteral("Z"));
        QCOMPARE(rig.store.get(QStringLiteral("Rows")), QStringLiteral("12"));
        QCOMPARE(rig.store.get(QStringLiteral("LineTag3")), QStringLiteral("6"));

        // The next start shows what was saved.
        CardRig again;
        again.fillLists = fillDemoLists;
        again.store.values = rig.store.values;
        again.start();
        QCOMPARE(again.find<QLineEdit>(QStringLiteral("txtTopTitle"))->text(), QStringLiteral("חורף"));
        QCOMPARE(again.find<QComboBox>(QStringLiteral("cmbExtraNote2"))->currentText(),
                 QStringLiteral("תמונה"));
        QVERIFY(again.find<QRadioButton>(QStringLiteral("OptPicSource(2)"))->isChecked());
        QVERIFY(again.find<QCheckBox>(QStringLiteral("chkRules"))->isChecked());
        QCOMPARE(again.find<QLineEdit>(QStringLiteral("txtRows"))->text(), QStringLiteral("12"));
    }

    void noEntryStaysNoEntryWhenEntriesArrive()
    {
        CardRig rig;
        rig.fillLists = fillDemoLists;
        rig.store.set(QStringLiteral("PriceField"), QStringLiteral("-1"));
        rig.store.set(QStringLiteral("SortBy"), QStringLiteral("-1"));
        rig.start();
        CatalogSettings &settings = rig.card->control().settings();
        auto *prices = rig.find<QComboBox>(QStringLiteral("cmbPriceField"));
        QCOMPARE(prices->count(), 3);
        QCOMPARE(prices->currentIndex(), -1);
        QCOMPARE(settings.priceList1.currentIndex(), -1);
        QCOMPARE(rig.find<QComboBox>(QStringLiteral("CmbSortBy"))->currentIndex(), -1);

        // Entries arriving later (a list filled again) leave "no entry" as it is.
        settings.priceList1.addEntry(QStringLiteral("מבצע"), 9);
        QCOMPARE(prices->currentIndex(), -1);
        QCOMPARE(settings.priceList1.currentIndex(), -1);
        settings.priceList1.clear();
        settings.priceList1.addEntry(QStringLiteral("מבצע"), 9);
        QCOMPARE(prices->currentIndex(), -1);
        QCOMPARE(settings.priceList1.currentIndex(), -1);

        // A choice in the box is the list's selection, and the other way round.
        prices->setCurrentIndex(0);
        QCOMPARE(settings.priceList1.currentIndex(), 0);
        settings.priceList1.setCurrentIndex(-1);
        QCOMPARE(prices->currentIndex(), -1);
        rig.find<QPushButton>(QStringLiteral("CmdDef"))->click();
        QCOMPARE(rig.store.get(QStringLiteral("PriceField")), QStringLiteral("-1"));
        QCOMPARE(rig.store.get(QStringLiteral("SortBy")), QStringLiteral("-1"));
    }

    void aRunDisablesTheCommandsAndHonoursStop()
    {
        QTemporaryDir output;
        qputenv("ZORBIN_BROWSER", "true");
        CardRig rig;
        rig.start();
        rig.card->control().settings().outputFolder = output.path();
        auto *run = rig.find<QPushButton>(QStringLiteral("cmdRunMailing"));
        auto *list = rig.find<QPushButton>(QStringLiteral("CmdPreview"));
        auto *save = rig.find<QPushButton>(QStringLiteral("CmdDef"));
        auto *stop = rig.find<QPushButton>(QStringLiteral("cmdStop"));
        auto *connectButton = rig.find<QPushButton>(QStringLiteral("CmdConnect"));
        auto *status = rig.find<QLabel>(QStringLiteral("Message1"));
        QList<bool> enabledDuringRun;
        int rowsCollected = 0;
        rig.during = [&](const QString &stage) {
            if (stage != QLatin1String("BuildAndCollectData"))
                return;
            enabledDuringRun = {run->isEnabled(), list->isEnabled(), save->isEnabled(), stop->isEnabled(),
                                connectButton->isEnabled()};
            RunContext &context = rig.card->control().context();
            context.user.showStatus(QStringLiteral("איסוף פריטים"));
            // The user presses stop while the step yields at its progress points.
            QTimer::singleShot(0, stop, [stop] { stop->click(); });
            ProgressMeter meter(context.user, context.state);
            meter.reset();
            for (int row = 1; row <= 1000; ++row) {
                rowsCollected = row;
                if (meter.tick(row, 1000))
                    break;
            }
            meter.reset();
        };
        ModalAnswerer answerer;
        answerer.buttons = {QMessageBox::Yes};
        run->click();

        QCOMPARE(answerer.texts.value(0), QStringLiteral("להתחיל בהכנת הקטלוג?"));
        QCOMPARE(enabledDuringRun, (QList<bool>{false, false, false, true, false}));
        // The click was delivered at the first progress point, and the step ended there.
        QCOMPARE(rowsCollected, 5);
        QCOMPARE(status->text(), QStringLiteral("איסוף פריטים"));
        // The run went on to its output, as a stopped collection does.
        QVERIFY(rig.stages->names().contains(QStringLiteral("CreateCatHTML")));
        QVERIFY(run->isEnabled() && list->isEnabled() && save->isEnabled() && connectButton->isEnabled());
        QVERIFY(!stop->isEnabled());
    }

    void numbersAreCheckedAsTypedAndBeforeARun_data()
    {
        QTest::addColumn<QString>("name");
        QTest::addColumn<QString>("typed");
        QTest::addColumn<QString>("field");
        QTest::newRow("no rows") << QStringLiteral("txtRows") << QStringLiteral("0")
                                 << QStringLiteral("שורות");
        QTest::newRow("empty columns") << QStringLiteral("txtCols") << QString() << QStringLiteral("עמודות");
    }
    void numbersAreCheckedAsTypedAndBeforeARun()
    {
        QFETCH(QString, name);
        QFETCH(QString, typed);
        QFETCH(QString, field);
        CardRig rig;
        rig.start();
        auto *box = rig.find<QLineEdit>(name);
        box->clear();
        QTest::keyClicks(box, typed + QStringLiteral("x.")); // letters and points are not taken
        QCOMPARE(box->text(), typed);
        QVERIFY(box->toolTip().contains(field));
        QVERIFY(box->property("invalid").toBool());

        ModalAnswerer answerer;
        answerer.buttons = {QMessageBox::Yes};
        rig.find<QPushButton>(QStringLiteral("cmdRunMailing"))->click();
        QCOMPARE(answerer.texts.size(), 2);
        QVERIFY(answerer.texts.at(1).contains(field));
        QCOMPARE(answerer.titles.at(1), QStringLiteral("תקלה"));
        QCOMPARE(answerer.icons.at(1), QMessageBox::Critical);
        QVERIFY(!rig.stages->names().contains(QStringLiteral("BuildAndCollectData")));

        QTest::keyClicks(box, QStringLiteral("5"));
        QVERIFY(!box->property("invalid").toBool());
        QVERIFY(box->toolTip().isEmpty());
    }

    void theLogoChooserOffersPicturesFirst()
    {
        CardRig rig;
        rig.start();
        auto *logo = rig.find<QLineEdit>(QStringLiteral("txtLogo"));
        logo->setText(QStringLiteral("/old/logo.png"));
        auto *chooser = rig.find<QAbstractButton>(QStringLiteral("imgLogo"));

        rig.files.answer = std::nullopt; // Cancel
        chooser->click();
        QCOMPARE(logo->text(), QStringLiteral("/old/logo.png"));
        QCOMPARE(rig.files.fileRequests.size(), 1);
        const FileChooser::FileRequest &request = rig.files.fileRequests.constFirst();
        QCOMPARE(request.nameFilters,
                 (QStringList{QStringLiteral("All Files (*.*)"),
                              QStringLiteral("Image files (GIF,JPG,PNG) (*.GIF *.JPG *.JPEG *.PNG)")}));
        QCOMPARE(request.selectedFilter, 1);

        rig.files.answer = QStringLiteral("/pictures/חנות/logo.GIF");
        chooser->click();
        QCOMPARE(logo->text(), QStringLiteral("/pictures/חנות/logo.GIF"));
        QCOMPARE(rig.card->control().settings().logo, QStringLiteral("/pictures/חנות/logo.GIF"));
        chooser->click();
        QCOMPARE(rig.files.fileRequests.last().startPath, QStringLiteral("/pictures/חנות/logo.GIF"));
    }

    void folderChoosersFillTheirBoxes()
    {
        CardRig rig;
        rig.start();
        rig.files.answer = QStringLiteral("/srv/pictures");
        rig.find<QAbstractButton>(QStringLiteral("cmdPicPath"))->click();
        // Picture names are joined straight onto the folder: it keeps its separator.
        QCOMPARE(rig.card->control().settings().pictureFolder, QStringLiteral("/srv/pictures/"));
        rig.files.answer = QStringLiteral("/srv/catalog");
        rig.find<QAbstractButton>(QStringLiteral("cmdPagingPath"))->click();
        QCOMPARE(rig.card->control().settings().outputFolder, QStringLiteral("/srv/catalog"));
        rig.files.answer = std::nullopt;
        rig.find<QAbstractButton>(QStringLiteral("cmdPagingPath"))->click();
        QCOMPARE(rig.card->control().settings().outputFolder, QStringLiteral("/srv/catalog"));
    }

    void selectingItemsCollectsFirstThenAsks()
    {
        QTemporaryDir folder;
        const QString workDB = folder.filePath(QStringLiteral("zorbindb.tmp"));
        WorkRows rows;
        rows.items = {WorkItem(QStringLiteral("A1")), WorkItem(QStringLiteral("A2"))};
        QVERIFY(makeWorkDatabase(workDB, rows).isOk());
        CardRig rig;
        rig.start();
        rig.stages->workDBFile = workDB;
        auto *select = rig.find<QPushButton>(QStringLiteral("cmdSelectAccount"));
        auto *useMarked = rig.find<QCheckBox>(QStringLiteral("ChkSelectAccount"));
        ModalAnswerer answerer;
        QStringList dialogs;
        answerer.onDialog = [&dialogs](QDialog *dialog) {
            auto *items = qobject_cast<frmSelectItem *>(dialog);
            dialogs << QStringLiteral("%1:%2")
                           .arg(dialog->objectName())
                           .arg(items ? items->model()->rowCount() : -1);
            dialog->accept();
        };

        // The first time there is nothing collected yet: collect without asking.
        select->click();
        QVERIFY(answerer.texts.isEmpty());
        QCOMPARE(rig.stages->names().count(QStringLiteral("BuildAndCollectData")), 1);
        QVERIFY(useMarked->isChecked());
        QCOMPARE(dialogs, QStringList{QStringLiteral("frmSelectItem:2")});

        // Then the user is asked; No keeps the working database and its marks.
        answerer.buttons = {QMessageBox::No};
        select->click();
        QCOMPARE(answerer.texts, QStringList{QStringLiteral("לסרוק מחדש את רשימת הפריטים?")});
        QCOMPARE(answerer.titles, QStringList{QStringLiteral("שימו לב")});
        QCOMPARE(rig.stages->names().count(QStringLiteral("BuildAndCollectData")), 1);
        answerer.buttons = {QMessageBox::Yes};
        select->click();
        QCOMPARE(rig.stages->names().count(QStringLiteral("BuildAndCollectData")), 2);
        QCOMPARE(dialogs.size(), 3);
    }

    void theConnectionButtonOpensTheConnectionDialog()
    {
        CardRig rig;
        rig.start();
        rig.card->control().connection().server = QStringLiteral("srv-7");
        ModalAnswerer answerer;
        QString shownServer;
        QString title;
        answerer.onDialog = [&](QDialog *dialog) {
            title = dialog->windowTitle();
            if (auto *server = dialog->findChild<QLineEdit *>(QStringLiteral("txtConnServer")))
                shownServer = server->text();
            dialog->reject();
        };
        rig.find<QPushButton>(QStringLiteral("CmdConnect"))->click();
        QCOMPARE(title, QStringLiteral("הגדרות התחברות לויזקאונט חלונות"));
        QCOMPARE(shownServer, QStringLiteral("srv-7"));
    }

    void bringingThePageTabForwardClearsTheSelectedLine()
    {
        CardRig rig;
        rig.start();
        CellLineEditor *editor = rig.card->pageSetupTab()->editor();
        rig.card->tabs()->setCurrentIndex(MainCard::PageSetupPage);
        editor->lblLine_Click(2);
        QCOMPARE(editor->selectedLine(), 2);
        rig.card->tabs()->setCurrentIndex(MainCard::TitlesPage);
        rig.card->tabs()->setCurrentIndex(MainCard::PageSetupPage);
        QCOMPARE(editor->selectedLine(), -1);
        QVERIFY(!rig.find<QPushButton>(QStringLiteral("cmdSetLabDef"))->isEnabled());
    }
};

ZORBIN_TEST_CLASS(MainCardTest)
#include "MainCardTest.moc"
