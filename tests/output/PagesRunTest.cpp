// The page writer and the list beyond their golden files: progress, stop, sizes past 16 bits,
// and failures that must leave whole pages and clear messages.
#include "OutputContext.h"
#include "output/CatalogPages.h"
#include "output/ListPage.h"
#include "platform/FileSystem.h"
#include "testutil/FaultyFileSystem.h"
#include "testutil/StoredOptions.h"
#include "testutil/TestFiles.h"
#include "testutil/TestMain.h"
#include "workdb/RowWriter.h"
#include "workdb/WorkDatabase.h"
#include "workdb/WorkSchema.h"

#include <QLocale>
#include <QTemporaryDir>
#include <QTest>

using namespace zorbin;

namespace {

// A working database with `count` plain items, keys "K0000001" onwards, all in the catalog.
Status makeItems(const QString &path, int count)
{
    if (const Status created = createWorkDatabase(localFileSystem(), path); !created)
        return created;
    auto work = WorkDatabase::open(path);
    if (!work)
        return work.status();
    if (const Status begun = work.value()->begin(); !begun)
        return begun;
    {
        RowWriter writer(*work.value(), QStringLiteral("tItems"),
                         {QStringLiteral("ItemKey"), QStringLiteral("ItemName"), QStringLiteral("Include")});
        for (int i = 1; i <= count; ++i) {
            const QVariant row[] = {QStringLiteral("K%1").arg(i, 7, 10, QLatin1Char('0')),
                                    QStringLiteral("פריט %1").arg(i), WorkTrue};
            if (WriteOutcome written = writer.write(row); !written)
                return Status::fault(written.description());
        }
    }
    return work.value()->commit();
}

QByteArray tail(const QByteArray &content, int lines)
{
    qsizetype at = content.size();
    for (int i = 0; i <= lines && at > 0; ++i)
        at = content.lastIndexOf('\n', at - 1);
    return content.mid(at + 1);
}

// Whether every element of that name that opens in the page also closes.
bool isBalanced(const QByteArray &page, const QByteArray &element)
{
    const QByteArray open = '<' + element;
    qsizetype opened = 0;
    for (qsizetype at = page.indexOf(open); at >= 0; at = page.indexOf(open, at + 1)) {
        const char next = page.at(at + open.size());
        opened += next == ' ' || next == '>' ? 1 : 0;
    }
    return opened == page.count("</" + element + '>');
}

} // namespace

class PagesRunTest : public QObject
{
    Q_OBJECT

private:
    QTemporaryDir m_dir;
    QString m_sevenItems;

    QString out(const QString &name = {}) const { return m_dir.filePath(QStringLiteral("out/")) + name; }

    void prepare(test::OutputContext &output, bool filePerPage)
    {
        QVERIFY(QDir(out()).removeRecursively());
        QVERIFY(QDir().mkpath(out(QStringLiteral("images"))));
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
        return CreateCatHTML(output.context, out(QStringLiteral("zo")), db, out(QStringLiteral("images")));
    }

private Q_SLOTS:
    void initTestCase()
    {
        QLocale::setDefault(QLocale::c());
        QVERIFY(m_dir.isValid());
        m_sevenItems = m_dir.filePath(QStringLiteral("seven.db"));
        const Status made = makeItems(m_sevenItems, 7);
        QVERIFY2(made.isOk(), qPrintable(made.description()));
    }

    void progressCountsCellsWritten()
    {
        test::OutputContext output;
        prepare(output, true);
        output.user.frameWidth = 800;
        const auto first = pages(output, m_sevenItems);
        QVERIFY(first.isOk());
        // 8 cells on 2 pages: a progress point after the fifth cell, 5 / 8 of the frame.
        QCOMPARE(output.user.widths, (QList<int>{0, 500, 0}));
        QCOMPARE(output.user.yields, 1);
    }

    void stopClosesThePage_data()
    {
        QTest::addColumn<bool>("filePerPage");
        QTest::newRow("file per page") << true;
        QTest::newRow("one file") << false;
    }

    void stopClosesThePage()
    {
        QFETCH(bool, filePerPage);
        test::OutputContext output;
        prepare(output, filePerPage);
        output.user.onYield = [&output] { output.state.StopRequested = true; };
        const auto first = pages(output, m_sevenItems);
        QVERIFY(first.isOk());
        QCOMPARE(first.value(), out(QStringLiteral("zoindex.htm")));
        // The stop comes after the fifth cell: the first cell of the second page.
        const QByteArray stopped =
            test::readFile(out(filePerPage ? QStringLiteral("zo000002.htm") : QStringLiteral("zoindex.htm")));
        QVERIFY(stopped.contains("K0000005"));
        QVERIFY(!stopped.contains("K0000006"));
        QCOMPARE(tail(stopped, 6), QByteArray("     </table>\r\n"
                                              "    </td>\r\n"
                                              "  </tr>\r\n"
                                              "</table>\r\n"
                                              "</BODY>\r\n"
                                              "</HTML>\r\n"));
        QCOMPARE(stopped.count("<HTML>"), 1);
        QCOMPARE(stopped.count("</HTML>"), 1);
        for (const char *element : {"table", "tr", "td"})
            QVERIFY2(isBalanced(stopped, element), element);
        if (filePerPage) {
            QVERIFY(test::readFile(out(QStringLiteral("zoindex.htm")))
                        .endsWith("</table>\r\n</BODY>\r\n</HTML>\r\n"));
            QVERIFY(!QFile::exists(out(QStringLiteral("zo000003.htm"))));
        }
        // The bar stays where the writing stopped: 5 of 8 cells.
        QCOMPARE(output.user.widths, (QList<int>{0, 625}));
    }

