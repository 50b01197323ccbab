#include "control/CatalogControl.h"

#include "output/CopiedPictures.h"
#include "testutil/FaultyFileSystem.h"
#include "testutil/MemorySettingsStore.h"
#include "testutil/RecordingStages.h"
#include "testutil/RecordingUserPort.h"
#include "testutil/TestFiles.h"
#include "testutil/TestMain.h"

#include <QDir>
#include <QFileInfo>
#include <QTemporaryDir>
#include <QTest>

using namespace zorbin;
using namespace zorbin::test;

namespace {

// A control whose stages record their calls, writing into a fresh output folder.
struct Rig
{
    Rig()
    {
        auto made = std::make_unique<RecordingStages>();
        stages = made.get();
        control = std::make_unique<CatalogControl>(user, store, files, std::move(made));
        output = QDir(folder.path()).filePath(QStringLiteral("catalog"));
        control->settings().outputFolder = output;
        control->settings().pageSplit = PageSplit::FilePerPage;
        stages->firstPage = out(QStringLiteral("zoindex.htm"));
    }

    QString out(const QString &name = {}) const { return output + QLatin1Char('/') + name; }
    QString images() const { return output + QStringLiteral("/images"); }

    QTemporaryDir folder;
    QString output;
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
    void startUpFillsListsBeforeLoadingSettings()
    {
        Rig rig;
        rig.store.set(QStringLiteral("PriceField"), QStringLiteral("1"));
        rig.stages->during = [&rig](const QString &stage) {
            if (stage == QLatin1String("FillCmbPriceField")) {
                rig.control->settings().priceList1.addEntry(QStringLiteral("מחיר מכירה"), 0);
                rig.control->settings().priceList1.addEntry(QStringLiteral("סיטונאי"), 3);
            }
        };
        rig.control->runState().WorkDBFile = QStringLiteral("left over");
        rig.control->startUp();
        QCOMPARE(rig.stages->names(),
                 (QStringList{QStringLiteral("GetRegConnParams"), QStringLiteral("FillCmbExtraNote"),
                              QStringLiteral("FillCmbPriceField")}));
        QCOMPARE(rig.control->settings().priceList1.currentIndex(), 1);
        QCOMPARE(rig.control->runState().WorkDBFile, QString());
        QVERIFY(rig.user.messages.isEmpty());
    }

    void catalogRunCallsItsStagesInOrder()
    {
        Rig rig;
        rig.control->askAndMakeCatalog();

        QCOMPARE(rig.user.questions, QStringList{QStringLiteral("להתחיל בהכנת הקטלוג?")});
        QCOMPARE(rig.user.questionTitles, QStringList{QStringLiteral("שאלה חשובה")});
        QCOMPARE(rig.user.questionButtons.constFirst(), QuestionButtons::YesNo);
        const QString db = rig.stages->workDBFile;
        QCOMPARE(rig.stages->calls, (QStringList{
                                        QStringLiteral("BuildAndCollectData()"),
                                        QStringLiteral("CollectCatImages(%1,%2)").arg(rig.images(), db),
                                        QStringLiteral("CreateCatHTML(%1,%2,%3)")
                                            .arg(rig.out(QStringLiteral("zo")), db, rig.images()),
                                        QStringLiteral("CreateCSS(%1,true)").arg(rig.out()),
                                    }));
        QCOMPARE(rig.user.browsed, QStringList{rig.out(QStringLiteral("zoindex.htm"))});
        QVERIFY(QFileInfo(rig.images()).isDir());
        QVERIFY(rig.user.messages.isEmpty());
        QCOMPARE(rig.user.busyChanges, (QList<bool>{true, false}));
    }

    void oneFileModeCopiesNoPictures()
    {
        Rig rig;
        rig.control->settings().pageSplit = PageSplit::OneFile;
        rig.control->askAndMakeCatalog();
        QVERIFY(!rig.stages->names().contains(QStringLiteral("CollectCatImages")));
        QVERIFY(QFileInfo(rig.images()).isDir());
    }

    void handPickedItemsAreNotCollectedAgain()
    {
        Rig rig;
        rig.control->settings().useMarkedItems = true;
        rig.control->runState().WorkDBFile = QStringLiteral("/tmp/marked.tmp");
        rig.control->askAndMakeCatalog();
        QVERIFY(!rig.stages->names().contains(QStringLiteral("BuildAndCollectData")));
        QVERIFY(rig.stages->calls.contains(QStringLiteral("CreateCatHTML(%1,/tmp/marked.tmp,%2)")
                                               .arg(rig.out(QStringLiteral("zo")), rig.images())));
    }

