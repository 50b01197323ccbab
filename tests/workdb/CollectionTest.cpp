#include "model/CatalogSettings.h"
#include "model/RunContext.h"
#include "model/RunState.h"
#include "source/ConnectionString.h"
#include "source/SourceConnection.h"
#include "testutil/AccountingFixture.h"
#include "testutil/CaseTable.h"
#include "testutil/FaultyFileSystem.h"
#include "testutil/RecordingUserPort.h"
#include "testutil/TestFiles.h"
#include "testutil/TestMain.h"
#include "testutil/WorkDatabaseFixture.h"
#include "workdb/CollectionLock.h"
#include "workdb/CollectionRun.h"
#include "workdb/SourceReadAhead.h"
#include "workdb/SourceRowCount.h"
#include "workdb/WorkDatabasePath.h"

#include <QTemporaryDir>

using namespace zorbin;
using namespace zorbin::test;
using namespace Qt::Literals::StringLiterals;

namespace {

// The small accounting database of small-source.sql and the working tables a collection makes
// of it, small-collected.txt.
QString testData(const char *name)
{
    return QString::fromUtf8(
        readFile(QStringLiteral(ZORBIN_SOURCE_DIR "/tests/workdb/data/") + QLatin1String(name)));
}

// Sources whose item step fails ("; " between statements, %1 a text of 100 Hebrew letters; no
// source: a database that cannot be reached), and the keys written before the failure. Reading
// fails after some rows: the SQLite ODBC driver reads them all ahead, and fails when the statement
// runs. A text too long: characters, not bytes, count (Hebrew letters take two bytes each).
const struct FailedItemStep
{
    const char *name, *source, *failure, *written;
    int fillWidth;
} FailedItemSteps[] = {
    {"a text too long",
     "INSERT INTO Items (ItemKey, ItemName) VALUES ('K1','a'),('K2','b'),('K3','c'),('K4','d'),('K5','%1'),"
     "('K6','%1x'),('K7','g')",
     "פריט K6: הטקסט ארוך מדי לשדה ItemName, שמקבל עד 100 תווים.", "K1 K2 K3 K4 K5", 714},
    {"reading fails after some rows",
     "ALTER TABLE Items RENAME TO ItemRows; INSERT INTO ItemRows (ItemKey, SortGroup) VALUES ('K1',1),('K2',2),"
     "('K3',3),('K4',4),('K5',5),('K6',6),('K7',7); CREATE VIEW Items AS SELECT ItemKey, ItemName, ForignName, "
     "Filter, SalesUnit, Price, Currency, ExFile, abs(CASE WHEN SortGroup = 6 THEN -9223372036854775807 - 1 ELSE "
     "SortGroup END) AS SortGroup FROM ItemRows",
     "integer overflow", "K1 K2 K3 K4 K5", 714},
    {"a sort bound that is not a number", "", "מקוד מיון", "", 0},
    {"pictures from a note not chosen", "", "נתון נוסף", "", 0},
    {"an unreachable source", nullptr, "", "", 0},
};

// Copies the first column's text.
const SourceReadAhead::Shaper KeyOnly = [](std::span<const QVariant> read, std::span<WorkValue> row) {
    row[0] = WorkValue::from(read[0]);
};

// Selects the entry of `itemData` in a list of the sales price and two others.
void choose(ChoiceList &list, int itemData)
{
    list.clear();
    for (const int number : {0, 1, 2})
        list.addEntry(QString::number(number), number);
    list.setCurrentIndex(itemData);
}

} // namespace

// The collection run against SQLite accounting databases, opened as a database file and
// through the real ODBC driver manager with the SQLite3 ODBC driver; and the reading of the
// source on a thread of its own, many batches ahead of the step that writes the rows.
class CollectionTest : public QObject
{
    Q_OBJECT

private:
    QTemporaryDir m_temp;
    QString m_smallSource;
    QString m_manyRows; // 10,000 items, K00001 to K10000, each its number as sort group
    bool m_odbc = false;
    std::unique_ptr<CatalogSettings> m_settings;
    ConnectionParams m_connection;
    RunState m_state;
    RecordingUserPort m_user;
    FaultyFileSystem m_files;
    std::unique_ptr<RunContext> m_context;

