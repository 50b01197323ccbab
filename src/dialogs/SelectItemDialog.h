#pragma once

#include "control/ItemSelection.h"

#include <QDialog>

class QLabel;
class QLineEdit;
class QPushButton;
class QTableView;

namespace zorbin {

class ItemListModel;

// The item selection dialog ("בחירת פריטים להדפסה"): every item of the working database with
// its key, its name and its mark. A mark changed here is stored at once in tItems.Include, so
// the dialog has no save and no cancel; the next collection marks every item again.
class frmSelectItem : public QDialog
{
    Q_OBJECT

public:
    // Opens the working database at `workDBFile` and lists every item, marked ones first. A
    // database that cannot be opened leaves the list empty and says why in the dialog.
    explicit frmSelectItem(const QString &workDBFile, QWidget *parent = nullptr);
    ~frmSelectItem() override;

    ItemListModel *model() const { return m_model; }
    QTableView *grid() const { return m_VSSelectItems; }

    void CmdAllItems_Click();
    void cmdNoneItems_Click();
    void cmdFindKey_Click();
    void cmdFindByDesc_Click();
    void cmdShowMarked_Click();
    void cmdShowAll_Click();
    void cmdClose_Click();

private:
    QWidget *buildSearch(const QString &frameName, const QString &buttonName, const QString &caption,
                         const QString &boxName, QPushButton *&button, QLineEdit *&box);
    void findRow(ItemSearchColumn column, const QString &text);
    void showOutcome(const Status &status);
    void fitColumns();

    ItemListModel *m_model = nullptr;
    QTableView *m_VSSelectItems = nullptr;
    QLabel *m_DataItems = nullptr;
    QLineEdit *m_txtToItemName = nullptr;
    QLineEdit *m_txtToItemkey = nullptr;
    QPushButton *m_cmdFindByDesc = nullptr;
    QPushButton *m_cmdFindKey = nullptr;
};

} // namespace zorbin