    void handPickedWithoutCollectionSaysWhatToDo()
    {
        Rig rig;
        rig.control->settings().useMarkedItems = true;
        writeFile(QDir(rig.folder.path()).filePath(QStringLiteral("keep.htm")));
        const RunOutcome outcome = rig.control->askAndMakeCatalog();
        QCOMPARE(outcome.ending, RunOutcome::Ending::Failed);
        QCOMPARE(rig.user.messages.size(), 1);
        QCOMPARE(rig.user.messages.constFirst().title, QStringLiteral("תקלה"));
        QVERIFY(rig.user.messages.constFirst().text.contains(QStringLiteral("בחירת פריטים")));
        QVERIFY(rig.stages->calls.isEmpty());
        QVERIFY(!QFileInfo::exists(rig.out()));
    }

    void declinedQuestionsDoNothing()
    {
        Rig rig;
        rig.control->runState().StopRequested = true;
        rig.user.answers = {Answer::No};
        QCOMPARE(rig.control->askAndMakeCatalog().ending, RunOutcome::Ending::Declined);
        rig.control->settings().useMarkedItems = true;
        rig.user.answers = {Answer::Cancel};
        QCOMPARE(rig.control->askAndMakeList().ending, RunOutcome::Ending::Declined);

        QVERIFY(rig.stages->calls.isEmpty());
        QVERIFY(rig.control->runState().StopRequested);
        QVERIFY(!QFileInfo::exists(rig.out()));
        QVERIFY(rig.user.browsed.isEmpty());
    }

    void listRunAsksOnlyAboutHandPickedItems()
    {
        Rig rig;
        rig.control->askAndMakeList();
        QVERIFY(rig.user.questions.isEmpty());
        QCOMPARE(rig.stages->calls,
                 (QStringList{QStringLiteral("BuildAndCollectData()"),
                              QStringLiteral("CreateListHTML(%1,%2)")
                                  .arg(rig.out(QStringLiteral("zorbin3.htm")), rig.stages->workDBFile)}));
        QCOMPARE(rig.user.browsed, QStringList{rig.out(QStringLiteral("zorbin3.htm"))});

        rig.stages->calls.clear();
        rig.control->settings().useMarkedItems = true;
        rig.user.answers = {Answer::No};
        rig.control->askAndMakeList();
        QCOMPARE(rig.user.questions, QStringList{QStringLiteral("לסרוק מחדש את הפריטים?")});
        QCOMPARE(rig.user.questionTitles, QStringList{QStringLiteral("שים לב")});
        QCOMPARE(rig.user.questionButtons.constFirst(), QuestionButtons::YesNoCancel);
        QCOMPARE(rig.stages->names(), QStringList{QStringLiteral("CreateListHTML")});

        rig.stages->calls.clear();
        rig.user.answers = {Answer::Yes};
        rig.control->askAndMakeList();
        QCOMPARE(rig.stages->names(),
                 (QStringList{QStringLiteral("BuildAndCollectData"), QStringLiteral("CreateListHTML")}));
    }

    void outputFolderIsCreatedOneLevelDeep()
    {
        Rig rig;
        rig.control->settings().outputFolder = rig.out(QStringLiteral("a/b"));
        const RunOutcome outcome = rig.control->makeCatalog();
        QCOMPARE(outcome.ending, RunOutcome::Ending::Failed);
        QCOMPARE(rig.user.messages.size(), 1);
        QCOMPARE(rig.user.messages.constFirst().icon, MessageIcon::Critical);
        QVERIFY(rig.user.messages.constFirst().text.contains(rig.out(QStringLiteral("a/b"))));
        QCOMPARE(rig.stages->names(), QStringList{QStringLiteral("BuildAndCollectData")});
        QVERIFY(!QFileInfo::exists(rig.out()));

        rig.control->settings().outputFolder = rig.output + QLatin1Char('/');
        QCOMPARE(rig.control->makeCatalog().ending, RunOutcome::Ending::Complete);
        QVERIFY(QFileInfo(rig.out()).isDir());
    }

    void emptyOutputFolderMeansTheTemporaryFolder()
    {
        Rig rig;
        const QByteArray saved = qgetenv("TMPDIR");
        qputenv("TMPDIR", rig.folder.path().toUtf8());
        rig.control->settings().outputFolder.clear();
        rig.stages->firstPage = QStringLiteral("page");
        rig.control->makeCatalog();
        qputenv("TMPDIR", saved);
        QVERIFY(rig.stages->calls.contains(QStringLiteral("CreateCSS(%1/,true)").arg(rig.folder.path())));
    }

