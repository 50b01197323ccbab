#include "card/ProgressStrip.h"

#include <QPainter>
#include <QPalette>
#include <algorithm>

namespace zorbin {

ProgressStrip::ProgressStrip(QWidget *parent) : QWidget(parent)
{
    setObjectName(QStringLiteral("ProgressFrame"));
    setSizePolicy(QSizePolicy::Expanding, QSizePolicy::Fixed);
    setAccessibleName(QStringLiteral("התקדמות"));
}

int ProgressStrip::frameWidth() const
{
    return std::max(width() - 2, 1);
}

void ProgressStrip::setFillWidth(int width)
{
    m_fill = std::clamp(width, 0, frameWidth());
    update();
}

QSize ProgressStrip::sizeHint() const
{
    return {200, fontMetrics().height() / 2 + 6};
}

void ProgressStrip::paintEvent(QPaintEvent *)
{
    QPainter painter(this);
    const QRect outline = rect().adjusted(0, 0, -1, -1);
    painter.fillRect(outline, palette().color(QPalette::Base));
    if (m_fill > 0) {
        // The fill grows from the right edge, as the page reads.
        QRect fill(0, 1, m_fill, height() - 2);
        if (layoutDirection() == Qt::RightToLeft)
            fill.moveRight(width() - 2);
        else
            fill.moveLeft(1);
        painter.fillRect(fill, palette().color(QPalette::Highlight));
    }
    painter.setPen(palette().color(QPalette::Mid));
    painter.drawRect(outline);
}

} // namespace zorbin
