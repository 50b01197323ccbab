#pragma once

#include <QString>
#include <functional>
#include <optional>
#include <vector>

namespace zorbin {

struct CatalogSettings;

// How a stored option reads as the store's text, one code per kind of widget that shows it.
enum class PropertyKind : int {
    Text = 1,      // a text box's text
    ListIndex = 2, // a drop-down list's selected index: "-1" for none
    Value = 3,     // a check box's value ("0", "1") or an option button's state ("True", "False")
    Caption = 4,   // a label's caption
    Tag = 41,      // a label's tag
};

// One option as the settings store keeps it: its key, the text form it is kept in, and the
// text that stands for it when the key is absent. `storeText` reads the option of a record as
// that text; `apply` sets it from a text and refuses (false, the record unchanged) a text its
// kind cannot take: a list index the list does not have, a word where a check value, a line
// tag or a format byte belongs. The settings page shows and edits the option through the same
// two functions, so the store and the page always agree on a value's text.
struct StoredOption
{
    QString key;
    PropertyKind kind;
    QString defaultText;
    std::function<QString(const CatalogSettings &)> storeText;
    std::function<bool(CatalogSettings &, const QString &)> apply;
};

// The catalog options and the cell lines' captions and tags, in the order they are saved and
// loaded.
const std::vector<StoredOption> &catalogOptionTable();
// The six format bytes of each cell line, "Font0" .. "Align8".
const std::vector<StoredOption> &cellFormatTable();
// The option stored under `key` in either table; nothing for a key that neither has.
const StoredOption *findStoredOption(const QString &key);

// An option button's state as the store holds it: "True"/"False" are written; on reading,
// "True"/"False" in any letter case and numbers (0 false, anything else true) are accepted.
QString optionStoreText(bool value);
std::optional<bool> optionFromStoreText(const QString &text);

// A number option's text: "" for an empty option, the number otherwise; and back: a whole
// number in [lowest, highest] (a fraction rounded half to even), or empty for any other text.
QString numberStoreText(const std::optional<int> &value);
std::optional<int> numberFromText(const QString &text, int lowest, int highest);

} // namespace zorbin
