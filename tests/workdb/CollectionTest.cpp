#include "model/CatalogSettings.h"
#include "model/ConnectionParams.h"
#include "model/RunContext.h"
#include "model/RunState.h"
#include "platform/FileSystem.h"
#include "source/ConnectionString.h"
#include "source/SourceConnection.h"
#include "testutil/AccountingFixture.h"
#include "testutil/FaultyFileSystem.h"
#include "testutil/RecordingUserPort.h"
#include "testutil/SqliteOdbcDriver.h"
#include "testutil/TestMain.h"
#include "testutil/WorkDatabaseFixture.h"
#include "workdb/CollectionLock.h"
#include "workdb/CollectionRun.h"
#include "workdb/WorkDatabasePath.h"

#include <QTemporaryDir>
#include <QTest>

using namespace zorbin;
using namespace zorbin::test;

namespace {

// A small accounting database with a case for every rule of the collection, in the order the
// source returns the rows.
const QStringList SmallSource = {
    QStringLiteral("INSERT INTO Items VALUES "
                   "('A100','כיסא אלון','Oak chair',1,'AX00000001','יח''',10.5,'ש\"ח','/pics/a100.png'),"
                   "('a200',NULL,'Lamp',NULL,NULL,NULL,NULL,NULL,NULL),"
                   "('ab','first ab',NULL,2,'BX','סט',3,'$','/pics/ab.png'),"
                   "('AB','second AB',NULL,3,'CX','סט',4,'$','/pics/AB2.png'),"
                   "('#','general',NULL,1,NULL,NULL,0,NULL,NULL),"
                   "('*','internal',NULL,1,NULL,NULL,0,NULL,NULL),"
                   "(NULL,'no key',NULL,1,NULL,NULL,0,NULL,NULL),"
                   "('','empty key',NULL,1,NULL,NULL,0,NULL,NULL),"
                   "('B300','first B300',NULL,4,NULL,'זוג',5,'ש\"ח',''),"
                   "('B300','second B300',NULL,5,NULL,'זוג',6,'ש\"ח',NULL),"
                   "('C400','מנורה',NULL,6,NULL,'סט',7,'ש\"ח',NULL),"
                   "('D500','ספה',NULL,7,NULL,'סט',8,'ש\"ח',NULL),"
                   "('E600','שטיח',NULL,8,NULL,'סט',9,'ש\"ח',NULL),"
                   "('ך1','final',NULL,9,NULL,'סט',1,'ש\"ח',NULL),"
                   "('כ1','normal',NULL,9,NULL,'סט',2,'ש\"ח',NULL)"),
    QStringLiteral("INSERT INTO PriceListsLastDateWithSub VALUES "
                   "('A100',1,9.5,NULL,''),('a200',1,NULL,'$',''),('A100',1,8,'$',''),('#',1,1,'$',''),"
                   "('ab',2,7,'$',''),('AB',2,70,'$','')"),
    QStringLiteral("INSERT INTO ExtraNotes VALUES "
                   "(1,'A100',1,'אדום'),(1,'A100',1,'שני'),(1,'a200',1,NULL),(0,'A100',2,'not an item note'),"
                   "(1,'ab',2,'/pics/note-ab.png'),(1,'C400',2,'/pics/note-c.png'),(1,'*',2,'star')"),
    QStringLiteral("INSERT INTO ItemSortNames VALUES "
                   "(1,'סלון'),(2,NULL),(3,''),(1,'כפול'),(NULL,'ללא קוד'),(40,'מחוץ לטווח')"),
};

// The small source's items in tItems (columns in the table's order), ordered by key (Hebrew first, Latin
// without letter case).
const QStringList SmallItems = {
    QStringLiteral("ך1|final|9|<null>|סט|1|ש\"ח|?|-1"),
    QStringLiteral("כ1|normal|9|<null>|סט|2|ש\"ח|?|-1"),
    QStringLiteral("A100|כיסא אלון|1|AX00000001|יח'|10.5|ש\"ח|/pics/a100.png|-1"),
    QStringLiteral("a200|?|<null>|<null>|?|<null>|?|?|-1"),
    QStringLiteral("ab|first ab|2|BX|סט|3|$|/pics/ab.png|-1"),
    QStringLiteral("B300|first B300|4|<null>|זוג|5|ש\"ח||-1"),
    QStringLiteral("C400|מנורה|6|<null>|סט|7|ש\"ח|?|-1"),
    QStringLiteral("D500|ספה|7|<null>|סט|8|ש\"ח|?|-1"),
    QStringLiteral("E600|שטיח|8|<null>|סט|9|ש\"ח|?|-1"),
};

QString cell(const QVariant &value)
{
    return value.isNull() ? QStringLiteral("<null>") : value.toString();
}

void choose(ChoiceList &list, int itemData)
{
    list.clear();
    list.addEntry(QStringLiteral("מחיר מכירה"), 0);
    list.addEntry(QStringLiteral("ראשון"), 1);
    list.addEntry(QStringLiteral("שני"), 2);
    for (int i = 0; i < list.count(); ++i) {
        if (list.entry(i).itemData == itemData)
            list.setCurrentIndex(i);
    }
}

} // namespace

