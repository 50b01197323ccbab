#include "model/CatalogSettings.h"
#include "source/ConnectionString.h"
#include "source/SourceConnection.h"
#include "source/SourceCriteria.h"
#include "testutil/AccountingFixture.h"
#include "testutil/TestMain.h"

#include <QSqlQuery>
#include <QTemporaryDir>
#include <QTest>

using namespace zorbin;
using namespace zorbin::test;

namespace {

const QString Fixed = QStringLiteral(" And Items.ItemKey <> '#' And Items.ItemKey <> '*'");

void setCutOff(CatalogSettings &settings, const QStringList &positions)
{
    for (int i = 0; i < CutOffPositions; ++i)
        settings.cutOff[std::size_t(i)] = i < positions.size() ? positions.at(i) : QStringLiteral("*");
}

QStringList texts(std::initializer_list<const char *> values)
{
    QStringList list;
    for (const char *value : values)
        list << QString::fromUtf8(value);
    return list;
}

QString criteria(const CatalogSettings &settings)
{
    const auto built = BuildSourceDBCriteria(settings);
    if (!built) {
        QTest::qFail(qPrintable(built.status().description()), __FILE__, __LINE__);
        return {};
    }
    return built.value();
}

} // namespace

class CriteriaTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void nothingTickedGivesTheFixedCondition()
    {
        CatalogSettings settings;
        settings.sortCodeFrom = QStringLiteral("10");
        settings.itemKeyFrom = QStringLiteral("100");
        setCutOff(settings, {QStringLiteral("A")});
        QCOMPARE(criteria(settings), Fixed);
    }

    void allThreeConditionsInTheirOrder()
    {
        CatalogSettings settings;
        settings.sortCodeRange = true;
        settings.sortCodeFrom = QStringLiteral("10");
        settings.sortCodeTo = QStringLiteral("20");
        settings.cutOffFilter = true;
        setCutOff(settings, {QStringLiteral("A"), QStringLiteral("*"), QStringLiteral("B")});
        settings.itemKeyRange = true;
        settings.itemKeyFrom = QStringLiteral("100");
        QCOMPARE(criteria(settings),
                 QStringLiteral(
                     " And Items.ItemKey <> '#' And Items.ItemKey <> '*' And Items.SortGroup >= 10 And "
                     "Items.SortGroup <= 20 And Items.Filter Like 'A_B_______' And Items.ItemKey >= '100'"));
    }

    void eachConditionOnItsOwn_data()
    {
        QTest::addColumn<int>("catCode");
        QTest::addColumn<QString>("fromSort");
        QTest::addColumn<QString>("toSort");
        QTest::addColumn<int>("filter");
        QTest::addColumn<QStringList>("cutOff");
        QTest::addColumn<int>("itemKey");
        QTest::addColumn<QString>("fromItem");
        QTest::addColumn<QString>("toItem");
        QTest::addColumn<QString>("added");
        const QStringList none;
        QTest::newRow("upper sort bound only") << 1 << ""
                                               << "7" << 0 << none << 0 << ""
                                               << ""
                                               << " And Items.SortGroup <= 7";
        QTest::newRow("sort bound of blanks is empty") << 1 << "   "
                                                       << " 8 " << 0 << none << 0 << ""
                                                       << ""
                                                       << " And Items.SortGroup <= 8";
        QTest::newRow("both sort bounds empty") << 1 << ""
                                                << "" << 0 << none << 0 << ""
                                                << ""
                                                << "";
        QTest::newRow("negative sort bound") << 1 << "-3"
                                             << "" << 0 << none << 0 << ""
                                             << ""
                                             << " And Items.SortGroup >= -3";
        QTest::newRow("grey counts as off") << 2 << "1"
                                            << "2" << 2 << texts({"A"}) << 2 << "a"
                                            << "b"
                                            << "";
        QTest::newRow("all positions *") << 0 << ""
                                         << "" << 1 << none << 0 << ""
                                         << ""
                                         << "";
        QTest::newRow("all positions empty") << 0 << ""
                                             << "" << 1 << QStringList(10, QString()) << 0 << ""
                                             << ""
                                             << "";
        QTest::newRow("one position")
            << 0 << ""
            << "" << 1 << texts({"*", "*", "*", "*", "*", "*", "*", "*", "*", "Z"}) << 0 << ""
            << ""
            << " And Items.Filter Like '_________Z'";
        QTest::newRow("blanks around a position") << 0 << ""
                                                  << "" << 1 << texts({" A "}) << 0 << ""
                                                  << ""
                                                  << " And Items.Filter Like 'A_________'";
        QTest::newRow("a box of two characters") << 0 << ""
                                                 << "" << 1 << texts({"AB", "C"}) << 0 << ""
                                                 << ""
                                                 << " And Items.Filter Like 'ABC________'";
        QTest::newRow("upper key bound only") << 0 << ""
                                              << "" << 0 << none << 1 << ""
                                              << "Z9"
                                              << " And Items.ItemKey <= 'Z9'";
        QTest::newRow("key bounds trimmed") << 0 << ""
                                            << "" << 0 << none << 1 << " A1 "
                                            << " B2 "
                                            << " And Items.ItemKey >= 'A1' And Items.ItemKey <= 'B2'";
        QTest::newRow("key bound of blanks is empty") << 0 << ""
                                                      << "" << 0 << none << 1 << "  "
                                                      << ""
                                                      << "";
    }
    void eachConditionOnItsOwn()
    {
        QFETCH(int, catCode);
        QFETCH(QString, fromSort);
        QFETCH(QString, toSort);
        QFETCH(int, filter);
        QFETCH(QStringList, cutOff);
        QFETCH(int, itemKey);
        QFETCH(QString, fromItem);
        QFETCH(QString, toItem);
        QFETCH(QString, added);
        CatalogSettings settings;
        settings.sortCodeRange = catCode == 1;
        settings.sortCodeFrom = fromSort;
        settings.sortCodeTo = toSort;
        settings.cutOffFilter = filter == 1;
        setCutOff(settings, cutOff);
        settings.itemKeyRange = itemKey == 1;
        settings.itemKeyFrom = fromItem;
        settings.itemKeyTo = toItem;
        QCOMPARE(criteria(settings), Fixed + added);
    }

    // A sort-group bound goes into the query without quotes, so anything but a whole number is
    // refused before a query is sent, with the field named.
    void refusesASortBoundThatIsNotAWholeNumber_data()
    {
        QTest::addColumn<QString>("fromSort");
        QTest::addColumn<QString>("toSort");
        QTest::addColumn<QString>("field");
        QTest::addColumn<QString>("offending");
        QTest::newRow("letters") << "abc"
                                 << ""
                                 << "מקוד מיון"
                                 << "abc";
        QTest::newRow("fraction") << "1"
                                  << "2.5"
                                  << "עד קוד מיון"
                                  << "2.5";
        QTest::newRow("inner blank") << "1 0"
                                     << ""
                                     << "מקוד מיון"
                                     << "1 0";
        QTest::newRow("a second condition") << " 1 Or 1=1"
                                            << ""
                                            << "מקוד מיון"
                                            << "1 Or 1=1";
        QTest::newRow("a second statement") << ""
                                            << "5; DELETE FROM Items"
                                            << "עד קוד מיון"
                                            << "5; DELETE FROM Items";
    }
    void refusesASortBoundThatIsNotAWholeNumber()
    {
        QFETCH(QString, fromSort);
        QFETCH(QString, toSort);
        QFETCH(QString, field);
        QFETCH(QString, offending);
        CatalogSettings settings;
        settings.sortCodeRange = true;
        settings.sortCodeFrom = fromSort;
        settings.sortCodeTo = toSort;
        const auto built = BuildSourceDBCriteria(settings);
        QVERIFY(!built);
        QVERIFY2(built.status().description().contains(QLatin1Char('"') + field + QLatin1Char('"')),
                 qPrintable(built.status().description()));
        QVERIFY(built.status().description().contains(QLatin1Char('"') + offending + QLatin1Char('"')));
        // The same text with the box off is not looked at.
        settings.sortCodeRange = false;
        QVERIFY(BuildSourceDBCriteria(settings));
    }

    void doublesApostrophesInQuotedTexts()
    {
        CatalogSettings settings;
        settings.cutOffFilter = true;
        setCutOff(settings, {QStringLiteral("'")});
        settings.itemKeyRange = true;
        settings.itemKeyFrom = QStringLiteral("O'Brien");
        settings.itemKeyTo = QStringLiteral("x' Or '1'='1");
        QCOMPARE(criteria(settings),
                 Fixed + QStringLiteral(" And Items.Filter Like '''_________' And Items.ItemKey >= "
                                        "'O''Brien' And Items.ItemKey <= 'x'' Or ''1''=''1'"));
    }

    // On a real database, a bound that tries to widen the query selects only what its own
    // condition allows.
    void aQuotedBoundCannotWidenTheQuery()
    {
        QTemporaryDir folder;
        const QString path = folder.filePath(QStringLiteral("accounting.db"));
        QVERIFY(makeAccountingFile(
            path, {QStringLiteral("INSERT INTO Items (ItemKey) VALUES ('A1'), ('B2'), ('C3'), "
                                  "('x'' Or ''1''=''1'), ('#')")}));
        CatalogSettings settings;
        settings.itemKeyRange = true;
        settings.itemKeyFrom = QStringLiteral("x' Or '1'='1");
        settings.itemKeyTo = QStringLiteral("x' Or '1'='1");
        auto source = SourceConnection::open(BuildConnString(fileConnection(path)));
        QVERIFY2(source, qPrintable(source.status().description()));
        auto rows = source.value()->select(
            QStringLiteral("SELECT Items.ItemKey FROM Items WHERE Not (ItemKey Is Null)") +
            criteria(settings));
        QVERIFY2(rows, qPrintable(rows.status().description()));
        QStringList keys;
        while (rows->next())
            keys << rows->value(0).toString();
        QCOMPARE(keys, QStringList{QStringLiteral("x' Or '1'='1")});
    }
};

ZORBIN_TEST_CLASS(CriteriaTest)
#include "CriteriaTest.moc"
