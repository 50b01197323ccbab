// The pages, stylesheet and list of each golden case (a folder of golden/ with a settings.ini),
// byte for byte. The cases run in one temporary folder ROOT: ROOT/pictures holds the pictures
// of golden/pictures, the working databases lie in ROOT, ROOT/out is the output folder, and
// the picture step's copies go to ROOT/out/images in the file-per-page mode. Pages hold full
// paths, so ROOT is written "{root}" in the settings and the expected files. A case's [Test]
// section holds what the store does not: OnlyWithPic=1 ticks the option, NoItems=1 marks no
// item for the catalog. ZORBIN_UPDATE_GOLDEN=1 writes the produced files into the case
// folders instead of comparing them; review the difference before committing it.
#include "output/CatalogPages.h"
#include "output/ListPage.h"
#include "output/Stylesheet.h"
#include "testutil/OutputContext.h"
#include "testutil/StoredOptions.h"
#include "testutil/TestFiles.h"
#include "testutil/TestMain.h"
#include "workdb/WorkDatabase.h"

#include <QDir>
#include <QLocale>
#include <QRegularExpression>
#include <QSettings>
#include <QTemporaryDir>
#include <QTest>

using namespace zorbin;

namespace {

const QString Golden = QStringLiteral(ZORBIN_SOURCE_DIR "/tests/output/golden/");
const QString RootMark = u"{root}"_qs;

// The working database of golden/work-database.sql, its pictures under `root`.
Status makeGoldenWorkDatabase(const QString &path, const QString &root, bool noneIncluded)
{
    if (const Status created = createWorkDatabase(localFileSystem(), path); !created)
        return created;
    auto work = WorkDatabase::open(path);
    if (!work)
        return work.status();
    QString script = QString::fromUtf8(test::readFile(Golden + u"work-database.sql"_qs));
    script.replace(RootMark, root)
        .remove(QRegularExpression(u"^--[^\n]*\n"_qs, QRegularExpression::MultilineOption));
    if (noneIncluded)
        script += u"UPDATE tItems SET Include = 0;"_qs;
    for (const QString &statement : script.split(QLatin1Char(';'))) {
        if (statement.trimmed().isEmpty())
            continue;
        if (const WriteOutcome done = work.value()->exec(statement); !done)
            return done.status();
    }
    return Status::ok();
}

// The files of a folder (top level only) by name, with `root` replaced by the mark.
QMap<QString, QByteArray> filesOf(const QString &folder, const QString &root = {}, const QString &except = {})
{
    QMap<QString, QByteArray> files;
    const QDir dir(folder);
    for (const QString &name : dir.entryList(QDir::Files, QDir::Name)) {
        QByteArray content = test::readFile(dir.filePath(name));
        if (name != except)
            files.insert(name, root.isEmpty() ? content : content.replace(root.toUtf8(), RootMark.toUtf8()));
    }
    return files;
}

} // namespace

class GoldenCatalogTest : public QObject
{
    Q_OBJECT

private:
    static void copyPictures(const QString &to)
    {
        QVERIFY(QDir().mkpath(to));
        const QDir from(Golden + u"pictures"_qs);
        for (const QString &name : from.entryList(QDir::Files))
            QVERIFY(QFile::copy(from.filePath(name), to + QLatin1Char('/') + name));
    }

    // Applies a case's settings as a load from the store does, after giving the source-dependent
    // lists two entries each.
    void loadSettings(const QString &caseFolder, CatalogSettings &settings)
    {
        for (ChoiceList *list : settings.sourceLists()) {
            list->clear();
            list->addEntry(u"ראשון"_qs, 0);
            list->addEntry(u"שני"_qs, 2);
        }
        QSettings ini(caseFolder + u"settings.ini"_qs, QSettings::IniFormat);
        for (const QString &key : ini.allKeys()) {
            const QString value = ini.value(key).toString().replace(RootMark, m_root.path());
            if (key == u"Test/OnlyWithPic"_qs)
                settings.onlyWithPicture = value == u"1"_qs;
            else if (key.startsWith(u"Params/"_qs))
                test::setStored(settings, key.mid(7), value);
        }
    }

