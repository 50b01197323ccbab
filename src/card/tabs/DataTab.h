#pragma once

#include <QWidget>

namespace zorbin {

struct CardContext;

// The data settings tab ("הגדרות נתונים"): where the item name comes from, the two price lists,
// the two extra notes and the source of the picture file names.
class DataTab : public QWidget
{
    Q_OBJECT

public:
    // `context` must outlive the tab.
    explicit DataTab(CardContext &context, QWidget *parent = nullptr);

private:
    QWidget *buildNames();
    QWidget *buildPrices();
    QWidget *buildNotes();
    QWidget *buildPictures();

    CardContext &m_context;
};

} // namespace zorbin
