// The pages, stylesheet and list of each golden case, byte for byte (see GoldenFixture.h for
// the layout of a case). ZORBIN_UPDATE_GOLDEN=1 writes the produced files into the case
// folders instead of comparing them; review the difference before committing it.
#include "GoldenFixture.h"
#include "OutputContext.h"
#include "output/CatalogPages.h"
#include "output/ListPage.h"
#include "output/Stylesheet.h"
#include "testutil/TestFiles.h"
#include "testutil/TestMain.h"

#include <QDir>
#include <QLocale>
#include <QTemporaryDir>
#include <QTest>

using namespace zorbin;

class GoldenCatalogTest : public QObject
{
    Q_OBJECT

private:
    static void copyPictures(const QString &to)
    {
        QVERIFY(QDir().mkpath(to));
        const QDir from(test::goldenFolder() + QStringLiteral("/pictures"));
        for (const QString &name : from.entryList(QDir::Files))
            QVERIFY(QFile::copy(from.filePath(name), to + QLatin1Char('/') + name));
    }

    // One folder and two working databases serve every case, so the paths in the files are
    // the same for all of them.
    QTemporaryDir m_root;
    QString m_itemsDb;
    QString m_emptyDb;

private Q_SLOTS:
    void initTestCase()
    {
        // The C locale: "," groups thousands, "." marks decimals, "/" separates the date.
        QLocale::setDefault(QLocale::c());
        QVERIFY(!test::goldenCases().isEmpty());
        QVERIFY(m_root.isValid());
        QVERIFY2(m_root.path().toLatin1() == m_root.path().toUtf8(),
                 "the temporary folder's path must be ASCII");
        copyPictures(m_root.filePath(QStringLiteral("pictures")));
        m_itemsDb = m_root.filePath(QStringLiteral("items.db"));
        m_emptyDb = m_root.filePath(QStringLiteral("no-items.db"));
        const Status items = test::makeGoldenWorkDatabase(m_itemsDb, m_root.path());
        QVERIFY2(items.isOk(), qPrintable(items.description()));
        const Status empty = test::makeGoldenWorkDatabase(m_emptyDb, m_root.path(), true);
        QVERIFY2(empty.isOk(), qPrintable(empty.description()));
    }

    void catalogFiles_data()
    {
        QTest::addColumn<QString>("caseName");
        for (const QString &name : test::goldenCases())
            QTest::newRow(qPrintable(name)) << name;
    }

    void catalogFiles()
    {
        QFETCH(QString, caseName);
        const QString root = m_root.path();
        const bool noItems = test::goldenTestValue(caseName, QStringLiteral("NoItems")) == QLatin1String("1");
        const QString db = noItems ? m_emptyDb : m_itemsDb;
        const QString out = root + QStringLiteral("/out/");
        QVERIFY(QDir(out).removeRecursively());

        test::OutputContext output;
        const Status loaded = test::loadGoldenSettings(caseName, root, output.settings);
        QVERIFY2(loaded.isOk(), qPrintable(loaded.description()));
        const QString images = out + QStringLiteral("images");
        QVERIFY(QDir().mkpath(images));
        // The copies that the picture step makes in the file-per-page mode.
        if (output.settings.pageSplit == PageSplit::FilePerPage)
            copyPictures(images);

        const auto first = CreateCatHTML(output.context, out + QStringLiteral("zo"), db, images);
        QVERIFY2(first.isOk(), qPrintable(first.status().description()));
        QCOMPARE(first.value(), noItems ? QString() : out + QStringLiteral("zoindex.htm"));
        const Status styled = CreateCSS(output.context, out, true);
        QVERIFY2(styled.isOk(), qPrintable(styled.description()));
        const Status listed =
            writeListPage(output.context, out + QStringLiteral("zorbin3.htm"), db, QDate(2024, 3, 5));
        QVERIFY2(listed.isOk(), qPrintable(listed.description()));
        QCOMPARE(output.user.fillWidth, 0);

        const auto produced = test::producedFiles(out, root);
        const QString caseFolder = test::goldenFolder() + QLatin1Char('/') + caseName + QLatin1Char('/');
        if (qEnvironmentVariableIntValue("ZORBIN_UPDATE_GOLDEN") == 1) {
            const auto old = test::expectedFiles(caseName);
            for (auto it = old.cbegin(); it != old.cend(); ++it)
                QFile::remove(caseFolder + it.key());
            for (auto it = produced.cbegin(); it != produced.cend(); ++it)
                test::writeFile(caseFolder + it.key(), it.value());
            QSKIP("golden files written");
        }
        const auto expected = test::expectedFiles(caseName);
        QCOMPARE(produced.keys(), expected.keys());
        for (auto it = expected.cbegin(); it != expected.cend(); ++it) {
            const QByteArray &actual = produced.value(it.key());
            if (actual == it.value())
                continue;
            const QList<QByteArray> actualLines = actual.split('\n');
            const QList<QByteArray> expectedLines = it.value().split('\n');
            for (qsizetype line = 0; line < std::max(actualLines.size(), expectedLines.size()); ++line) {
                const QByteArray a = actualLines.value(line);
                const QByteArray e = expectedLines.value(line);
                if (a != e)
                    QFAIL(qPrintable(
                        QStringLiteral("%1 differs at line %2:\n  produced: %3\n  expected: %4")
                            .arg(it.key())
                            .arg(line + 1)
                            .arg(QString::fromLatin1(a.toPercentEncoding(" <>='/:;#!&-_.,(){}")),
                                 QString::fromLatin1(e.toPercentEncoding(" <>='/:;#!&-_.,(){}")))));
            }
        }
    }
};

ZORBIN_TEST_CLASS(GoldenCatalogTest)
#include "GoldenCatalogTest.moc"
