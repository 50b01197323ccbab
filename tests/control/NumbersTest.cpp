#include "common/Numbers.h"

#include "testutil/TestMain.h"

#include <QTest>

using namespace zorbin;

class NumbersTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void halvesRoundToEven_data()
    {
        QTest::addColumn<double>("value");
        QTest::addColumn<qint64>("rounded");
        QTest::newRow("2.5") << 2.5 << qint64(2);
        QTest::newRow("3.5") << 3.5 << qint64(4);
        QTest::newRow("-2.5") << -2.5 << qint64(-2);
        QTest::newRow("12.5") << 12.5 << qint64(12);
        QTest::newRow("13.5") << 13.5 << qint64(14);
        QTest::newRow("2.6") << 2.6 << qint64(3);
        QTest::newRow("416.67") << 416.67 << qint64(417);
    }
    void halvesRoundToEven()
    {
        QFETCH(double, value);
        QFETCH(qint64, rounded);
        QCOMPARE(roundHalfEven(value), rounded);
    }

    void typedTextsConvert_data()
    {
        QTest::addColumn<QString>("text");
        QTest::addColumn<int>("asByte"); // -1: refused
        QTest::newRow("plain") << QStringLiteral("9") << 9;
        QTest::newRow("blanks") << QStringLiteral(" 12 ") << 12;
        QTest::newRow("half down") << QStringLiteral("12.5") << 12;
        QTest::newRow("half up") << QStringLiteral("13.5") << 14;
        QTest::newRow("largest") << QStringLiteral("255") << 255;
        QTest::newRow("too large") << QStringLiteral("300") << -1;
        QTest::newRow("rounds above range") << QStringLiteral("255.5") << -1;
        QTest::newRow("negative") << QStringLiteral("-1") << -1;
        QTest::newRow("empty") << QString() << -1;
        QTest::newRow("letters") << QStringLiteral("abc") << -1;
        QTest::newRow("number then letters") << QStringLiteral("12abc") << -1;
        QTest::newRow("huge") << QStringLiteral("1e300") << -1;
    }
    void typedTextsConvert()
    {
        QFETCH(QString, text);
        QFETCH(int, asByte);
        const auto byte = toByte(text);
        QCOMPARE(byte.has_value(), asByte >= 0);
        if (byte)
            QCOMPARE(int(*byte), asByte);
    }

    void listIndexesAreSixteenBit()
    {
        QCOMPARE(toInt16(QStringLiteral("-1")).value(), qint16(-1));
        QCOMPARE(toInt16(QStringLiteral("32767")).value(), qint16(32767));
        QVERIFY(!toInt16(QStringLiteral("32768")));
        QVERIFY(!toInt16(QStringLiteral("True")));
    }
};

ZORBIN_TEST_CLASS(NumbersTest)
#include "NumbersTest.moc"
