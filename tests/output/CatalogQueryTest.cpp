// The catalog statement: which columns each cell line adds, the order, the filters.
#include "output/CatalogQuery.h"

#include "model/CatalogSettings.h"
#include "testutil/TestMain.h"

#include <QTest>

using namespace zorbin;

class CatalogQueryTest : public QObject
{
    Q_OBJECT

private:
    static void setTags(CatalogSettings &settings, const QStringList &tags)
    {
        for (int i = 0; i < tags.size(); ++i)
            settings.lines[static_cast<std::size_t>(i)].field = fieldOfTag(tags.at(i));
    }
    static void fillPriceLists(CatalogSettings &settings)
    {
        for (ChoiceList *list : {&settings.priceList1, &settings.priceList2}) {
            list->addEntry(QStringLiteral("מחיר מכירה"), 0);
            list->addEntry(QStringLiteral("מחירון סיטונאי"), 7);
        }
    }

private Q_SLOTS:
    void selectList_data()
    {
        QTest::addColumn<QStringList>("tags");
        QTest::addColumn<int>("priceList");
        QTest::addColumn<QString>("expected");
        const QString fixed = QStringLiteral("SELECT tItems.ItemKey, tItems.ItemName, tItems.ItemSort");
        const QString from = QStringLiteral(" FROM tItems");
        QTest::newRow("no lines") << QStringList{} << 0 << fixed + from;
        QTest::newRow("key and name add nothing")
            << QStringList{QStringLiteral("1"), QString(), QStringLiteral("2")} << 0 << fixed + from;
        QTest::newRow("out of range adds nothing")
            << QStringList{QStringLiteral("9"), QStringLiteral("-1")} << 0 << fixed + from;
        QTest::newRow("line order, not tag order")
            << QStringList{QStringLiteral("6"), QString(), QString(), QString(), QStringLiteral("0")} << 0
            << fixed + QStringLiteral(", tItems.Unit, tItems.ItemPic") + from;
        QTest::newRow("sort name")
            << QStringList{QStringLiteral("3")} << 0
            << fixed +
                   QStringLiteral(
                       ", (Select SortName From tItemSort Where tItemSort.ItemSort = tItems.ItemSort) As SortName") +
                   from;
        QTest::newRow("own price for both")
            << QStringList{QStringLiteral("4"), QStringLiteral("5")} << 0
            << fixed +
                   QStringLiteral(
                       ", tItems.SellPrice As Price1, tItems.SellCoin As Coin1, tItems.SellPrice As "
                       "Price2, tItems.SellCoin As Coin2") +
                   from;
        QTest::newRow("price lists")
            << QStringList{QStringLiteral("5"), QStringLiteral("4")} << 1
            << fixed +
                   QStringLiteral(
                       ", (Select Price From tItemPrice2 Where tItemPrice2.ItemKey = tItems.ItemKey) As "
                       "Price2, (Select Coin From tItemPrice2 Where tItemPrice2.ItemKey = "
                       "tItems.ItemKey) As Coin2, (Select Price From tItemPrice1 Where "
                       "tItemPrice1.ItemKey = tItems.ItemKey) As Price1, (Select Coin From "
                       "tItemPrice1 Where tItemPrice1.ItemKey = tItems.ItemKey) As Coin1") +
                   from;
        QTest::newRow("no price list selected reads the price table")
            << QStringList{QStringLiteral("4")} << -1
            << fixed +
                   QStringLiteral(
                       ", (Select Price From tItemPrice1 Where tItemPrice1.ItemKey = tItems.ItemKey) As "
                       "Price1, (Select Coin From tItemPrice1 Where tItemPrice1.ItemKey = "
                       "tItems.ItemKey) As Coin1") +
                   from;
        QTest::newRow("extra notes")
            << QStringList{QStringLiteral("8"), QStringLiteral("7")} << 0
            << fixed +
                   QStringLiteral(
                       ", (Select ExtraNote From tExtraNote2 Where tExtraNote2.ItemKey = tItems.ItemKey) "
                       "As ExtraNote2, (Select ExtraNote From tExtraNote1 Where tExtraNote1.ItemKey = "
                       "tItems.ItemKey) As ExtraNote1") +
                   from;
        QTest::newRow("a field on two lines is selected once")
            << QStringList{QStringLiteral("6"), QStringLiteral("0"), QStringLiteral("6")} << 0
            << fixed + QStringLiteral(", tItems.Unit, tItems.ItemPic") + from;
        QTest::newRow("blanks around a tag")
            << QStringList{QStringLiteral(" 6 ")} << 0 << fixed + QStringLiteral(", tItems.Unit") + from;
    }