    ConnectionParams connectionTo(const QString &path) const
    {
        return m_odbc ? odbcConnection(path) : fileConnection(path);
    }
    QString makeSource(const QString &name, const QStringList &statements)
    {
        if (const Status made = makeAccountingFile(m_temp.filePath(name), statements); !made)
            qWarning("%s", qPrintable(made.description()));
        return m_temp.filePath(name);
    }
    void collectPrice(int digit, int list)
    {
        (digit == 1 ? m_settings->collectPrice1 : m_settings->collectPrice2) = true;
        choose(digit == 1 ? m_settings->priceList1 : m_settings->priceList2, list);
    }
    Result<CollectionReport> collect() { return BuildAndCollectData(*m_context); }
    // A collection that starts and runs every step.
    void collectAll()
    {
        const Result<CollectionReport> report = collect();
        QVERIFY2(report, qPrintable(report.status().description()));
        QVERIFY2(report->stepFailure, qPrintable(report->stepFailure.description()));
    }
    // A collection that starts and ends early at a failed step: that step's failure.
    Status failedStep()
    {
        const Result<CollectionReport> report = collect();
        return report ? report->stepFailure : Status::fault(u"escaped: "_s + report.status().description());
    }
    // The rows of a working table, "|" between values, a Null as "<null>".
    QStringList rows(const QString &table) const
    {
        QStringList described;
        for (const QVariantList &row : readWorkTable(m_state.WorkDBFile, table)) {
            QStringList cells;
            for (const QVariant &value : row)
                cells << (value.isNull() ? u"<null>"_s : value.toString());
            described << cells.join(QLatin1Char('|'));
        }
        return described;
    }
    // One column of a working table (the key by default), its values separated by blanks.
    QString keys(const QString &table, int column = 0) const
    {
        QStringList found = rows(table);
        for (QString &row : found)
            row = row.section(u'|', column, column);
        return found.join(u' ');
    }

private Q_SLOTS:
    void initTestCase_data()
    {
        QTest::addColumn<bool>("odbc");
        QTest::newRow("database file") << false;
        QTest::newRow("ODBC") << true;
    }
    void initTestCase()
    {
        QVERIFY(m_temp.isValid());
        QVERIFY2(qEnvironmentVariableIsSet("ODBCSYSINI"),
                 "run through ctest, which registers the ODBC driver");
        qputenv("TMPDIR", QFile::encodeName(m_temp.path())); // the working database's folder
        m_smallSource = makeSource(u"small.db"_s, testData("small-source.sql").split(u";\n"_s));
        m_manyRows = makeSource(u"many.db"_s,
                                {u"INSERT INTO Items (ItemKey, SortGroup) WITH RECURSIVE n(i) AS (SELECT "
                                 "1 UNION ALL SELECT i + 1 FROM n WHERE i < 10000) SELECT "
                                 "printf('K%05d', i), i FROM n"_s});
    }
    void init()
    {
        QFETCH_GLOBAL(bool, odbc);
        m_odbc = odbc;
        m_settings = std::make_unique<CatalogSettings>();
        m_settings->pictureSource = PictureSource::FileField;
        m_settings->itemName = ItemNameSource::Standard;
        m_connection = connectionTo(m_smallSource);
        m_state = RunState();
        m_user = RecordingUserPort();
        m_context =
            std::make_unique<RunContext>(RunContext{*m_settings, m_connection, m_state, m_user, m_files});
    }

    void copiesItemsSortGroupsPricesAndNotes()
    {
        collectPrice(1, 1);
        collectPrice(2, 2);
        m_settings->collectNote1 = m_settings->collectNote2 = true;
        choose(m_settings->extraNote1, 1);
        choose(m_settings->extraNote2, 2);
        collectAll();
        QCOMPARE(m_state.WorkDBFile, workDatabasePath());
        QCOMPARE(m_user.statuses,
                 QStringList({u"מאתחל בסיס נתונים זמני"_s, u"סורק את רשימת הפריטים"_s, u"סורק קודי מיון"_s,
                              u"סורק מחירון ראשי"_s, u"סורק מחירון משני"_s, u"סורק נתון נוסף 1"_s,
                              u"סורק נתון נוסף 2"_s, u"סריקת הנתונים הסתיימה"_s}));
        QStringList tables;
        for (const QString &table :
             u"tItems tItemPrice1 tItemPrice2 tExtraNote1 tExtraNote2 tItemSort"_s.split(u' '))
            tables << table << rows(table);
        QStringList expected = testData("small-collected.txt").split(u'\n', Qt::SkipEmptyParts);
        expected.removeIf([](const QString &line) { return line.startsWith(u'#'); });
        QCOMPARE(tables, expected);
        QVERIFY(m_user.messages.isEmpty());
        // Twelve items selected (the empty key and both duplicates count): points at 5 and 10; the
        // bar empty at the start and the end of each step that has rows and polls.
        QCOMPARE(m_user.widths, QList<int>({0, 417, 833, 0, 0, 0, 0, 0, 0, 0, 0, 0}));
        QCOMPARE(m_user.yields, 2);
    }

