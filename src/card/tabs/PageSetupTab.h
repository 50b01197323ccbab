#pragma once

#include <QWidget>

namespace zorbin {

struct CardContext;
class CellLineEditor;

// The catalog page setup tab ("הגדרת עמוד בקטלוג"): the cell-line editor, and the page's grid,
// file split, picture place and size, frames and the "only items with a picture" switch.
class PageSetupTab : public QWidget
{
    Q_OBJECT

public:
    // `context` must outlive the tab.
    explicit PageSetupTab(CardContext &context, QWidget *parent = nullptr);

    CellLineEditor *editor() const { return m_editor; }

private:
    QWidget *buildPage();
    QWidget *buildPictureSize();

    CardContext &m_context;
    CellLineEditor *m_editor = nullptr;
};

} // namespace zorbin