    void noSixteenBitLimits()
    {
        // 32,768 pages of one cell, and a page of 200 x 200 cells: both past 16-bit numbers.
        const QString many = m_dir.filePath(QStringLiteral("many.db"));
        const Status made = makeItems(many, 32768);
        QVERIFY2(made.isOk(), qPrintable(made.description()));
        test::OutputContext output;
        prepare(output, false);
        output.settings.rows = 1;
        output.settings.columns = 1;
        output.settings.bottomPercent = 5;
        QVERIFY(pages(output, many).isOk());
        const QByteArray page = test::readFile(out(QStringLiteral("zoindex.htm")));
        QCOMPARE(page.count("<table height='100%' width='100%'>"), 32768);
        QVERIFY(page.contains("K0032768"));
        QCOMPARE(output.user.widths.size(), 32768 / 5 + 2);

        test::OutputContext large;
        prepare(large, true);
        large.settings.rows = 200;
        large.settings.columns = 200;
        QVERIFY(pages(large, m_sevenItems).isOk());
        QCOMPARE(test::readFile(out(QStringLiteral("zoindex.htm"))).count("<td class=D1>"), 40000);
        QCOMPARE(large.user.widths.size(), 40000 / 5 + 2);
    }

    void failuresBeforeAnyPage_data()
    {
        QTest::addColumn<QString>("rows");
        QTest::addColumn<bool>("missingDatabase");
        QTest::addColumn<QString>("named");
        QTest::newRow("rows not a number") << QStringLiteral("x") << false << QStringLiteral("\"שורות\"");
        QTest::newRow("no working database") << QStringLiteral("2") << true << QString();
    }

    void failuresBeforeAnyPage()
    {
        QFETCH(QString, rows);
        QFETCH(bool, missingDatabase);
        QFETCH(QString, named);
        test::OutputContext output;
        prepare(output, true);
        test::setStored(output.settings, QStringLiteral("Rows"), rows);
        const auto first =
            pages(output, missingDatabase ? m_dir.filePath(QStringLiteral("none.db")) : m_sevenItems);
        QVERIFY(!first.isOk());
        QVERIFY2(first.status().description().contains(named), qPrintable(first.status().description()));
        QVERIFY(localFileSystem().fileNames(out()).isEmpty());
    }

    void pageThatCannotBeWrittenFails()
    {
        test::FaultyFileSystem files;
        test::OutputContext output(files);
        prepare(output, true);
        files.failingPaths << out(QStringLiteral("zo000002.htm"));
        const auto first = pages(output, m_sevenItems);
        QVERIFY(!first.isOk());
        QVERIFY(first.status().description().contains(out(QStringLiteral("zo000002.htm"))));
        QVERIFY(test::readFile(out(QStringLiteral("zoindex.htm"))).endsWith("</BODY>\r\n</HTML>\r\n"));
    }

    void priceThatIsNotANumberLeavesAWholePage()
    {
        // The schema keeps text out of a price column; a damaged file (here a price list
        // without types) does not.
        const QString db = m_dir.filePath(QStringLiteral("bad-price.db"));
        QVERIFY(makeItems(db, 3).isOk());
        {
            auto work = WorkDatabase::open(db);
            QVERIFY(work.isOk());
            for (const char *sql :
                 {"DROP TABLE tItemPrice1", "CREATE TABLE tItemPrice1 (ItemKey, Coin, Price)",
                  "INSERT INTO tItemPrice1 VALUES ('K0000001', '$', 1), ('K0000002', '$', 'abc')"}) {
                const WriteOutcome done = work.value()->exec(QString::fromLatin1(sql));
                QVERIFY2(done.isOk(), qPrintable(done.description()));
            }
        }
        test::OutputContext output;
        prepare(output, false);
        output.settings.lines[2].field = 4;
        const auto first = pages(output, db);
        QVERIFY(!first.isOk());
        QVERIFY(first.status().description().contains(QStringLiteral("abc")));
        // The failure comes within the second item's cell, after its first lines.
        const QByteArray page = test::readFile(out(QStringLiteral("zoindex.htm")));
        QVERIFY(page.contains("K0000002"));
        QVERIFY(page.endsWith("</table>\r\n</BODY>\r\n</HTML>\r\n"));
        for (const char *element : {"table", "tr", "td"})
            QVERIFY2(isBalanced(page, element), element);
    }

    void listStopsAsAWholePage()
    {
        test::OutputContext output;
        prepare(output, false);
        output.user.onYield = [&output] {
            if (output.user.yields == 3)
                output.state.StopRequested = true;
        };
        const QString list = out(QStringLiteral("zorbin3.htm"));
        QVERIFY(writeListPage(output.context, list, m_sevenItems, QDate(2024, 1, 2)).isOk());
        const QByteArray content = test::readFile(list);
        QCOMPARE(content.count("  <tr bgcolor='#FFFFFF' align='right'>"), 3);
        QVERIFY(content.endsWith("    <td>K0000003</td>\r\n  </tr>\r\n</table>\r\n</BODY>\r\n</HTML>\r\n"));
        QCOMPARE(output.user.widths, (QList<int>{0, 143, 286, 429, 0}));
    }

    void listWithoutDatabaseWritesNothing()
    {
        test::OutputContext output;
        prepare(output, false);
        const QString list = out(QStringLiteral("zorbin3.htm"));
        QVERIFY(!writeListPage(output.context, list, QString(), QDate(2024, 1, 2)).isOk());
        QVERIFY(!QFile::exists(list));
    }
};

ZORBIN_TEST_CLASS(PagesRunTest)
#include "PagesRunTest.moc"