    // Stop pressed while row 7 is copied: the loop sees it at row 10. The request stays: the
    // sort groups are copied whole (no stop test), a price list stops at its first point.
    void stopEndsTheStepAtTheNextProgressPoint()
    {
        m_user.onYield = [this] {
            if (m_user.yields == 2)
                m_state.StopRequested = true;
        };
        collectPrice(1, 1);
        const Result<CollectionReport> report = collect();
        QVERIFY(report && report->stepFailure && report->stopped);
        QCOMPARE(keys(u"tItems"_s), u"A100 a200 ab B300 C400 D500 E600"_s);
        QCOMPARE(m_user.widths.mid(0, 4), QList<int>({0, 417, 833, 0}));
        QCOMPARE(rows(u"tItemSort"_s).size(), 4);
        QCOMPARE(keys(u"tItemPrice1"_s), u"A100 a200"_s);
        QCOMPARE(m_user.statuses.last(), u"סריקת הנתונים הסתיימה"_s);
    }

    // The folder, a separator unless it ends in one, the key and the extension.
    void picturesNamedByKey_data()
    {
        QTest::addColumn<QString>("folder");
        for (const char *folder : {"/photos", "/photos/", ""})
            QTest::newRow(folder) << QString::fromUtf8(folder);
    }
    void picturesNamedByKey()
    {
        QFETCH(QString, folder);
        m_settings->pictureSource = PictureSource::ItemKey;
        m_settings->pictureFolder = folder;
        m_settings->pictureExtension = u".JPG"_s;
        collectAll();
        QCOMPARE(keys(u"tItems"_s, 7).section(u' ', 2, 2),
                 folder.isEmpty() ? u"/A100.JPG"_s : u"/photos/A100.JPG"_s);
    }

    // Pictures from an extra note leave out the items without one; foreign names.
    void picturesFromAnExtraNoteAndForeignNames()
    {
        m_settings->pictureSource = PictureSource::ExtraNote;
        choose(m_settings->pictureNote, 2);
        m_settings->itemName = ItemNameSource::Foreign;
        collectAll();
        QCOMPARE(rows(u"tItems"_s), QStringList({u"ab|?|2|BX|סט|3|$|/pics/note-ab.png|-1"_s,
                                                 u"C400|?|6|<null>|סט|7|ש\"ח|/pics/note-c.png|-1"_s}));
        m_settings->pictureSource = PictureSource::FileField;
        collectAll();
        QCOMPARE(keys(u"tItems"_s, 1), u"? ? Oak chair Lamp ? ? ? ? ?"_s);
    }

    // A failure of the item step ends the run there; what was written before it stays, and the
    // bar keeps its last width.
    void aFailedItemStepEndsTheRun_data() { addCaseRows(FailedItemSteps); }
    void aFailedItemStepEndsTheRun()
    {
        const FailedItemStep &c = fetchCase(FailedItemSteps);
        const QByteArray name = c.name;
        const QString source = QString::fromUtf8(c.source).replace(u"%1"_s, QString(100, QChar(0x05E9)));
        m_connection = connectionTo(c.source ? makeSource(u"failing.db"_s, source.split(u"; "_s))
                                             : m_temp.filePath(u"missing/nothing.db"_s));
        m_settings->sortCodeRange = name.contains("sort bound");
        m_settings->sortCodeFrom = u"x"_s;
        if (name.contains("note"))
            m_settings->pictureSource = PictureSource::ExtraNote;
        collectPrice(1, 1);
        const Status failure = failedStep();
        QVERIFY2(!failure && failure.description().contains(QString::fromUtf8(c.failure)),
                 qPrintable(failure.description()));
        QCOMPARE(m_user.statuses.last(), u"סורק את רשימת הפריטים"_s);
        const bool readAhead = m_odbc && name.startsWith("reading");
        QCOMPARE(keys(u"tItems"_s), readAhead ? QString() : QString::fromUtf8(c.written));
        QCOMPARE(m_user.fillWidth, readAhead ? 0 : c.fillWidth);
        QCOMPARE(keys(u"tItemSort"_s), QString());
    }

    // A list to collect without an entry chosen ends the run before its step.
    void aChosenListWithoutSelectionEndsTheRun()
    {
        collectPrice(1, 1);
        m_settings->collectNote1 = true;
        const Result<CollectionReport> collected = collect();
        QVERIFY(!collected && collected.status().description().contains(u"נתון נוסף 1"_s));
        QCOMPARE(m_user.statuses.last(), u"סורק נתון נוסף 1"_s);
        QCOMPARE(rows(u"tItems"_s).size(), 9);
        QCOMPARE(keys(u"tItemPrice1"_s), u"A100 a200"_s);
    }

