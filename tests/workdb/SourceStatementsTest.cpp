#include "workdb/SourceStatements.h"

#include "model/CatalogSettings.h"
#include "testutil/TestMain.h"

#include <QTest>

using namespace zorbin;

namespace {

const QString NoRange = QStringLiteral(" And Items.ItemKey <> '#' And Items.ItemKey <> '*'");

} // namespace

// The statements reach the accounting database exactly as written here.
class SourceStatementsTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void itemStatement_data()
    {
        QTest::addColumn<int>("pictureSource");
        QTest::addColumn<int>("nameType");
        QTest::addColumn<QString>("expected");
        const QString head = QStringLiteral(
            "SELECT Items.ItemKey, Items.SortGroup, Items.Filter, Items.SalesUnit, Items.Price, Items.Currency");
        QTest::newRow("picture by key, standard name")
            << 1 << 0
            << QStringLiteral(
                   "SELECT Items.ItemKey, Items.SortGroup, Items.Filter, Items.SalesUnit, Items.Price, Items.Currency, Items.ItemName As ItemDesc FROM Items WHERE Not (ItemKey Is Null) And Items.ItemKey <> '#' And Items.ItemKey <> '*'");
        QTest::newRow("file field, no name chosen")
            << 0 << -1
            << head +
                   QStringLiteral(
                       ", Items.ItemName As ItemDesc, Items.ExFile As PicFile FROM Items WHERE Not (ItemKey Is Null)") +
                   NoRange;
        QTest::newRow("file field, foreign name")
            << 0 << 1
            << head +
                   QStringLiteral(
                       ", Items.ForignName As ItemDesc, Items.ExFile As PicFile FROM Items WHERE Not (ItemKey Is Null)") +
                   NoRange;
        QTest::newRow("extra note -3, standard name")
            << 2 << 0
            << head +
                   QStringLiteral(
                       ", Items.ItemName As ItemDesc, ExtraNotes.Note As PicFile FROM Items, ExtraNotes WHERE Not (ItemKey Is Null) And ExtraNotes.ItemFlag = 1 And ExtraNotes.KeF = Items.ItemKey And ExtraNotes.NoteID = -3") +
                   NoRange;
    }
    void itemStatement()
    {
        QFETCH(int, pictureSource);
        QFETCH(int, nameType);
        QFETCH(QString, expected);
        CatalogSettings settings;
        settings.pictureSource = static_cast<PictureSource>(pictureSource);
        settings.itemName = static_cast<ItemNameSource>(nameType);
        settings.pictureNote.addEntry(QStringLiteral("תמונה"), -3);
        settings.pictureNote.setCurrentIndex(0);
        const Result<QString> statement = buildItemStatement(settings);
        QVERIFY(statement);
        QCOMPARE(statement.value(), expected);
    }

    void criteriaFollowEveryItemStatement()
    {
        CatalogSettings settings;
        settings.pictureSource = PictureSource::ItemKey;
        settings.sortCodeRange = true;
        settings.sortCodeFrom = QStringLiteral("10");
        settings.sortCodeTo = QStringLiteral("20");
        settings.cutOffFilter = true;
        settings.cutOff[0] = QStringLiteral("A");
        settings.cutOff[2] = QStringLiteral("B");
        settings.itemKeyRange = true;
        settings.itemKeyFrom = QStringLiteral("100");
        const QString criteria = QStringLiteral(
            " And Items.ItemKey <> '#' And Items.ItemKey <> '*' And Items.SortGroup >= 10 And Items.SortGroup <= 20 And Items.Filter Like 'A_B_______' And Items.ItemKey >= '100'");
        QVERIFY(buildItemStatement(settings).value().endsWith(QStringLiteral("WHERE Not (ItemKey Is Null)") +
                                                              criteria));
        QVERIFY(buildPriceStatement(settings, 1)
                    .value()
                    .endsWith(QStringLiteral("PriceListNumber = 1") + criteria));
        QVERIFY(
            buildExtraNoteStatement(settings, 1).value().endsWith(QStringLiteral("NoteID = 1") + criteria));
        QCOMPARE(
            buildSortGroupStatement(),
            QStringLiteral(
                "SELECT ItemSortCode, SortCodeName FROM ItemSortNames WHERE Not (ItemSortCode Is Null)"));
    }

    void priceAndNoteStatements()
    {
        CatalogSettings settings;
        QCOMPARE(
            buildPriceStatement(settings, 3).value(),
            QStringLiteral(
                "SELECT Items.ItemKey, PriceListsLastDateWithSub.Price, PriceListsLastDateWithSub.CurrencyCode FROM Items, PriceListsLastDateWithSub Where PriceListsLastDateWithSub.ItemKey = Items.ItemKey And PriceListsLastDateWithSub.PriceListNumber = 3 And Items.ItemKey <> '#' And Items.ItemKey <> '*'"));
        QCOMPARE(
            buildExtraNoteStatement(settings, 2).value(),
            QStringLiteral(
                "SELECT Items.ItemKey, ExtraNotes.Note FROM Items, ExtraNotes Where ExtraNotes.ItemFlag = 1 And ExtraNotes.KeF = Items.ItemKey And ExtraNotes.NoteID = 2 And Items.ItemKey <> '#' And Items.ItemKey <> '*'"));
        QVERIFY(buildPriceStatement(settings, 0).value().contains(QStringLiteral("PriceListNumber = 0 And")));
    }

    void faultsBeforeAnyStatementIsSent()
    {
        CatalogSettings settings;
        settings.pictureSource = PictureSource::ExtraNote;
        const Result<QString> noNote = buildItemStatement(settings);
        QVERIFY(!noNote);
        QVERIFY(noNote.status().description().contains(QStringLiteral("נתון נוסף")));

        settings.pictureSource = PictureSource::FileField;
        settings.sortCodeRange = true;
        settings.sortCodeFrom = QStringLiteral("1 or 1=1");
        QVERIFY(!buildItemStatement(settings));
        QVERIFY(!buildPriceStatement(settings, 1));
        QVERIFY(!buildExtraNoteStatement(settings, 1));
    }
};

ZORBIN_TEST_CLASS(SourceStatementsTest)
#include "SourceStatementsTest.moc"
