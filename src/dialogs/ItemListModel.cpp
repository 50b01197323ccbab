#include "dialogs/ItemListModel.h"

#include <QHash>

namespace zorbin {

ItemListModel::ItemListModel(QObject *parent) : QAbstractTableModel(parent) {}

ItemListModel::~ItemListModel() = default;

Status ItemListModel::open(const QString &path)
{
    beginResetModel();
    m_items.clear();
    m_database.reset();
    endResetModel();
    auto opened = MarkedItems::open(path);
    if (!opened)
        return opened.status();
    m_database = std::move(opened).value();
    return reload(false);
}

Status ItemListModel::reload(bool onlyMarked)
{
    if (!m_database)
        return Status::ok();
    auto items = m_database->read(onlyMarked);
    beginResetModel();
    m_items = items ? std::move(items).value() : QVector<SelectableItem>();
    endResetModel();
    return items ? Status::ok() : items.status();
}

Status ItemListModel::setAllIncluded(bool include)
{
    if (!m_database || m_items.isEmpty())
        return Status::ok();
    QStringList keys;
    keys.reserve(m_items.size());
    for (const SelectableItem &item : std::as_const(m_items))
        keys << item.key;
    const Status written = m_database->write(keys, include);
    if (written) {
        for (SelectableItem &item : m_items)
            item.include = include;
        Q_EMIT dataChanged(index(0, IncludeColumn), index(rowCount() - 1, IncludeColumn),
                           {Qt::CheckStateRole});
        return written;
    }
    // Part of the rows may have been written: show what is stored.
    auto stored = m_database->read(false);
    if (stored) {
        QHash<QString, bool> marks;
        for (const SelectableItem &item : std::as_const(stored.value()))
            marks.insert(item.key, item.include);
        for (SelectableItem &item : m_items)
            item.include = marks.value(item.key, item.include);
        Q_EMIT dataChanged(index(0, IncludeColumn), index(rowCount() - 1, IncludeColumn),
                           {Qt::CheckStateRole});
    }
    return written;
}

int ItemListModel::find(ItemSearchColumn column, const QString &text) const
{
    return findItemRow(m_items, column, text);
}

int ItemListModel::rowCount(const QModelIndex &parent) const
{
    return parent.isValid() ? 0 : static_cast<int>(m_items.size());
}

int ItemListModel::columnCount(const QModelIndex &parent) const
{
    return parent.isValid() ? 0 : ColumnCount;
}

QVariant ItemListModel::data(const QModelIndex &index, int role) const
{
    if (!index.isValid() || index.row() >= m_items.size())
        return {};
    const SelectableItem &item = m_items.at(index.row());
    if (role == Qt::TextAlignmentRole)
        return QVariant::fromValue(Qt::AlignRight | Qt::AlignVCenter);
    switch (index.column()) {
    case KeyColumn:
        return role == Qt::DisplayRole ? QVariant(item.key) : QVariant();
    case NameColumn:
        return role == Qt::DisplayRole ? QVariant(item.name) : QVariant();
    case IncludeColumn:
        return role == Qt::CheckStateRole ? QVariant(item.include ? Qt::Checked : Qt::Unchecked) : QVariant();
    default:
        return {};
    }
}

QVariant ItemListModel::headerData(int section, Qt::Orientation orientation, int role) const
{
    if (orientation != Qt::Horizontal) // the row-header column is a plain margin, without numbers
        return role == Qt::DisplayRole ? QVariant(QString()) : QVariant();
    if (role == Qt::TextAlignmentRole)
        return QVariant::fromValue(Qt::AlignRight | Qt::AlignVCenter);
    if (role != Qt::DisplayRole)
        return {};
    switch (section) {
    case KeyColumn:
        return QStringLiteral("מפתח פריט");
    case NameColumn:
        return QStringLiteral("שם פריט");
    case IncludeColumn:
        return QStringLiteral("להציג?");
    default:
        return {};
    }
}

Qt::ItemFlags ItemListModel::flags(const QModelIndex &index) const
{
    Qt::ItemFlags result = QAbstractTableModel::flags(index);
    if (index.isValid() && index.column() == IncludeColumn)
        result |= Qt::ItemIsUserCheckable;
    return result;
}

bool ItemListModel::setData(const QModelIndex &index, const QVariant &value, int role)
{
    if (!m_database || !index.isValid() || index.column() != IncludeColumn || role != Qt::CheckStateRole)
        return false;
    SelectableItem &item = m_items[index.row()];
    const bool include = value.toInt() == Qt::Checked;
    if (const Status written = m_database->write({item.key}, include); !written) {
        Q_EMIT writeFailed(written.description());
        return false;
    }
    item.include = include;
    Q_EMIT dataChanged(index, index, {Qt::CheckStateRole});
    return true;
}

} // namespace zorbin
