#pragma once

#include <QString>
#include <memory>

namespace zorbin {

// A per-user store of text values addressed by application, section and key.
// A missing key reads as the caller's default; nothing is ever deleted from the store.
class SettingsStore
{
public:
    virtual ~SettingsStore() = default;

    // The stored text, or `fallback` when the key is absent.
    virtual QString read(const QString &app, const QString &section, const QString &key,
                         const QString &fallback) const = 0;
    virtual bool contains(const QString &app, const QString &section, const QString &key) const = 0;
    virtual void write(const QString &app, const QString &section, const QString &key,
                       const QString &value) = 0;
    // Makes the writes so far last. A store does it by itself at the latest when it is destroyed;
    // a caller that saves many keys calls it once after the last, so that the store does not
    // rewrite its whole file for every key.
    virtual void flush() {}
};

// The user's own store: on Windows the per-user registry area that earlier versions used,
// elsewhere Qt's per-user configuration folder (~/.config/<app>/<app>.conf on Linux). The file
// holds the connection password, so on Linux it is readable by its owner only.
std::unique_ptr<SettingsStore> openUserSettingsStore();

// A store kept in an INI file in Qt's format: one "[section]" per section, one "key=value" per key.
// The application name is not part of the file; `zorbin-cli --settings FILE` uses it.
std::unique_ptr<SettingsStore> openIniSettingsStore(const QString &path);

} // namespace zorbin
