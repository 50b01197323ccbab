#include "card/CellLineEditor.h"

#include "card/CellLineEditing.h"
#include "card/SettingsBinder.h"

#include <QCheckBox>
#include <QComboBox>
#include <QGridLayout>
#include <QHBoxLayout>
#include <QLineEdit>
#include <QPushButton>
#include <QVBoxLayout>

namespace zorbin {
namespace {

QComboBox *fixedList(const QString &name, const QString &what, const QStringList &entries, QWidget *parent)
{
    auto *list = new QComboBox(parent);
    list->setObjectName(name);
    list->setPlaceholderText(what);
    list->setToolTip(what);
    list->setAccessibleName(what);
    list->setSizeAdjustPolicy(QComboBox::AdjustToContents);
    list->addItems(entries);
    list->setCurrentIndex(-1); // no entry until a line is selected
    return list;
}

QCheckBox *styleBox(const QString &name, const QString &caption, QWidget *parent)
{
    auto *box = new QCheckBox(caption, parent);
    box->setObjectName(name);
    return box;
}

QLabel *heading(const QString &text, QWidget *parent)
{
    auto *label = new QLabel(text, parent);
    label->setAlignment(Qt::AlignCenter);
    label->setWordWrap(true);
    QFont bold = label->font();
    bold.setBold(true);
    label->setFont(bold);
    return label;
}

int checkValue(const QCheckBox *box)
{
    switch (box->checkState()) {
    case Qt::Checked:
        return 1;
    case Qt::PartiallyChecked:
        return 2;
    case Qt::Unchecked:
        break;
    }
    return 0;
}

void setListIndex(QComboBox *list, int index)
{
    if (index >= -1 && index < list->count())
        list->setCurrentIndex(index);
}

void setCheckValue(QCheckBox *box, int value)
{
    if (value == 0 || value == 1)
        box->setCheckState(value == 1 ? Qt::Checked : Qt::Unchecked);
    else if (value == 2)
        box->setCheckState(Qt::PartiallyChecked);
}

} // namespace

CellLineEditor::CellLineEditor(CellLines &lines, SettingsBinder &binder, QWidget *parent)
    : QGroupBox(QStringLiteral("נתוני פריט בקטלוג:"), parent), m_lines(lines)
{
    setObjectName(QStringLiteral("CellLineEditor"));
    auto *columns = new QWidget(this);
    buildColumns(columns);
    for (int i = 0; i < CellLineCount; ++i)
        binder.text(m_captions[static_cast<std::size_t>(i)], QStringLiteral("LineCaption%1").arg(i));
    binder.custom([this] {
        for (int i = 0; i < CellLineCount; ++i)
            showLine(i);
    });

    auto *layout = new QVBoxLayout(this);
    layout->addWidget(columns);
    layout->addWidget(buildFormatRow());
    layout->addStretch();
    select(-1);
}

void CellLineEditor::buildColumns(QWidget *area)
{
    auto *grid = new QGridLayout(area);
    grid->setContentsMargins(0, 0, 0, 0);
    grid->setVerticalSpacing(3);
    // Right to left: the palette, the captions, the slots.
    grid->addWidget(heading(QStringLiteral("נתונים לבחירה (גרור ומקם)"), area), 0, 0);
    grid->addWidget(heading(QStringLiteral("כותרות"), area), 0, 1);
    grid->addWidget(heading(QStringLiteral("נתונים להצגה (גרור מימין)"), area), 0, 2);
    for (int i = 0; i < CellLineCount; ++i) {
        const auto slot = static_cast<std::size_t>(i);
        auto *field = new FieldLabel(FieldLabel::PaletteArray, i, area);
        field->setText(catalogFields()[slot].caption);
        field->setColours(paletteColours());
        field->setToolTip(QStringLiteral("גרור אל אחת השורות משמאל"));
        connect(field, &FieldLabel::dropped, this,
                [this](int, const FieldLabel::Dragged &source) { LblTitle_DragDrop(source); });
        m_palette[slot] = field;

        auto *caption = new QLineEdit(area);
        caption->setObjectName(QStringLiteral("txtLineCaption(%1)").arg(i));
        caption->setAccessibleName(QStringLiteral("כותרת שורה %1").arg(i + 1));
        m_captions[slot] = caption;

        auto *line = new FieldLabel(FieldLabel::SlotArray, i, area);
        line->setToolTip(
            QStringLiteral("לחיצה בוחרת את השורה לעיצוב; לחיצה כפולה וגרירה אל הנתונים לבחירה מרוקנת אותה"));
        connect(line, &FieldLabel::clicked, this, &CellLineEditor::lblLine_Click);
        connect(line, &FieldLabel::dropped, this, &CellLineEditor::lblLine_DragDrop);
        m_slots[slot] = line;

        grid->addWidget(field, i + 1, 0);
        grid->addWidget(caption, i + 1, 1);
        grid->addWidget(line, i + 1, 2);
    }
    grid->setColumnStretch(0, 1);
    grid->setColumnStretch(1, 1);
    grid->setColumnStretch(2, 1);
}

QWidget *CellLineEditor::buildFormatRow()
{
    auto *row = new QWidget(this);
    m_lblCellName = new QLabel(row);
    m_lblCellName->setObjectName(QStringLiteral("lblCellName"));
    m_lblCellName->setMinimumWidth(fontMetrics().horizontalAdvance(QStringLiteral("נתון נוסף 1")) + 8);
    m_lblCellName->setFrameShape(QFrame::StyledPanel);
    m_CmbFontAll =
        fixedList(QStringLiteral("CmbFontAll"), QStringLiteral("גופן"),
                  {QStringLiteral("Arial"), QStringLiteral("David"), QStringLiteral("Miriam")}, row);
    m_txtFontSizeAll = new QLineEdit(QStringLiteral("10"), row);
    m_txtFontSizeAll->setObjectName(QStringLiteral("txtFontSizeAll"));
    m_txtFontSizeAll->setAccessibleName(QStringLiteral("גודל גופן"));
    m_txtFontSizeAll->setToolTip(QStringLiteral("גודל הגופן בנקודות"));
    m_txtFontSizeAll->setMaximumWidth(fontMetrics().horizontalAdvance(QStringLiteral("0000")) + 16);
    m_CmbWeightAll = fixedList(QStringLiteral("CmbWeightAll"), QStringLiteral("משקל"),
                               {QStringLiteral("רגיל"), QStringLiteral("מודגש"), QStringLiteral("עבה")}, row);
    m_CmbAlignAll = fixedList(QStringLiteral("CmbAlignAll"), QStringLiteral("יישור"),
                              {QStringLiteral("ימין"), QStringLiteral("מרכז"), QStringLiteral("שמאל")}, row);
    m_ChkULAll = styleBox(QStringLiteral("ChkULAll"), QStringLiteral("U"), row);
    QFont underlined = m_ChkULAll->font();
    underlined.setUnderline(true);
    m_ChkULAll->setFont(underlined);
    m_ChkULAll->setToolTip(QStringLiteral("קו תחתי"));
    m_ChkItalicAll = styleBox(QStringLiteral("ChkItalicAll"), QStringLiteral("I"), row);
    QFont slanted = m_ChkItalicAll->font();
    slanted.setItalic(true);
    m_ChkItalicAll->setFont(slanted);
    m_ChkItalicAll->setToolTip(QStringLiteral("נטוי"));
    m_cmdSetLabDef = new QPushButton(QStringLiteral("החל"), row);
    m_cmdSetLabDef->setObjectName(QStringLiteral("cmdSetLabDef"));
    m_cmdSetLabDef->setToolTip(QStringLiteral("החלת העיצוב על השורה שנבחרה"));
    connect(m_cmdSetLabDef, &QPushButton::clicked, this, &CellLineEditor::cmdSetLabDef_Click);

    // Right to left: the line's name, font, size, weight, alignment, underline, italic, apply.
    auto *layout = new QHBoxLayout(row);
    layout->setContentsMargins(0, 6, 0, 0);
    for (QWidget *widget :
         std::initializer_list<QWidget *>{m_lblCellName, m_CmbFontAll, m_txtFontSizeAll, m_CmbWeightAll,
                                          m_CmbAlignAll, m_ChkULAll, m_ChkItalicAll, m_cmdSetLabDef})
        layout->addWidget(widget);
    layout->addStretch();
    return row;
}

void CellLineEditor::showLine(int index)
{
    const CellLine &line = m_lines[static_cast<std::size_t>(index)];
    FieldLabel *slot = m_slots[static_cast<std::size_t>(index)];
    slot->setText(line.slotCaption());
    slot->setColours(line.slotColours());
    slot->setAccessibleName(QStringLiteral("שורה %1: %2").arg(index + 1).arg(line.slotCaption()));
    QLineEdit *caption = m_captions[static_cast<std::size_t>(index)];
    if (caption->text() != line.caption)
        caption->setText(line.caption);
    if (index == m_selectedLine)
        m_lblCellName->setText(line.slotCaption());
}

void CellLineEditor::select(int index)
{
    m_selectedLine = static_cast<std::int16_t>(index);
    // With no line selected the name box says how to select one.
    m_lblCellName->setToolTip(index < 0 ? QStringLiteral("לחיצה על שורה משמאל בוחרת אותה לעיצוב")
                                        : QString());
    m_lblCellName->setEnabled(index >= 0);
    for (int i = 0; i < CellLineCount; ++i)
        m_slots[static_cast<std::size_t>(i)]->setSelected(i == index);
    m_cmdSetLabDef->setEnabled(index >= 0);
}

void CellLineEditor::lblLine_Click(int index)
{
    if (index < 0 || index >= CellLineCount)
        return;
    select(index);
    const CellLine &line = m_lines[static_cast<std::size_t>(index)];
    m_lblCellName->setText(line.slotCaption());
    const FormatControls shown = formatControlsOf(line.format);
    setListIndex(m_CmbFontAll, shown.font);
    setCheckValue(m_ChkItalicAll, shown.italic);
    m_txtFontSizeAll->setText(shown.size);
    setCheckValue(m_ChkULAll, shown.underline);
    setListIndex(m_CmbWeightAll, shown.weight);
    setListIndex(m_CmbAlignAll, shown.align);
}

void CellLineEditor::lblLine_DragDrop(int index, const FieldLabel::Dragged &source)
{
    if (source.arrayName != FieldLabel::PaletteArray || index < 0 || index >= CellLineCount)
        return;
    assignField(m_lines[static_cast<std::size_t>(index)], source.index);
    showLine(index);
}

void CellLineEditor::LblTitle_DragDrop(const FieldLabel::Dragged &source)
{
    if (source.arrayName != FieldLabel::SlotArray || source.index < 0 || source.index >= CellLineCount)
        return;
    emptyLine(m_lines[static_cast<std::size_t>(source.index)]);
    showLine(source.index);
}

void CellLineEditor::cmdSetLabDef_Click()
{
    if (m_selectedLine < 0 || m_selectedLine >= CellLineCount)
        return;
    const FormatControls controls{m_CmbFontAll->currentIndex(),   checkValue(m_ChkItalicAll),
                                  m_txtFontSizeAll->text(),       checkValue(m_ChkULAll),
                                  m_CmbWeightAll->currentIndex(), m_CmbAlignAll->currentIndex()};
    applyFormat(m_lines[static_cast<std::size_t>(m_selectedLine)].format, controls);
}

void CellLineEditor::resetSelection()
{
    select(-1);
    m_lblCellName->clear();
}

} // namespace zorbin
