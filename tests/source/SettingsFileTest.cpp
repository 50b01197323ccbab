#include "platform/SettingsStore.h"
#include "testutil/TestFiles.h"
#include "testutil/TestMain.h"

#include <QDir>
#include <QFileInfo>
#include <QSettings>
#include <QStandardPaths>
#include <QTemporaryDir>
#include <QTest>

using namespace zorbin;
using namespace zorbin::test;

namespace {

const QFileDevice::Permissions OwnerOnly = QFileDevice::ReadOwner | QFileDevice::WriteOwner;
const QFileDevice::Permissions OthersAndGroup = QFileDevice::ReadGroup | QFileDevice::WriteGroup |
                                                QFileDevice::ExeGroup | QFileDevice::ReadOther |
                                                QFileDevice::WriteOther | QFileDevice::ExeOther;

} // namespace

// The settings hold the connection password in plain text (earlier versions read it so), so on
// Linux the file is readable by its owner only.
class SettingsFileTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void userSettingsAreTheOwnersOnly()
    {
#ifdef Q_OS_WIN
        QSKIP("The registry keeps the settings on Windows.");
#else
        // ctest points XDG_CONFIG_HOME into the build tree, so that no real settings are touched.
        QVERIFY2(qEnvironmentVariableIsSet("XDG_CONFIG_HOME"), "run through ctest");
        const QString path = QSettings(QSettings::NativeFormat, QSettings::UserScope,
                                       QStringLiteral("Zorbin"), QStringLiteral("Zorbin"))
                                 .fileName();
        QVERIFY(path.startsWith(qEnvironmentVariable("XDG_CONFIG_HOME")));
        QFile::remove(path);
        auto store = openUserSettingsStore();
        store->write(QStringLiteral("Zorbin"), QStringLiteral("Params"), QStringLiteral("ConnPWD"),
                     QStringLiteral("secret"));
        store->flush();
        QVERIFY(QFileInfo::exists(path));
        QCOMPARE(QFileInfo(path).permissions() & (OwnerOnly | OthersAndGroup), OwnerOnly);
        QCOMPARE(store->read(QStringLiteral("Zorbin"), QStringLiteral("Params"), QStringLiteral("ConnPWD"),
                             QString()),
                 QStringLiteral("secret"));
#endif
    }

    void aFileOthersCouldReadIsClosedAtTheNextSave()
    {
#ifdef Q_OS_WIN
        QSKIP("The registry keeps the settings on Windows.");
#else
        QTemporaryDir folder;
        const QString path = folder.filePath(QStringLiteral("settings.ini"));
        writeFile(path, "[Params]\nConnPWD=old\n");
        QVERIFY(QFile::setPermissions(path, OwnerOnly | QFileDevice::ReadGroup | QFileDevice::ReadOther));
        auto store = openIniSettingsStore(path);
        store->write(QStringLiteral("Zorbin"), QStringLiteral("Params"), QStringLiteral("ConnPWD"),
                     QStringLiteral("new"));
        store->flush();
        QCOMPARE(QFileInfo(path).permissions() & (OwnerOnly | OthersAndGroup), OwnerOnly);
#endif
    }

    // The demo's installed settings and a settings file given to zorbin-cli are only read: a
    // run must leave them readable by whoever could read them before.
    void aFileOnlyReadKeepsItsPermissions()
    {
#ifdef Q_OS_WIN
        QSKIP("File permissions are a Unix matter.");
#else
        QTemporaryDir folder;
        const QString path = folder.filePath(QStringLiteral("settings.ini"));
        writeFile(path, "[Params]\nRows=4\n");
        const auto readable = OwnerOnly | QFileDevice::ReadGroup | QFileDevice::ReadOther;
        QVERIFY(QFile::setPermissions(path, readable));
        {
            auto store = openIniSettingsStore(path);
            QCOMPARE(store->read(QStringLiteral("Zorbin"), QStringLiteral("Params"), QStringLiteral("Rows"),
                                 QString()),
                     QStringLiteral("4"));
            store->flush();
        }
        QCOMPARE(QFileInfo(path).permissions() & (OwnerOnly | OthersAndGroup), readable);
#endif
    }
};

ZORBIN_TEST_CLASS(SettingsFileTest)
#include "SettingsFileTest.moc"
