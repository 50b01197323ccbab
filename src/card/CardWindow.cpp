#include "card/CardWindow.h"

#include "card/MainCard.h"

#include <QCloseEvent>
#include <QTimer>

namespace zorbin {

CardWindow::CardWindow(CatalogControl &control, WidgetUserPort &user, QWidget *parent)
    : QMainWindow(parent), m_card(new MainCard(control, user, this))
{
    setObjectName(QStringLiteral("CardWindow"));
    setWindowTitle(QStringLiteral("זורבין - קטלוג מוצרים"));
    setLayoutDirection(Qt::RightToLeft);
    setCentralWidget(m_card);
    connect(m_card, &MainCard::busyChanged, this, [this](bool busy) {
        // Closed once the run has unwound completely.
        if (!busy && m_closeAfterRun)
            QTimer::singleShot(0, this, &QWidget::close);
    });
}

void CardWindow::closeEvent(QCloseEvent *event)
{
    if (!m_card->isRunning()) {
        QMainWindow::closeEvent(event);
        return;
    }
    event->ignore();
    if (!m_closeAfterRun) {
        m_closeAfterRun = true;
        m_card->control().requestStop();
    }
}

} // namespace zorbin
