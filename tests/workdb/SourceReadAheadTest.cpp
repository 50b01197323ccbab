#include "workdb/SourceReadAhead.h"

#include "source/ConnectionString.h"
#include "source/SourceConnection.h"
#include "testutil/AccountingFixture.h"
#include "testutil/SqliteOdbcDriver.h"
#include "testutil/TestMain.h"
#include "workdb/SourceRowCount.h"

#include <QTemporaryDir>
#include <QTest>

using namespace zorbin;
using namespace zorbin::test;

namespace {

// Copies the first column's text.
const SourceReadAhead::Shaper KeyOnly = [](std::span<const QVariant> read, std::span<WorkValue> row) {
    row[0] = WorkValue::from(read[0]);
};

} // namespace

// Reading the source on a thread of its own, and counting its rows, through both drivers.
class SourceReadAheadTest : public QObject
{
    Q_OBJECT

private:
    QTemporaryDir m_folder;
    QString m_database;
    QString m_connection;

    static QString manyKeys(int count)
    {
        return QStringLiteral(
                   "INSERT INTO Items (ItemKey, SortGroup) WITH RECURSIVE n(i) AS "
                   "(SELECT 1 UNION ALL SELECT i + 1 FROM n WHERE i < %1) SELECT printf('K%05d', i), i FROM n")
            .arg(count);
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
        QVERIFY(m_folder.isValid());
        QVERIFY(registerSqliteOdbcAsSqlServer());
        m_database = m_folder.filePath(QStringLiteral("many.db"));
        QVERIFY(makeAccountingFile(m_database, {manyKeys(10000)}));
    }
    void init()
    {
        QFETCH_GLOBAL(bool, odbc);
        m_connection = BuildConnString(odbc ? odbcConnection(m_database) : fileConnection(m_database));
    }

    void readsEveryRowInOrderAndCountsThem()
    {
        SourceReadAhead source(m_connection,
                               QStringLiteral("SELECT ItemKey FROM Items WHERE SortGroup > 100"),
                               {QStringLiteral("itemkey")}, true, 1, KeyOnly);
        QVERIFY(source.waitUntilRunning());
        QCOMPARE(source.total(), 9900);
        int rows = 0;
        while (source.next()) {
            ++rows;
            QCOMPARE(source.row()[0].toText(),
                     QStringLiteral("K%1").arg(100 + rows, 5, 10, QLatin1Char('0')));
        }
        QCOMPARE(rows, 9900);
        QVERIFY(source.readFailure());
    }

    void stoppingEarlyReleasesTheReader()
    {
        // Far more rows than are held ahead: the reader waits for room until it is stopped.
        SourceReadAhead source(m_connection, QStringLiteral("SELECT ItemKey FROM Items"),
                               {QStringLiteral("ItemKey")}, false, 1, KeyOnly);
        QVERIFY(source.waitUntilRunning());
        QCOMPARE(source.total(), 0);
        for (int i = 0; i < 7; ++i)
            QVERIFY(source.next());
        QCOMPARE(source.row()[0].toText(), QStringLiteral("K00007"));
    }

    void aRefusedStatementOrAMissingColumnIsAFault()
    {
        SourceReadAhead refused(m_connection, QStringLiteral("SELECT Nothing FROM Nowhere"),
                                {QStringLiteral("Nothing")}, true, 1, KeyOnly);
        QVERIFY(!refused.waitUntilRunning());
        QVERIFY(!refused.next());

        SourceReadAhead missing(m_connection, QStringLiteral("SELECT ItemKey FROM Items"),
                                {QStringLiteral("ItemName")}, false, 1, KeyOnly);
        const Status running = missing.waitUntilRunning();
        QVERIFY(!running);
        QVERIFY(running.description().contains(QStringLiteral("ItemName")));
    }

    void aFailureWhileReadingComesAfterTheRowsBeforeIt()
    {
        // abs() of the smallest integer fails when the row that holds it is read.
        SourceReadAhead source(
            m_connection,
            QStringLiteral("SELECT ItemKey, abs(CASE WHEN SortGroup = 3 THEN -9223372036854775807 - 1 "
                           "ELSE SortGroup END) AS Size FROM Items"),
            {QStringLiteral("ItemKey"), QStringLiteral("Size")}, false, 1, KeyOnly);
        QFETCH_GLOBAL(bool, odbc);
        const Status running = source.waitUntilRunning();
        QStringList keys;
        while (source.next())
            keys << source.row()[0].toText();
        // The SQLite ODBC driver reads ahead of its own when the statement runs, and fails there.
        const Status failure = running ? source.readFailure() : running;
        QVERIFY(!failure);
        if (!odbc)
            QCOMPARE(keys, QStringList({QStringLiteral("K00001"), QStringLiteral("K00002")}));
        QVERIFY2(failure.description().contains(QStringLiteral("overflow")),
                 qPrintable(failure.description()));
    }

    void countsAStatementTheDatabaseCannotNest()
    {
        Result<std::unique_ptr<SourceConnection>> source = SourceConnection::open(m_connection);
        QVERIFY(source);
        // A trailing comment would swallow the closing parenthesis of the count: the rows are counted
        // instead.
        QCOMPARE(
            countSourceRows(*source.value(),
                            QStringLiteral("SELECT ItemKey FROM Items WHERE SortGroup <= 42 -- the first")),
            42);
        QCOMPARE(countSourceRows(*source.value(),
                                 QStringLiteral("SELECT ItemKey FROM Items WHERE SortGroup <= 42")),
                 42);
        QCOMPARE(countSourceRows(*source.value(), QStringLiteral("SELECT Nothing FROM Nowhere")), 0);
    }
};

ZORBIN_TEST_CLASS(SourceReadAheadTest)
#include "SourceReadAheadTest.moc"
