#pragma once

#include "model/OptionTable.h"

#include <QHash>
#include <QString>
#include <QStringList>
#include <cstdint>
#include <functional>

namespace zorbin {

struct CatalogSettings;
class SettingsStore;

// The action codes of the persisting operations; any other value does nothing.
inline constexpr std::uint8_t SaveAction = 1;
inline constexpr std::uint8_t LoadAction = 2;

inline const QString StoreApp = QStringLiteral("Zorbin");
inline const QString StoreSection = QStringLiteral("Params");

// One value of some record as the store keeps it: its text, and how a stored text is applied
// (false when the value cannot take it; it then stays as it was).
struct StoreValue
{
    std::function<QString()> storeText;
    std::function<bool(const QString &)> apply;
};

// Saves or loads one value: Save writes its text under the key; Load reads the key (the
// fallback when absent) and applies it. Returns false when the loaded text could not be applied.
bool SetGetRegControlValue(std::uint8_t action, SettingsStore &store, const QString &app,
                           const QString &section, const QString &key, const StoreValue &value,
                           const QString &fallback);

// Loads the options record from the store and saves it back, through catalogOptionTable() and
// cellFormatTable().
//
// Each key is applied on its own: a stored value that cannot be applied (a list index beyond a
// list that has since shrunk, a word where a check value belongs) leaves its option at the value
// it had, and loading goes on with the next key. Such a key is remembered, and a later save does
// not write over its stored value unless the user has changed that option since: a start while
// the accounting database is unreachable must not cost the user the settings it could not show.
//
// `store` and `settings` must outlive this object.
class SettingsPersistence
{
public:
    SettingsPersistence(SettingsStore &store, CatalogSettings &settings);

    // Saves (1) or loads (2) every catalog option and every cell line's caption and tag.
    void SetGetRegParams(std::uint8_t action);
    // Saves (1) or loads (2) the six format bytes of each cell line.
    void GetSetFormLabDefs(std::uint8_t action, const QString &app, const QString &section);
    // Saves everything, then writes the store out.
    void saveAll();

    // Keys whose stored value could not be applied at the last load, and not changed since.
    QStringList unappliedKeys() const;

private:
    void persist(std::uint8_t action, const QString &app, const QString &section, const StoredOption &option);

    SettingsStore &m_store;
    CatalogSettings &m_settings;
    // Key -> the option's text at the moment its stored value was refused.
    QHash<QString, QString> m_unapplied;
};

} // namespace zorbin
