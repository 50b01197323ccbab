#pragma once

#include "card/FieldLabel.h"
#include "model/CellLine.h"

#include <QGroupBox>
#include <array>
#include <cstdint>

class QCheckBox;
class QComboBox;
class QLineEdit;
class QPushButton;

namespace zorbin {

class SettingsBinder;

// The cell-line editor of the page setup tab: the palette of the nine fields (`LblTitle`),
// the caption boxes (`txtLineCaption`) and the nine line slots (`lblLine`) in three columns of
// nine rows, and beneath them the format row that shows and sets one line's format.
//
// The user drags a field from the palette onto a slot to show it on that line, picks a slot up
// with a double click and drops it on the palette to empty it, clicks a slot to select it and
// load its format into the row, and applies the row to the selected line with `cmdSetLabDef`.
// The editor works on the settings record's cell lines; `lines` and `binder` must outlive it.
class CellLineEditor : public QGroupBox
{
    Q_OBJECT

public:
    CellLineEditor(CellLines &lines, SettingsBinder &binder, QWidget *parent = nullptr);

    // The selected line, 0 to 8, or -1 for none.
    int selectedLine() const { return m_selectedLine; }

    // The editor's handlers, as the widgets call them.
    void lblLine_Click(int index);
    void lblLine_DragDrop(int index, const FieldLabel::Dragged &source);
    void LblTitle_DragDrop(const FieldLabel::Dragged &source);
    void cmdSetLabDef_Click();
    // The page setup tab came to the front: no line is selected, so apply does nothing until
    // the user clicks a line.
    void resetSelection();

private:
    void buildColumns(QWidget *area);
    QWidget *buildFormatRow();
    // Slot `index` and its caption box show the record.
    void showLine(int index);
    void select(int index);

    CellLines &m_lines;
    std::array<FieldLabel *, CellLineCount> m_palette{};
    std::array<FieldLabel *, CellLineCount> m_slots{};
    std::array<QLineEdit *, CellLineCount> m_captions{};
    QLabel *m_lblCellName = nullptr;
    QComboBox *m_CmbFontAll = nullptr;
    QLineEdit *m_txtFontSizeAll = nullptr;
    QComboBox *m_CmbWeightAll = nullptr;
    QComboBox *m_CmbAlignAll = nullptr;
    QCheckBox *m_ChkULAll = nullptr;
    QCheckBox *m_ChkItalicAll = nullptr;
    QPushButton *m_cmdSetLabDef = nullptr;
    std::int16_t m_selectedLine = -1;
};

} // namespace zorbin
