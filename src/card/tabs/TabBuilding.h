#pragma once

#include <QLabel>
#include <QString>
#include <utility>

class QGridLayout;
class QLineEdit;

// Small helpers that keep the tabs' construction readable: every widget that stands for a
// member of the settings record carries that member's name as its objectName.
namespace zorbin::tabs {

template <typename Widget, typename... Args> Widget *named(const QString &objectName, Args &&...args)
{
    auto *widget = new Widget(std::forward<Args>(args)...);
    widget->setObjectName(objectName);
    return widget;
}

// A caption for a field; the field becomes the caption's buddy, so the caption's text is the
// field's accessible name too.
QLabel *captionFor(const QString &text, QWidget *field, QWidget *parent);

// A text box wide enough for `characters` characters like `sample` (the box's entry limit).
void fitToCharacters(QLineEdit *box, int characters, QChar sample = QLatin1Char('W'));

// A box for a path, a file extension or another Latin text: it reads left to right even on a
// right-to-left page, so that "/" and "." stay where they were typed.
void showLeftToRight(QLineEdit *box);

} // namespace zorbin::tabs
