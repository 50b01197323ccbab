#pragma once

#include "platform/SettingsStore.h"
#include "testutil/AccountingFixture.h"
#include "testutil/TestFiles.h"

#include <QDir>
#include <QRegularExpression>
#include <QTemporaryDir>
#include <memory>

namespace zorbin::test {

// The demo's settings copied into a scratch folder, with the output going to its "catalog"
// folder: where both programs' whole runs on the demo database start.
struct DemoScratch
{
    DemoScratch()
    {
        if (!QFile::copy(demoSettingsPath(), settingsFile))
            QTest::qFail("cannot copy the demo settings (is the project built?)", __FILE__, __LINE__);
        QFile::setPermissions(settingsFile, QFileDevice::ReadOwner | QFileDevice::WriteOwner);
        store = openIniSettingsStore(settingsFile);
        store->write(QStringLiteral("Zorbin"), QStringLiteral("Params"), QStringLiteral("PagingPath"),
                     output);
        store->flush();
    }

    // A file in the output folder.
    QString out(const QString &name) const { return QDir(output).filePath(name); }

    QTemporaryDir folder;
    QString settingsFile = folder.filePath(QStringLiteral("demo-settings.ini")); // the copy
    QString output = folder.filePath(QStringLiteral("catalog"));
    std::unique_ptr<SettingsStore> store;
};

// The key of the first item on a catalog page of the demo settings (the key line reads left to
// right); empty when the page has no item.
inline QString firstItemKey(const QString &page)
{
    static const QRegularExpression key(QStringLiteral("dir=ltr>([^<]+)<"));
    return key.match(QString::fromLatin1(readFile(page))).captured(1);
}

// The number of item rows on an item list page.
inline qsizetype listRows(const QString &page)
{
    return QString::fromLatin1(readFile(page)).count(QStringLiteral("<tr bgcolor='#FFFFFF'"));
}

} // namespace zorbin::test
