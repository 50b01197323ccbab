#pragma once

#include "model/CatalogSettings.h"
#include "model/SettingsValidation.h"

#include <QObject>
#include <functional>
#include <vector>

class QButtonGroup;
class QCheckBox;
class QComboBox;
class QLineEdit;
class QRadioButton;

namespace zorbin {

// Binds the widgets of the settings page to the members of the settings record, both ways:
// an edit writes the record at once, and refresh() makes every bound widget show the record
// (after the start-up load, or after the core has changed a value).
//
// The record and the widgets must outlive the binder.
class SettingsBinder : public QObject
{
    Q_OBJECT

public:
    explicit SettingsBinder(QObject *parent = nullptr);

    // A text box; `maxLength` limits typing (0 for no limit). A longer stored text is shown
    // whole, and the limit then allows its length.
    void text(QLineEdit *box, QString &value, int maxLength = 0);
    // A text box for a number, as wide as its entry limit: digits only while typing, and a value the runs cannot use is
    // marked at once with the sentence that says what to type (tool tip and red text).
    void number(QLineEdit *box, QString &value, int maxLength, NumericSetting setting);
    void check(QCheckBox *box, CheckValue &value);
    // A drop-down list shown through the record's list model. The box follows the list's
    // selection, including "no entry" (-1) when entries arrive; a choice in the box selects it
    // in the list.
    void choice(QComboBox *box, ChoiceList &list);
    // Option buttons of one group, button i for option i.
    void options(const std::vector<QRadioButton *> &buttons, OptionGroup<3> &group);

    // A widget the binder does not know: `show` makes it show the record.
    void custom(std::function<void()> show);

    // Every bound widget shows the record.
    void refresh();

private:
    // Runs `change` without writing the widgets' signals back into the record.
    void showing(const std::function<void()> &change);

    std::vector<std::function<void()>> m_refreshers;
    bool m_showing = false;
};

} // namespace zorbin