// The collection run against SQLite accounting databases, opened as a database file and
// through the real ODBC driver manager with the SQLite3 ODBC driver.
class CollectionTest : public QObject
{
    Q_OBJECT

private:
    QTemporaryDir m_temp;
    QByteArray m_oldTemp;
    QString m_smallSource;
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
        const QString path = m_temp.filePath(name);
        const Status made = makeAccountingFile(path, statements);
        if (!made)
            qWarning("%s", qPrintable(made.description()));
        return path;
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
        if (!report)
            return Status::fault(QStringLiteral("escaped: ") + report.status().description());
        return report->stepFailure;
    }
    QStringList rows(const QString &table) const
    {
        QStringList described;
        for (const QVariantList &row : readWorkTable(m_state.WorkDBFile, table)) {
            QStringList cells;
            for (const QVariant &value : row)
                cells << cell(value);
            described << cells.join(QLatin1Char('|'));
        }
        return described;
    }
    QStringList keys(const QString &table) const
    {
        QStringList found;
        for (const QVariantList &row : readWorkTable(m_state.WorkDBFile, table))
            found << row.first().toString();
        return found;
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
        const Status registered = registerSqliteOdbcAsSqlServer();
        QVERIFY2(registered, qPrintable(registered.description()));
        m_oldTemp = qgetenv("TMPDIR");
        qputenv("TMPDIR", QFile::encodeName(m_temp.path()));
        m_smallSource = m_temp.filePath(QStringLiteral("small.db"));
        const Status made = makeAccountingFile(m_smallSource, SmallSource);
        QVERIFY2(made, qPrintable(made.description()));
    }
    void cleanupTestCase() { qputenv("TMPDIR", m_oldTemp); }
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
        m_files.failingPaths.clear();
        m_context =
            std::make_unique<RunContext>(RunContext{*m_settings, m_connection, m_state, m_user, m_files});
    }

    void theSourceIsReachedThroughTheDriverItsTextNames()
    {
        const QString text = BuildConnString(m_connection);
        Result<std::unique_ptr<SourceConnection>> source = SourceConnection::open(text);
        QVERIFY2(source, qPrintable(source.status().description()));
        if (m_odbc) {
            QCOMPARE(text,
                     QStringLiteral("driver={SQL Server};server=localhost;uid=catalog;pwd=secret;database=") +
                         m_smallSource);
            QCOMPARE(source.value()->database().driverName(), QStringLiteral("QODBC"));
        } else {
            QCOMPARE(source.value()->database().driverName(), QStringLiteral("QSQLITE"));
        }
    }

    void copiesItemsSortGroupsPricesAndNotes()
    {
        m_settings->collectPrice1 = true;
        choose(m_settings->priceList1, 1);
        m_settings->collectPrice2 = true;
        choose(m_settings->priceList2, 2);
        m_settings->collectNote1 = true;
        choose(m_settings->extraNote1, 1);
        m_settings->collectNote2 = true;
        choose(m_settings->extraNote2, 2);

        collectAll();
        QCOMPARE(m_state.WorkDBFile, workDatabasePath());
        QCOMPARE(
            m_user.statuses,
            QStringList({QStringLiteral("מאתחל בסיס נתונים זמני"), QStringLiteral("סורק את רשימת הפריטים"),
                         QStringLiteral("סורק קודי מיון"), QStringLiteral("סורק מחירון ראשי"),
                         QStringLiteral("סורק מחירון משני"), QStringLiteral("סורק נתון נוסף 1"),
                         QStringLiteral("סורק נתון נוסף 2"), QStringLiteral("סריקת הנתונים הסתיימה")}));
        // Nulls become "?" in name, unit, currency and picture and stay Null in sort group,
        // filter and price; "#", "*", the Null key and the empty key never arrive; of "ab" and
        // "AB", and of the two "B300", the first stays.
        QCOMPARE(rows(QStringLiteral("tItems")), SmallItems);
        // Sort groups ignore the item range: every code, the first of a code held twice, Null
        // for a Null or empty name.
        QCOMPARE(rows(QStringLiteral("tItemSort")),
                 QStringList({QStringLiteral("1|סלון"), QStringLiteral("2|<null>"),
                              QStringLiteral("3|<null>"), QStringLiteral("40|מחוץ לטווח")}));
        // A Null currency is the shekel, a Null price stays Null, the first price of an item stays.
        QCOMPARE(rows(QStringLiteral("tItemPrice1")),
                 QStringList({QStringLiteral("A100|ש\"ח|9.5"), QStringLiteral("a200|$|<null>")}));
        QCOMPARE(rows(QStringLiteral("tItemPrice2")), QStringList{QStringLiteral("ab|$|7")});
        QCOMPARE(rows(QStringLiteral("tExtraNote1")),
                 QStringList({QStringLiteral("A100|אדום"), QStringLiteral("a200|?")}));
        QCOMPARE(rows(QStringLiteral("tExtraNote2")), QStringList({QStringLiteral("ab|/pics/note-ab.png"),
                                                                   QStringLiteral("C400|/pics/note-c.png")}));
    }

    void progressCountsEverySelectedRow()
    {
        // Twelve rows selected (the empty key and both duplicates count): points at 5 and 10.
        QVERIFY(collect());
        QCOMPARE(m_user.widths, QList<int>({0, 417, 833, 0}));
        QCOMPARE(m_user.yields, 2);
    }

    void stopEndsTheStepAtTheNextProgressPoint()
    {
        // Stop pressed while row 7 is copied: the loop sees it at row 10.
        m_user.onYield = [this] {
            if (m_user.yields == 2)
                m_state.StopRequested = true;
        };
        m_settings->collectPrice1 = true;
        choose(m_settings->priceList1, 1);
        collectAll();
        QCOMPARE(keys(QStringLiteral("tItems")),
                 QStringList({QStringLiteral("A100"), QStringLiteral("a200"), QStringLiteral("ab"),
                              QStringLiteral("B300"), QStringLiteral("C400"), QStringLiteral("D500"),
                              QStringLiteral("E600")}));
        QCOMPARE(m_user.widths.mid(0, 4), QList<int>({0, 417, 833, 0}));
        // The request stays: the sort groups are copied whole (no stop test), the price list
        // stops at its first point, which it does not reach with two rows.
        QCOMPARE(keys(QStringLiteral("tItemSort")).size(), 4);
        QCOMPARE(keys(QStringLiteral("tItemPrice1")).size(), 2);
        QCOMPARE(m_user.statuses.last(), QStringLiteral("סריקת הנתונים הסתיימה"));
    }

    void aStopStaysSetForTheNextSteps()
    {
        // Set before the run: every polling step ends at its first progress point.
        m_state.StopRequested = true;
        QVERIFY(collect());
        QCOMPARE(keys(QStringLiteral("tItems")),
                 QStringList({QStringLiteral("A100"), QStringLiteral("a200"), QStringLiteral("ab")}));
        QCOMPARE(m_user.widths, QList<int>({0, 417, 0}));
    }

    void pictureReferencesByKey_data()
    {
        QTest::addColumn<QString>("folder");
        QTest::addColumn<QString>("expected");
        QTest::newRow("folder") << QStringLiteral("/photos") << QStringLiteral("/photos/A100.JPG");
        QTest::newRow("folder with separator")
            << QStringLiteral("/photos/") << QStringLiteral("/photos/A100.JPG");
        QTest::newRow("no folder") << QString() << QStringLiteral("/A100.JPG");
    }
    void pictureReferencesByKey()
    {
        QFETCH(QString, folder);
        QFETCH(QString, expected);
        m_settings->pictureSource = PictureSource::ItemKey;
        m_settings->pictureFolder = folder;
        m_settings->pictureExtension = QStringLiteral(".JPG");
        QVERIFY(collect());
        QCOMPARE(readWorkTable(m_state.WorkDBFile, QStringLiteral("tItems")).at(2).at(7).toString(),
                 expected);
    }

    void picturesFromAnExtraNoteLeaveOutItemsWithoutOne()
    {
        m_settings->pictureSource = PictureSource::ExtraNote;
        choose(m_settings->pictureNote, 2);
        m_settings->itemName = ItemNameSource::Foreign;
        QVERIFY(collect());
        QCOMPARE(rows(QStringLiteral("tItems")),
                 QStringList({QStringLiteral("ab|?|2|BX|סט|3|$|/pics/note-ab.png|-1"),
                              QStringLiteral("C400|?|6|<null>|סט|7|ש\"ח|/pics/note-c.png|-1")}));
    }

    void foreignNames()
    {
        m_settings->itemName = ItemNameSource::Foreign;
        QVERIFY(collect());
        const QList<QVariantList> items = readWorkTable(m_state.WorkDBFile, QStringLiteral("tItems"));
        QCOMPARE(items.at(2).at(1).toString(), QStringLiteral("Oak chair"));
        QCOMPARE(items.at(3).at(1).toString(), QStringLiteral("Lamp"));
        QCOMPARE(items.at(4).at(1).toString(), QStringLiteral("?"));
    }

    void aTextTooLongFailsTheItemStepAndStopsTheRun()
    {
        const QString longName(101, QChar(0x05E9));
        m_connection = connectionTo(makeSource(
            QStringLiteral("long.db"),
            {QStringLiteral(
                 "INSERT INTO Items (ItemKey, ItemName) VALUES ('K1','a'),('K2','b'),('K3','c'),('K4','d'),"
                 "('K5','e'),('K6','%1'),('K7','g')")
                 .arg(longName)}));
        m_settings->collectPrice1 = true;
        choose(m_settings->priceList1, 1);
        QCOMPARE(failedStep().description(),
                 QStringLiteral("פריט K6: הטקסט ארוך מדי לשדה ItemName, שמקבל עד 100 תווים."));
        QCOMPARE(m_user.statuses.last(), QStringLiteral("סורק את רשימת הפריטים"));
        // What was written before the failure stays; the bar keeps its last width.
        QCOMPARE(keys(QStringLiteral("tItems")).size(), 5);
        QCOMPARE(m_user.fillWidth, 714);
        QCOMPARE(keys(QStringLiteral("tItemSort")).size(), 0);
    }

    void keysDifferingInCaseAreOneKey()
    {
        QVERIFY(collect());
        QVERIFY(keys(QStringLiteral("tItems")).contains(QStringLiteral("ab")));
        QVERIFY(!keys(QStringLiteral("tItems")).contains(QStringLiteral("AB")));
        QVERIFY(m_user.messages.isEmpty());
    }

    void aChosenListWithoutSelectionEndsTheRun()
    {
        m_settings->collectPrice1 = true;
        choose(m_settings->priceList1, 1);
        m_settings->collectNote1 = true;
        m_settings->extraNote1.clear();
        const Result<CollectionReport> collected = collect();
        QVERIFY(!collected);
        QVERIFY(collected.status().description().contains(QStringLiteral("נתון נוסף 1")));
        QCOMPARE(m_user.statuses.last(), QStringLiteral("סורק נתון נוסף 1"));
        QCOMPARE(keys(QStringLiteral("tItems")).size(), SmallItems.size());
        QCOMPARE(keys(QStringLiteral("tItemPrice1")).size(), 2);
    }

    void onlyPriceListTwoFillsOnlyItsTable()
    {
        m_settings->collectPrice2 = true;
        choose(m_settings->priceList2, 2);
        choose(m_settings->priceList1, 1);
        QVERIFY(collect());
        QVERIFY(!m_user.statuses.contains(QStringLiteral("סורק מחירון ראשי")));
        QCOMPARE(keys(QStringLiteral("tItemPrice1")), QStringList());
        QCOMPARE(keys(QStringLiteral("tItemPrice2")), QStringList{QStringLiteral("ab")});
        QCOMPARE(keys(QStringLiteral("tExtraNote1")), QStringList());
    }

    void aSecondRunLeavesNothingOfTheFirst()
    {
        m_settings->collectPrice1 = true;
        choose(m_settings->priceList1, 1);
        QVERIFY(collect());
        QCOMPARE(keys(QStringLiteral("tItemPrice1")).size(), 2);

        m_settings->collectPrice1 = false;
        m_settings->itemKeyRange = true;
        m_settings->itemKeyFrom = QStringLiteral("C");
        m_settings->itemKeyTo = QStringLiteral("E");
        QVERIFY(collect());
        QCOMPARE(keys(QStringLiteral("tItems")),
                 QStringList({QStringLiteral("C400"), QStringLiteral("D500")}));
        QCOMPARE(keys(QStringLiteral("tItemPrice1")), QStringList());
        QCOMPARE(keys(QStringLiteral("tItemSort")).size(), 4);
    }

    void anEmptySelectionWritesNothingAndLeavesTheBar()
    {
        m_settings->itemKeyRange = true;
        m_settings->itemKeyFrom = QStringLiteral("תת");
        m_user.fillWidth = 300;
        collectAll();
        QCOMPARE(keys(QStringLiteral("tItems")), QStringList());
        QVERIFY(m_user.widths.isEmpty());
        QCOMPARE(m_user.fillWidth, 300);
    }

    void anUnreachableSourceIsShownOnceAndStopsTheRun()
    {
        m_connection = connectionTo(m_temp.filePath(QStringLiteral("missing/nothing.db")));
        QVERIFY(!failedStep());
        QCOMPARE(m_user.statuses.last(), QStringLiteral("סורק את רשימת הפריטים"));
    }

    void aWorkingDatabaseThatCannotBeMadeEndsTheCollection()
    {
        collectAll();
        m_files.failingPaths.insert(workDatabasePath());
        QVERIFY(!collect());
        QCOMPARE(m_state.WorkDBFile, QString());
        QCOMPARE(m_user.statuses.last(), QStringLiteral("מאתחל בסיס נתונים זמני"));
    }

    void aRefusedCriterionFailsTheItemStep()
    {
        m_settings->sortCodeRange = true;
        m_settings->sortCodeFrom = QStringLiteral("x");
        QVERIFY(failedStep().description().contains(QStringLiteral("מקוד מיון")));
    }

    void aSecondCollectionIsRefusedWhileOneRuns()
    {
        Result<std::unique_ptr<CollectionLock>> held = CollectionLock::acquire(workDatabasePath());
        QVERIFY(held);
        m_state.WorkDBFile = QStringLiteral("earlier");
        const Result<CollectionReport> refused = collect();
        QVERIFY(!refused);
        QVERIFY(refused.status().description().contains(QStringLiteral("איסוף נתונים אחר כבר פועל")));
        QCOMPARE(m_state.WorkDBFile, QStringLiteral("earlier"));
        QVERIFY(m_user.statuses.isEmpty());
        held.value().reset();
        QVERIFY(collect());
        QCOMPARE(m_state.WorkDBFile, workDatabasePath());
    }

    void theDemoDatabase()
    {
        m_connection = connectionTo(demoDatabasePath());
        m_settings->collectPrice1 = true;
        choose(m_settings->priceList1, 1);
        m_settings->collectNote2 = true;
        choose(m_settings->extraNote2, 2);
        collectAll();
        const QStringList items = keys(QStringLiteral("tItems"));
        QVERIFY(items.size() > 250);
        QVERIFY(!items.contains(QStringLiteral("#")));
        QVERIFY(!items.contains(QStringLiteral("*")));
        QCOMPARE(items.count(QStringLiteral("A0008")), 1);
        for (const QVariantList &item : readWorkTable(m_state.WorkDBFile, QStringLiteral("tItems"))) {
            if (item.first() == QStringLiteral("A0008"))
                QVERIFY(!item.at(1).toString().contains(QStringLiteral("כפולה")));
        }
        const QList<QVariantList> notes = readWorkTable(m_state.WorkDBFile, QStringLiteral("tExtraNote2"));
        QVERIFY(std::any_of(notes.begin(), notes.end(), [](const QVariantList &note) {
            return note.at(0) == QStringLiteral("B0009") && note.at(1) == QStringLiteral("?");
        }));
        QVERIFY(!keys(QStringLiteral("tItemPrice1")).isEmpty());
    }
};

ZORBIN_TEST_CLASS(CollectionTest)
#include "CollectionTest.moc"
