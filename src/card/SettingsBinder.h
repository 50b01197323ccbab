#pragma once

#include <QObject>
#include <QStringList>
#include <functional>
#include <optional>
#include <vector>

class QCheckBox;
class QComboBox;
class QLineEdit;
class QRadioButton;

namespace zorbin {

class ChoiceList;
struct CatalogSettings;
struct StoredOption;

// Binds the widgets of the settings page to the options record, both ways: an edit writes the
// record at once, and refresh() makes every bound widget show the record (after the start-up
// load, or after the core has changed a value).
//
// A stored option is bound by its store key and shown in its store text (OptionTable.h), so the
// page and the settings store read and write each value the same way: a text box shows the text,
// a check box "1", a list the entry of its index. Options that are not stored are bound to their
// members directly.
//
// The record and the widgets must outlive the binder.
class SettingsBinder : public QObject
{
    Q_OBJECT

public:
    explicit SettingsBinder(CatalogSettings &settings, QObject *parent = nullptr);

    CatalogSettings &settings() { return m_settings; }

    // A text box for the option stored under `key`; `maxLength` limits typing (0 for no limit).
    // A longer stored text is shown whole, and the limit then allows its length.
    void text(QLineEdit *box, const QString &key, int maxLength = 0);
    // A text box for an option that is not stored.
    void text(QLineEdit *box, QString &value, int maxLength);
    // A text box for a number option, as wide as its entry limit, digits only while typing.
    // `problem`, when given, says what is wrong with a typed number (empty when the box holds
    // no number); the box is marked at once with that sentence (tool tip and red text).
    void number(QLineEdit *box, const QString &key, int maxLength,
                std::function<std::optional<QString>(const std::optional<int> &)> problem = {});
    // A check box for the flag option stored under `key`.
    void check(QCheckBox *box, const QString &key);
    // A check box for an option that is not stored.
    void check(QCheckBox *box, bool &value);
    // A list of fixed entries, in index order, for the choice stored under `key`; no entry is
    // selected when the option is empty.
    void choice(QComboBox *box, const QString &key, const QStringList &entries);
    // A list filled from the accounting database, shown through the record's list model. The
    // box follows the list's selection, including "no entry" (-1) when entries arrive; a choice
    // in the box selects it in the list.
    void choice(QComboBox *box, ChoiceList &list);
    // Option buttons of one choice, button i for the option stored under keys[i].
    void options(const std::vector<QRadioButton *> &buttons, const QStringList &keys);

    // A widget the binder does not know: `show` makes it show the record.
    void custom(std::function<void()> show);

    // Every bound widget shows the record.
    void refresh();

private:
    const StoredOption &option(const QString &key) const;
    // Runs `change` without writing the widgets' signals back into the record.
    void showing(const std::function<void()> &change);
    void textBox(QLineEdit *box, std::function<QString()> read, std::function<void(const QString &)> write,
                 int maxLength);

    CatalogSettings &m_settings;
    std::vector<std::function<void()>> m_refreshers;
    bool m_showing = false;
};

} // namespace zorbin
