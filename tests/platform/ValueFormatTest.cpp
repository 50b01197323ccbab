// The number and date formats of the catalog files and the system's separators.
#include "platform/ValueFormat.h"

#include "testutil/TestMain.h"

#include <QLocale>
#include <QTest>
#include <limits>

using namespace zorbin;

class ValueFormatTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void amounts()
    {
        const std::pair<double, QString> cases[] = {
            {1234.5, u"1,234.50"_qs},
            {0.0, u"0.00"_qs},
            {-3.0, u"-3.00"_qs},
            {-98765.432, u"-98,765.43"_qs},
            {0.125, u"0.13"_qs}, // a half cent away from zero
            // Typed half cents whose doubles lie a hair below the half (2.67499999999999982...).
            {2.675, u"2.68"_qs},
            {0.285, u"0.29"_qs},
            {1.005, u"1.01"_qs},
            {-2.675, u"-2.68"_qs},
            {1.0049, u"1.00"_qs},
            {0.0049999999, u"0.00"_qs},
            {9999999999999.99, u"9,999,999,999,999.99"_qs},
            {999.999, u"1,000.00"_qs},
            {-0.001, u"0.00"_qs}, // no sign when it rounds to zero
            {123456789012345.0, u"123,456,789,012,345.00"_qs},
            // A corrupt price far beyond any amount of money is printed, not overrun.
            {-1e40, u"-10,000,000,000,000,000,000,000,000,000,000,000,000,000.00"_qs},
            {std::numeric_limits<double>::max(),
             u"179,769,313,486,232"_qs + u",000"_qs.repeated(98) + u".00"_qs},
        };
        for (const auto &[value, expected] : cases)
            QCOMPARE(formatAmount(value, Separators()), expected);
    }

    void separatorsAsGiven()
    {
        Separators separators;
        separators.group = u"."_qs;
        separators.decimal = u","_qs;
        separators.date = u"-"_qs;
        QCOMPARE(formatAmount(1234567.891, separators), u"1.234.567,89"_qs);
        QCOMPARE(formatDate(QDate(2024, 3, 5), Separators()), u"05/03/2024"_qs);
        QCOMPARE(formatDate(QDate(999, 12, 31), separators), u"31-12-0999"_qs);
    }

    void systemSeparators()
    {
        const std::pair<QLocale, QStringList> cases[] = {
            {QLocale::c(), {u","_qs, u"."_qs, u"/"_qs}},
            {QLocale(QLocale::German, QLocale::Germany), {u"."_qs, u","_qs, u"."_qs}},
            {QLocale(QLocale::Hebrew, QLocale::Israel), {u","_qs, u"."_qs, u"."_qs}},
        };
        const QLocale saved;
        for (const auto &[locale, expected] : cases) {
            QLocale::setDefault(locale);
            const Separators separators = Separators::ofSystem();
            QLocale::setDefault(saved);
            QCOMPARE((QStringList{separators.group, separators.decimal, separators.date}), expected);
        }
    }

    // The stylesheet's percentages.
    void oneDecimal()
    {
        QCOMPARE(formatOneDecimal(100.0 / 3), u"33.3"_qs);
        QCOMPARE(formatOneDecimal(100.0 / 1), u"100.0"_qs);
        QCOMPARE(formatOneDecimal(100.0 / 16), u"06.3"_qs); // a half away from zero
        QCOMPARE(formatOneDecimal(100.0 / 1.5), u"66.7"_qs);
        QCOMPARE(formatOneDecimal(100.0 / 999), u"00.1"_qs);
        QCOMPARE(formatOneDecimal(0.0), u"00.0"_qs);
    }
};

ZORBIN_TEST_CLASS(ValueFormatTest)
#include "ValueFormatTest.moc"
