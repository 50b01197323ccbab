#include "control/CatalogControl.h"

#include "output/CopiedPictures.h"
#include "testutil/CaseTable.h"
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
        stages->firstPage = out(u"zoindex.htm"_qs);
    }

    QString out(const QString &name = {}) const { return output + QLatin1Char('/') + name; }
    bool has(const char *stage) const { return stages->names().contains(QLatin1String(stage)); }

    QTemporaryDir folder;
    QString output = QDir(folder.path()).filePath(u"catalog"_qs);
    MemorySettingsStore store;
    RecordingUserPort user;
    FaultyFileSystem files;
    RecordingStages *stages = nullptr;
    std::unique_ptr<CatalogControl> control;
};

// What each failure does to a run: a failed collection step is told with the information icon
// and the output is still written from what was collected; any other fault is told as a fault
// and ends the run where it happened. `shown`: the result was handed to the browser.
const struct
{
    const char *name; // what fails; "list: " for a list run
    bool list;
    Ending ending;
    int stagesRun;
    bool shown;
} Failures[] = {
    {"collection cannot start", false, Ending::Failed, 1, false},
    {"collection step", false, Ending::Partial, 4, true},
    {"pictures", false, Ending::Failed, 2, false},
    {"pages", false, Ending::Failed, 3, false},
    {"stylesheet", false, Ending::Failed, 4, false},
    {"browser", false, Ending::Failed, 4, true},
    {"page file in use", false, Ending::Failed, 1, false},
    {"output folder two levels deep", false, Ending::Failed, 1, false},
    {"marked items, none collected", false, Ending::Failed, 0, false},
    {"list: collection step", true, Ending::Partial, 2, true},
    {"list: list page", true, Ending::Failed, 2, false},
    {"list: marked items, none collected", true, Ending::Failed, 0, false},
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
        QCOMPARE(rig.stages->names(), (QStringList{u"BuildAndCollectData"_qs, u"CollectCatImages"_qs,
                                                   u"CreateCatHTML"_qs, u"CreateCSS"_qs}));
        QCOMPARE(rig.stages->calls.constLast(), u"CreateCSS(%1,true)"_qs.arg(rig.out()));
        QCOMPARE(rig.user.browsed, QStringList{rig.out(u"zoindex.htm"_qs)});
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
        rig.control->runState().WorkDBFile = u"/tmp/marked.tmp"_qs;
        QCOMPARE(rig.control->makeCatalog().ending, Ending::Complete);
        QVERIFY(!rig.has("BuildAndCollectData"));
        QVERIFY(
            rig.stages->calls.value(1).startsWith(u"CreateCatHTML(%1zo,/tmp/marked.tmp,"_qs.arg(rig.out())));

        rig.stages->calls.clear(); // the list asks whether to collect them again
        rig.user.answers = {Answer::No, Answer::Yes};
        rig.control->askAndMakeList();
        QCOMPARE(rig.stages->names(), QStringList{u"CreateListHTML"_qs});
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
        QCOMPARE(rig.stages->names().count(u"BuildAndCollectData"_qs), 2);
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
        QCOMPARE(rig.control->makeList(true).file, rig.out(u"zorbin3.htm"_qs));
        rig.control->makeCatalog();
        QVERIFY(QFileInfo(rig.out(u"images"_qs)).isDir());

        const QByteArray saved = qgetenv("TMPDIR"); // no folder at all: the temporary folder
        qputenv("TMPDIR", rig.folder.path().toUtf8());
        rig.control->settings().outputFolder.clear();
        rig.control->makeCatalog();
        qputenv("TMPDIR", saved);
        QCOMPARE(rig.stages->calls.constLast(), u"CreateCSS(%1/,true)"_qs.arg(rig.folder.path()));
    }

    // Only what catalog runs wrote is removed: their pages, the list page and the pictures they
    // recorded as copied; the user's own files in the same folders stay. A record that names a
    // folder (or the images folder itself) does not stop the run.
    void cleanUpRemovesOnlyTheCatalogsOwnFiles()
    {
        Rig rig;
        QDir().mkpath(rig.out(u"images/mine"_qs));
        const QStringList ours = {u"zoindex.htm"_qs, u"zo000002.htm"_qs, u"zo1234567.htm"_qs,
                                  u"zorbin3.htm"_qs, u"images/A1.JPG"_qs};
        const QStringList theirs = {u"index.htm"_qs, u"zo12.htm"_qs, u"notes.txt"_qs, u"zoindex.html"_qs,
                                    u"images/mine.png"_qs};
        for (const QString &name : ours + theirs)
            writeFile(rig.out(name));
        {
            CopiedPictures record(rig.files, rig.out(u"images"_qs));
            for (const char *name : {"A1.JPG", "../notes.txt", ".", "mine"})
                QVERIFY(record.add(QLatin1String(name)));
        }
        QCOMPARE(rig.control->makeCatalog().ending, Ending::Complete);
        for (const QString &name : ours)
            QVERIFY2(!QFileInfo::exists(rig.out(name)), qPrintable(name));
        for (const QString &name : theirs + QStringList{u"images/mine"_qs})
            QVERIFY2(QFileInfo::exists(rig.out(name)), qPrintable(name));
        QVERIFY(!QFileInfo::exists(CopiedPictures::recordPath(rig.out(u"images"_qs))));
    }

    void aFailureEndsTheRunOrWarns_data() { addCaseRows(Failures); }
    void aFailureEndsTheRunOrWarns()
    {
        const auto &[failing, list, ending, stagesRun, shown] = fetchCase(Failures);
        Rig rig;
        QString text = u"פריט K6: הטקסט ארוך מדי"_qs; // a part of what the user is told
        const QString page = rig.out(u"zo000002.htm"_qs);
        const QMap<QString, std::function<void()>> failures = {
            {u"collection cannot start"_qs, [&] { rig.stages->collectResult = Status::fault(text); }},
            {u"collection step"_qs, [&] { rig.stages->stepFailure = Status::fault(text); }},
            {u"pictures"_qs, [&] { rig.stages->imagesResult = Status::fault(text); }},
            {u"pages"_qs, [&] { rig.stages->pagesResult = Status::fault(text); }},
            {u"stylesheet"_qs, [&] { rig.stages->cssResult = Status::fault(text); }},
            {u"list page"_qs, [&] { rig.stages->listResult = Status::fault(text); }},
            {u"browser"_qs, [&] { rig.user.browserResult = Status::fault(text); }},
            {u"page file in use"_qs,
             [&] {
                 QDir().mkpath(rig.output);
                 writeFile(page);
                 rig.files.failingPaths.insert(page);
                 text = page;
             }},
            {u"output folder two levels deep"_qs,
             [&] { rig.control->settings().outputFolder = text = rig.out(u"a/b"_qs); }},
            {u"marked items, none collected"_qs, [&] {
                 rig.control->settings().useMarkedItems = true;
                 text = u"\"בחירת פריטים...\""_qs;
             }}};
        failures.value(QString::fromLatin1(failing).section(u": "_qs, -1))();
        const RunOutcome outcome = list ? rig.control->makeList(!rig.control->settings().useMarkedItems)
                                        : rig.control->makeCatalog();
        QCOMPARE(outcome.ending, ending);
        QVERIFY2(outcome.message.contains(text), qPrintable(outcome.message));
        QCOMPARE(rig.user.messages.size(), 1); // told once
        QVERIFY(rig.user.messages[0].text.contains(text));
        QCOMPARE(rig.user.messages[0].icon,
                 ending == Ending::Partial ? MessageIcon::Information : MessageIcon::Critical);
        QCOMPARE(rig.stages->names().size(), stagesRun);
        QCOMPARE(rig.user.browsed.size(), shown ? 1 : 0);
        QCOMPARE(outcome.file, rig.user.browsed.value(0));
        QVERIFY(!rig.control->isRunning());
        QCOMPARE(QFileInfo::exists(rig.out()), stagesRun > 1 || QByteArray(failing).contains("in use"));
    }

    void catalogWithoutItemsOpensNoWindow()
    {
        Rig rig;
        rig.stages->firstPage.clear();
        QCOMPARE(rig.control->makeCatalog().ending, Ending::NoItems);
        QCOMPARE(rig.user.messages.size(), 1);
        QCOMPARE(rig.user.messages[0].icon, MessageIcon::Information);
        rig.stages->stepFailure = Status::fault(u"step"_qs); // partial says more
        QCOMPARE(rig.control->makeCatalog().ending, Ending::Partial);
        QVERIFY(rig.user.browsed.isEmpty());
    }

    // A stop pressed while idle is forgotten when a run starts; a stop during the collection
    // shortens the collection, and is cleared again before the output is written; a stop
    // during the writing leaves a shorter result, which is still shown.
    void stopRequestIsClearedWhereRunsStart()
    {
        Rig rig;
        QString stopIn = u"BuildAndCollectData"_qs;
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
        rig.control
            ->requestStop(); // a stop left over from before does not cut the item selection's collection
        QCOMPARE(rig.control->collectItems().ending, Ending::Complete);
        QCOMPARE(rig.stages->stopSeen.constLast(), false);
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
            rig.control->settings().topTitle = u"changed"_qs;
            rig.control->saveSettings();
        };
        rig.control->makeCatalog();
        QCOMPARE(nested, QList<Ending>(6, Ending::Declined));
        QVERIFY(rig.user.questions.isEmpty());
        QCOMPARE(rig.store.writes, 0);
        QVERIFY(!rig.control->isRunning());
        rig.control->saveSettings();
        QCOMPARE(rig.store.get(u"TopTitle"_qs), u"changed"_qs);
    }
};

QTEST_GUILESS_MAIN(CatalogControlTest)
#include "CatalogControlTest.moc"
