#pragma once

#include <QAbstractListModel>
#include <QString>
#include <QVector>
#include <cstdint>
#include <optional>

namespace zorbin {

// A drop-down list of the settings page: entries of a text and an item data number, and the
// selected entry's index (-1 for none). A combo box shows it as its model; the runs read the
// selection from here.
class ChoiceList : public QAbstractListModel
{
    Q_OBJECT

public:
    struct Entry
    {
        QString text;
        std::int32_t itemData = 0;
    };

    static constexpr int ItemDataRole = Qt::UserRole;

    explicit ChoiceList(QObject *parent = nullptr);
    // A list with fixed entries, as the settings define them (item data 0 each).
    explicit ChoiceList(const QStringList &texts, QObject *parent = nullptr);

    int rowCount(const QModelIndex &parent = QModelIndex()) const override;
    QVariant data(const QModelIndex &index, int role) const override;

    int count() const { return static_cast<int>(m_entries.size()); }
    const Entry &entry(int index) const { return m_entries.at(index); }
    const QVector<Entry> &entries() const { return m_entries; }

    // Empties the list; the selection becomes -1.
    void clear();
    // Adds an entry at the end and returns its index. The selection does not change.
    int addEntry(const QString &text, std::int32_t itemData);

    int currentIndex() const { return m_currentIndex; }
    // Selects an entry, or none with -1. An index the list does not have is refused.
    bool setCurrentIndex(int index);
    // The item data of the selected entry; nothing when no entry is selected.
    std::optional<std::int32_t> currentItemData() const;

Q_SIGNALS:
    void currentIndexChanged(int index);

private:
    QVector<Entry> m_entries;
    int m_currentIndex = -1;
};

} // namespace zorbin
