// The demo catalog through `zorbin-cli pdf`, as a user makes it.
#include "PdfFixture.h"
#include "testutil/AccountingFixture.h"
#include "testutil/TestFiles.h"
#include "testutil/TestMain.h"
#include "workdb/WorkDatabase.h"
#include "workdb/WorkDatabasePath.h"

#include <QDir>
#include <QRegularExpression>
#include <QSet>
#include <QTemporaryDir>
#include <QTest>

using namespace zorbin;
using namespace zorbin::test;

class DemoPdfTest : public QObject
{
    Q_OBJECT

    QTemporaryDir m_folder;
    QString m_pdf;
    long long m_items = 0;

    ToolRun cli(const QStringList &arguments)
    {
        return runTool(QStringLiteral(ZORBIN_CLI),
                       QStringList{QStringLiteral("pdf"), QStringLiteral("--settings"), demoSettingsPath()} +
                           arguments);
    }

private Q_SLOTS:
    void initTestCase()
    {
        QVERIFY(m_folder.isValid());
        m_folder.setAutoRemove(!keepTestFiles(m_folder.path()));
        m_pdf = m_folder.filePath(QStringLiteral("demo.pdf"));
        const ToolRun run = cli({QStringLiteral("--out"), m_pdf});
        QVERIFY2(run.exitCode == 0, run.err.constData());
        QCOMPARE(QString::fromUtf8(run.out).trimmed(), QDir::toNativeSeparators(m_pdf));
        // The items the catalog shows: every item the collection marked (no other rule is set).
        auto work = WorkDatabase::open(workDatabasePath());
        QVERIFY(work);
        auto counted =
            work.value()->select(QStringLiteral("SELECT COUNT(*) FROM tItems WHERE Include = True"));
        QVERIFY(counted && counted->next());
        m_items = counted->value(0).toLongLong();
        QVERIFY(m_items > 9);
    }

    void everyFontIsEmbedded()
    {
        const QList<FontRow> fonts = pdfFonts(m_pdf);
        QVERIFY(!fonts.isEmpty());
        for (const FontRow &font : fonts) {
            QVERIFY2(font.embedded, qPrintable(font.name));
            // Arial is drawn in Liberation Sans; DejaVu Sans is every line's fallback.
            QVERIFY2(font.name.contains(
                         QRegularExpression(QStringLiteral("^(\\w+\\+)?(LiberationSans|DejaVuSans)"))),
                     qPrintable(font.name));
        }
    }

    void pagesHoldRowsTimesColumns()
    {
        QCOMPARE(pdfPageCount(m_pdf), static_cast<int>((m_items + 8) / 9)); // the demo's 3 x 3
    }

    // Each distinct picture (twelve, and the logo) is stored once, however often it is drawn.
    void picturesAreStoredOnce()
    {
        const QList<ImageRow> images = pdfImages(m_pdf);
        QSet<int> objects;
        for (const ImageRow &image : images)
            objects.insert(image.object);
        QCOMPARE(objects.size(), 13);
        QVERIFY(images.size() > 100);
    }

    // The first page as pdftotext lays it out, against the text beside this test. After a
    // deliberate change: ZORBIN_UPDATE_GOLDEN=1 rewrites it; review the diff.
    void firstPageText()
    {
        const ToolRun text = runTool(QStringLiteral("pdftotext"),
                                     {QStringLiteral("-layout"), QStringLiteral("-f"), QStringLiteral("1"),
                                      QStringLiteral("-l"), QStringLiteral("1"), m_pdf, QStringLiteral("-")});
        QCOMPARE(text.exitCode, 0);
        const QString expected = QStringLiteral(ZORBIN_SOURCE_DIR "/tests/pdf/demo-first-page.txt");
        if (qEnvironmentVariableIsSet("ZORBIN_UPDATE_GOLDEN"))
            writeFile(expected, text.out);
        QCOMPARE(QString::fromUtf8(text.out), QString::fromUtf8(readFile(expected)));
    }

    void pageSizes()
    {
        const QString letter = m_folder.filePath(QStringLiteral("letter.pdf"));
        QCOMPARE(
            cli({QStringLiteral("--out"), letter, QStringLiteral("--page-size"), QStringLiteral("letter")})
                .exitCode,
            0);
        QVERIFY(runTool(QStringLiteral("pdfinfo"), {letter}).out.contains("612 x 792 pts (letter)"));
        QVERIFY(runTool(QStringLiteral("pdfinfo"), {m_pdf}).out.contains("595 x 842 pts (A4)"));
        QCOMPARE(cli({QStringLiteral("--page-size"), QStringLiteral("a5")}).exitCode, 2);
    }
};

ZORBIN_TEST_CLASS(DemoPdfTest)
#include "DemoPdfTest.moc"
