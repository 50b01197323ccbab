#pragma once

#include "model/CatalogSettings.h"

#include <QString>
#include <cstdint>
#include <functional>

namespace zorbin {

// Which property of a widget a stored value belongs to, with the store's code for it.
enum class PropertyKind : int {
    Text = 1,      // a text box's text
    ListIndex = 2, // a drop-down list's selected index, -1 for none
    Value = 3,     // a check box's value (0, 1, 2) or an option button's state
    Caption = 4,   // a label's caption
    Tag = 41,      // a label's tag
};

// One persisted property of one widget of the settings record: how it reads as store text and
// how a stored text is applied to it. A text that the property cannot take (a list index the
// list does not have, a word where a number belongs) is refused and leaves the value as it was.
class ControlProperty
{
public:
    static ControlProperty text(QString &value);
    static ControlProperty listIndex(ChoiceList &list);
    static ControlProperty check(CheckValue &value);
    static ControlProperty option(OptionGroup<3> &group, int index);
    static ControlProperty caption(QString &value);
    static ControlProperty tag(QString &value);       // a cell line's field tag: empty or 0 to 8
    static ControlProperty byte(std::uint8_t &value); // one byte of the cell-line format table

    PropertyKind kind() const { return m_kind; }
    QString storeText() const { return m_read(); }
    bool apply(const QString &storedText) const { return m_apply(storedText); }

private:
    ControlProperty(PropertyKind kind, std::function<QString()> read,
                    std::function<bool(const QString &)> apply)
        : m_kind(kind), m_read(std::move(read)), m_apply(std::move(apply))
    {}

    PropertyKind m_kind;
    std::function<QString()> m_read;
    std::function<bool(const QString &)> m_apply;
};

// An option button's state as the store holds it: "True"/"False" are written; on reading,
// "True"/"False" in any letter case and numbers (0 false, anything else true) are accepted.
QString optionStoreText(bool value);
std::optional<bool> optionFromStoreText(const QString &text);

} // namespace zorbin
