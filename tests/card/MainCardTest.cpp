// The settings page over recording stages: the stored options in its widgets and back, the
// entry limits and number checks, a run's effect on the page, the choosers, the cell-line
// editor; and the desktop program's whole runs on the demo database.
#include "card/MainCard.h"

#include "card/CardWindow.h"
#include "card/CellLineEditor.h"
#include "card/FileChooser.h"
#include "card/WidgetUserPort.h"
#include "card/tabs/PageSetupTab.h"
#include "control/Program.h"
#include "model/ProgressMeter.h"
#include "platform/FileSystem.h"
#include "testutil/CaseTable.h"
#include "testutil/DemoScratch.h"
#include "testutil/MemorySettingsStore.h"
#include "testutil/Pictures.h"
#include "testutil/RecordingStages.h"
#include "testutil/TestFiles.h"

#include <QApplication>
#include <QCheckBox>
#include <QComboBox>
#include <QDropEvent>
#include <QFileInfo>
#include <QLineEdit>
#include <QMessageBox>
#include <QMimeData>
#include <QPushButton>
#include <QRegularExpression>
#include <QTabWidget>
#include <QTemporaryDir>
#include <QTest>
#include <QTimer>

using namespace zorbin;
using namespace zorbin::test;

namespace {

// Answers the modal windows a test's clicks open: message boxes with the queued buttons (OK, or
// No to a question, when the queue is empty), recording their texts; dialogs through `onDialog`,
// rejected when it leaves them open.
class ModalAnswerer : public QObject
{
public:
    ModalAnswerer()
    {
        connect(&m_timer, &QTimer::timeout, this, [this] {
            QWidget *modal = QApplication::activeModalWidget();
            if (auto *box = qobject_cast<QMessageBox *>(modal)) {
                texts << box->text();
                const auto unasked =
                    box->standardButtons() & QMessageBox::No ? QMessageBox::No : QMessageBox::Ok;
                if (QAbstractButton *button = box->button(buttons.isEmpty() ? unasked : buttons.takeFirst()))
                    button->click();
                else
                    box->reject();
            } else if (auto *dialog = qobject_cast<QDialog *>(modal)) {
                if (onDialog)
                    onDialog(dialog);
                if (dialog->isVisible())
                    dialog->reject();
            }
        });
        m_timer.start(20);
    }

    QList<QMessageBox::StandardButton> buttons;
    QStringList texts;
    std::function<void(QDialog *)> onDialog;

private:
    QTimer m_timer;
};

// Answers the file dialogs with `answer` (nothing stands for Cancel), keeping the last request.
class FakeFileChooser final : public FileChooser
{
public:
    std::optional<QString> openFile(QWidget *, const FileRequest &request) override
    {
        lastRequest = request;
        return answer;
    }
    std::optional<QString> chooseFolder(QWidget *, const QString &, const QString &) override
    {
        return answer;
    }

    std::optional<QString> answer;
    FileRequest lastRequest;
};

// A settings card over an in-memory store holding `stored` and recording stages, whose list
// filling gives the first price list three entries, as the accounting database does. `during`
// runs inside each stage.
struct CardRig
{
    explicit CardRig(const QMap<QString, QString> &stored = {}, bool withCard = true)
    {
        for (auto it = stored.cbegin(); it != stored.cend(); ++it)
            store.set(it.key(), it.value());
        auto made = std::make_unique<RecordingStages>();
        stages = made.get();
        control = std::make_unique<CatalogControl>(user, store, localFileSystem(), std::move(made));
        stages->during = [this](const QString &stage) {
            if (stage == QLatin1String("FillCmbPriceField")) {
                for (const char *name : {"מחיר הפריט", "סיטונאי", "קמעונאי"})
                    settings().priceList1.addEntry(QString::fromUtf8(name), 0);
            }
            if (during)
                during(stage);
        };
        if (!withCard)
            return;
        card = std::make_unique<MainCard>(*control, user);
        card->setFileChooser(files);
    }
    template <typename Widget = QWidget> Widget *find(const QString &name) const
    {
        auto *widget = card->findChild<Widget *>(name);
        if (!widget)
            qWarning("no widget named %s", qPrintable(name));
        return widget;
    }
    CatalogSettings &settings() { return control->settings(); }

