#pragma once

#include <QWidget>

namespace zorbin {

struct CardContext;

// The item range tab ("טווח הפריטים"): the sort-code and item-key ranges, the cut-off pattern,
// the catalog order, and the selection of items by hand.
class RangeTab : public QWidget
{
    Q_OBJECT

public:
    // `context` must outlive the tab.
    explicit RangeTab(CardContext &context, QWidget *parent = nullptr);

    // The item selection button: makes sure the working database holds the items (collecting
    // when there is none yet, or when the user asks for a fresh list), then opens the item
    // selection dialog on it. From then on the runs use the marked items.
    void cmdSelectAccount_Click();

private:
    QWidget *buildRanges();
    QWidget *buildOrder();
    QWidget *buildSelection();

    CardContext &m_context;
};

} // namespace zorbin