    // Only what catalog runs wrote is removed: their pages, the list page and the pictures they
    // recorded as copied; the user's own files in the same folders stay.
    void cleanUpRemovesOnlyTheCatalogsOwnFiles()
    {
        Rig rig;
        QDir().mkpath(rig.images());
        const QStringList ours = {QStringLiteral("zoindex.htm"), QStringLiteral("zo000002.htm"),
                                  QStringLiteral("zo1234567.htm"), QStringLiteral("zorbin3.htm")};
        const QStringList theirs = {QStringLiteral("index.htm"), QStringLiteral("zo12.htm"),
                                    QStringLiteral("notes.txt"), QStringLiteral("zoindex.html")};
        for (const QString &name : ours + theirs)
            writeFile(rig.out(name));
        writeFile(rig.images() + QStringLiteral("/A1.JPG"));
        writeFile(rig.images() + QStringLiteral("/mine.png"));
        {
            CopiedPictures record(rig.files, rig.images());
            QVERIFY(record.add(QStringLiteral("A1.JPG")));
            QVERIFY(record.add(QStringLiteral("../notes.txt"))); // a damaged record stays in its folder
        }

        rig.control->makeCatalog();
        for (const QString &name : ours)
            QVERIFY2(!QFileInfo::exists(rig.out(name)), qPrintable(name));
        for (const QString &name : theirs)
            QVERIFY2(QFileInfo::exists(rig.out(name)), qPrintable(name));
        QVERIFY(!QFileInfo::exists(rig.images() + QStringLiteral("/A1.JPG")));
        QVERIFY(QFileInfo::exists(rig.images() + QStringLiteral("/mine.png")));
        QVERIFY(!QFileInfo::exists(CopiedPictures::recordPath(rig.images())));
    }

    // A record that names a folder (or the images folder itself) must not stop every later
    // run: the folder is no copy of ours and stays.
    void recordNamingAFolderDoesNotBlockTheRun()
    {
        Rig rig;
        QDir().mkpath(rig.images() + QStringLiteral("/mine"));
        writeFile(rig.images() + QStringLiteral("/A1.JPG"));
        {
            CopiedPictures record(rig.files, rig.images());
            QVERIFY(record.add(QStringLiteral(".")));
            QVERIFY(record.add(QStringLiteral("mine")));
            QVERIFY(record.add(QStringLiteral("A1.JPG")));
        }

        QCOMPARE(rig.control->makeCatalog().ending, RunOutcome::Ending::Complete);
        QVERIFY(QFileInfo(rig.images() + QStringLiteral("/mine")).isDir());
        QVERIFY(!QFileInfo::exists(rig.images() + QStringLiteral("/A1.JPG")));
        QVERIFY(!QFileInfo::exists(CopiedPictures::recordPath(rig.images())));
    }

    void fileInUseEndsTheRunBeforeAnyPage()
    {
        Rig rig;
        QDir().mkpath(rig.output);
        writeFile(rig.out(QStringLiteral("zo000002.htm")));
        rig.files.failingPaths.insert(rig.out(QStringLiteral("zo000002.htm")));
        const RunOutcome outcome = rig.control->makeCatalog();
        QCOMPARE(outcome.ending, RunOutcome::Ending::Failed);
        QVERIFY(outcome.message.contains(QStringLiteral("zo000002.htm")));
        QCOMPARE(rig.user.messages.constFirst().title, QStringLiteral("תקלה"));
        QCOMPARE(rig.stages->names(), QStringList{QStringLiteral("BuildAndCollectData")});
        QVERIFY(rig.user.browsed.isEmpty());
    }

    void escapedCollectionErrorEndsTheRunBeforeOutput()
    {
        Rig rig;
        rig.stages->collectResult = Status::fault(QStringLiteral("Invalid list index"));
        const RunOutcome outcome = rig.control->makeCatalog();
        QCOMPARE(outcome.ending, RunOutcome::Ending::Failed);
        QCOMPARE(rig.user.messages.size(), 1);
        QCOMPARE(rig.user.messages.constFirst().text, QStringLiteral("Invalid list index"));
        QCOMPARE(rig.user.messages.constFirst().icon, MessageIcon::Critical);
        QCOMPARE(rig.stages->names(), QStringList{QStringLiteral("BuildAndCollectData")});
        QVERIFY(!QFileInfo::exists(rig.out()));
    }

