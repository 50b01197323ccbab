#include "control/CatalogControl.h"

#include "output/CopiedPictures.h"
#include "testutil/FaultyFileSystem.h"
#include "testutil/MemorySettingsStore.h"
#include "testutil/RecordingStages.h"
#include "testutil/RecordingUserPort.h"
#include "testutil/TestFiles.h"

#include <QDir>
#include <QFileInfo>
#include <QTemporaryDir>
#include <QTest>

using namespace zorbin;
using namespace zorbin::test;
using Ending = RunOutcome::Ending;

namespace {

// A control whose stages record their calls, writing a page per file into a fresh folder.
struct Rig
{
    Rig()
    {
        auto made = std::make_unique<RecordingStages>();
        stages = made.get();
        control = std::make_unique<CatalogControl>(user, store, files, std::move(made));
        control->settings().outputFolder = output;
        control->settings().pageSplit = PageSplit::FilePerPage;
        stages->firstPage = out(QStringLiteral("zoindex.htm"));
    }

    QString out(const QString &name = {}) const { return output + QLatin1Char('/') + name; }
    bool has(const char *stage) const { return stages->names().contains(QLatin1String(stage)); }
    // The one message the user was told.
    RecordingUserPort::Message told() const
    {
        return user.messages.size() == 1 ? user.messages.constFirst()
                                         : RecordingUserPort::Message{{}, {}, MessageIcon::Question};
    }

    QTemporaryDir folder;
    QString output = QDir(folder.path()).filePath(QStringLiteral("catalog"));
    MemorySettingsStore store;
    RecordingUserPort user;
    FaultyFileSystem files;
    RecordingStages *stages = nullptr;
    std::unique_ptr<CatalogControl> control;
};

} // namespace

class CatalogControlTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void catalogRunCallsItsStagesInOrder()
    {
        Rig rig;
        QCOMPARE(rig.control->askAndMakeCatalog().ending, Ending::Complete);
        QCOMPARE(rig.user.questionButtons.value(0), QuestionButtons::YesNo);
        QCOMPARE(rig.stages->names(),
                 (QStringList{QStringLiteral("BuildAndCollectData"), QStringLiteral("CollectCatImages"),
                              QStringLiteral("CreateCatHTML"), QStringLiteral("CreateCSS")}));
        QCOMPARE(rig.stages->calls.constLast(), QStringLiteral("CreateCSS(%1,true)").arg(rig.out()));
        QCOMPARE(rig.user.browsed, QStringList{rig.out(QStringLiteral("zoindex.htm"))});
        QCOMPARE(rig.user.busyChanges, (QList<bool>{true, false}));

        rig.stages->calls.clear(); // one file holds every page: no pictures are copied
        rig.control->settings().pageSplit = PageSplit::OneFile;
        rig.control->makeCatalog();
        QVERIFY(!rig.has("CollectCatImages") && rig.has("CreateCSS"));
    }

    void handPickedItemsAreNotCollectedAgain()
    {
        Rig rig;
        rig.control->settings().useMarkedItems = true;
        rig.control->runState().WorkDBFile = QStringLiteral("/tmp/marked.tmp");
        QCOMPARE(rig.control->makeCatalog().ending, Ending::Complete);
        QVERIFY(!rig.has("BuildAndCollectData"));
        QVERIFY(rig.stages->calls.value(1).startsWith(
            QStringLiteral("CreateCatHTML(%1zo,/tmp/marked.tmp,").arg(rig.out())));

        rig.stages->calls.clear(); // the list asks whether to collect them again
        rig.user.answers = {Answer::No, Answer::Yes};
        rig.control->askAndMakeList();
        QCOMPARE(rig.stages->names(), QStringList{QStringLiteral("CreateListHTML")});
        rig.control->askAndMakeList();
        QVERIFY(rig.has("BuildAndCollectData"));
        QCOMPARE(rig.user.questionButtons.value(1), QuestionButtons::YesNoCancel);
    }

    // Before marking items by hand: the first time the items are collected without asking;
    // later the user chooses between the marks made so far and a new collection.
    void markingCollectsFirstThenAsks()
    {
        Rig rig;
        rig.user.answers = {Answer::No, Answer::Yes};
        for (int opening = 0; opening < 3; ++opening)
            QCOMPARE(rig.control->prepareMarking().file, rig.stages->workDBFile);
        QCOMPARE(rig.user.questions.size(), 2);
        QCOMPARE(rig.stages->names().count(QStringLiteral("BuildAndCollectData")), 2);
        QVERIFY(rig.control->settings().useMarkedItems);
    }

    void declinedQuestionsDoNothing()
    {
        Rig rig;
        rig.control->runState().StopRequested = true;
        rig.user.answers = {Answer::No, Answer::Cancel};
        QCOMPARE(rig.control->askAndMakeCatalog().ending, Ending::Declined);
        rig.control->settings().useMarkedItems = true;
        QCOMPARE(rig.control->askAndMakeList().ending, Ending::Declined);
        QVERIFY(rig.stages->calls.isEmpty() && rig.user.browsed.isEmpty());
        QVERIFY(rig.control->runState().StopRequested);
        QVERIFY(!QFileInfo::exists(rig.out()));
    }

    void outputFolder()
    {
        Rig rig;
        rig.control->settings().outputFolder = rig.output + QLatin1Char('/');
        QCOMPARE(rig.control->makeList(true).file, rig.out(QStringLiteral("zorbin3.htm")));
        rig.control->makeCatalog();
        QVERIFY(QFileInfo(rig.out(QStringLiteral("images"))).isDir());

        const QByteArray saved = qgetenv("TMPDIR"); // no folder at all: the temporary folder
        qputenv("TMPDIR", rig.folder.path().toUtf8());
        rig.control->settings().outputFolder.clear();
        rig.control->makeCatalog();
        qputenv("TMPDIR", saved);
        QCOMPARE(rig.stages->calls.constLast(), QStringLiteral("CreateCSS(%1/,true)").arg(rig.folder.path()));
    }

    // Only what catalog runs wrote is removed: their pages, the list page and the pictures they
    // recorded as copied; the user's own files in the same folders stay. A record that names a
    // folder (or the images folder itself) does not stop the run.
    void cleanUpRemovesOnlyTheCatalogsOwnFiles()
    {
        Rig rig;
        QDir().mkpath(rig.out(QStringLiteral("images/mine")));
        const QStringList ours = {QStringLiteral("zoindex.htm"), QStringLiteral("zo000002.htm"),
                                  QStringLiteral("zo1234567.htm"), QStringLiteral("zorbin3.htm"),
                                  QStringLiteral("images/A1.JPG")};
        const QStringList theirs = {QStringLiteral("index.htm"), QStringLiteral("zo12.htm"),
                                    QStringLiteral("notes.txt"), QStringLiteral("zoindex.html"),
                                    QStringLiteral("images/mine.png")};
        for (const QString &name : ours + theirs)
            writeFile(rig.out(name));
        {
            CopiedPictures record(rig.files, rig.out(QStringLiteral("images")));
            for (const char *name : {"A1.JPG", "../notes.txt", ".", "mine"})
                QVERIFY(record.add(QLatin1String(name)));
        }
        QCOMPARE(rig.control->makeCatalog().ending, Ending::Complete);
        for (const QString &name : ours)
            QVERIFY2(!QFileInfo::exists(rig.out(name)), qPrintable(name));
        for (const QString &name : theirs + QStringList{QStringLiteral("images/mine")})
            QVERIFY2(QFileInfo::exists(rig.out(name)), qPrintable(name));
        QVERIFY(!QFileInfo::exists(CopiedPictures::recordPath(rig.out(QStringLiteral("images")))));
    }

    // What each failure does to a run: a failed collection step is told with the information
    // icon and the output is still written from what was collected; any other fault is told as
    // a fault and ends the run where it happened.
    void aFailureEndsTheRunOrWarns_data()
    {
        QTest::addColumn<QString>("failing");
        QTest::addColumn<bool>("list");
        QTest::addColumn<Ending>("ending");
        QTest::addColumn<int>("stagesRun");
        QTest::addColumn<bool>("shown"); // the result was handed to the browser
        auto row = [](const char *failing, bool list, Ending ending, int stagesRun, bool shown) {
            QTest::newRow(failing) << QString::fromLatin1(failing) << list << ending << stagesRun << shown;
        };
        row("collection cannot start", false, Ending::Failed, 1, false);
        row("collection step", false, Ending::Partial, 4, true);
        row("pictures", false, Ending::Failed, 2, false);
        row("pages", false, Ending::Failed, 3, false);
        row("stylesheet", false, Ending::Failed, 4, false);
        row("browser", false, Ending::Failed, 4, true);
        row("page file in use", false, Ending::Failed, 1, false);
        row("output folder two levels deep", false, Ending::Failed, 1, false);
        row("marked items, none collected", false, Ending::Failed, 0, false);
        row("list: collection step", true, Ending::Partial, 2, true);
        row("list: list page", true, Ending::Failed, 2, false);
        row("list: browser", true, Ending::Failed, 2, true);
        row("list: marked items, none collected", true, Ending::Failed, 0, false);
    }
    void aFailureEndsTheRunOrWarns()
    {
        QFETCH(QString, failing);
        QFETCH(bool, list);
        QFETCH(Ending, ending);
        QFETCH(int, stagesRun);
        QFETCH(bool, shown);
        Rig rig;
        QString text = QStringLiteral("פריט K6: הטקסט ארוך מדי"); // a part of what the user is told
        const QString page = rig.out(QStringLiteral("zo000002.htm"));
        const QMap<QString, std::function<void()>> failures = {
            {QStringLiteral("collection cannot start"),
             [&] { rig.stages->collectResult = Status::fault(text); }},
            {QStringLiteral("collection step"), [&] { rig.stages->stepFailure = Status::fault(text); }},
            {QStringLiteral("pictures"), [&] { rig.stages->imagesResult = Status::fault(text); }},
            {QStringLiteral("pages"), [&] { rig.stages->pagesResult = Status::fault(text); }},
            {QStringLiteral("stylesheet"), [&] { rig.stages->cssResult = Status::fault(text); }},
            {QStringLiteral("list page"), [&] { rig.stages->listResult = Status::fault(text); }},
            {QStringLiteral("browser"), [&] { rig.user.browserResult = Status::fault(text); }},
            {QStringLiteral("page file in use"),
             [&] {
                 QDir().mkpath(rig.output);
                 writeFile(page);
                 rig.files.failingPaths.insert(page);
                 text = page;
             }},
            {QStringLiteral("output folder two levels deep"),
             [&] { rig.control->settings().outputFolder = text = rig.out(QStringLiteral("a/b")); }},
            {QStringLiteral("marked items, none collected"), [&] {
                 rig.control->settings().useMarkedItems = true;
                 text = QStringLiteral("\"בחירת פריטים...\"");
             }}};
        failures.value(failing.section(QStringLiteral(": "), -1))();
        const RunOutcome outcome = list ? rig.control->makeList(!rig.control->settings().useMarkedItems)
                                        : rig.control->makeCatalog();
        QCOMPARE(outcome.ending, ending);
        QVERIFY2(outcome.message.contains(text), qPrintable(outcome.message));
        QVERIFY(rig.told().text.contains(text));
        QCOMPARE(rig.told().icon,
                 ending == Ending::Partial ? MessageIcon::Information : MessageIcon::Critical);
        QCOMPARE(rig.stages->names().size(), stagesRun);
        QCOMPARE(rig.user.browsed.size(), shown ? 1 : 0);
        QCOMPARE(outcome.file, rig.user.browsed.value(0));
        QVERIFY(!rig.control->isRunning());
        QCOMPARE(QFileInfo::exists(rig.out()), stagesRun > 1 || failing.contains(QStringLiteral("in use")));
    }

    void catalogWithoutItemsOpensNoWindow()
    {
        Rig rig;
        rig.stages->firstPage.clear();
        QCOMPARE(rig.control->makeCatalog().ending, Ending::NoItems);
        QCOMPARE(rig.told().icon, MessageIcon::Information);
        rig.stages->stepFailure = Status::fault(QStringLiteral("step")); // partial says more
        QCOMPARE(rig.control->makeCatalog().ending, Ending::Partial);
        QVERIFY(rig.user.browsed.isEmpty());
    }

    // A stop pressed while idle is forgotten when a run starts; a stop during the collection
    // shortens the collection, and is cleared again before the output is written; a stop
    // during the writing leaves a shorter result, which is still shown.
    void stopRequestIsClearedWhereRunsStart()
    {
        Rig rig;
        QString stopIn = QStringLiteral("BuildAndCollectData");
        rig.stages->during = [&](const QString &stage) {
            if (stage == stopIn)
                rig.control->requestStop();
        };
        for (const char *stage : {"BuildAndCollectData", "CreateCatHTML"}) {
            stopIn = QLatin1String(stage);
            rig.control->requestStop();
            QCOMPARE(rig.control->makeCatalog().ending, Ending::Stopped);
            QCOMPARE(rig.user.browsed.size(), stopIn == QLatin1String("CreateCatHTML") ? 2 : 1);
        }
        QCOMPARE(rig.stages->stopSeen, (QList<bool>{false, false, false, false, false, false, false, true}));
        QCOMPARE(rig.user.yields, 4);
        rig.control->requestStop();
        QCOMPARE(rig.control->makeList(true).ending, Ending::Complete);
        QCOMPARE(rig.stages->stopSeen.mid(8), (QList<bool>{false, false}));
    }

    // While a run yields, the buttons can be pressed: a second run or a save is refused.
    void secondStartDuringARunIsRefused()
    {
        Rig rig;
        QList<Ending> nested;
        rig.stages->during = [&](const QString &stage) {
            if (stage != QLatin1String("BuildAndCollectData"))
                return;
            QVERIFY(rig.control->isRunning());
            nested = {rig.control->askAndMakeCatalog().ending, rig.control->askAndMakeList().ending,
                      rig.control->makeCatalog().ending,       rig.control->makeList(true).ending,
                      rig.control->collectItems().ending,      rig.control->prepareMarking().ending};
            rig.control->settings().topTitle = QStringLiteral("changed");
            rig.control->saveSettings();
        };
        rig.control->makeCatalog();
        QCOMPARE(nested, QList<Ending>(6, Ending::Declined));
        QVERIFY(rig.user.questions.isEmpty());
        QCOMPARE(rig.store.writes, 0);
        QVERIFY(!rig.control->isRunning());
        rig.control->saveSettings();
        QCOMPARE(rig.store.get(QStringLiteral("TopTitle")), QStringLiteral("changed"));
    }
};

QTEST_GUILESS_MAIN(CatalogControlTest)
#include "CatalogControlTest.moc"
