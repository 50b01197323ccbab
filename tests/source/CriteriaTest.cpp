#include "model/CatalogSettings.h"
#include "source/ConnectionString.h"
#include "source/SourceConnection.h"
#include "source/SourceCriteria.h"
#include "testutil/AccountingFixture.h"
#include "testutil/CaseTable.h"
#include "testutil/TestMain.h"

using namespace zorbin;
using namespace zorbin::test;
using namespace Qt::Literals::StringLiterals;

namespace {

// The item-range boxes of the settings page (the filter positions separated by "|", the rest
// "*") and the conditions they add after " And Items.ItemKey <> '#' And Items.ItemKey <> '*'".
const struct Range
{
    const char *name;
    bool sortRange;
    const char *sortFrom, *sortTo;
    bool filter;
    const char *positions;
    bool keyRange;
    const char *keyFrom, *keyTo, *added;
} Ranges[] = {
    {"nothing ticked", false, "10", "20", false, "A", false, "100", "200", ""},
    {"all three in their order", true, "10", "20", true, "A|*|B", true, "100", "",
     " And Items.SortGroup >= 10 And Items.SortGroup <= 20 And Items.Filter Like 'A_B_______' And "
     "Items.ItemKey >= '100'"},
    {"upper sort bound only", true, "", "7", false, "", false, "", "", " And Items.SortGroup <= 7"},
    {"sort bounds trimmed", true, "   ", " 8 ", false, "", false, "", "", " And Items.SortGroup <= 8"},
    {"signed sort bounds", true, "-3", "+4", false, "", false, "", "",
     " And Items.SortGroup >= -3 And Items.SortGroup <= +4"},
    {"all positions *", false, "", "", true, "", false, "", "", ""},
    {"all positions empty", false, "", "", true, "|||||||||", false, "", "", ""},
    {"the last position", false, "", "", true, "*|*|*|*|*|*|*|*|*|Z", false, "", "",
     " And Items.Filter Like '_________Z'"},
    {"blanks around a position", false, "", "", true, " A ", false, "", "",
     " And Items.Filter Like 'A_________'"},
    {"a box of two characters", false, "", "", true, "AB|C", false, "", "",
     " And Items.Filter Like 'ABC________'"},
    {"an apostrophe in a position", false, "", "", true, "'", false, "", "",
     " And Items.Filter Like '''_________'"},
    {"upper key bound only", false, "", "", false, "", true, "", "Z9", " And Items.ItemKey <= 'Z9'"},
    {"key bounds trimmed", false, "", "", false, "", true, " A1 ", " B2 ",
     " And Items.ItemKey >= 'A1' And Items.ItemKey <= 'B2'"},
    {"key bound of blanks", false, "", "", false, "", true, "  ", "", ""},
    {"apostrophes in key bounds", false, "", "", false, "", true, "O'Brien", "x' Or '1'='1",
     " And Items.ItemKey >= 'O''Brien' And Items.ItemKey <= 'x'' Or ''1''=''1'"},
};

// A sort-group bound goes into the query without quotes, so anything but a whole number is
// refused before a query is sent, with the field named.
const struct Refusal
{
    const char *name, *from, *to, *named;
} Refusals[] = {
    {"letters", "abc", "", "\"מקוד מיון\" של טווח קודי המיון כתוב \"abc\""},
    {"fraction", "1", "2.5", "\"עד קוד מיון\" של טווח קודי המיון כתוב \"2.5\""},
    {"a second statement", "", "5; DELETE FROM Items", "כתוב \"5; DELETE FROM Items\""},
};

Result<QString> criteriaOf(const Range &range)
{
    CatalogSettings settings;
    settings.sortCodeRange = range.sortRange;
    settings.sortCodeFrom = QString::fromUtf8(range.sortFrom);
    settings.sortCodeTo = QString::fromUtf8(range.sortTo);
    settings.cutOffFilter = range.filter;
    const QStringList positions = QString::fromUtf8(range.positions).split(u'|');
    for (int i = 0; i < CutOffPositions; ++i)
        settings.cutOff[std::size_t(i)] = i < positions.size() ? positions.at(i) : u"*"_s;
    settings.itemKeyRange = range.keyRange;
    settings.itemKeyFrom = QString::fromUtf8(range.keyFrom);
    settings.itemKeyTo = QString::fromUtf8(range.keyTo);
    return BuildSourceDBCriteria(settings);
}

} // namespace

// The conditions of the settings page's item range on the accounting database's query.
class CriteriaTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void buildsTheConditions_data() { addCaseRows(Ranges); }
    void buildsTheConditions()
    {
        const Range &range = fetchCase(Ranges);
        const Result<QString> built = criteriaOf(range);
        QVERIFY2(built, qPrintable(built.status().description()));
        QCOMPARE(built.value(),
                 u" And Items.ItemKey <> '#' And Items.ItemKey <> '*'"_s + QString::fromUtf8(range.added));
    }

    void refusesASortBoundThatIsNotAWholeNumber_data() { addCaseRows(Refusals); }
    void refusesASortBoundThatIsNotAWholeNumber()
    {
        const Refusal &refusal = fetchCase(Refusals);
        Range range = {"", true, refusal.from, refusal.to, false, "", false, "", "", ""};
        const Result<QString> built = criteriaOf(range);
        QVERIFY(!built);
        QVERIFY2(built.status().description().contains(QString::fromUtf8(refusal.named)),
                 qPrintable(built.status().description()));
        range.sortRange = false; // the box off: the text is not read
        QVERIFY(criteriaOf(range));
    }
};

ZORBIN_TEST_CLASS(CriteriaTest)
#include "CriteriaTest.moc"