    MemorySettingsStore store;
    WidgetUserPort user;
    RecordingStages *stages = nullptr;
    std::unique_ptr<CatalogControl> control;
    FakeFileChooser files;
    std::function<void(const QString &stage)> during;
    std::unique_ptr<MainCard> card;
};

// What a widget shows: a box or label its text, a list its entry, a button "1" when it is on.
QString shown(QWidget *widget)
{
    if (auto *box = qobject_cast<QLineEdit *>(widget))
        return box->text();
    if (auto *list = qobject_cast<QComboBox *>(widget))
        return list->currentText();
    if (auto *label = qobject_cast<QLabel *>(widget))
        return label->text();
    return qobject_cast<QAbstractButton *>(widget)->isChecked() ? u"1"_qs : u"0"_qs;
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

// Each kind of widget shows its stored option at start-up, and a user's edit is what the save
// button writes back.
const struct
{
    const char *name; // the widget
    const char *key, *stored, *shows, *input, *saved;
} Bindings[] = {
    {"txtRows", "Rows", "12", "12", "5x.", "5"},
    {"txtLineCaption(3)", "LineCaption3", "יח':", "יח':", "מידה", "מידה"},
    {"lblLine(3)", "LineTag3", "6", "יחידת מידה", "", "6"},
    {"ChkCatCode", "UseCatCode", "1", "1", "", "0"},
    {"cmbPriceField", "PriceField", "2", "קמעונאי", "0", "0"},
    {"CmbSortDir", "SortDir", "1", "יורד", "0", "0"},
    {"OptPicSource(1)", "PicSource1", "True", "1", "", "True"},
    {"OptPicSource(2)", "PicSource1", "True", "0", "", "False"},
};

const QString Slot = u"lblLine(%1)"_qs;
const QString Palette = u"LblTitle(%1)"_qs;

} // namespace

class MainCardTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void initTestCase() { qputenv("ZORBIN_BROWSER", "true"); }
    // A page built wrong warns (a widget placed outside its grid, say); the offscreen platform's
    // own warning aside.
    void init() { QTest::failOnWarning(QRegularExpression(u"^(?!This plugin does not support)"_qs)); }

    // The run buttons on the demo settings, with the program's own stages: the catalog's files
    // and first item, the list's rows, and no message but the question.
    void theRunButtonsWriteTheCatalogAndTheList()
    {
        DemoScratch demo;
        WidgetUserPort user;
        const auto control = assembleControl(user, *demo.store);
        MainCard card(*control, user);
        ModalAnswerer answerer;
        answerer.buttons = {QMessageBox::Yes};
        card.findChild<QPushButton *>(u"cmdRunMailing"_qs)->click();
        card.findChild<QPushButton *>(u"CmdPreview"_qs)->click();
        QCOMPARE(answerer.texts, QStringList{u"להתחיל בהכנת הקטלוג?"_qs});
        QCOMPARE(firstItemKey(demo.out(u"zoindex.htm"_qs)), u"00010"_qs);
        for (const char *name : {"zo000034.htm", "tarnik.css", "images/item-11.jpg"})
            QVERIFY2(QFileInfo::exists(demo.out(QLatin1String(name))), name);
        QCOMPARE(listRows(demo.out(u"zorbin3.htm"_qs)), 301);
        // The stored choice of a list that the demo database fills.
        QCOMPARE(shown(card.findChild<QComboBox *>(u"cmbPriceField"_qs)), u"מחירון סיטונאי"_qs);
    }

