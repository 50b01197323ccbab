#pragma once

#include "common/Status.h"
#include "control/ItemSelection.h"

#include <QAbstractTableModel>
#include <memory>

namespace zorbin {

// The items of the working database as the item selection dialog lists them: key, name, and
// the mark as a check box in the third column. A change of a mark is written to
// tItems.Include at once. The rows are those of the list query at the last load; a mark changed
// afterwards keeps its row where it is until the next load.
class ItemListModel : public QAbstractTableModel
{
    Q_OBJECT

public:
    enum Column { KeyColumn = 0, NameColumn = 1, IncludeColumn = 2, ColumnCount = 3 };

    explicit ItemListModel(QObject *parent = nullptr);
    ~ItemListModel() override;

    // Opens the working database at `path` and lists every item. A database that cannot be
    // opened or read leaves the list empty; the failure is returned.
    Status open(const QString &path);
    // Lists every item (false) or only the marked ones (true) again, in the query's order.
    Status reload(bool onlyMarked);
    // Marks or clears every row listed now, in order; each change is written at once.
    Status setAllIncluded(bool include);
    // The first listed row whose key or name begins with `text`, letter case ignored; -1 for none.
    int find(ItemSearchColumn column, const QString &text) const;

    const QVector<SelectableItem> &items() const { return m_items; }

    int rowCount(const QModelIndex &parent = QModelIndex()) const override;
    int columnCount(const QModelIndex &parent = QModelIndex()) const override;
    QVariant data(const QModelIndex &index, int role) const override;
    QVariant headerData(int section, Qt::Orientation orientation, int role) const override;
    Qt::ItemFlags flags(const QModelIndex &index) const override;
    bool setData(const QModelIndex &index, const QVariant &value, int role) override;

Q_SIGNALS:
    // A mark could not be written; the row shows the mark that is stored.
    void writeFailed(const QString &description);

private:
    std::unique_ptr<MarkedItems> m_database;
    QVector<SelectableItem> m_items;
};

} // namespace zorbin
