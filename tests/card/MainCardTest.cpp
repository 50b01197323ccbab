// The settings page over recording stages: the stored options in its widgets and back, the
// entry limits and number checks, a run's effect on the page, the choosers, the layout, the
// cell-line editor; and the desktop program's whole runs on the demo database.
#include "card/CardWindow.h"
#include "card/CellLineEditor.h"
#include "card/tabs/PageSetupTab.h"
#include "model/ProgressMeter.h"
#include "tests/card/CardRig.h"
#include "testutil/DemoScratch.h"
#include "testutil/TestFiles.h"

#include <QBuffer>
#include <QCheckBox>
#include <QComboBox>
#include <QDropEvent>
#include <QFileInfo>
#include <QLineEdit>
#include <QMimeData>
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

// Three price lists, as the accounting database fills them.
void fillPriceLists(CatalogSettings &settings)
{
    for (const char *name : {"מחיר הפריט", "סיטונאי", "קמעונאי"})
        settings.priceList1.addEntry(QString::fromUtf8(name), 0);
}

// Drops a label dragged from `array` (a slot or the palette) onto `target`, as the window
// system delivers a drop; whether the target took it.
bool drop(QWidget *target, const QString &array, int index, QMimeData *payload = nullptr)
{
    std::unique_ptr<QMimeData> dragged(payload ? nullptr : FieldLabel::dragData(array, index));
    payload = payload ? payload : dragged.get();
    QDragEnterEvent enter(QPoint(5, 5), Qt::MoveAction, payload, Qt::LeftButton, Qt::NoModifier);
    QApplication::sendEvent(target, &enter);
    QDropEvent dropped(QPointF(5, 5), Qt::MoveAction, payload, Qt::LeftButton, Qt::NoModifier);
    if (enter.isAccepted())
        QApplication::sendEvent(target, &dropped);
    return enter.isAccepted() && dropped.isAccepted();
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

const QString Slot = QStringLiteral("lblLine(%1)");
const QString Palette = QStringLiteral("LblTitle(%1)");

} // namespace

class MainCardTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void initTestCase() { qputenv("ZORBIN_BROWSER", "true"); }

    // The run buttons on the demo settings, with the program's own stages: the catalog's files
    // and first item, the list's rows, and no message but the question.
    void theRunButtonsWriteTheCatalogAndTheList()
    {
        DemoScratch demo;
        AssembledProgram program(*demo.store);
        MainCard card(*program.control, program.user);
        ModalAnswerer answerer;
        answerer.buttons = {QMessageBox::Yes};
        card.findChild<QPushButton *>(QStringLiteral("cmdRunMailing"))->click();
        card.findChild<QPushButton *>(QStringLiteral("CmdPreview"))->click();
        QCOMPARE(answerer.texts, QStringList{QStringLiteral("להתחיל בהכנת הקטלוג?")});
        QCOMPARE(firstItemKey(demo.out(QStringLiteral("zoindex.htm"))), QStringLiteral("00010"));
        for (const char *name : {"zo000034.htm", "tarnik.css", "images/item-11.jpg"})
            QVERIFY2(QFileInfo::exists(demo.out(QLatin1String(name))), name);
        QCOMPARE(listRows(demo.out(QStringLiteral("zorbin3.htm"))), 301);
        // The stored choice of a list that the demo database fills.
        QCOMPARE(shown(card.findChild<QComboBox *>(QStringLiteral("cmbPriceField"))),
                 QStringLiteral("מחירון סיטונאי"));
    }

    // "בחירת פריטים..." has the items collected (the control decides whether to ask first), ticks
    // "only the marked items" and opens the selection dialog.
    void selectingItemsOpensTheSelectionDialog()
    {
        CardRig rig;
        rig.start();
        ModalAnswerer answerer;
        QString opened;
        answerer.onDialog = [&](QDialog *dialog) { opened = dialog->objectName(); };
        rig.find<QPushButton>(QStringLiteral("cmdSelectAccount"))->click();
        QCOMPARE(opened, QStringLiteral("frmSelectItem"));
        QVERIFY(rig.find<QCheckBox>(QStringLiteral("ChkSelectAccount"))->isChecked());
        QVERIFY(rig.stages->names().contains(QStringLiteral("BuildAndCollectData")));
    }

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
        auto row = [](const char *widget, const char *key, const char *stored, const char *shows,
                      const char *input, const char *saved) {
            QTest::newRow(widget) << QString::fromLatin1(widget) << QString::fromLatin1(key)
                                  << QString::fromUtf8(stored) << QString::fromUtf8(shows)
                                  << QString::fromUtf8(input) << QString::fromUtf8(saved);
        };
        row("txtTopTitle", "TopTitle", "מבצעי קיץ", "מבצעי קיץ", "חורף", "חורף");
        row("txtRows", "Rows", "12", "12", "5x.", "5");
        row("txtLineCaption(3)", "LineCaption3", "יח':", "יח':", "מידה", "מידה");
        row("lblLine(3)", "LineTag3", "6", "יחידת מידה", "", "6");
        row("ChkCatCode", "UseCatCode", "1", "1", "", "0");
        row("cmbPriceField", "PriceField", "2", "קמעונאי", "0", "0");
        row("CmbSortDir", "SortDir", "1", "יורד", "0", "0");
        row("OptPicSource(1)", "PicSource1", "True", "1", "", "True");
        row("OptPicSource(2)", "PicSource1", "True", "0", "", "False");
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
        rig.fillLists = fillPriceLists;
        rig.store.set(key, stored);
        rig.start();
        QCOMPARE(shown(rig.find(widget)), shows);
        edit(rig.find(widget), input);
        rig.find<QPushButton>(QStringLiteral("CmdDef"))->click();
        QCOMPARE(rig.store.get(key), saved);
    }

    // A list whose stored choice is "no entry" keeps it when entries arrive later (a combo box
    // selects its first entry by itself); the box and the list follow each other.
    void noEntryStaysNoEntryWhenEntriesArrive()
    {
        CardRig rig;
        rig.fillLists = fillPriceLists;
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
        QTest::newRow("top band") << QStringLiteral("txtTopPercent") << 2;
        QTest::newRow("cut-off beyond the stored positions") << QStringLiteral("ItemCutOff(7)") << 1;
    }
    void entryLimitsHoldWhileTyping()
    {
        QFETCH(QString, name);
        QFETCH(int, limit);
        CardRig rig;
        rig.start();
        edit(rig.find(name), QStringLiteral("12345678901234567890"));
        QCOMPARE(int(shown(rig.find(name)).size()), limit);
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

    // A grid count that cannot make a page turns its box red and names the field.
    void gridCountsAreCheckedAsTyped()
    {
        CardRig rig;
        rig.start();
        auto *rows = rig.find<QLineEdit>(QStringLiteral("txtRows"));
        auto *columns = rig.find<QLineEdit>(QStringLiteral("txtCols"));
        edit(rows, QStringLiteral("0"));
        edit(columns, QString());
        QVERIFY(rows->property("invalid").toBool() && rows->toolTip().contains(QStringLiteral("\"שורות\"")));
        QVERIFY(columns->property("invalid").toBool() &&
                columns->toolTip().contains(QStringLiteral("עמודות")));
        edit(rows, QStringLiteral("1"));
        QVERIFY(!rows->property("invalid").toBool() && rows->toolTip().isEmpty());
    }

    // While a run goes on, only the stop button can be pressed (it is honoured at the next
    // progress point), and the tabs hold still; when it ends, the page shows the options as the
    // run left them.
    void aRunDisablesThePageAndHonoursStop()
    {
        QTemporaryDir output;
        CardRig rig;
        rig.start();
        rig.settings().outputFolder = output.path();
        auto *stop = rig.find<QPushButton>(QStringLiteral("cmdStop"));
        auto enabled = [&] {
            QList<bool> states;
            for (const char *name :
                 {"cmdRunMailing", "CmdPreview", "CmdDef", "cmdStop", "PageSetupTab", "GeneralTab"})
                states << rig.find(QLatin1String(name))->isEnabled();
            return states;
        };
        QList<bool> enabledDuringRun;
        int rows = 0;
        rig.during = [&](const QString &stage) {
            if (stage != QLatin1String("BuildAndCollectData"))
                return;
            enabledDuringRun = enabled();
            rig.settings().useMarkedItems = true;
            QTimer::singleShot(0, stop, &QPushButton::click);
            ProgressMeter meter(rig.control->context().user, rig.control->context().state);
            while (rows < 1000 && !meter.tick(++rows, 1000))
                ;
        };
        for (const char *button : {"cmdRunMailing", "CmdPreview"}) {
            rows = 0;
            rig.settings().useMarkedItems = false;
            ModalAnswerer answerer;
            answerer.buttons = {QMessageBox::Yes};
            rig.find<QPushButton>(QLatin1String(button))->click();
            QCOMPARE(enabledDuringRun, (QList<bool>{false, false, false, true, false, false}));
            QCOMPARE(rows, 5); // the click was delivered at the first progress point
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
        auto *chooser = rig.find<QAbstractButton>(QStringLiteral("imgLogo"));
        chooser->click(); // Cancel
        QCOMPARE(rig.find<QLineEdit>(QStringLiteral("txtLogo"))->text(), QString());
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
        int checked = 0;
        for (int tab = 0; tab < rig.card->tabs()->count(); ++tab) {
            rig.card->tabs()->setCurrentIndex(tab);
            QCoreApplication::processEvents();
            for (const QLabel *caption : rig.card->tabs()->widget(tab)->findChildren<QLabel *>()) {
                if (const QWidget *field = caption->buddy()) {
                    const QRect c(caption->mapTo(rig.card.get(), QPoint()), caption->size());
                    const QRect f(field->mapTo(rig.card.get(), QPoint()), field->size());
                    QVERIFY2(f.right() < c.left() && c.left() - f.right() < 20, qPrintable(caption->text()));
                    QVERIFY2(qAbs(f.center().y() - c.center().y()) < c.height(), qPrintable(caption->text()));
                    ++checked;
                }
            }
        }
        QVERIFY(checked >= 20);
    }

    // A field dropped on a line's slot stands on that line with its caption; the slot dropped
    // back on the palette empties the line. The line's format stays as it was.
    void cellLineDropsFillAndEmptyLines()
    {
        CardRig rig;
        rig.start();
        CellLine &line = rig.settings().lines[2];
        const CellFormat format{2, 16, 1, 1, 0, 2};
        line.format = format;
        auto *slot = rig.find<FieldLabel>(Slot.arg(2));
        auto *caption = rig.find<QLineEdit>(QStringLiteral("txtLineCaption(2)"));
        QVERIFY(drop(slot, FieldLabel::PaletteArray, 4));
        QCOMPARE(line.field, 4);
        QCOMPARE(slot->text(), QStringLiteral("מחיר 1"));
        QCOMPARE(slot->backColour(), QColor(128, 128, 255));
        QCOMPARE(caption->text(), QStringLiteral("מחיר 1:"));
        QTest::keyClicks(caption, QStringLiteral(" (VAT)")); // another field writes its caption anew
        QVERIFY(drop(slot, FieldLabel::PaletteArray, 2));
        QCOMPARE(line.caption, QStringLiteral("שם פריט:"));

        // A palette label on the palette, a slot on a slot, text from elsewhere: nothing changes.
        drop(rig.find(Palette.arg(0)), FieldLabel::PaletteArray, 3);
        drop(rig.find(Slot.arg(5)), FieldLabel::SlotArray, 2);
        QMimeData text;
        text.setText(QStringLiteral("1"));
        QVERIFY(!drop(rig.find(Slot.arg(0)), {}, 0, &text));
        QCOMPARE(line.field, 2);
        QVERIFY(!rig.settings().lines[5].isUsed() && !rig.settings().lines[0].isUsed());

        QVERIFY(drop(rig.find(Palette.arg(8)), FieldLabel::SlotArray, 2));
        QVERIFY(!line.isUsed());
        QCOMPARE(slot->text(), QString());
        QCOMPARE(caption->text(), QString());
        QCOMPARE(slot->backColour(), QColor(192, 192, 255));
        QCOMPARE(line.format, format);
    }

    // Clicking a line loads its format into the format row; "apply" stores the row into that line
    // only. A stored value that a list does not have leaves that list as it was. Bringing the
    // page tab forward again clears the selection, and "apply" does nothing then.
    void cellLineFormatRowEditsTheSelectedLine()
    {
        CardRig rig;
        rig.start();
        CellLines &lines = rig.settings().lines;
        lines[0].field = 6;
        lines[0].format = CellFormat{1, 9, 2, 1, 1, 2};
        lines[1].format = CellFormat{7, 11, 0, 0, 0, 1};
        rig.card->tabs()->setCurrentIndex(MainCard::PageSetupPage);
        QTest::mouseClick(rig.find(Slot.arg(0)), Qt::LeftButton);
        auto *font = rig.find<QComboBox>(QStringLiteral("CmbFontAll"));
        auto *size = rig.find<QLineEdit>(QStringLiteral("txtFontSizeAll"));
        auto *weight = rig.find<QComboBox>(QStringLiteral("CmbWeightAll"));
        auto *align = rig.find<QComboBox>(QStringLiteral("CmbAlignAll"));
        auto *underline = rig.find<QCheckBox>(QStringLiteral("ChkULAll"));
        auto *italic = rig.find<QCheckBox>(QStringLiteral("ChkItalicAll"));
        auto *apply = rig.find<QPushButton>(QStringLiteral("cmdSetLabDef"));
        QCOMPARE(shown(rig.find(QStringLiteral("lblCellName"))), QStringLiteral("יחידת מידה"));
        const QStringList row = {shown(font),  shown(size),      shown(weight),
                                 shown(align), shown(underline), shown(italic)};
        QCOMPARE(row, (QStringList{QStringLiteral("David"), QStringLiteral("9"), QStringLiteral("עבה"),
                                   QStringLiteral("שמאל"), QStringLiteral("1"), QStringLiteral("1")}));

        // The top line takes the row: the size rounds half to even; no entry and no size keep
        // what the line had.
        font->setCurrentIndex(2);
        size->setText(QStringLiteral("12.5"));
        weight->setCurrentIndex(1);
        underline->setChecked(false);
        italic->setCheckState(Qt::PartiallyChecked);
        align->setCurrentIndex(-1);
        apply->click();
        QCOMPARE(lines[0].format, (CellFormat{2, 12, 1, 0, 2, 2}));
        size->setText(QStringLiteral("300"));
        apply->click();
        QCOMPARE(lines[0].format, (CellFormat{2, 12, 1, 0, 2, 2}));
        QCOMPARE(lines[2].format, CellFormat());

        QTest::mouseClick(rig.find(Slot.arg(1)), Qt::LeftButton);
        QCOMPARE(font->currentText(), QStringLiteral("Miriam"));
        QCOMPARE(size->text(), QStringLiteral("11"));
        QCOMPARE(shown(rig.find(QStringLiteral("lblCellName"))), QString());

        rig.card->tabs()->setCurrentIndex(MainCard::TitlesPage);
        QCOMPARE(rig.card->pageSetupTab()->editor()->selectedLine(), 1);
        rig.card->tabs()->setCurrentIndex(MainCard::PageSetupPage);
        QVERIFY(!apply->isEnabled());
        rig.card->pageSetupTab()->editor()->cmdSetLabDef_Click();
        QCOMPARE(lines[1].format, (CellFormat{7, 11, 0, 0, 0, 1}));
    }
};

QTEST_MAIN(MainCardTest)
#include "MainCardTest.moc"