    // "בחירת פריטים..." has the items collected (the control decides whether to ask first), ticks
    // "only the marked items" and opens the selection dialog.
    void selectingItemsOpensTheSelectionDialog()
    {
        CardRig rig;
        ModalAnswerer answerer;
        QString opened;
        answerer.onDialog = [&](QDialog *dialog) { opened = dialog->objectName(); };
        rig.find<QPushButton>(u"cmdSelectAccount"_qs)->click();
        QCOMPARE(opened, u"frmSelectItem"_qs);
        QVERIFY(rig.find<QCheckBox>(u"ChkSelectAccount"_qs)->isChecked());
        QVERIFY(rig.stages->names().contains(u"BuildAndCollectData"_qs));
    }

    void storedOptionsShowAndEditsSaveBack_data() { addCaseRows(Bindings); }
    void storedOptionsShowAndEditsSaveBack()
    {
        const auto &c = fetchCase(Bindings);
        const QString key = QLatin1String(c.key);
        CardRig rig({{key, QString::fromUtf8(c.stored)}});
        QWidget *widget = rig.find(QLatin1String(c.name));
        QCOMPARE(shown(widget), QString::fromUtf8(c.shows));
        edit(widget, QString::fromUtf8(c.input));
        rig.find<QPushButton>(u"CmdDef"_qs)->click();
        QCOMPARE(rig.store.get(key), QString::fromUtf8(c.saved));
    }

    // A list whose stored choice is "no entry" keeps it when entries arrive later (a combo box
    // selects its first entry by itself).
    void noEntryStaysNoEntryWhenEntriesArrive()
    {
        CardRig rig({{u"PriceField"_qs, u"-1"_qs}});
        ChoiceList &prices = rig.settings().priceList1;
        auto *box = rig.find<QComboBox>(u"cmbPriceField"_qs);
        QCOMPARE(box->count(), 3);
        QCOMPARE(box->currentIndex(), -1);
        prices.clear();
        prices.addEntry(u"מבצע"_qs, 9);
        QCOMPARE(box->currentIndex(), -1);
        QCOMPARE(prices.currentIndex(), -1);
    }

    // The most characters each box takes while typing; the first sort code has no limit, and the
    // cut-offs beyond the stored positions take one.
    void entryLimitsHoldWhileTyping()
    {
        CardRig rig;
        for (const auto &[name, limit] :
             {std::pair{"txtToSort", 15}, {"txtFromSort", 20}, {"txtTopPercent", 2}, {"ItemCutOff(7)", 1}}) {
            QWidget *box = rig.find(QLatin1String(name));
            edit(box, u"12345678901234567890"_qs);
            QVERIFY2(shown(box).size() == limit, name);
        }
    }

    // Written by hand or by an older version: the run uses what the user sees, and a save keeps it.
    void aLongerStoredTextIsShownWholeAndKept()
    {
        const QString longBound = u"ABCDEFGHIJKLMNOPQRST"_qs; // typing allows 15
        CardRig rig({{u"ToSort"_qs, longBound}});
        auto *box = rig.find<QLineEdit>(u"txtToSort"_qs);
        QCOMPARE(box->text(), longBound);
        QTest::keyClicks(box, u"UVW"_qs);
        QCOMPARE(box->text(), longBound); // no longer than it already is
        rig.find<QPushButton>(u"CmdDef"_qs)->click();
        QCOMPARE(rig.store.get(u"ToSort"_qs), longBound);
    }

    // A grid count that cannot make a page turns its box red and names the field.
    void gridCountsAreCheckedAsTyped()
    {
        CardRig rig;
        auto *rows = rig.find<QLineEdit>(u"txtRows"_qs);
        auto *columns = rig.find<QLineEdit>(u"txtCols"_qs);
        edit(rows, u"0"_qs);
        edit(columns, QString());
        QVERIFY(rows->property("invalid").toBool() && rows->toolTip().contains(u"\"שורות\""_qs));
        QVERIFY(columns->property("invalid").toBool() && columns->toolTip().contains(u"עמודות"_qs));
        edit(rows, u"1"_qs);
        QVERIFY(!rows->property("invalid").toBool() && rows->toolTip().isEmpty());
    }

