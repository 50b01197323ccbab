#include "card/tabs/TabBuilding.h"

#include <QGridLayout>
#include <QLineEdit>

namespace zorbin::tabs {

QLabel *captionFor(const QString &text, QWidget *field, QWidget *parent)
{
    auto *caption = new QLabel(text, parent);
    caption->setBuddy(field);
    if (field->accessibleName().isEmpty())
        field->setAccessibleName(QString(text).remove(QLatin1Char(':')));
    return caption;
}

void addFieldRow(QGridLayout *grid, int row, const QString &caption, QWidget *field, QWidget *shown,
                 Qt::Alignment alignment, int column)
{
    grid->addWidget(captionFor(caption, field, grid->parentWidget()), row, column);
    grid->addWidget(shown ? shown : field, row, column + 1, alignment);
}

void fitToCharacters(QLineEdit *box, int characters, QChar sample)
{
    const QFontMetrics metrics = box->fontMetrics();
    const int textWidth = metrics.horizontalAdvance(sample) * characters;
    box->setFixedWidth(textWidth + 2 * metrics.horizontalAdvance(QLatin1Char(' ')) + 14);
}

void showLeftToRight(QLineEdit *box)
{
    box->setLayoutDirection(Qt::LeftToRight);
}

} // namespace zorbin::tabs
