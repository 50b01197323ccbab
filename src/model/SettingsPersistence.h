#pragma once

#include "model/CatalogSettings.h"
#include "model/ControlProperty.h"

#include <QHash>
#include <QString>
#include <cstdint>
#include <vector>

namespace zorbin {

class SettingsStore;

// The action codes of the persisting operations; any other value does nothing.
inline constexpr std::uint8_t SaveAction = 1;
inline constexpr std::uint8_t LoadAction = 2;

inline const QString StoreApp = QStringLiteral("Zorbin");
inline const QString StoreSection = QStringLiteral("Params");

// One stored setting: its key, the widget property it belongs to, and the text used on load
// when the key is absent.
struct StoredSetting
{
    QString key;
    ControlProperty property;
    QString fallback;
};

// The catalog settings and the cell-line captions and tags, in the order they are saved and
// loaded (the store's text forms depend on nothing else, so a store written by one version
// reads in the next).
std::vector<StoredSetting> catalogSettingsTable(CatalogSettings &settings);
// The six format keys of each cell line, "Font0" .. "Align8".
std::vector<StoredSetting> cellFormatTable(CellLines &lines);

// Saves or loads one value: Save writes the property's text under the key; Load reads the key
// (the fallback when absent) and applies it. Returns false when the loaded text could not be
// applied; the property then keeps its value.
bool SetGetRegControlValue(std::uint8_t action, SettingsStore &store, const QString &app,
                           const QString &section, const QString &key, const ControlProperty &property,
                           const QString &fallback);

// Loads the settings record from the store and saves it back.
//
// Each key is applied on its own: a stored value that cannot be applied (a list index beyond a
// list that has since shrunk, a word where a number belongs) leaves its widget at the value it
// had, and loading goes on with the next key. Such a key is remembered, and a later save does
// not write over its stored value unless the user has changed that widget since: a start while
// the accounting database is unreachable must not cost the user the settings it could not show.
//
// `store` and `settings` must outlive this object.
class SettingsPersistence
{
public:
    SettingsPersistence(SettingsStore &store, CatalogSettings &settings);

    // Saves (1) or loads (2) every catalog setting and every cell line's caption and tag.
    void SetGetRegParams(std::uint8_t action);
    // Saves (1) or loads (2) the six format bytes of each cell line.
    void GetSetFormLabDefs(std::uint8_t action, const QString &app, const QString &section);
    // The save button: the settings, then the line formats.
    void CmdDef_Click();

    // Keys whose stored value could not be applied at the last load, and not changed since.
    QStringList unappliedKeys() const;

private:
    void persist(std::uint8_t action, const QString &app, const QString &section,
                 const StoredSetting &setting);

    SettingsStore &m_store;
    CatalogSettings &m_settings;
    // Key -> the widget's text at the moment its stored value was refused.
    QHash<QString, QString> m_unapplied;
};

} // namespace zorbin
