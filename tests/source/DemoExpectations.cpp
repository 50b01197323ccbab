#include "DemoExpectations.h"

#include "dialogs/LogonForm.h"
#include "model/CatalogSettings.h"
#include "source/ChoiceLists.h"
#include "source/ConnectionString.h"
#include "source/SourceConnection.h"
#include "source/SourceCriteria.h"
#include "testutil/MemorySettingsStore.h"

#include <QTest>

namespace zorbin::test {

Entries entriesOf(const ChoiceList &list)
{
    Entries entries;
    for (const auto &entry : list.entries())
        entries << qMakePair(entry.text, int(entry.itemData));
    return entries;
}

Entries demoNoteEntries()
{
    return {{QStringLiteral("צבע"), 1},
            {QStringLiteral("חומר"), 2},
            {QStringLiteral("תמונה נוספת"), 3},
            {QStringLiteral("ארץ ייצור"), 7}};
}

Entries demoPriceListEntries()
{
    return {{QStringLiteral("מחיר מכירה"), 0},
            {QStringLiteral("מחירון סיטונאי"), 1},
            {QStringLiteral("מחירון קמעונאי"), 2},
            {QStringLiteral("Export prices"), 3},
            {QStringLiteral("מבצע חורף"), 6}};
}

int demoSelectedItemRows()
{
    return 300 + 2; // the generated items, the second row of A0008 and Z9999
}

void checkListsFillFromDemo(const ConnectionParams &params)
{
    CatalogSettings settings;
    FillCmbExtraNote(params, settings);
    FillCmbPriceField(params, settings);
    QCOMPARE(entriesOf(settings.pictureNote), demoNoteEntries());
    QCOMPARE(entriesOf(settings.extraNote1), demoNoteEntries());
    QCOMPARE(entriesOf(settings.extraNote2), demoNoteEntries());
    QCOMPARE(entriesOf(settings.priceList1), demoPriceListEntries());
    QCOMPARE(entriesOf(settings.priceList2), demoPriceListEntries());
}

void checkLogonTestSucceeds(const ConnectionParams &params)
{
    LogonForm form;
    form.Form_Load(params);
    const Status outcome = form.CmdCheck_Click();
    QVERIFY2(outcome, qPrintable(outcome.description()));
    QCOMPARE(form.LblMsg, LogonForm::TestSucceededText);
}

void checkItemQueryReadsDemo(const ConnectionParams &params)
{
    CatalogSettings settings;
    const auto criteria = BuildSourceDBCriteria(settings);
    QVERIFY(criteria);
    auto source = SourceConnection::open(BuildConnString(params));
    QVERIFY2(source, qPrintable(source.status().description()));
    auto items = source.value()->select(
        QStringLiteral(
            "SELECT Items.ItemKey, Items.SortGroup, Items.Filter, Items.SalesUnit, Items.Price, "
            "Items.Currency, Items.ItemName As ItemDesc, Items.ExFile As PicFile FROM Items WHERE Not "
            "(ItemKey Is Null)") +
        criteria.value());
    QVERIFY2(items, qPrintable(items.status().description()));
    int rows = 0;
    bool sawHebrew = false;
    bool sawNullName = false;
    while (items->next()) {
        ++rows;
        const QString key = items->value(QStringLiteral("ItemKey")).toString();
        QVERIFY(key != QLatin1String("#") && key != QLatin1String("*"));
        if (key == QLatin1String("C0002")) {
            sawHebrew = true;
            QCOMPARE(items->value(QStringLiteral("ItemDesc")).toString(), QStringLiteral("מנורה עץ אלון 12"));
            QCOMPARE(items->value(QStringLiteral("SalesUnit")).toString(), QStringLiteral("מטר"));
            QCOMPARE(items->value(QStringLiteral("Price")).toDouble(), 84.4);
        }
        if (key == QLatin1String("F0053"))
            sawNullName = items->value(QStringLiteral("ItemDesc")).isNull();
    }
    QCOMPARE(rows, demoSelectedItemRows());
    QVERIFY(sawHebrew);
    QVERIFY(sawNullName);
}

} // namespace zorbin::test