    // A failed step is told, with the information icon, and the catalog is still written from
    // what was collected before it; the outcome says it is partial.
    void failedCollectionStepStillLeadsToOutput()
    {
        Rig rig;
        rig.stages->stepFailure = Status::fault(QStringLiteral("פריט K6: הטקסט ארוך מדי"));
        const RunOutcome outcome = rig.control->makeCatalog();
        QCOMPARE(outcome.ending, RunOutcome::Ending::Partial);
        QCOMPARE(outcome.message, QStringLiteral("פריט K6: הטקסט ארוך מדי"));
        QCOMPARE(outcome.file, rig.out(QStringLiteral("zoindex.htm")));
        QCOMPARE(rig.user.messages.size(), 1);
        QCOMPARE(rig.user.messages.constFirst().icon, MessageIcon::Information);
        QCOMPARE(rig.stages->names().size(), 4);
    }

    void outputFaultIsShownAndEndsTheRun()
    {
        Rig rig;
        rig.stages->pagesResult = Status::fault(QStringLiteral("disk full"));
        const RunOutcome outcome = rig.control->makeCatalog();
        QCOMPARE(outcome.ending, RunOutcome::Ending::Failed);
        QCOMPARE(rig.user.messages.constFirst().text, QStringLiteral("disk full"));
        QVERIFY(!rig.stages->names().contains(QStringLiteral("CreateCSS")));
        QVERIFY(rig.user.browsed.isEmpty());
    }

    void catalogWithoutItemsOpensNoWindow()
    {
        Rig rig;
        rig.stages->firstPage.clear();
        const RunOutcome outcome = rig.control->makeCatalog();
        QCOMPARE(outcome.ending, RunOutcome::Ending::NoItems);
        QVERIFY(rig.user.browsed.isEmpty());
        QCOMPARE(rig.user.messages.size(), 1);
        QCOMPARE(rig.user.messages.constFirst().icon, MessageIcon::Information);
    }

    // A stop pressed while idle is forgotten when a run starts; a stop during the collection
    // shortens the collection, and is cleared again before the output is written.
    void stopRequestIsClearedWhereRunsStart()
    {
        Rig rig;
        rig.control->requestStop();
        QCOMPARE(rig.user.yields, 1);
        rig.stages->during = [&rig](const QString &stage) {
            if (stage == QLatin1String("BuildAndCollectData"))
                rig.control->requestStop();
        };
        rig.control->makeCatalog();
        QCOMPARE(rig.stages->stopSeen, (QList<bool>{false, false, false, false}));
        QVERIFY(rig.control->runState().StopRequested == false);

        rig.control->requestStop();
        rig.stages->during = {};
        rig.control->makeList(true);
        QCOMPARE(rig.stages->stopSeen.mid(4), (QList<bool>{false, false}));
    }

    // While a run yields, the buttons can be pressed: a second run or a save is refused.
    void secondStartDuringARunIsRefused()
    {
        Rig rig;
        RunOutcome nested;
        rig.stages->during = [&](const QString &stage) {
            if (stage == QLatin1String("BuildAndCollectData")) {
                QVERIFY(rig.control->isRunning());
                nested = rig.control->askAndMakeCatalog();
                rig.control->askAndMakeList();
                rig.control->settings().topTitle = QStringLiteral("changed");
                rig.control->saveSettings();
            }
        };
        rig.control->makeCatalog();
        QCOMPARE(nested.ending, RunOutcome::Ending::Declined);
        QVERIFY(rig.user.questions.isEmpty());
        QCOMPARE(rig.stages->names().count(QStringLiteral("BuildAndCollectData")), 1);
        QCOMPARE(rig.store.writes, 0);
        QVERIFY(!rig.control->isRunning());
    }

    void browserFailureIsReported()
    {
        Rig rig;
        rig.user.browserResult = Status::fault(QStringLiteral("no browser"));
        const RunOutcome outcome = rig.control->makeCatalog();
        QCOMPARE(outcome.ending, RunOutcome::Ending::Failed);
        QCOMPARE(outcome.file, rig.out(QStringLiteral("zoindex.htm")));
        QCOMPARE(rig.user.messages.constFirst().text, QStringLiteral("no browser"));
    }
};

ZORBIN_TEST_CLASS(CatalogControlTest)
#include "CatalogControlTest.moc"