    void selectList()
    {
        QFETCH(QStringList, tags);
        QFETCH(int, priceList);
        QFETCH(QString, expected);
        CatalogSettings settings;
        fillPriceLists(settings);
        QVERIFY(settings.priceList1.setCurrentIndex(priceList));
        QVERIFY(settings.priceList2.setCurrentIndex(priceList));
        setTags(settings, tags);
        QCOMPARE(BuildSelect(settings), expected);
    }

    void orderBy_data()
    {
        QTest::addColumn<int>("field");
        QTest::addColumn<int>("direction");
        QTest::addColumn<QString>("expected");
        QTest::newRow("key ascending") << 0 << 0 << QStringLiteral(" ORDER BY tItems.ItemKey ASC");
        QTest::newRow("name descending") << 1 << 1 << QStringLiteral(" ORDER BY tItems.ItemName DESC");
        QTest::newRow("sort code ascending") << 2 << 0 << QStringLiteral(" ORDER BY tItems.ItemSort ASC");
        QTest::newRow("no direction keeps the blank")
            << 2 << -1 << QStringLiteral(" ORDER BY tItems.ItemSort ");
        QTest::newRow("no field sorts by key") << -1 << 1 << QStringLiteral(" ORDER BY tItems.ItemKey DESC");
    }

    void orderBy()
    {
        QFETCH(int, field);
        QFETCH(int, direction);
        QFETCH(QString, expected);
        CatalogSettings settings;
        settings.sortKey = field < 0 ? std::nullopt : std::optional(static_cast<SortKey>(field));
        settings.sortDirection =
            direction < 0 ? std::nullopt : std::optional(static_cast<SortDirection>(direction));
        QCOMPARE(BuildOrderBy(settings), expected);
    }

    void finalStatement_data()
    {
        QTest::addColumn<bool>("onlyWithPicture");
        QTest::addColumn<QString>("expected");
        QTest::newRow("only items with a picture")
            << true
            << QStringLiteral(
                   "SELECT tItems.ItemKey, tItems.ItemName, tItems.ItemSort, tItems.ItemPic, "
                   "tItems.SellPrice As Price1, tItems.SellCoin As Coin1 FROM tItems WHERE "
                   "tItems.Include = True And tItems.ItemPic <> '?' And Not tItems.ItemPic Is Null "
                   "ORDER BY tItems.ItemName DESC");
        QTest::newRow("every item")
            << false
            << QStringLiteral("SELECT tItems.ItemKey, tItems.ItemName, tItems.ItemSort, tItems.ItemPic, "
                              "tItems.SellPrice As Price1, tItems.SellCoin As Coin1 FROM tItems WHERE "
                              "tItems.Include = True ORDER BY tItems.ItemName DESC");
    }

    void finalStatement()
    {
        QFETCH(bool, onlyWithPicture);
        QFETCH(QString, expected);
        CatalogSettings settings;
        fillPriceLists(settings);
        QVERIFY(settings.priceList1.setCurrentIndex(0));
        setTags(settings,
                {QStringLiteral("0"), QStringLiteral("2"), QStringLiteral("1"), QStringLiteral("4")});
        settings.onlyWithPicture = onlyWithPicture;
        settings.sortKey = SortKey::ItemName;
        settings.sortDirection = SortDirection::Descending;
        QCOMPARE(BuildFinalSQL(settings), expected);
    }
};

ZORBIN_TEST_CLASS(CatalogQueryTest)
#include "CatalogQueryTest.moc"
