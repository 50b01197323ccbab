#include "platform/SettingsStore.h"

#include <QDir>
#include <QFile>
#include <QFileInfo>
#include <QSettings>
#include <QStringList>
#include <map>
#include <memory>
#include <set>

namespace zorbin {
namespace {

// QSettings keeps every value the program writes as a string; a hand-edited INI line with
// commas reads back as a list, which is joined again so that no text is lost.
QString asText(const QVariant &value)
{
    if (value.metaType().id() == QMetaType::QStringList)
        return value.toStringList().join(QLatin1Char(','));
    return value.toString();
}

class QtSettingsStore final : public SettingsStore
{
public:
    // `fixedFile` empty: one native store per application name; otherwise that INI file for all.
    explicit QtSettingsStore(QString fixedFile) : m_fixedFile(std::move(fixedFile)) {}

    QString read(const QString &app, const QString &section, const QString &key,
                 const QString &fallback) const override
    {
        const auto *settings = open(app);
        const QString path = section + QLatin1Char('/') + key;
        if (!settings->contains(path))
            return fallback;
        return asText(settings->value(path));
    }

    bool contains(const QString &app, const QString &section, const QString &key) const override
    {
        return open(app)->contains(section + QLatin1Char('/') + key);
    }

    ~QtSettingsStore() override { flush(); }

    void write(const QString &app, const QString &section, const QString &key, const QString &value) override
    {
        open(app)->setValue(section + QLatin1Char('/') + key, value);
        m_written.insert(storeName(app));
    }

    // Only a store that was written to is saved: a file that was only read is left as it is
    // (a shared or installed settings file must not become its reader's only).
    void flush() override
    {
        for (const auto &[name, settings] : m_opened) {
            if (!m_written.contains(name))
                continue;
            createForOwnerOnly(settings->fileName());
            settings->sync();
            restrictToOwner(settings->fileName());
        }
        m_written.clear();
    }

private:
    QString storeName(const QString &app) const { return m_fixedFile.isEmpty() ? app : QString(); }

    QSettings *open(const QString &app) const
    {
        auto &settings = m_opened[storeName(app)];
        if (!settings)
            settings = create(app);
        return settings.get();
    }

    std::unique_ptr<QSettings> create(const QString &app) const
    {
        if (!m_fixedFile.isEmpty())
            return std::make_unique<QSettings>(m_fixedFile, QSettings::IniFormat);
#ifdef Q_OS_WIN
        // The registry area where the settings of earlier versions live, so that they carry over.
        return std::make_unique<QSettings>(
            QStringLiteral("HKEY_CURRENT_USER\\Software\\VB and VBA Program Settings\\") + app,
            QSettings::NativeFormat);
#else
        return std::make_unique<QSettings>(QSettings::NativeFormat, QSettings::UserScope, app, app);
#endif
    }

    // A file about to be written for the first time is made its owner's before the password
    // goes into it; a rewrite keeps the permissions of the file it replaces.
    static void createForOwnerOnly(const QString &fileName)
    {
#ifndef Q_OS_WIN
        if (QFile::exists(fileName) || !QDir().mkpath(QFileInfo(fileName).absolutePath()))
            return;
        QFile file(fileName);
        (void)file.open(QIODevice::WriteOnly | QIODevice::NewOnly,
                        QFileDevice::ReadOwner | QFileDevice::WriteOwner);
#else
        Q_UNUSED(fileName);
#endif
    }

    static void restrictToOwner(const QString &fileName)
    {
#ifndef Q_OS_WIN
        if (QFile::exists(fileName))
            QFile::setPermissions(fileName, QFileDevice::ReadOwner | QFileDevice::WriteOwner);
#else
        Q_UNUSED(fileName);
#endif
    }

    QString m_fixedFile;
    mutable std::map<QString, std::unique_ptr<QSettings>> m_opened;
    std::set<QString> m_written; // the names of the stores written to since the last flush
};

} // namespace

std::unique_ptr<SettingsStore> openUserSettingsStore()
{
    return std::make_unique<QtSettingsStore>(QString());
}

std::unique_ptr<SettingsStore> openIniSettingsStore(const QString &path)
{
    return std::make_unique<QtSettingsStore>(path);
}

} // namespace zorbin
