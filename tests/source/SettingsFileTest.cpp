#include "platform/SettingsStore.h"
#include "testutil/TestFiles.h"
#include "testutil/TestMain.h"

#include <QFileInfo>
#include <QSettings>
#include <QTemporaryDir>
#include <QTest>

using namespace zorbin;
using namespace zorbin::test;
using namespace Qt::Literals::StringLiterals;

// The settings hold the connection password in plain text (earlier versions read it so), so a
// settings file that is written is its owner's only; one that is only read (the demo's installed
// settings, a file given to zorbin-cli) keeps its permissions.
class SettingsFileTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void aWrittenFileIsTheOwnersOnly_data()
    {
        QTest::addColumn<QString>("file"); // empty: the user's own settings, made anew
        QTest::addColumn<bool>("written");
        QTest::newRow("the user's new settings") << QString() << true;
        QTest::newRow("a file others could read, written") << u"settings.ini"_s << true;
        QTest::newRow("a file others can read, only read") << u"settings.ini"_s << false;
    }
    void aWrittenFileIsTheOwnersOnly()
    {
#ifdef Q_OS_WIN
        QSKIP("The registry keeps the settings on Windows.");
#endif
        QFETCH(QString, file);
        QFETCH(bool, written);
        QTemporaryDir folder;
        // ctest points XDG_CONFIG_HOME into the build tree, so that no real settings are touched.
        QVERIFY2(qEnvironmentVariableIsSet("XDG_CONFIG_HOME"), "run through ctest");
        const QString path = file.isEmpty() ? QSettings(QSettings::NativeFormat, QSettings::UserScope,
                                                        u"Zorbin"_s, u"Zorbin"_s)
                                                  .fileName()
                                            : folder.filePath(file);
        const auto readable = QFileDevice::ReadOwner | QFileDevice::WriteOwner | QFileDevice::ReadGroup |
                              QFileDevice::ReadOther;
        QFile::remove(path);
        if (!file.isEmpty()) {
            writeFile(path, "[Params]\nConnPWD=old\n");
            QVERIFY(QFile::setPermissions(path, readable));
        }
        {
            auto store = file.isEmpty() ? openUserSettingsStore() : openIniSettingsStore(path);
            QCOMPARE(store->read(u"Zorbin"_s, u"Params"_s, u"ConnPWD"_s, {}),
                     file.isEmpty() ? QString() : u"old"_s);
            if (written)
                store->write(u"Zorbin"_s, u"Params"_s, u"ConnPWD"_s, u"secret"_s);
            store->flush();
        }
        const auto everyone = QFileDevice::Permissions::fromInt(0x7077); // owner, group, others
        QCOMPARE(QFileInfo(path).permissions() & everyone,
                 written ? QFileDevice::ReadOwner | QFileDevice::WriteOwner : readable);
    }
};

ZORBIN_TEST_CLASS(SettingsFileTest)
#include "SettingsFileTest.moc"
