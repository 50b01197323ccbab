#include "model/SettingsValidation.h"

#include "model/CatalogSettings.h"
#include "testutil/TestMain.h"

#include <QTest>

using namespace zorbin;

Q_DECLARE_METATYPE(zorbin::NumericSetting)

class SettingsValidationTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void eachNumberHasItsRange_data()
    {
        QTest::addColumn<NumericSetting>("setting");
        QTest::addColumn<QString>("text");
        QTest::addColumn<bool>("accepted");
        const auto rows = NumericSetting::Rows;
        const auto top = NumericSetting::TopPercent;
        const auto height = NumericSetting::ImageH;
        QTest::newRow("one row") << rows << QStringLiteral("1") << true;
        QTest::newRow("999 rows") << rows << QStringLiteral("999") << true;
        QTest::newRow("no rows") << rows << QStringLiteral("0") << false;
        QTest::newRow("1000 rows from the store") << rows << QStringLiteral("1000") << false;
        QTest::newRow("rows empty") << rows << QString() << false;
        QTest::newRow("rows a word") << rows << QStringLiteral("שמונה") << false;
        QTest::newRow("rows rounded like the runs") << rows << QStringLiteral("0.5") << false;
        QTest::newRow("columns") << NumericSetting::Cols << QStringLiteral("-3") << false;
        QTest::newRow("band 0") << top << QStringLiteral("0") << true;
        QTest::newRow("band 99") << top << QStringLiteral("99") << true;
        QTest::newRow("band 100") << top << QStringLiteral("100") << false;
        QTest::newRow("no bottom band") << NumericSetting::BottomPercent << QString() << true;
        QTest::newRow("bottom band a word") << NumericSetting::BottomPercent << QStringLiteral("x") << false;
        QTest::newRow("no largest height") << height << QString() << true;
        QTest::newRow("height 0") << height << QStringLiteral("0") << true;
        QTest::newRow("height 999") << height << QStringLiteral("999") << true;
        QTest::newRow("width 1000") << NumericSetting::ImageW << QStringLiteral("1000") << false;
        QTest::newRow("width letters") << NumericSetting::ImageW << QStringLiteral("abc") << false;
    }
    void eachNumberHasItsRange()
    {
        QFETCH(NumericSetting, setting);
        QFETCH(QString, text);
        QFETCH(bool, accepted);
        const auto problem = numericSettingProblem(setting, text);
        QCOMPARE(!problem.has_value(), accepted);
        if (problem && !text.isEmpty())
            QVERIFY(problem->contains(QStringLiteral("\"%1\"").arg(text)));
    }

    void theFirstProblemNamesItsFieldAndTab()
    {
        CatalogSettings settings;
        QVERIFY(validateNumericSettings(settings).isOk());
        settings.txtBottomPercent = QStringLiteral("150");
        settings.txtImageW = QStringLiteral("x");
        const Status status = validateNumericSettings(settings);
        QVERIFY(!status.isOk());
        QVERIFY(status.description().contains(QStringLiteral("רוחב מקסימלי לתמונה")));
        QVERIFY(status.description().contains(QStringLiteral("הגדרת עמוד בקטלוג")));
        settings.txtImageW.clear();
        QVERIFY(
            validateNumericSettings(settings).description().contains(QStringLiteral("גובה הכותרת התחתונה")));
    }
};

ZORBIN_TEST_CLASS(SettingsValidationTest)
#include "SettingsValidationTest.moc"
