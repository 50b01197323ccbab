#pragma once

#include <QWidget>

namespace zorbin {

struct CardContext;

// The general tab ("כללי"): the catalog's output folder and the connection settings button.
class GeneralTab : public QWidget
{
    Q_OBJECT

public:
    // `context` must outlive the tab.
    explicit GeneralTab(CardContext &context, QWidget *parent = nullptr);

    // The connection settings button: the connection dialog, modal.
    void CmdConnect_Click();

private:
    CardContext &m_context;
};

} // namespace zorbin
