#include "model/ChoiceList.h"

namespace zorbin {

ChoiceList::ChoiceList(QObject *parent) : QAbstractListModel(parent) {}

ChoiceList::ChoiceList(const QStringList &texts, QObject *parent) : QAbstractListModel(parent)
{
    for (const QString &text : texts)
        m_entries.push_back({text, 0});
}

int ChoiceList::rowCount(const QModelIndex &parent) const
{
    return parent.isValid() ? 0 : count();
}

QVariant ChoiceList::data(const QModelIndex &index, int role) const
{
    if (!index.isValid() || index.row() >= count())
        return {};
    const Entry &item = m_entries.at(index.row());
    if (role == Qt::DisplayRole || role == Qt::EditRole)
        return item.text;
    if (role == ItemDataRole)
        return item.itemData;
    return {};
}

void ChoiceList::clear()
{
    beginResetModel();
    m_entries.clear();
    endResetModel();
    setCurrentIndex(-1);
}

int ChoiceList::addEntry(const QString &text, std::int32_t itemData)
{
    const int row = count();
    beginInsertRows(QModelIndex(), row, row);
    m_entries.push_back({text, itemData});
    endInsertRows();
    return row;
}

bool ChoiceList::setCurrentIndex(int index)
{
    if (index < -1 || index >= count())
        return false;
    if (index != m_currentIndex) {
        m_currentIndex = index;
        Q_EMIT currentIndexChanged(index);
    }
    return true;
}

std::optional<std::int32_t> ChoiceList::currentItemData() const
{
    if (m_currentIndex < 0)
        return std::nullopt;
    return m_entries.at(m_currentIndex).itemData;
}

} // namespace zorbin
