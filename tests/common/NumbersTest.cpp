#include "common/Numbers.h"

#include <QTest>

using namespace zorbin;

// A stored or typed text as a format byte and as a 16-bit number (a list index, a grid count):
// fractions round half to even, and a text out of range or not wholly a number is refused.
class NumbersTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void typedTextsConvert_data()
    {
        QTest::addColumn<QString>("text");
        QTest::addColumn<int>("asByte");  // -1: refused
        QTest::addColumn<int>("asInt16"); // 99999: refused
        const int no = 99999;
        QTest::newRow("plain") << QStringLiteral("9") << 9 << 9;
        QTest::newRow("blanks and a sign") << QStringLiteral(" +12 ") << 12 << 12;
        QTest::newRow("half down to even") << QStringLiteral("12.5") << 12 << 12;
        QTest::newRow("half up to even") << QStringLiteral("13.5") << 14 << 14;
        QTest::newRow("below half") << QStringLiteral("2.4") << 2 << 2;
        QTest::newRow("a point first") << QStringLiteral(".5") << 0 << 0;
        QTest::newRow("exponent") << QStringLiteral("1e2") << 100 << 100;
        QTest::newRow("largest byte") << QStringLiteral("255") << 255 << 255;
        QTest::newRow("rounds above a byte") << QStringLiteral("255.5") << -1 << 256;
        QTest::newRow("rounds to zero from below") << QStringLiteral("-0.5") << 0 << 0;
        QTest::newRow("negative half") << QStringLiteral("-2.5") << -1 << -2;
        QTest::newRow("largest 16-bit") << QStringLiteral("32767") << -1 << 32767;
        QTest::newRow("above 16 bits") << QStringLiteral("32768") << -1 << no;
        QTest::newRow("lowest 16-bit") << QStringLiteral("-32768") << -1 << -32768;
        QTest::newRow("below 16 bits") << QStringLiteral("-32769") << -1 << no;
        QTest::newRow("empty") << QString() << -1 << no;
        QTest::newRow("letters") << QStringLiteral("True") << -1 << no;
        QTest::newRow("number then letters") << QStringLiteral("12abc") << -1 << no;
        QTest::newRow("two points") << QStringLiteral("1.2.3") << -1 << no;
        QTest::newRow("huge") << QStringLiteral("1e300") << -1 << no;
        QTest::newRow("beyond a double") << QStringLiteral("1e400") << -1 << no;
    }
    void typedTextsConvert()
    {
        QFETCH(QString, text);
        QFETCH(int, asByte);
        QFETCH(int, asInt16);
        const auto byte = toByte(text);
        QCOMPARE(byte ? int(*byte) : -1, asByte);
        const auto int16 = toInt16(text);
        QCOMPARE(int16 ? int(*int16) : 99999, asInt16);
    }
};

QTEST_GUILESS_MAIN(NumbersTest)
#include "NumbersTest.moc"
