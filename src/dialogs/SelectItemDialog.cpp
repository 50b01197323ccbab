#include "dialogs/SelectItemDialog.h"

#include "dialogs/ItemListModel.h"

#include <QFrame>
#include <QGridLayout>
#include <QHBoxLayout>
#include <QHeaderView>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QTableView>
#include <QVBoxLayout>
#include <algorithm>

namespace zorbin {
namespace {

QPushButton *namedButton(const QString &name, const QString &caption, QWidget *parent)
{
    auto *button = new QPushButton(caption, parent);
    button->setObjectName(name);
    button->setAutoDefault(false);
    return button;
}

// The grid's design widths, in twips (1/1440 inch), as pixels of this screen.
int designWidth(int twips, const QWidget *widget)
{
    return twips * widget->logicalDpiX() / 1440;
}

} // namespace

frmSelectItem::frmSelectItem(const QString &workDBFile, QWidget *parent) : QDialog(parent)
{
    setObjectName(QStringLiteral("frmSelectItem"));
    setWindowTitle(QStringLiteral("בחירת פריטים להדפסה"));
    setLayoutDirection(Qt::RightToLeft);
    setModal(true);

    m_model = new ItemListModel(this);
    m_VSSelectItems = new QTableView(this);
    m_VSSelectItems->setObjectName(QStringLiteral("VSSelectItems"));
    m_VSSelectItems->setModel(m_model);
    QFont gridFont = m_VSSelectItems->font();
    gridFont.setFamily(QStringLiteral("Arial"));
    m_VSSelectItems->setFont(gridFont);
    m_VSSelectItems->setSelectionBehavior(QAbstractItemView::SelectRows);
    m_VSSelectItems->setSelectionMode(QAbstractItemView::SingleSelection);
    m_VSSelectItems->setEditTriggers(QAbstractItemView::NoEditTriggers);
    m_VSSelectItems->setAlternatingRowColors(true);
    m_VSSelectItems->setWordWrap(false);
    m_VSSelectItems->verticalHeader()->setSectionResizeMode(QHeaderView::Fixed);
    m_VSSelectItems->verticalHeader()->setDefaultSectionSize(m_VSSelectItems->fontMetrics().height() + 8);
    m_VSSelectItems->verticalHeader()->setMinimumWidth(designWidth(210, this));
    m_VSSelectItems->horizontalHeader()->setDefaultAlignment(Qt::AlignRight | Qt::AlignVCenter);
    m_VSSelectItems->setMinimumWidth(designWidth(1650 + 2790 + 645 + 210, this) + 24);
    connect(m_model, &ItemListModel::writeFailed, this,
            [this](const QString &description) { showOutcome(Status::fault(description)); });

    m_DataItems = new QLabel(this);
    m_DataItems->setObjectName(QStringLiteral("DataItems"));
    m_DataItems->setWordWrap(true);

    QWidget *byName = buildSearch(QStringLiteral("Shape3"), QStringLiteral("cmdFindByDesc"),
                                  QStringLiteral("איתור פריט לפי תאור:"), QStringLiteral("txtToItemName"),
                                  m_cmdFindByDesc, m_txtToItemName);
    QWidget *byKey = buildSearch(QStringLiteral("Shape2"), QStringLiteral("cmdFindKey"),
                                 QStringLiteral("איתור פריט לפי מפתח:"), QStringLiteral("txtToItemkey"),
                                 m_cmdFindKey, m_txtToItemkey);
    connect(m_cmdFindByDesc, &QPushButton::clicked, this, &frmSelectItem::cmdFindByDesc_Click);
    connect(m_txtToItemName, &QLineEdit::returnPressed, this, &frmSelectItem::cmdFindByDesc_Click);
    connect(m_cmdFindKey, &QPushButton::clicked, this, &frmSelectItem::cmdFindKey_Click);
    connect(m_txtToItemkey, &QLineEdit::returnPressed, this, &frmSelectItem::cmdFindKey_Click);

    auto *showAll = namedButton(QStringLiteral("cmdShowAll"), QStringLiteral("הצג את כולם"), this);
    auto *showMarked = namedButton(QStringLiteral("cmdShowMarked"), QStringLiteral("הצג רק מסומנים"), this);
    auto *noneItems = namedButton(QStringLiteral("cmdNoneItems"), QStringLiteral("בטל את כולם"), this);
    auto *allItems = namedButton(QStringLiteral("CmdAllItems"), QStringLiteral("סמן את כולם"), this);
    auto *close = namedButton(QStringLiteral("cmdClose"), QStringLiteral("סגור"), this);
    connect(showAll, &QPushButton::clicked, this, &frmSelectItem::cmdShowAll_Click);
    connect(showMarked, &QPushButton::clicked, this, &frmSelectItem::cmdShowMarked_Click);
    connect(noneItems, &QPushButton::clicked, this, &frmSelectItem::cmdNoneItems_Click);
    connect(allItems, &QPushButton::clicked, this, &frmSelectItem::CmdAllItems_Click);
    connect(close, &QPushButton::clicked, this, &frmSelectItem::cmdClose_Click);

    // The left column; right to left, the right half of each pair comes first.
    auto *commands = new QGridLayout;
    commands->addWidget(m_DataItems, 0, 0, 1, 2);
    commands->addWidget(byName, 1, 0, 1, 2);
    commands->addWidget(byKey, 2, 0, 1, 2);
    commands->addWidget(showMarked, 3, 0);
    commands->addWidget(showAll, 3, 1);
    commands->addWidget(allItems, 4, 0);
    commands->addWidget(noneItems, 4, 1);
    commands->setRowStretch(5, 1);
    commands->addWidget(close, 6, 0, 1, 2);

    auto *layout = new QHBoxLayout(this);
    layout->addWidget(m_VSSelectItems, 1);
    layout->addLayout(commands);

    showOutcome(m_model->open(workDBFile));
    m_VSSelectItems->setColumnWidth(ItemListModel::KeyColumn, designWidth(1650, this));
    m_VSSelectItems->setColumnWidth(ItemListModel::NameColumn, designWidth(2790, this));
    fitColumns();
    resize(sizeHint().width(), 520);
}

frmSelectItem::~frmSelectItem() = default;

QWidget *frmSelectItem::buildSearch(const QString &frameName, const QString &buttonName,
                                    const QString &caption, const QString &boxName, QPushButton *&button,
                                    QLineEdit *&box)
{
    auto *frame = new QFrame(this);
    frame->setObjectName(frameName);
    frame->setFrameShape(QFrame::StyledPanel);
    button = namedButton(buttonName, caption, frame);
    box = new QLineEdit(frame);
    box->setObjectName(boxName);
    box->setAccessibleName(caption);
    box->setClearButtonEnabled(true);
    auto *layout = new QVBoxLayout(frame);
    layout->addWidget(button);
    layout->addWidget(box);
    return frame;
}

void frmSelectItem::fitColumns()
{
    // The mark column follows its heading and its check box; the name column takes the rest.
    QHeaderView *headings = m_VSSelectItems->horizontalHeader();
    headings->setMinimumSectionSize(designWidth(645, this));
    headings->setSectionResizeMode(ItemListModel::IncludeColumn, QHeaderView::ResizeToContents);
    headings->setSectionResizeMode(ItemListModel::NameColumn, QHeaderView::Stretch);
    headings->setStretchLastSection(false);
}

void frmSelectItem::showOutcome(const Status &status)
{
    if (!status) {
        m_DataItems->setText(status.description());
        return;
    }
    m_DataItems->setText(QStringLiteral("%1 פריטים ברשימה").arg(m_model->rowCount()));
}

void frmSelectItem::CmdAllItems_Click()
{
    showOutcome(m_model->setAllIncluded(true));
}

void frmSelectItem::cmdNoneItems_Click()
{
    showOutcome(m_model->setAllIncluded(false));
}

void frmSelectItem::findRow(ItemSearchColumn column, const QString &text)
{
    const int row = m_model->find(column, text);
    if (row < 0)
        return;
    const QModelIndex keyCell = m_model->index(row, ItemListModel::KeyColumn);
    m_VSSelectItems->setCurrentIndex(keyCell);
    m_VSSelectItems->scrollTo(keyCell);
}

void frmSelectItem::cmdFindKey_Click()
{
    findRow(ItemSearchColumn::Key, m_txtToItemkey->text());
}

void frmSelectItem::cmdFindByDesc_Click()
{
    findRow(ItemSearchColumn::Name, m_txtToItemName->text());
}

void frmSelectItem::cmdShowMarked_Click()
{
    showOutcome(m_model->reload(true));
}

void frmSelectItem::cmdShowAll_Click()
{
    showOutcome(m_model->reload(false));
}

void frmSelectItem::cmdClose_Click()
{
    accept();
}

} // namespace zorbin