    // Only the ticked lists are collected; a second run leaves nothing of the first (not even a
    // journal, which would be played back), and its item range holds for the prices too.
    void aSecondRunLeavesNothingOfTheFirst()
    {
        collectPrice(1, 1);
        choose(m_settings->priceList2, 2);
        collectAll();
        QVERIFY(!m_user.statuses.contains(u"סורק מחירון משני"_s));
        QCOMPARE(keys(u"tItemPrice1"_s), u"A100 a200"_s);
        QCOMPARE(keys(u"tItemPrice2"_s), QString());

        writeFile(workDatabasePath() + u"-journal"_s, QByteArray(512, 'j'));
        m_user.statuses.clear();
        m_settings->collectPrice1 = false;
        collectPrice(2, 2);
        m_settings->itemKeyRange = true;
        m_settings->itemKeyFrom = u"B"_s;
        m_settings->itemKeyTo = u"E"_s;
        collectAll();
        QVERIFY(!m_user.statuses.contains(u"סורק מחירון ראשי"_s));
        QCOMPARE(keys(u"tItems"_s), u"B300 C400 D500"_s);
        QCOMPARE(keys(u"tItemPrice1"_s), QString());
        QCOMPARE(keys(u"tItemPrice2"_s), u"D500"_s);
        QCOMPARE(rows(u"tItemSort"_s).size(), 4);
        QVERIFY(!QFile::exists(workDatabasePath() + u"-journal"_s));
    }

    void anEmptySelectionWritesNothingAndLeavesTheBar()
    {
        m_settings->itemKeyRange = true;
        m_settings->itemKeyFrom = u"תת"_s;
        m_user.fillWidth = 300;
        collectAll();
        QCOMPARE(keys(u"tItems"_s), QString());
        QVERIFY(m_user.widths.isEmpty());
        QCOMPARE(m_user.fillWidth, 300);
    }

    // The last collection's file cannot be deleted (another program holds it open).
    void aWorkingDatabaseThatCannotBeMadeEndsTheCollection()
    {
        collectAll();
        m_files.failingPaths = {workDatabasePath()};
        const Result<CollectionReport> collected = collect();
        m_files.failingPaths.clear();
        QVERIFY(!collected && collected.status().description().contains(workDatabasePath()));
        QCOMPARE(m_state.WorkDBFile, QString());
        QCOMPARE(m_user.statuses.last(), u"מאתחל בסיס נתונים זמני"_s);
    }

    void aSecondCollectionIsRefusedWhileOneRuns()
    {
        Result<std::unique_ptr<CollectionLock>> held = CollectionLock::acquire(workDatabasePath());
        QVERIFY(held);
        m_state.WorkDBFile = u"earlier"_s;
        const Result<CollectionReport> refused = collect();
        QVERIFY(!refused && refused.status().description().contains(u"איסוף נתונים אחר כבר פועל"_s));
        QCOMPARE(m_state.WorkDBFile, u"earlier"_s);
        QVERIFY(m_user.statuses.isEmpty());
        held.value().reset();
        collectAll();
        QCOMPARE(m_state.WorkDBFile, workDatabasePath());
    }

    void readsEveryRowInOrderAndCountsThem()
    {
        SourceReadAhead source(BuildConnString(connectionTo(m_manyRows)),
                               u"SELECT ItemKey FROM Items WHERE SortGroup > 100"_s, {u"itemkey"_s}, true, 1,
                               KeyOnly);
        QVERIFY(source.waitUntilRunning());
        QCOMPARE(source.total(), 9900);
        int rows = 0;
        while (source.next()) {
            ++rows;
            QCOMPARE(source.row()[0].toText(), u"K%1"_s.arg(100 + rows, 5, 10, QLatin1Char('0')));
        }
        QCOMPARE(rows, 9900);
        QVERIFY(source.readFailure());
    }

    // Far more rows than are held ahead: the reader waits for room until it is stopped.
    void stoppingEarlyReleasesTheReader()
    {
        SourceReadAhead source(BuildConnString(connectionTo(m_manyRows)), u"SELECT ItemKey FROM Items"_s,
                               {u"ItemKey"_s}, false, 1, KeyOnly);
        QVERIFY(source.waitUntilRunning());
        QCOMPARE(source.total(), 0);
        for (int i = 0; i < 7; ++i)
            QVERIFY(source.next());
        QCOMPARE(source.row()[0].toText(), u"K00007"_s);
    }

    // A trailing comment would swallow the closing parenthesis of the count: the rows are counted
    // instead.
    void countsAStatementTheDatabaseCannotNest()
    {
        Result<std::unique_ptr<SourceConnection>> source =
            SourceConnection::open(BuildConnString(connectionTo(m_manyRows)));
        QVERIFY(source);
        for (const QString &comment : {QString(), u" -- the first"_s})
            QCOMPARE(countSourceRows(*source.value(),
                                     u"SELECT ItemKey FROM Items WHERE SortGroup <= 42"_s + comment),
                     42);
        QCOMPARE(countSourceRows(*source.value(), u"SELECT Nothing FROM Nowhere"_s), 0);
    }
};

ZORBIN_TEST_CLASS(CollectionTest)
#include "CollectionTest.moc"
