#include "model/SettingsPersistence.h"

#include "model/CatalogSettings.h"
#include "platform/SettingsStore.h"

namespace zorbin {

bool SetGetRegControlValue(std::uint8_t action, SettingsStore &store, const QString &app,
                           const QString &section, const QString &key, const StoreValue &value,
                           const QString &fallback)
{
    if (action == SaveAction) {
        store.write(app, section, key, value.storeText());
        return true;
    }
    if (action == LoadAction)
        return value.apply(store.read(app, section, key, fallback));
    return true;
}

SettingsPersistence::SettingsPersistence(SettingsStore &store, CatalogSettings &settings)
    : m_store(store), m_settings(settings)
{}

void SettingsPersistence::persist(std::uint8_t action, const QString &app, const QString &section,
                                  const StoredOption &option)
{
    const QString &key = option.key;
    const QString before = option.storeText(m_settings);
    const StoreValue value{[&] { return option.storeText(m_settings); },
                           [&](const QString &text) { return option.apply(m_settings, text); }};
    if (action == SaveAction) {
        const auto refused = m_unapplied.constFind(key);
        if (refused != m_unapplied.constEnd() && *refused == before)
            return; // the user never saw the stored value, so saving must not replace it
        m_unapplied.remove(key);
    } else if (action == LoadAction) {
        if (!SetGetRegControlValue(action, m_store, app, section, key, value, option.defaultText))
            m_unapplied.insert(key, before);
        else
            m_unapplied.remove(key);
        return;
    }
    SetGetRegControlValue(action, m_store, app, section, key, value, option.defaultText);
}

void SettingsPersistence::SetGetRegParams(std::uint8_t action)
{
    for (const StoredOption &option : catalogOptionTable())
        persist(action, StoreApp, StoreSection, option);
}

void SettingsPersistence::GetSetFormLabDefs(std::uint8_t action, const QString &app, const QString &section)
{
    for (const StoredOption &option : cellFormatTable())
        persist(action, app, section, option);
}

void SettingsPersistence::saveAll()
{
    SetGetRegParams(SaveAction);
    GetSetFormLabDefs(SaveAction, StoreApp, StoreSection);
    m_store.flush();
}

QStringList SettingsPersistence::unappliedKeys() const
{
    QStringList keys = m_unapplied.keys();
    keys.sort();
    return keys;
}

} // namespace zorbin