    QTemporaryDir m_root;

private Q_SLOTS:
    void initTestCase()
    {
        // The C locale: "," groups thousands, "." marks decimals, "/" separates the date.
        QLocale::setDefault(QLocale::c());
        QVERIFY(m_root.isValid());
        QVERIFY2(m_root.path().toLatin1() == m_root.path().toUtf8(),
                 "the temporary folder's path must be ASCII");
        copyPictures(m_root.filePath(u"pictures"_qs));
        for (const bool none : {false, true}) {
            const QString db = m_root.filePath(none ? u"no-items.db"_qs : u"items.db"_qs);
            const Status made = makeGoldenWorkDatabase(db, m_root.path(), none);
            QVERIFY2(made.isOk(), qPrintable(made.description()));
        }
    }

    void catalogFiles_data()
    {
        QTest::addColumn<QString>("caseName");
        const QDir golden(Golden);
        int cases = 0;
        for (const QString &name : golden.entryList(QDir::Dirs | QDir::NoDotAndDotDot, QDir::Name)) {
            if (!QFileInfo::exists(golden.filePath(name + u"/settings.ini"_qs)))
                continue;
            QTest::newRow(qPrintable(name)) << name;
            ++cases;
        }
        QVERIFY(cases > 0);
    }

    void catalogFiles()
    {
        QFETCH(QString, caseName);
        const QString caseFolder = Golden + caseName + QLatin1Char('/');
        const bool noItems = QSettings(caseFolder + u"settings.ini"_qs, QSettings::IniFormat)
                                 .value(u"Test/NoItems"_qs)
                                 .toBool();
        const QString db = m_root.filePath(noItems ? u"no-items.db"_qs : u"items.db"_qs);
        const QString out = m_root.filePath(u"out/"_qs);
        QVERIFY(QDir(out).removeRecursively());

        test::OutputContext output;
        loadSettings(caseFolder, output.settings);
        const QString images = out + u"images"_qs;
        QVERIFY(QDir().mkpath(images));
        if (output.settings.pageSplit == PageSplit::FilePerPage)
            copyPictures(images);

        const auto first = CreateCatHTML(output.context, out + u"zo"_qs, db, images);
        QVERIFY2(first.isOk(), qPrintable(first.status().description()));
        QCOMPARE(first.value(), noItems ? QString() : out + u"zoindex.htm"_qs);
        const Status styled = CreateCSS(output.context, out, true);
        QVERIFY2(styled.isOk(), qPrintable(styled.description()));
        const Status listed = writeListPage(output.context, out + u"zorbin3.htm"_qs, db, QDate(2024, 3, 5));
        QVERIFY2(listed.isOk(), qPrintable(listed.description()));
        QCOMPARE(output.user.fillWidth, 0);

        const auto produced = filesOf(out, m_root.path());
        if (qEnvironmentVariableIntValue("ZORBIN_UPDATE_GOLDEN") == 1) {
            for (const QString &name : filesOf(caseFolder, {}, u"settings.ini"_qs).keys())
                QFile::remove(caseFolder + name);
            for (auto it = produced.cbegin(); it != produced.cend(); ++it)
                test::writeFile(caseFolder + it.key(), it.value());
            QSKIP("golden files written");
        }
        const auto expected = filesOf(caseFolder, {}, u"settings.ini"_qs);
        QCOMPARE(produced.keys(), expected.keys());
        for (auto it = expected.cbegin(); it != expected.cend(); ++it) {
            // The first line that differs, with its file and number.
            const QList<QByteArray> actual = produced.value(it.key()).split('\n');
            const QList<QByteArray> wanted = it.value().split('\n');
            const auto [line, other] =
                std::mismatch(actual.begin(), actual.end(), wanted.begin(), wanted.end());
            QVERIFY2(line == actual.end() && other == wanted.end(),
                     qPrintable(u"%1:%2:\n  produced: %3\n  expected: %4"_qs.arg(it.key())
                                    .arg(line - actual.begin() + 1)
                                    .arg(QString::fromUtf8(line == actual.end() ? QByteArray() : *line),
                                         QString::fromUtf8(other == wanted.end() ? QByteArray() : *other))));
        }
    }
};

ZORBIN_TEST_CLASS(GoldenCatalogTest)
#include "GoldenCatalogTest.moc"
