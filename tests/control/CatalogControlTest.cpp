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
    // The one message the user was told: its text and icon.
    std::pair<QString, MessageIcon> told() const
    {
        if (user.messages.size() != 1)
            return {QStringLiteral("%1 messages").arg(user.messages.size()), MessageIcon::Question};
        return {user.messages.constFirst().text, user.messages.constFirst().icon};
    }

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
    // The stored choice of a list filled from the accounting database can only be selected
    // once the list is filled.
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
        QCOMPARE(rig.control->settings().priceList1.currentIndex(), 1);
        QCOMPARE(rig.control->runState().WorkDBFile, QString());
        QVERIFY(rig.user.messages.isEmpty());
    }

    void catalogRunCallsItsStagesInOrder()
    {
        Rig rig;
        QCOMPARE(rig.control->askAndMakeCatalog().ending, Ending::Complete);
        QCOMPARE(rig.user.questionButtons, QList<QuestionButtons>{QuestionButtons::YesNo});
        const QString db = rig.stages->workDBFile;
        QCOMPARE(rig.stages->calls, (QStringList{
                                        QStringLiteral("BuildAndCollectData()"),
                                        QStringLiteral("CollectCatImages(%1,%2)").arg(rig.images(), db),
                                        QStringLiteral("CreateCatHTML(%1,%2,%3)")
                                            .arg(rig.out(QStringLiteral("zo")), db, rig.images()),
                                        QStringLiteral("CreateCSS(%1,true)").arg(rig.out()),
                                    }));
        QCOMPARE(rig.user.browsed, QStringList{rig.out(QStringLiteral("zoindex.htm"))});
        QVERIFY(rig.user.messages.isEmpty());
        QCOMPARE(rig.user.busyChanges, (QList<bool>{true, false}));

        // One file holds every page: no pictures are copied.
        rig.stages->calls.clear();
        rig.control->settings().pageSplit = PageSplit::OneFile;
        rig.control->makeCatalog();
        QCOMPARE(rig.stages->names().size(), 3);
        QVERIFY(!rig.stages->names().contains(QStringLiteral("CollectCatImages")));
    }

    void handPickedItemsAreNotCollectedAgain()
    {
        Rig rig;
        rig.control->settings().useMarkedItems = true;
        QCOMPARE(rig.control->makeCatalog().ending, Ending::Failed); // nothing collected yet
        QVERIFY(rig.told().first.contains(QStringLiteral("בחירת פריטים")));
        QVERIFY(rig.stages->calls.isEmpty());
        QVERIFY(!QFileInfo::exists(rig.out()));

        rig.control->runState().WorkDBFile = QStringLiteral("/tmp/marked.tmp");
        QCOMPARE(rig.control->makeCatalog().ending, Ending::Complete);
        QVERIFY(!rig.stages->names().contains(QStringLiteral("BuildAndCollectData")));
        QVERIFY(rig.stages->calls.contains(QStringLiteral("CreateCatHTML(%1,/tmp/marked.tmp,%2)")
                                               .arg(rig.out(QStringLiteral("zo")), rig.images())));
    }

    void declinedQuestionsDoNothing()
    {
        Rig rig;
        rig.control->runState().StopRequested = true;
        rig.user.answers = {Answer::No};
        QCOMPARE(rig.control->askAndMakeCatalog().ending, Ending::Declined);
        rig.control->settings().useMarkedItems = true;
        rig.user.answers = {Answer::Cancel};
        QCOMPARE(rig.control->askAndMakeList().ending, Ending::Declined);
        QVERIFY(rig.stages->calls.isEmpty());
        QVERIFY(rig.control->runState().StopRequested);
        QVERIFY(!QFileInfo::exists(rig.out()));
        QVERIFY(rig.user.browsed.isEmpty());
    }

    void listRunAsksOnlyAboutHandPickedItems()
    {
        Rig rig;
        const QString list = rig.out(QStringLiteral("zorbin3.htm"));
        QCOMPARE(rig.control->askAndMakeList().file, list);
        QVERIFY(rig.user.questions.isEmpty());
        QCOMPARE(rig.stages->calls,
                 (QStringList{QStringLiteral("BuildAndCollectData()"),
                              QStringLiteral("CreateListHTML(%1,%2)").arg(list, rig.stages->workDBFile)}));
        QCOMPARE(rig.user.browsed, QStringList{list});

        rig.control->settings().useMarkedItems = true;
        for (const Answer answer : {Answer::No, Answer::Yes}) {
            rig.stages->calls.clear();
            rig.user.answers = {answer};
            rig.control->askAndMakeList();
            QCOMPARE(rig.stages->names().size(), answer == Answer::Yes ? 2 : 1);
        }
        QCOMPARE(rig.user.questionButtons.size(), 2);
        QCOMPARE(rig.user.questionButtons.constFirst(), QuestionButtons::YesNoCancel);
    }

    // Before marking items by hand: the first time the items are collected without asking;
    // later the user chooses between the marks made so far and a new collection.
    void markingCollectsFirstThenAsks()
    {
        Rig rig;
        QCOMPARE(rig.control->prepareMarking().file, rig.stages->workDBFile);
        QVERIFY(rig.user.questions.isEmpty());
        QVERIFY(rig.control->settings().useMarkedItems);
        QCOMPARE(rig.user.busyChanges, (QList<bool>{true, false}));
        for (const Answer answer : {Answer::No, Answer::Yes}) {
            rig.user.answers = {answer};
            QCOMPARE(rig.control->prepareMarking().file, rig.stages->workDBFile);
        }
        QCOMPARE(rig.user.questions.size(), 2);
        QCOMPARE(rig.stages->names().count(QStringLiteral("BuildAndCollectData")), 2);
    }

    void outputFolderIsCreatedOneLevelDeep()
    {
        Rig rig;
        rig.control->settings().outputFolder = rig.out(QStringLiteral("a/b"));
        QCOMPARE(rig.control->makeCatalog().ending, Ending::Failed);
        QVERIFY(rig.told().first.contains(rig.out(QStringLiteral("a/b"))));
        QCOMPARE(rig.told().second, MessageIcon::Critical);
        QCOMPARE(rig.stages->names(), QStringList{QStringLiteral("BuildAndCollectData")});
        QVERIFY(!QFileInfo::exists(rig.out()));

        rig.control->settings().outputFolder = rig.output + QLatin1Char('/');
        QCOMPARE(rig.control->makeCatalog().ending, Ending::Complete);
        QVERIFY(QFileInfo(rig.images()).isDir());

        // No folder at all: the temporary folder.
        const QByteArray saved = qgetenv("TMPDIR");
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
        QDir().mkpath(rig.images() + QStringLiteral("/mine"));
        const QStringList ours = {QStringLiteral("zoindex.htm"), QStringLiteral("zo000002.htm"),
                                  QStringLiteral("zo1234567.htm"), QStringLiteral("zorbin3.htm"),
                                  QStringLiteral("images/A1.JPG")};
        const QStringList theirs = {QStringLiteral("index.htm"), QStringLiteral("zo12.htm"),
                                    QStringLiteral("notes.txt"), QStringLiteral("zoindex.html"),
                                    QStringLiteral("images/mine.png")};
        for (const QString &name : ours + theirs)
            writeFile(rig.out(name));
        {
            CopiedPictures record(rig.files, rig.images());
            for (const char *name : {"A1.JPG", "../notes.txt", ".", "mine"})
                QVERIFY(record.add(QLatin1String(name)));
        }

        QCOMPARE(rig.control->makeCatalog().ending, Ending::Complete);
        for (const QString &name : ours)
            QVERIFY2(!QFileInfo::exists(rig.out(name)), qPrintable(name));
        for (const QString &name : theirs)
            QVERIFY2(QFileInfo::exists(rig.out(name)), qPrintable(name));
        QVERIFY(QFileInfo(rig.images() + QStringLiteral("/mine")).isDir());
        QVERIFY(!QFileInfo::exists(CopiedPictures::recordPath(rig.images())));
    }

    void fileInUseEndsTheRunBeforeAnyPage()
    {
        Rig rig;
        QDir().mkpath(rig.output);
        writeFile(rig.out(QStringLiteral("zo000002.htm")));
        rig.files.failingPaths.insert(rig.out(QStringLiteral("zo000002.htm")));
        const RunOutcome outcome = rig.control->makeCatalog();
        QCOMPARE(outcome.ending, Ending::Failed);
        QVERIFY(outcome.message.contains(QStringLiteral("zo000002.htm")));
        QCOMPARE(rig.told().second, MessageIcon::Critical);
        QCOMPARE(rig.stages->names(), QStringList{QStringLiteral("BuildAndCollectData")});
        QVERIFY(rig.user.browsed.isEmpty());
    }

    // What each failing part does to the run: a failed collection step is told with the
    // information icon and the catalog is still written from what was collected; any other
    // fault is told as a fault and ends the run where it happened.
    void aFailureEndsTheRunOrWarns_data()
    {
        QTest::addColumn<QString>("failing");
        QTest::addColumn<bool>("list");
        QTest::addColumn<Ending>("ending");
        QTest::addColumn<int>("stagesRun");
        QTest::addColumn<bool>("shown"); // the result was handed to the browser
        QTest::newRow("collection cannot start")
            << QStringLiteral("collect") << false << Ending::Failed << 1 << false;
        QTest::newRow("a collection step") << QStringLiteral("step") << false << Ending::Partial << 4 << true;
        QTest::newRow("pictures") << QStringLiteral("images") << false << Ending::Failed << 2 << false;
        QTest::newRow("pages") << QStringLiteral("pages") << false << Ending::Failed << 3 << false;
        QTest::newRow("stylesheet") << QStringLiteral("css") << false << Ending::Failed << 4 << false;
        QTest::newRow("browser") << QStringLiteral("browser") << false << Ending::Failed << 4 << true;
        QTest::newRow("list, a collection step")
            << QStringLiteral("step") << true << Ending::Partial << 2 << true;
        QTest::newRow("list page") << QStringLiteral("list") << true << Ending::Failed << 2 << false;
        QTest::newRow("list, browser") << QStringLiteral("browser") << true << Ending::Failed << 2 << true;
    }
    void aFailureEndsTheRunOrWarns()
    {
        QFETCH(QString, failing);
        QFETCH(bool, list);
        QFETCH(Ending, ending);
        QFETCH(int, stagesRun);
        QFETCH(bool, shown);
        Rig rig;
        const QString text = QStringLiteral("פריט K6: הטקסט ארוך מדי");
        const QMap<QString, Status *> parts = {{QStringLiteral("collect"), &rig.stages->collectResult},
                                               {QStringLiteral("step"), &rig.stages->stepFailure},
                                               {QStringLiteral("images"), &rig.stages->imagesResult},
                                               {QStringLiteral("pages"), &rig.stages->pagesResult},
                                               {QStringLiteral("css"), &rig.stages->cssResult},
                                               {QStringLiteral("list"), &rig.stages->listResult},
                                               {QStringLiteral("browser"), &rig.user.browserResult}};
        *parts.value(failing) = Status::fault(text);
        const RunOutcome outcome = list ? rig.control->makeList(true) : rig.control->makeCatalog();
        QCOMPARE(outcome.ending, ending);
        QCOMPARE(outcome.message, text);
        QCOMPARE(rig.told().first, text);
        QCOMPARE(rig.told().second,
                 ending == Ending::Partial ? MessageIcon::Information : MessageIcon::Critical);
        QCOMPARE(rig.stages->names().size(), stagesRun);
        QCOMPARE(rig.user.browsed.size(), shown ? 1 : 0);
        QCOMPARE(outcome.file, shown ? rig.user.browsed.constFirst() : QString());
        QVERIFY(!rig.control->isRunning());
    }

    void catalogWithoutItemsOpensNoWindow()
    {
        Rig rig;
        rig.stages->firstPage.clear();
        QCOMPARE(rig.control->makeCatalog().ending, Ending::NoItems);
        QVERIFY(rig.user.browsed.isEmpty());
        QCOMPARE(rig.told().second, MessageIcon::Information);

        // After a failed step the run stays partial, which says more than "no items".
        rig.stages->stepFailure = Status::fault(QStringLiteral("step"));
        QCOMPARE(rig.control->makeCatalog().ending, Ending::Partial);
        QVERIFY(rig.user.browsed.isEmpty());
    }

    // A stop pressed while idle is forgotten when a run starts; a stop during the collection
    // shortens the collection, and is cleared again before the output is written; a stop
    // during the writing leaves a shorter result, which is still shown.
    void stopRequestIsClearedWhereRunsStart()
    {
        Rig rig;
        rig.control->requestStop();
        QCOMPARE(rig.user.yields, 1);
        rig.stages->during = [&rig](const QString &stage) {
            if (stage == QLatin1String("BuildAndCollectData"))
                rig.control->requestStop();
        };
        QCOMPARE(rig.control->makeCatalog().ending, Ending::Stopped);
        QCOMPARE(rig.stages->stopSeen, (QList<bool>{false, false, false, false}));
        QVERIFY(!rig.control->runState().StopRequested);

        rig.control->requestStop();
        rig.stages->during = [&rig](const QString &stage) {
            if (stage == QLatin1String("CreateCatHTML"))
                rig.control->requestStop();
        };
        const RunOutcome outcome = rig.control->makeCatalog();
        QCOMPARE(outcome.ending, Ending::Stopped);
        QCOMPARE(outcome.file, rig.out(QStringLiteral("zoindex.htm")));
        QCOMPARE(rig.user.browsed.size(), 2);

        rig.control->requestStop();
        rig.stages->during = {};
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
        QCOMPARE(rig.stages->names().count(QStringLiteral("BuildAndCollectData")), 1);
        QCOMPARE(rig.store.writes, 0);
        QVERIFY(!rig.control->isRunning());
        rig.control->saveSettings();
        QCOMPARE(rig.store.get(QStringLiteral("TopTitle")), QStringLiteral("changed"));
    }
};

QTEST_GUILESS_MAIN(CatalogControlTest)
#include "CatalogControlTest.moc"