    // While a run goes on, only the stop button can be pressed (it is honoured at the next
    // progress point), and the tabs hold still; when it ends, the page shows the options as the
    // run left them.
    void aRunDisablesThePageAndHonoursStop()
    {
        QTemporaryDir output;
        CardRig rig;
        rig.settings().outputFolder = output.path();
        auto *stop = rig.find<QPushButton>(u"cmdStop"_qs);
        auto enabled = [&] {
            QList<bool> states;
            for (const char *name : {"cmdRunMailing", "CmdPreview", "cmdRunPdf", "cmdRunSite", "CmdDef",
                                     "cmdStop", "PageSetupTab", "GeneralTab"})
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
            QCOMPARE(enabledDuringRun, (QList<bool>{false, false, false, false, false, true, false, false}));
            QCOMPARE(rows, 5); // the click was delivered at the first progress point
            QCOMPARE(enabled(), (QList<bool>{true, true, true, true, true, false, true, true}));
            QVERIFY(rig.find<QCheckBox>(u"ChkSelectAccount"_qs)->isChecked());
        }
        QCOMPARE(rig.stages->names().constLast(), u"CreateListHTML"_qs); // the runs went on
    }

    // Closing the window during a run stops the run first; the window closes once it has ended.
    void closingDuringARunStopsItFirst()
    {
        QTemporaryDir output;
        CardRig rig({}, false);
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
        QCOMPARE(rig.stages->names().constLast(), u"CreateCSS"_qs); // the run ended in order
        QTRY_VERIFY(!window.isVisible());
        window.show();
        QVERIFY(window.close()); // while idle, at once
    }

    void choosersFillTheirBoxes()
    {
        QTemporaryDir folder;
        CardRig rig;
        auto *chooser = rig.find<QAbstractButton>(u"imgLogo"_qs);
        chooser->click(); // Cancel
        QCOMPARE(rig.find<QLineEdit>(u"txtLogo"_qs)->text(), QString());
        rig.files.answer = folder.filePath(u"logo.jpg"_qs);
        writeFile(*rig.files.answer, turned({40, 20}));
        chooser->click();
        QCOMPARE(rig.settings().logo, *rig.files.answer);
        chooser->click();
        QCOMPARE(rig.files.lastRequest.startPath, *rig.files.answer);
        // The button shows the logo as it will stand on the page: upright.
        QCOMPARE(chooser->icon().actualSize(QSize(24, 24)), QSize(12, 24));

        // A picture name is joined straight onto its folder: the folder keeps its separator.
        rig.files.answer = u"/srv/pictures"_qs;
        rig.find<QAbstractButton>(u"cmdPicPath"_qs)->click();
        QCOMPARE(rig.settings().pictureFolder, u"/srv/pictures/"_qs);
        rig.find<QAbstractButton>(u"cmdPagingPath"_qs)->click();
        rig.files.answer = std::nullopt;
        rig.find<QAbstractButton>(u"cmdPagingPath"_qs)->click();
        QCOMPARE(rig.settings().outputFolder, u"/srv/pictures"_qs);
    }

