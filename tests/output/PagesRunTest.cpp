// The page writer and the list beyond their golden files: progress, stop, sizes past 16 bits,
// and failures that must fail the run yet leave whole pages.
#include "output/CatalogPages.h"
#include "output/ListPage.h"
#include "testutil/DamagedWorkDatabase.h"
#include "testutil/FaultyFileSystem.h"
#include "testutil/OutputContext.h"
#include "testutil/StoredOptions.h"
#include "testutil/TestFiles.h"
#include "testutil/TestMain.h"
#include "testutil/WorkDatabaseFixture.h"

#include <QLocale>
#include <QTemporaryDir>
#include <QTest>

using namespace zorbin;

namespace {

// A working database with `count` items, keys "K0000001" onwards, all in the catalog.
Status makeItems(const QString &path, int count)
{
    test::WorkRows rows;
    for (int i = 1; i <= count; ++i) {
        test::WorkItem item(u"K%1"_qs.arg(i, 7, 10, QLatin1Char('0')));
        item.name = u"פריט %1"_qs.arg(i);
        rows.items << item;
    }
    return test::makeWorkDatabase(path, rows);
}

// A whole page: one document, its tables, rows and cells all closed, ending as a page ends.
void verifyWholePage(const QByteArray &page)
{
    QCOMPARE(page.count("<HTML>"), 1);
    QVERIFY(page.endsWith("</table>\r\n</BODY>\r\n</HTML>\r\n"));
    for (const QByteArray element : {"table", "tr", "td"}) {
        qsizetype opened = 0;
        for (qsizetype at = page.indexOf('<' + element); at >= 0; at = page.indexOf('<' + element, at + 1)) {
            const char next = page.at(at + element.size() + 1);
            opened += next == ' ' || next == '>' ? 1 : 0;
        }
        QVERIFY2(opened == page.count("</" + element + '>'), element.constData());
    }
}

} // namespace

class PagesRunTest : public QObject
{
    Q_OBJECT

private:
    QTemporaryDir m_dir;
    QString m_sevenItems;

    QString out(const QString &name = {}) const { return m_dir.filePath(u"out/"_qs) + name; }

    // Two by two cells showing the name and the key, sorted by key.
    void prepare(test::OutputContext &output, bool filePerPage)
    {
        QVERIFY(QDir(out()).removeRecursively());
        QVERIFY(QDir().mkpath(out(u"images"_qs)));
        output.settings.rows = 2;
        output.settings.columns = 2;
        output.settings.pageSplit = filePerPage ? PageSplit::FilePerPage : PageSplit::OneFile;
        output.settings.sortKey = SortKey::ItemKey;
        output.settings.sortDirection = SortDirection::Ascending;
        output.settings.lines[0].field = 2;
        output.settings.lines[1].field = 1;
    }

    Result<QString> pages(test::OutputContext &output, const QString &db)
    {
        return CreateCatHTML(output.context, out(u"zo"_qs), db, out(u"images"_qs));
    }

    Status list(test::OutputContext &output, const QString &db)
    {
        return writeListPage(output.context, out(u"zorbin3.htm"_qs), db, QDate(2024, 1, 2));
    }

private Q_SLOTS:
    void initTestCase()
    {
        QLocale::setDefault(QLocale::c());
        QVERIFY(m_dir.isValid());
        m_sevenItems = m_dir.filePath(u"seven.db"_qs);
        const Status made = makeItems(m_sevenItems, 7);
        QVERIFY2(made.isOk(), qPrintable(made.description()));
        QVERIFY(makeItems(m_dir.filePath(u"six.db"_qs), 6).isOk());
        const QString badPrice = m_dir.filePath(u"bad-price.db"_qs);
        QVERIFY(makeItems(badPrice, 3).isOk());
        QVERIFY(
            test::replacePriceList(badPrice, QStringLiteral("CREATE TABLE tItemPrice1 AS SELECT 'K0000002' "
                                                            "AS ItemKey, '$' AS Coin, 'abc' AS Price"))
                .isOk());
    }

    void progressCountsCellsWritten()
    {
        test::OutputContext output;
        prepare(output, true);
        output.user.frameWidth = 800;
        QVERIFY(pages(output, m_sevenItems).isOk());
        // 8 cells on 2 pages: a progress point after the fifth cell, 5 / 8 of the frame.
        QCOMPARE(output.user.widths, (QList<int>{0, 500, 0}));
        QCOMPARE(output.user.yields, 1);
    }

    // A stop, a price that is not a number (the schema keeps text out of a price column, a
    // damaged file does not) and a read that fails where the rows end: each leaves whole pages
    // where the writing stood; the failures fail the run.
    void abandonedPagesAreWhole_data()
    {
        QTest::addColumn<bool>("filePerPage");
        QTest::addColumn<QString>("database");
        QTest::addColumn<QString>("failure"); // none: a stop at the first progress point
        QTest::addColumn<QString>("lastPage");
        QTest::addColumn<QByteArray>("lastItem");
        for (const bool filePerPage : {true, false}) {
            const QString second = filePerPage ? u"zo000002.htm"_qs : u"zoindex.htm"_qs;
            QTest::addRow("stop, file per page %d", filePerPage)
                << filePerPage << u"seven.db"_qs << QString() << second << QByteArray("K0000005");
            QTest::addRow("read failure after the last row, file per page %d", filePerPage)
                << filePerPage << u"six.db"_qs << u"interrupted"_qs << second << QByteArray("K0000006");
        }
        QTest::newRow("price not a number")
            << false << u"bad-price.db"_qs << u"abc"_qs << u"zoindex.htm"_qs << QByteArray("K0000002");
    }

