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
    EditorRig() : binder(settings), editor(settings.lines, binder) {}

    template <typename Widget = FieldLabel> Widget *find(const QString &name, int i = -1) const
    {
        return editor.findChild<Widget *>(i < 0 ? name : QStringLiteral("%1(%2)").arg(name).arg(i));
    }
    CellLine &line(int i) { return settings.lines[static_cast<std::size_t>(i)]; }

    // Drops a label dragged from `array` onto `target` the way the window system delivers a drop.
    static bool drop(QWidget *target, const QString &array, int index)
    {
        std::unique_ptr<QMimeData> payload(FieldLabel::dragData(array, index));
        return drop(target, payload.get());
    }
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

    CatalogSettings settings;
    SettingsBinder binder;
    CellLineEditor editor;
};

const QString Slot = QStringLiteral("lblLine");
const QString Palette = QStringLiteral("LblTitle");
const QString Caption = QStringLiteral("txtLineCaption");

} // namespace

class CellLineEditorTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    // A field dropped on a line's slot stands on that line with its caption; the slot dropped
    // back on the palette empties the line. The line's format stays as it was.
    void dropsFillAndEmptyLines()
    {
        EditorRig rig;
        const CellFormat format{2, 16, 1, 1, 0, 2};
        rig.line(2).format = format;
        QVERIFY(EditorRig::drop(rig.find(Slot, 2), Palette, 4));
        QCOMPARE(rig.line(2).field, 4);
        QCOMPARE(rig.find(Slot, 2)->text(), QStringLiteral("מחיר 1"));
        QCOMPARE(rig.find(Slot, 2)->backColour(), QColor(128, 128, 255));
        QCOMPARE(rig.find(Slot, 2)->foreColour(), QColor(Qt::white));
        QCOMPARE(rig.find<QLineEdit>(Caption, 2)->text(), QStringLiteral("מחיר 1:"));

        // Another field replaces it, and writes the caption anew even after an edit.
        QTest::keyClicks(rig.find<QLineEdit>(Caption, 2), QStringLiteral(" (VAT)"));
        QVERIFY(EditorRig::drop(rig.find(Slot, 2), Palette, 2));
        QCOMPARE(rig.line(2).caption, QStringLiteral("שם פריט:"));

        // Drops of anything else change nothing: a palette label on the palette, a slot on a
        // slot, text from elsewhere.
        EditorRig::drop(rig.find(Palette, 0), Palette, 3);
        EditorRig::drop(rig.find(Slot, 5), Slot, 2);
        QMimeData text;
        text.setText(QStringLiteral("1"));
        QVERIFY(!EditorRig::drop(rig.find(Slot, 0), &text));
        QCOMPARE(rig.line(2).field, 2);
        QVERIFY(!rig.line(5).isUsed() && !rig.line(0).isUsed());

        QVERIFY(EditorRig::drop(rig.find(Palette, 8), Slot, 2));
        QVERIFY(!rig.line(2).isUsed());
        QCOMPARE(rig.find(Slot, 2)->text(), QString());
        QCOMPARE(rig.find<QLineEdit>(Caption, 2)->text(), QString());
        QCOMPARE(rig.find(Slot, 2)->backColour(), QColor(192, 192, 255));
        QCOMPARE(rig.find(Slot, 2)->foreColour(), QApplication::palette().color(QPalette::WindowText));
        QCOMPARE(rig.line(2).format, format);
    }

    // Clicking a line loads its format into the format row; "apply" stores the row into that line
    // only. A stored value that a list does not have leaves that list as it was.
    void theFormatRowEditsTheSelectedLine()
    {
        EditorRig rig;
        rig.line(0).field = 6;
        rig.line(0).format = CellFormat{1, 9, 2, 1, 1, 2};
        rig.line(1).format = CellFormat{7, 11, 0, 0, 0, 1};
        rig.line(6).format.size = 30;
        QTest::mouseClick(rig.find(Slot, 0), Qt::LeftButton);
        QCOMPARE(rig.editor.selectedLine(), 0);
        QCOMPARE(rig.find<QLabel>(QStringLiteral("lblCellName"))->text(), QStringLiteral("יחידת מידה"));
        auto *font = rig.find<QComboBox>(QStringLiteral("CmbFontAll"));
        auto *size = rig.find<QLineEdit>(QStringLiteral("txtFontSizeAll"));
        auto *weight = rig.find<QComboBox>(QStringLiteral("CmbWeightAll"));
        auto *align = rig.find<QComboBox>(QStringLiteral("CmbAlignAll"));
        auto *underline = rig.find<QCheckBox>(QStringLiteral("ChkULAll"));
        auto *italic = rig.find<QCheckBox>(QStringLiteral("ChkItalicAll"));
        QCOMPARE(font->currentText(), QStringLiteral("David"));
        QCOMPARE(size->text(), QStringLiteral("9"));
        QCOMPARE(weight->currentText(), QStringLiteral("עבה"));
        QCOMPARE(align->currentText(), QStringLiteral("שמאל"));
        QVERIFY(underline->isChecked() && italic->isChecked());

        // The top line takes the row: the size rounds half to even.
        font->setCurrentIndex(2);
        size->setText(QStringLiteral("12.5"));
        weight->setCurrentIndex(1);
        underline->setChecked(false);
        italic->setCheckState(Qt::PartiallyChecked);
        align->setCurrentIndex(-1); // no entry: kept
        rig.find<QPushButton>(QStringLiteral("cmdSetLabDef"))->click();
        QCOMPARE(rig.line(0).format, (CellFormat{2, 12, 1, 0, 2, 2}));
        size->setText(QStringLiteral("300")); // no size: kept
        rig.find<QPushButton>(QStringLiteral("cmdSetLabDef"))->click();
        QCOMPARE(int(rig.line(0).format.size), 12);
        QCOMPARE(int(rig.line(6).format.size), 30);

        rig.editor.lblLine_Click(1);
        QCOMPARE(font->currentText(), QStringLiteral("Miriam"));
        QCOMPARE(size->text(), QStringLiteral("11"));
        QCOMPARE(rig.find<QLabel>(QStringLiteral("lblCellName"))->text(), QString());
    }

    void applyingWithoutASelectedLineDoesNothing()
    {
        EditorRig rig;
        rig.find<QComboBox>(QStringLiteral("CmbFontAll"))->setCurrentIndex(2);
        rig.editor.cmdSetLabDef_Click();
        QVERIFY(!rig.find<QPushButton>(QStringLiteral("cmdSetLabDef"))->isEnabled());
        rig.editor.lblLine_Click(1);
        QVERIFY(rig.find<QPushButton>(QStringLiteral("cmdSetLabDef"))->isEnabled());
        rig.editor.resetSelection();
        rig.editor.cmdSetLabDef_Click();
        for (const CellLine &line : rig.settings.lines)
            QCOMPARE(line.format, CellFormat());
    }

    void theLinesShowAfterALoad()
    {
        EditorRig rig;
        rig.line(3).field = 6;
        rig.line(3).caption = QStringLiteral("יחידה:");
        rig.binder.refresh();
        QCOMPARE(rig.find(Slot, 3)->text(), QStringLiteral("יחידת מידה"));
        QCOMPARE(rig.find(Slot, 3)->backColour(), QColor(128, 128, 255));
        QCOMPARE(rig.find<QLineEdit>(Caption, 3)->text(), QStringLiteral("יחידה:"));
        rig.find<QLineEdit>(Caption, 3)->setText(QStringLiteral("יח':"));
        QCOMPARE(rig.line(3).caption, QStringLiteral("יח':"));
    }
};

ZORBIN_TEST_CLASS(CellLineEditorTest)
#include "CellLineEditorTest.moc"