    // A field dropped on a line's slot stands on that line with its caption; the slot dropped
    // back on the palette empties the line. The line's format stays as it was.
    void cellLineDropsFillAndEmptyLines()
    {
        CardRig rig;
        CellLine &line = rig.settings().lines[2];
        const CellFormat format{2, 16, 1, 1, 0, 2};
        line.format = format;
        auto *slot = rig.find<FieldLabel>(Slot.arg(2));
        auto *caption = rig.find<QLineEdit>(u"txtLineCaption(2)"_qs);
        QVERIFY(drop(slot, FieldLabel::PaletteArray, 4));
        QCOMPARE(line.field, 4);
        QCOMPARE(slot->text(), u"מחיר 1"_qs);
        QCOMPARE(slot->backColour(), QColor(128, 128, 255));
        QCOMPARE(caption->text(), u"מחיר 1:"_qs);
        QTest::keyClicks(caption, u" (VAT)"_qs); // another field writes its caption anew
        QVERIFY(drop(slot, FieldLabel::PaletteArray, 2));
        QCOMPARE(line.caption, u"שם פריט:"_qs);

        // A palette label on the palette, a slot on a slot, text from elsewhere: nothing changes.
        drop(rig.find(Palette.arg(0)), FieldLabel::PaletteArray, 3);
        drop(rig.find(Slot.arg(5)), FieldLabel::SlotArray, 2);
        QMimeData text;
        text.setText(u"1"_qs);
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
        CellLines &lines = rig.settings().lines;
        lines[0].field = 6;
        lines[0].format = CellFormat{1, 9, 2, 1, 1, 2};
        lines[1].format = CellFormat{3, 11, 0, 0, 0, 1}; // no font 3
        rig.card->tabs()->setCurrentIndex(MainCard::PageSetupPage);
        QTest::mouseClick(rig.find(Slot.arg(0)), Qt::LeftButton);
        auto *font = rig.find<QComboBox>(u"CmbFontAll"_qs);
        auto *size = rig.find<QLineEdit>(u"txtFontSizeAll"_qs);
        auto *weight = rig.find<QComboBox>(u"CmbWeightAll"_qs);
        auto *align = rig.find<QComboBox>(u"CmbAlignAll"_qs);
        auto *underline = rig.find<QCheckBox>(u"ChkULAll"_qs);
        auto *italic = rig.find<QCheckBox>(u"ChkItalicAll"_qs);
        auto *apply = rig.find<QPushButton>(u"cmdSetLabDef"_qs);
        QCOMPARE(shown(rig.find(u"lblCellName"_qs)), u"יחידת מידה"_qs);
        const QStringList row = {shown(font),  shown(size),      shown(weight),
                                 shown(align), shown(underline), shown(italic)};
        QCOMPARE(row, (QStringList{u"David"_qs, u"9"_qs, u"עבה"_qs, u"שמאל"_qs, u"1"_qs, u"1"_qs}));

        // The top line takes the row: the size rounds half to even; no entry and no size keep
        // what the line had.
        font->setCurrentIndex(2);
        size->setText(u"12.5"_qs);
        weight->setCurrentIndex(1);
        underline->setChecked(false);
        italic->setCheckState(Qt::PartiallyChecked);
        align->setCurrentIndex(-1);
        apply->click();
        QCOMPARE(lines[0].format, (CellFormat{2, 12, 1, 0, 2, 2}));
        size->setText(u"300"_qs);
        apply->click();
        QCOMPARE(lines[0].format, (CellFormat{2, 12, 1, 0, 2, 2}));
        QCOMPARE(lines[2].format, CellFormat());

        QTest::mouseClick(rig.find(Slot.arg(1)), Qt::LeftButton);
        QCOMPARE(font->currentText(), u"Miriam"_qs);
        QCOMPARE(size->text(), u"11"_qs);
        QCOMPARE(shown(rig.find(u"lblCellName"_qs)), QString());

        rig.card->tabs()->setCurrentIndex(MainCard::TitlesPage);
        QCOMPARE(rig.card->pageSetupTab()->editor()->selectedLine(), 1);
        rig.card->tabs()->setCurrentIndex(MainCard::PageSetupPage);
        QVERIFY(!apply->isEnabled());
        rig.card->pageSetupTab()->editor()->cmdSetLabDef_Click();
        QCOMPARE(lines[1].format, (CellFormat{3, 11, 0, 0, 0, 1}));
    }
};

QTEST_MAIN(MainCardTest)
#include "MainCardTest.moc"
