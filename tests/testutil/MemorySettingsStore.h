#pragma once

#include "platform/SettingsStore.h"

#include <QMap>

namespace zorbin::test {

// A settings store in memory, addressed "app/section/key".
class MemorySettingsStore final : public SettingsStore
{
public:
    QString read(const QString &app, const QString &section, const QString &key,
                 const QString &fallback) const override
    {
        return values.value(path(app, section, key), fallback);
    }
    bool contains(const QString &app, const QString &section, const QString &key) const override
    {
        return values.contains(path(app, section, key));
    }
    void write(const QString &app, const QString &section, const QString &key, const QString &value) override
    {
        values.insert(path(app, section, key), value);
        ++writes;
    }

    // Shortcuts for the store's one location, "Zorbin"/"Params".
    void set(const QString &key, const QString &value) { values.insert(params(key), value); }
    QString get(const QString &key) const { return values.value(params(key)); }
    bool has(const QString &key) const { return values.contains(params(key)); }

    QMap<QString, QString> values;
    int writes = 0;

private:
    static QString path(const QString &app, const QString &section, const QString &key)
    {
        return app + QLatin1Char('/') + section + QLatin1Char('/') + key;
    }
    static QString params(const QString &key) { return QStringLiteral("Zorbin/Params/") + key; }
};

} // namespace zorbin::test
