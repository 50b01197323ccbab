#include "card/SettingsBinder.h"

#include "card/tabs/TabBuilding.h"

#include <QButtonGroup>
#include <QCheckBox>
#include <QComboBox>
#include <QLineEdit>
#include <QRadioButton>
#include <QRegularExpressionValidator>
#include <algorithm>

namespace zorbin {
namespace {

Qt::CheckState checkStateOf(CheckValue value)
{
    switch (value) {
    case CheckValue::Checked:
        return Qt::Checked;
    case CheckValue::Grayed:
        return Qt::PartiallyChecked;
    case CheckValue::Unchecked:
        break;
    }
    return Qt::Unchecked;
}

CheckValue checkValueOf(int state)
{
    switch (static_cast<Qt::CheckState>(state)) {
    case Qt::Checked:
        return CheckValue::Checked;
    case Qt::PartiallyChecked:
        return CheckValue::Grayed;
    case Qt::Unchecked:
        break;
    }
    return CheckValue::Unchecked;
}

void markProblem(QLineEdit *box, const std::optional<QString> &problem)
{
    box->setToolTip(problem.value_or(QString()));
    box->setProperty("invalid", problem.has_value());
    QPalette colours = box->parentWidget() ? box->parentWidget()->palette() : box->palette();
    if (problem)
        colours.setColor(QPalette::Text, QColor(0xb0, 0x00, 0x20));
    box->setPalette(colours);
}

} // namespace

SettingsBinder::SettingsBinder(QObject *parent) : QObject(parent) {}

void SettingsBinder::showing(const std::function<void()> &change)
{
    const bool wasShowing = m_showing;
    m_showing = true;
    change();
    m_showing = wasShowing;
}

void SettingsBinder::text(QLineEdit *box, QString &value, int maxLength)
{
    // A stored text longer than the limit (written by hand, or by an older version) is shown
    // whole rather than cut: the run uses what the user sees, and a save keeps it.
    auto show = [box, &value, maxLength] {
        if (maxLength > 0)
            box->setMaxLength(std::max(maxLength, static_cast<int>(value.size())));
        if (box->text() != value)
            box->setText(value);
    };
    show();
    connect(box, &QLineEdit::textChanged, this, [this, &value](const QString &typed) {
        if (!m_showing)
            value = typed;
    });
    m_refreshers.push_back([this, show] { showing(show); });
}

void SettingsBinder::number(QLineEdit *box, QString &value, int maxLength, NumericSetting setting)
{
    text(box, value, maxLength);
    tabs::fitToCharacters(box, maxLength, QLatin1Char('0'));
    box->setValidator(new QRegularExpressionValidator(QRegularExpression(QStringLiteral("\\d*")), box));
    box->setInputMethodHints(Qt::ImhDigitsOnly);
    auto check = [box, setting] { markProblem(box, numericSettingProblem(setting, box->text())); };
    connect(box, &QLineEdit::textChanged, box, check);
    check();
}

void SettingsBinder::check(QCheckBox *box, CheckValue &value)
{
    box->setCheckState(checkStateOf(value));
    connect(box, &QCheckBox::stateChanged, this, [this, &value](int state) {
        if (!m_showing)
            value = checkValueOf(state);
    });
    m_refreshers.push_back([this, box, &value] {
        if (box->checkState() != checkStateOf(value))
            showing([&] { box->setCheckState(checkStateOf(value)); });
    });
}

void SettingsBinder::choice(QComboBox *box, ChoiceList &list)
{
    box->setModel(&list);
    auto follow = [this, box, &list] {
        if (box->currentIndex() != list.currentIndex())
            showing([&] { box->setCurrentIndex(list.currentIndex()); });
    };
    follow();
    // A combo box selects its first entry when entries arrive in an empty list; the list's own
    // selection (often none) is what counts, so the box is held still while rows change and then
    // put back where the list says.
    auto hold = [this] { m_showing = true; };
    auto release = [this, follow] {
        m_showing = false;
        follow();
    };
    connect(&list, &QAbstractItemModel::rowsAboutToBeInserted, this, hold);
    connect(&list, &QAbstractItemModel::rowsInserted, this, release);
    connect(&list, &QAbstractItemModel::rowsAboutToBeRemoved, this, hold);
    connect(&list, &QAbstractItemModel::rowsRemoved, this, release);
    connect(&list, &QAbstractItemModel::modelAboutToBeReset, this, hold);
    connect(&list, &QAbstractItemModel::modelReset, this, release);
    connect(&list, &ChoiceList::currentIndexChanged, this, follow);
    connect(box, &QComboBox::currentIndexChanged, this, [this, &list](int index) {
        if (!m_showing)
            list.setCurrentIndex(index);
    });
    m_refreshers.push_back(follow);
}

void SettingsBinder::options(const std::vector<QRadioButton *> &buttons, OptionGroup<3> &group)
{
    Q_ASSERT(static_cast<int>(buttons.size()) == OptionGroup<3>::size());
    auto *exclusive = new QButtonGroup(this);
    for (int i = 0; i < static_cast<int>(buttons.size()); ++i) {
        QRadioButton *button = buttons[static_cast<std::size_t>(i)];
        exclusive->addButton(button, i);
        connect(button, &QRadioButton::toggled, this, [this, &group, i](bool on) {
            if (!m_showing && on)
                group.setValue(i, true);
        });
    }
    auto show = [this, exclusive, buttons, &group] {
        showing([&] {
            // An exclusive group cannot show "none set", which a stored "False" for every
            // option gives.
            exclusive->setExclusive(false);
            for (int i = 0; i < static_cast<int>(buttons.size()); ++i)
                buttons[static_cast<std::size_t>(i)]->setChecked(group.value(i));
            exclusive->setExclusive(true);
        });
    };
    show();
    m_refreshers.push_back(show);
}

void SettingsBinder::custom(std::function<void()> show)
{
    showing(show);
    m_refreshers.push_back([this, show = std::move(show)] { showing(show); });
}

void SettingsBinder::refresh()
{
    for (const auto &show : m_refreshers)
        show();
}

} // namespace zorbin
