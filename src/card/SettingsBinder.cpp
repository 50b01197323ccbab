#include "card/SettingsBinder.h"

#include "card/tabs/TabBuilding.h"
#include "model/CatalogSettings.h"
#include "model/OptionTable.h"

#include <QButtonGroup>
#include <QCheckBox>
#include <QComboBox>
#include <QLineEdit>
#include <QRadioButton>
#include <QRegularExpressionValidator>
#include <algorithm>

namespace zorbin {
namespace {

const QString Ticked = QStringLiteral("1");
const QString NotTicked = QStringLiteral("0");

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

SettingsBinder::SettingsBinder(CatalogSettings &settings, QObject *parent)
    : QObject(parent), m_settings(settings)
{}

const StoredOption &SettingsBinder::option(const QString &key) const
{
    const StoredOption *found = findStoredOption(key);
    Q_ASSERT_X(found, "SettingsBinder", "a widget bound to a key that is not stored");
    return *found;
}

void SettingsBinder::showing(const std::function<void()> &change)
{
    const bool wasShowing = m_showing;
    m_showing = true;
    change();
    m_showing = wasShowing;
}

void SettingsBinder::textBox(QLineEdit *box, std::function<QString()> read,
                             std::function<void(const QString &)> write, int maxLength)
{
    // A stored text longer than the limit (written by hand, or by an older version) is shown
    // whole rather than cut: the run uses what the user sees, and a save keeps it.
    auto show = [box, read, maxLength] {
        const QString value = read();
        if (maxLength > 0)
            box->setMaxLength(std::max(maxLength, static_cast<int>(value.size())));
        if (box->text() != value)
            box->setText(value);
    };
    show();
    connect(box, &QLineEdit::textChanged, this, [this, write](const QString &typed) {
        if (!m_showing)
            write(typed);
    });
    m_refreshers.push_back([this, show] { showing(show); });
}

void SettingsBinder::text(QLineEdit *box, const QString &key, int maxLength)
{
    const StoredOption &stored = option(key);
    textBox(
        box, [this, &stored] { return stored.storeText(m_settings); },
        [this, &stored](const QString &typed) { stored.apply(m_settings, typed); }, maxLength);
}

void SettingsBinder::text(QLineEdit *box, QString &value, int maxLength)
{
    textBox(
        box, [&value] { return value; }, [&value](const QString &typed) { value = typed; }, maxLength);
}

void SettingsBinder::number(QLineEdit *box, const QString &key, int maxLength,
                            std::function<std::optional<QString>(const std::optional<int> &)> problem)
{
    text(box, key, maxLength);
    tabs::fitToCharacters(box, maxLength, QLatin1Char('0'));
    box->setValidator(new QRegularExpressionValidator(QRegularExpression(QStringLiteral("\\d*")), box));
    box->setInputMethodHints(Qt::ImhDigitsOnly);
    if (!problem)
        return;
    auto check = [box, problem] {
        markProblem(box, problem(numberFromText(box->text(), std::numeric_limits<std::int16_t>::min(),
                                                std::numeric_limits<std::int16_t>::max())));
    };
    connect(box, &QLineEdit::textChanged, box, check);
    check();
}

void SettingsBinder::check(QCheckBox *box, const QString &key)
{
    const StoredOption &stored = option(key);
    auto ticked = [this, &stored] { return stored.storeText(m_settings) == Ticked; };
    box->setChecked(ticked());
    connect(box, &QCheckBox::toggled, this, [this, &stored](bool on) {
        if (!m_showing)
            stored.apply(m_settings, on ? Ticked : NotTicked);
    });
    m_refreshers.push_back([this, box, ticked] {
        if (box->isChecked() != ticked())
            showing([&] { box->setChecked(ticked()); });
    });
}

void SettingsBinder::check(QCheckBox *box, bool &value)
{
    box->setChecked(value);
    connect(box, &QCheckBox::toggled, this, [this, &value](bool on) {
        if (!m_showing)
            value = on;
    });
    m_refreshers.push_back([this, box, &value] {
        if (box->isChecked() != value)
            showing([&] { box->setChecked(value); });
    });
}

void SettingsBinder::choice(QComboBox *box, const QString &key, const QStringList &entries)
{
    const StoredOption &stored = option(key);
    box->addItems(entries);
    auto show = [this, box, &stored] {
        const int index = stored.storeText(m_settings).toInt();
        if (box->currentIndex() != index)
            showing([&] { box->setCurrentIndex(index); });
    };
    show();
    connect(box, &QComboBox::currentIndexChanged, this, [this, &stored](int index) {
        if (!m_showing)
            stored.apply(m_settings, QString::number(index));
    });
    m_refreshers.push_back(show);
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

void SettingsBinder::options(const std::vector<QRadioButton *> &buttons, const QStringList &keys)
{
    Q_ASSERT(buttons.size() == static_cast<std::size_t>(keys.size()));
    auto *exclusive = new QButtonGroup(this);
    std::vector<const StoredOption *> stored;
    for (std::size_t i = 0; i < buttons.size(); ++i) {
        stored.push_back(&option(keys.at(static_cast<qsizetype>(i))));
        exclusive->addButton(buttons[i], static_cast<int>(i));
        connect(buttons[i], &QRadioButton::toggled, this, [this, option = stored.back()](bool on) {
            if (!m_showing && on)
                option->apply(m_settings, optionStoreText(true));
        });
    }
    auto show = [this, exclusive, buttons, stored] {
        showing([&] {
            // An exclusive group cannot show "none set", which a stored "False" for every
            // option gives.
            exclusive->setExclusive(false);
            for (std::size_t i = 0; i < buttons.size(); ++i)
                buttons[i]->setChecked(optionFromStoreText(stored[i]->storeText(m_settings)).value_or(false));
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