    void abandonedPagesAreWhole()
    {
        QFETCH(bool, filePerPage);
        QFETCH(QString, database);
        QFETCH(QString, failure);
        QFETCH(QString, lastPage);
        QFETCH(QByteArray, lastItem);
        test::OutputContext output;
        prepare(output, filePerPage);
        output.settings.lines[2].field = 4;
        const bool interrupted = failure == u"interrupted"_qs;
        output.user.onYield = [&] {
            output.state.StopRequested = failure.isEmpty();
            if (interrupted && output.user.yields == 1)
                test::interruptWorkDatabases();
        };
        const auto first = pages(output, m_dir.filePath(database));
        if (failure.isEmpty()) {
            QVERIFY(first.isOk());
            QCOMPARE(first.value(), out(u"zoindex.htm"_qs));
            // The bar stays where the writing stopped: 5 of 8 cells.
            QCOMPARE(output.user.widths, (QList<int>{0, 625}));
        } else {
            QVERIFY(!first.isOk());
            QVERIFY2(first.status().description().contains(failure),
                     qPrintable(first.status().description()));
        }
        const QByteArray page = test::readFile(out(lastPage));
        QVERIFY(page.contains(lastItem));
        QVERIFY(!page.contains(lastItem.chopped(1) + char(lastItem.back() + 1)));
        verifyWholePage(page);
        verifyWholePage(test::readFile(out(u"zoindex.htm"_qs)));
        QVERIFY(!QFile::exists(out(u"zo000003.htm"_qs)));
        if (interrupted) { // the list fails the read after its sixth and last row
            output.user.yields = 0;
            output.user.onYield = [&output] {
                if (output.user.yields == 6)
                    test::interruptWorkDatabases();
            };
            QVERIFY(!list(output, m_dir.filePath(database)).isOk());
            const QByteArray listed = test::readFile(out(u"zorbin3.htm"_qs));
            QVERIFY(listed.contains("K0000006"));
            verifyWholePage(listed);
        }
    }

    void noSixteenBitLimits()
    {
        // 32,768 pages of one cell, and a page of 200 x 200 cells: both past 16-bit numbers.
        const QString many = m_dir.filePath(u"many.db"_qs);
        const Status made = makeItems(many, 32768);
        QVERIFY2(made.isOk(), qPrintable(made.description()));
        test::OutputContext output;
        prepare(output, false);
        output.settings.rows = 1;
        output.settings.columns = 1;
        output.settings.bottomPercent = 5;
        QVERIFY(pages(output, many).isOk());
        const QByteArray page = test::readFile(out(u"zoindex.htm"_qs));
        QCOMPARE(page.count("<table height='100%' width='100%'>"), 32768);
        QVERIFY(page.contains("K0032768"));
        QCOMPARE(output.user.widths.size(), 32768 / 5 + 2);

        test::OutputContext large;
        prepare(large, true);
        large.settings.rows = 200;
        large.settings.columns = 200;
        QVERIFY(pages(large, m_sevenItems).isOk());
        QCOMPARE(test::readFile(out(u"zoindex.htm"_qs)).count("<td class=D1>"), 40000);
        QCOMPARE(large.user.widths.size(), 40000 / 5 + 2);
    }

    void failuresBeforeAnyPage()
    {
        test::OutputContext output;
        prepare(output, true);
        test::setStored(output.settings, u"Rows"_qs, u"x"_qs);
        const auto notANumber = pages(output, m_sevenItems);
        QVERIFY(!notANumber.isOk());
        QVERIFY(notANumber.status().description().contains(u"\"שורות\""_qs));
        output.settings.rows = 2;
        const QString none = m_dir.filePath(u"none.db"_qs);
        QVERIFY(!pages(output, none).isOk());
        QVERIFY(!list(output, none).isOk());
        QVERIFY(QDir(out()).entryList(QDir::Files).isEmpty());
    }

    void pageThatCannotBeWrittenFails()
    {
        test::FaultyFileSystem files;
        test::OutputContext output(files);
        prepare(output, true);
        files.failingPaths << out(u"zo000002.htm"_qs);
        const auto first = pages(output, m_sevenItems);
        QVERIFY(!first.isOk());
        QVERIFY(first.status().description().contains(out(u"zo000002.htm"_qs)));
        verifyWholePage(test::readFile(out(u"zoindex.htm"_qs)));
    }

    void listStopsAsAWholePage()
    {
        test::OutputContext output;
        prepare(output, false);
        output.user.onYield = [&output] {
            if (output.user.yields == 3)
                output.state.StopRequested = true;
        };
        QVERIFY(list(output, m_sevenItems).isOk());
        const QByteArray content = test::readFile(out(u"zorbin3.htm"_qs));
        QCOMPARE(content.count("  <tr bgcolor='#FFFFFF' align='right'>"), 3);
        QVERIFY(content.endsWith("    <td>K0000003</td>\r\n  </tr>\r\n</table>\r\n</BODY>\r\n</HTML>\r\n"));
        QCOMPARE(output.user.widths, (QList<int>{0, 143, 286, 429, 0}));
    }
};

ZORBIN_TEST_CLASS(PagesRunTest)
#include "PagesRunTest.moc"
