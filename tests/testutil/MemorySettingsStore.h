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
    void set(const QString &key, const QString &value)
    {
        values.insert(path(QStringLiteral("Zorbin"), QStringLiteral("Params"), key), value);
    }
    QString get(const QString &key) const
    {
        return values.value(path(QStringLiteral("Zorbin"), QStringLiteral("Params"), key));
    }
    bool has(const QString &key) const
    {
        return values.contains(path(QStringLiteral("Zorbin"), QStringLiteral("Params"), key));
    }
    // The keys under "Zorbin"/"Params", without the prefix.
    QStringList keys() const
    {
        QStringList result;
        const QString prefix = QStringLiteral("Zorbin/Params/");
        for (auto it = values.cbegin(); it != values.cend(); ++it) {
            if (it.key().startsWith(prefix))
                result << it.key().mid(prefix.size());
        }
        return result;
    }

    QMap<QString, QString> values;
    int writes = 0;

private:
    static QString path(const QString &app, const QString &section, const QString &key)
    {
        return app + QLatin1Char('/') + section + QLatin1Char('/') + key;
    }
};

} // namespace zorbin::test
