#include "card/CellLineEditor.h"

#include "card/SettingsBinder.h"
#include "model/CatalogSettings.h"
#include "testutil/TestMain.h"

#include <QApplication>
#include <QCheckBox>
#include <QComboBox>
#include <QDropEvent>
#include <QLineEdit>
#include <QMimeData>
#include <QPushButton>
#include <QTest>

using namespace zorbin;

namespace {

// An editor over a settings record of its own, as the page setup tab holds it.
struct EditorRig
{
    EditorRig() : binder(settings), editor(settings.lines, binder) { editor.resize(700, 500); }

    FieldLabel *label(const QString &name) const { return editor.findChild<FieldLabel *>(name); }
    FieldLabel *slot(int i) const { return label(QStringLiteral("lblLine(%1)").arg(i)); }
    FieldLabel *field(int i) const { return label(QStringLiteral("LblTitle(%1)").arg(i)); }
    QLineEdit *caption(int i) const
    {
        return editor.findChild<QLineEdit *>(QStringLiteral("txtLineCaption(%1)").arg(i));
    }
    template <typename Widget> Widget *control(const QString &name) const
    {
        return editor.findChild<Widget *>(name);
    }
    CellLine &line(int i) { return settings.lines[static_cast<std::size_t>(i)]; }

    // Drops a dragged label onto `target` the way the window system delivers a drop.
    static bool drop(QWidget *target, QMimeData *payload)
    {
        const QPointF middle(target->width() / 2.0, target->height() / 2.0);
        QDragEnterEvent enter(middle.toPoint(), Qt::MoveAction, payload, Qt::LeftButton, Qt::NoModifier);
        QApplication::sendEvent(target, &enter);
        if (!enter.isAccepted())
            return false;
        QDropEvent dropped(middle, Qt::MoveAction, payload, Qt::LeftButton, Qt::NoModifier);
        QApplication::sendEvent(target, &dropped);
        return dropped.isAccepted();
    }
    bool dragFieldOntoSlot(int field, int slotIndex)
    {
        std::unique_ptr<QMimeData> payload(FieldLabel::dragData(FieldLabel::PaletteArray, field));
        return drop(slot(slotIndex), payload.get());
    }
    bool dragSlotOntoPalette(int slotIndex, int paletteIndex)
    {
        std::unique_ptr<QMimeData> payload(FieldLabel::dragData(FieldLabel::SlotArray, slotIndex));
        return drop(field(paletteIndex), payload.get());
    }

    CatalogSettings settings;
    SettingsBinder binder;
    CellLineEditor editor;
};

const QColor PaletteBack(128, 128, 255);
const QColor EmptyBack(192, 192, 255);

} // namespace

class CellLineEditorTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void thePaletteShowsTheNineFieldsInTheirColours()
    {
        EditorRig rig;
        const QStringList captions = {
            QStringLiteral("תמונה"),      QStringLiteral("מפתח פריט"),   QStringLiteral("שם פריט"),
            QStringLiteral("קטגוריה"),    QStringLiteral("מחיר 1"),      QStringLiteral("מחיר 2"),
            QStringLiteral("יחידת מידה"), QStringLiteral("נתון נוסף 1"), QStringLiteral("נתון נוסף 2")};
        for (int i = 0; i < 9; ++i) {
            QVERIFY(rig.field(i) && rig.slot(i) && rig.caption(i));
            QCOMPARE(rig.field(i)->text(), captions.at(i));
            QCOMPARE(rig.field(i)->backColour(), PaletteBack);
            QCOMPARE(rig.field(i)->foreColour(), QColor(Qt::white));
            QCOMPARE(rig.slot(i)->text(), QString());
            QCOMPARE(rig.slot(i)->backColour(), EmptyBack);
            QCOMPARE(rig.slot(i)->foreColour(), QApplication::palette().color(QPalette::WindowText));
        }
    }

    void droppingAFieldOnASlotAssignsIt()
    {
        EditorRig rig;
        rig.line(2).format.size = 14;
        QVERIFY(rig.dragFieldOntoSlot(4, 2));
        QCOMPARE(rig.line(2).field, 4);
        QCOMPARE(rig.slot(2)->text(), QStringLiteral("מחיר 1"));
        QCOMPARE(rig.slot(2)->backColour(), PaletteBack);
        QCOMPARE(rig.slot(2)->foreColour(), QColor(255, 255, 255));
        QCOMPARE(rig.caption(2)->text(), QStringLiteral("מחיר 1:"));
        QCOMPARE(rig.line(2).caption, QStringLiteral("מחיר 1:"));
        QCOMPARE(rig.line(2).format.size, 14);
        QCOMPARE(rig.editor.selectedLine(), -1);

        // Another field replaces it, and the caption box is written anew even after an edit.
        QTest::keyClicks(rig.caption(2), QStringLiteral(" (VAT)"));
        QVERIFY(rig.dragFieldOntoSlot(2, 2));
        QCOMPARE(rig.line(2).field, 2);
        QCOMPARE(rig.slot(2)->text(), QStringLiteral("שם פריט"));
        QCOMPARE(rig.caption(2)->text(), QStringLiteral("שם פריט:"));
        // The same field may stand on several lines.
        QVERIFY(rig.dragFieldOntoSlot(2, 7));
        QCOMPARE(rig.line(7).field, 2);
        QCOMPARE(rig.line(2).field, 2);
    }

    void droppingASlotOnThePaletteEmptiesIt()
    {
        EditorRig rig;
        QVERIFY(rig.dragFieldOntoSlot(4, 2));
        const CellFormat format{2, 16, 1, 1, 0, 2};
        rig.line(2).format = format;
        QVERIFY(rig.dragSlotOntoPalette(2, 8));
        QVERIFY(!rig.line(2).isUsed());
        QCOMPARE(rig.slot(2)->text(), QString());
        QCOMPARE(rig.caption(2)->text(), QString());
        QCOMPARE(rig.slot(2)->backColour(), EmptyBack);
        QCOMPARE(rig.slot(2)->foreColour(), QApplication::palette().color(QPalette::WindowText));
        QCOMPARE(rig.line(2).format, format);
    }

    void dropsOfAnythingElseChangeNothing()
    {
        EditorRig rig;
        QVERIFY(rig.dragFieldOntoSlot(1, 0));
        // A palette label on the palette, a slot on a slot, and text from elsewhere.
        std::unique_ptr<QMimeData> field(FieldLabel::dragData(FieldLabel::PaletteArray, 3));
        EditorRig::drop(rig.field(0), field.get());
        std::unique_ptr<QMimeData> slot(FieldLabel::dragData(FieldLabel::SlotArray, 0));
        EditorRig::drop(rig.slot(5), slot.get());
        QMimeData text;
        text.setText(QStringLiteral("1"));
        QVERIFY(!EditorRig::drop(rig.slot(0), &text));
        QCOMPARE(rig.line(0).field, 1);
        QVERIFY(!rig.line(5).isUsed());
        QCOMPARE(rig.caption(0)->text(), QStringLiteral("מפתח פריט:"));
    }

    void clickingASlotLoadsItsFormat()
    {
        EditorRig rig;
        QVERIFY(rig.dragFieldOntoSlot(6, 3));
        rig.line(3).format = CellFormat{1, 9, 2, 1, 1, 2};
        QTest::mouseClick(rig.slot(3), Qt::LeftButton);
        QCOMPARE(rig.editor.selectedLine(), 3);
        QCOMPARE(rig.control<QLabel>(QStringLiteral("lblCellName"))->text(), QStringLiteral("יחידת מידה"));
        QCOMPARE(rig.control<QComboBox>(QStringLiteral("CmbFontAll"))->currentText(),
                 QStringLiteral("David"));
        QCOMPARE(rig.control<QLineEdit>(QStringLiteral("txtFontSizeAll"))->text(), QStringLiteral("9"));
        QCOMPARE(rig.control<QComboBox>(QStringLiteral("CmbWeightAll"))->currentText(),
                 QStringLiteral("עבה"));
        QCOMPARE(rig.control<QComboBox>(QStringLiteral("CmbAlignAll"))->currentText(),
                 QStringLiteral("שמאל"));
        QVERIFY(rig.control<QCheckBox>(QStringLiteral("ChkULAll"))->isChecked());
        QVERIFY(rig.control<QCheckBox>(QStringLiteral("ChkItalicAll"))->isChecked());

        // A stored value the list does not have leaves that control as it was.
        rig.line(4).format = CellFormat{7, 11, 0, 0, 0, 1};
        rig.editor.lblLine_Click(4);
        QCOMPARE(rig.control<QComboBox>(QStringLiteral("CmbFontAll"))->currentText(),
                 QStringLiteral("David"));
        QCOMPARE(rig.control<QLineEdit>(QStringLiteral("txtFontSizeAll"))->text(), QStringLiteral("11"));
        QCOMPARE(rig.control<QLabel>(QStringLiteral("lblCellName"))->text(), QString());
    }

    void applyingWithoutASelectedLineDoesNothing()
    {
        EditorRig rig;
        rig.control<QComboBox>(QStringLiteral("CmbFontAll"))->setCurrentIndex(2);
        rig.control<QLineEdit>(QStringLiteral("txtFontSizeAll"))->setText(QStringLiteral("20"));
        rig.editor.cmdSetLabDef_Click();
        for (const CellLine &line : rig.settings.lines)
            QCOMPARE(line.format, CellFormat());
        QVERIFY(!rig.control<QPushButton>(QStringLiteral("cmdSetLabDef"))->isEnabled());

        // Selected, then the selection cleared as the page tab comes forward again.
        rig.editor.lblLine_Click(1);
        rig.editor.resetSelection();
        rig.editor.cmdSetLabDef_Click();
        QCOMPARE(rig.line(1).format, CellFormat());
    }

    void applyingStoresTheFormatRow_data()
    {
        QTest::addColumn<QString>("size");
        QTest::addColumn<int>("stored");
        QTest::newRow("not a number") << QStringLiteral("abc") << 9;
        QTest::newRow("above a byte") << QStringLiteral("300") << 9;
        QTest::newRow("empty") << QString() << 9;
        QTest::newRow("half down to even") << QStringLiteral("12.5") << 12;
        QTest::newRow("half up to even") << QStringLiteral("13.5") << 14;
        QTest::newRow("whole") << QStringLiteral("18") << 18;
    }
    void applyingStoresTheFormatRow()
    {
        QFETCH(QString, size);
        QFETCH(int, stored);
        EditorRig rig;
        rig.line(5).format.align = 1;
        rig.line(6).format.size = 30;
        rig.editor.lblLine_Click(5);
        rig.control<QComboBox>(QStringLiteral("CmbFontAll"))->setCurrentIndex(2);
        rig.control<QLineEdit>(QStringLiteral("txtFontSizeAll"))->setText(size);
        rig.control<QComboBox>(QStringLiteral("CmbWeightAll"))->setCurrentIndex(1);
        rig.control<QCheckBox>(QStringLiteral("ChkULAll"))->setChecked(true);
        rig.control<QCheckBox>(QStringLiteral("ChkItalicAll"))->setChecked(true);
        rig.control<QComboBox>(QStringLiteral("CmbAlignAll"))->setCurrentIndex(-1); // no entry: kept
        rig.control<QPushButton>(QStringLiteral("cmdSetLabDef"))->click();
        const CellFormat &format = rig.line(5).format;
        QCOMPARE(int(format.size), stored);
        QCOMPARE(int(format.font), 2);
        QCOMPARE(int(format.weight), 1);
        QCOMPARE(int(format.underline), 1);
        QCOMPARE(int(format.italic), 1);
        QCOMPARE(int(format.align), 1);
        QCOMPARE(int(rig.line(6).format.size), 30); // the other lines are not touched
    }

    void theRecordShowsAfterALoad()
    {
        EditorRig rig;
        rig.line(3).field = 6;
        rig.line(3).caption = QStringLiteral("יחידה:");
        rig.binder.refresh();
        QCOMPARE(rig.slot(3)->text(), QStringLiteral("יחידת מידה"));
        QCOMPARE(rig.slot(3)->backColour(), PaletteBack);
        QCOMPARE(rig.caption(3)->text(), QStringLiteral("יחידה:"));
        rig.caption(3)->setText(QStringLiteral("יח':"));
        QCOMPARE(rig.line(3).caption, QStringLiteral("יח':"));
    }
};

ZORBIN_TEST_CLASS(CellLineEditorTest)
#include "CellLineEditorTest.moc"
