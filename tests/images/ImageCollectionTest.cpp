#include "output/ImageCollection.h"

#include "model/CatalogSettings.h"
#include "model/ConnectionParams.h"
#include "model/RunContext.h"
#include "model/RunState.h"
#include "output/CopiedPictures.h"
#include "platform/ForwardingFileSystem.h"
#include "testutil/FaultyFileSystem.h"
#include "testutil/RecordingUserPort.h"
#include "testutil/TestFiles.h"
#include "testutil/TestMain.h"
#include "testutil/WorkDatabaseFixture.h"

#include <QDir>
#include <QFileInfo>
#include <QTemporaryDir>
#include <QTest>

using namespace zorbin;
using namespace zorbin::test;

namespace {

// The file system of the tests: the real one, failing the paths of `inner.failingPaths`, and
// counting the copies it makes.
class CountingFileSystem final : public ForwardingFileSystem
{
public:
    CountingFileSystem() : ForwardingFileSystem(inner) {}

    Status copyFile(const QString &from, const QString &to) override
    {
        copies << QFileInfo(to).fileName();
        return ForwardingFileSystem::copyFile(from, to);
    }

    // The target names of the copies, in order.
    QStringList copies;
    FaultyFileSystem inner;
};

// A catalog run's surroundings: a pictures folder, an emptied images folder, a working database.
struct Catalog
{
    Catalog()
    {
        QDir(root.path()).mkpath(QStringLiteral("pictures"));
        QDir(root.path()).mkpath(QStringLiteral("images"));
        settings.lines[0].field = 0; // the picture
        settings.lines[1].field = 2; // the name
        settings.sortKey = SortKey::ItemKey;
        settings.sortDirection = SortDirection::Ascending;
    }

    QString picture(const QString &name) const { return root.filePath(QStringLiteral("pictures/") + name); }
    QString images() const { return root.filePath(QStringLiteral("images")); }
    QString database() const { return root.filePath(QStringLiteral("zorbindb.tmp")); }
    QStringList imageFiles() const
    {
        QStringList names = QDir(images()).entryList(QDir::Files, QDir::Name);
        names.removeAll(CopiedPictures::RecordName);
        return names;
    }
    QStringList recorded() const { return CopiedPictures::read(files, images()); }

    // Items "A01", "A02", ... showing the given picture references; each referenced file in
    // the pictures folder exists unless its name starts with "missing".
    void makeItems(const QStringList &references)
    {
        WorkRows rows;
        for (qsizetype i = 0; i < references.size(); ++i) {
            WorkItem item(QStringLiteral("A%1").arg(i + 1, 2, 10, QLatin1Char('0')));
            item.picture = references.at(i).isNull() ? QVariant() : QVariant(references.at(i));
            rows.items << item;
        }
        QVERIFY2(makeWorkDatabase(database(), rows).isOk(), "working database");
    }

    Status collect()
    {
        RunContext context{settings, connection, state, user, files};
        return CollectCatImages(context, images(), database());
    }

    QTemporaryDir root;
    CatalogSettings settings;
    ConnectionParams connection;
    RunState state;
    RecordingUserPort user;
    CountingFileSystem files;
};

QStringList picturesNamed(Catalog &catalog, int count)
{
    QStringList references;
    for (int i = 1; i <= count; ++i) {
        const QString name = QStringLiteral("p%1.jpg").arg(i, 2, 10, QLatin1Char('0'));
        writeFile(catalog.picture(name), name.toLatin1());
        references << catalog.picture(name);
    }
    return references;
}

} // namespace

// Copying the logo and the catalog's pictures into the images folder.
class ImageCollectionTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void copiesEveryPictureWithProgress()
    {
        Catalog catalog;
        const QStringList references = picturesNamed(catalog, 12);
        catalog.makeItems(references);
        QVERIFY(catalog.collect().isOk());
        QCOMPARE(catalog.imageFiles().size(), 12);
        QCOMPARE(readFile(catalog.images() + QStringLiteral("/p07.jpg")), QByteArray("p07.jpg"));
        // After items 5 and 10, 5/12 and 10/12 of the frame of 1000, then back to 0.
        QCOMPARE(catalog.user.widths, (QList<int>{0, 417, 833, 0}));
        QCOMPARE(catalog.user.yields, 2);
        QCOMPARE(catalog.recorded(), catalog.imageFiles());
    }

    void copiesOnlyTheCatalogItemsInCatalogOrder()
    {
        Catalog catalog;
        const QStringList references = picturesNamed(catalog, 4);
        WorkRows rows;
        for (int i = 0; i < 4; ++i) {
            WorkItem item(QStringLiteral("K%1").arg(4 - i));
            item.picture = references.at(i);
            item.include = i != 1;
            rows.items << item;
        }
        QVERIFY(makeWorkDatabase(catalog.database(), rows).isOk());
        QVERIFY(catalog.collect().isOk());
        // Sorted by key: K1 (p04), K2 (p03), K4 (p01); K3 (p02) is not in the catalog.
        QCOMPARE(catalog.files.copies, (QStringList{u"p04.jpg"_qs, u"p03.jpg"_qs, u"p01.jpg"_qs}));
    }

    void aStopKeepsTheCopiesMadeSoFar()
    {
        Catalog catalog;
        catalog.makeItems(picturesNamed(catalog, 12));
        catalog.user.onYield = [&catalog] { catalog.state.StopRequested = true; };
        QVERIFY(catalog.collect().isOk());
        QCOMPARE(catalog.imageFiles(),
                 (QStringList{u"p01.jpg"_qs, u"p02.jpg"_qs, u"p03.jpg"_qs, u"p04.jpg"_qs, u"p05.jpg"_qs}));
        QCOMPARE(catalog.recorded(), catalog.imageFiles());
        // The bar stays where the stop found it.
        QCOMPARE(catalog.user.widths, (QList<int>{0, 417}));
    }

    void missingPicturesAreNoFault()
    {
        Catalog catalog;
        QStringList references = picturesNamed(catalog, 1);
        // A file literally named "?" and a name that a pattern "p?1.jpg" would match.
        writeFile(catalog.picture(u"?"_qs));
        references << catalog.picture(u"missing.jpg"_qs) << u"?"_qs << QString() << QString(u""_qs)
                   << catalog.picture(u"p?1.jpg"_qs) << catalog.picture(u"*.jpg"_qs) << catalog.root.path();
        catalog.makeItems(references);
        const QString previous = QDir::currentPath();
        QDir::setCurrent(catalog.picture(QString())); // where a relative "?" would be looked up
        const Status status = catalog.collect();
        QDir::setCurrent(previous);
        QVERIFY2(status.isOk(), qPrintable(status.description()));
        QCOMPARE(catalog.imageFiles(), QStringList{u"p01.jpg"_qs});
        QCOMPARE(catalog.user.widths.last(), 0);
    }

    void aSharedPictureIsCopiedOnce()
    {
        Catalog catalog;
        const QStringList two = picturesNamed(catalog, 2);
        QStringList references;
        // 100 items (the fixture writes a row at a time): each picture is copied once.
        for (int i = 0; i < 100; ++i)
            references << two.at(i % 2 == 0 ? 0 : 1);
        catalog.makeItems(references);
        QVERIFY(catalog.collect().isOk());
        QCOMPARE(catalog.files.copies, (QStringList{u"p01.jpg"_qs, u"p02.jpg"_qs}));
        QCOMPARE(catalog.recorded(), (QStringList{u"p01.jpg"_qs, u"p02.jpg"_qs}));
    }

    void theLaterOfTwoPicturesOfOneNameWins()
    {
        Catalog catalog;
        QDir(catalog.root.path()).mkpath(u"other"_qs);
        const QString first = catalog.picture(u"same.jpg"_qs);
        const QString second = catalog.root.filePath(u"other/same.jpg"_qs);
        writeFile(first, "first");
        writeFile(second, "second");
        catalog.makeItems({first, second, first, second});
        QVERIFY(catalog.collect().isOk());
        QCOMPARE(readFile(catalog.images() + u"/same.jpg"_qs), QByteArray("second"));
        QCOMPARE(catalog.recorded(), QStringList{u"same.jpg"_qs});
    }

    void theLogoAloneWithoutAPictureLine()
    {
        Catalog catalog;
        catalog.settings.lines[0].field = 1; // the key instead of the picture
        catalog.makeItems(picturesNamed(catalog, 3));
        writeFile(catalog.picture(u"logo.png"_qs), "logo");
        catalog.settings.logo = catalog.picture(u"logo.png"_qs);
        const Status status = catalog.collect();
        QVERIFY2(status.isOk(), qPrintable(status.description()));
        QCOMPARE(catalog.imageFiles(), QStringList{u"logo.png"_qs});
        QCOMPARE(catalog.recorded(), QStringList{u"logo.png"_qs});
        QCOMPARE(catalog.user.widths, (QList<int>{0, 0}));
    }

    void theLogoWithoutItems()
    {
        Catalog catalog;
        catalog.makeItems({});
        writeFile(catalog.picture(u"logo.png"_qs), "logo");
        catalog.settings.logo = catalog.picture(u"logo.png"_qs);
        QVERIFY(catalog.collect().isOk());
        QCOMPARE(catalog.imageFiles(), QStringList{u"logo.png"_qs});
    }

    void aMissingLogoIsNoFault()
    {
        Catalog catalog;
        catalog.makeItems(picturesNamed(catalog, 1));
        catalog.settings.logo = catalog.picture(u"no-logo.png"_qs);
        QVERIFY(catalog.collect().isOk());
        QCOMPARE(catalog.imageFiles(), QStringList{u"p01.jpg"_qs});
    }

    void aFailedCopyKeepsTheCopiesMadeSoFar()
    {
        Catalog catalog;
        catalog.makeItems(picturesNamed(catalog, 6));
        catalog.files.inner.failingPaths << catalog.images() + u"/p04.jpg"_qs;
        const Status status = catalog.collect();
        QVERIFY(!status.isOk());
        QVERIFY2(status.description().contains(u"p04.jpg"_qs), qPrintable(status.description()));
        QCOMPARE(catalog.imageFiles(), (QStringList{u"p01.jpg"_qs, u"p02.jpg"_qs, u"p03.jpg"_qs}));
        QCOMPARE(catalog.recorded(), catalog.imageFiles());
    }

    void aPictureInTheImagesFolderIsNoCopy()
    {
        Catalog catalog;
        const QString own = catalog.images() + u"/own.jpg"_qs;
        writeFile(own, "own");
        catalog.makeItems({own});
        QVERIFY(catalog.collect().isOk());
        // Not recorded, so the next run does not delete the user's own picture.
        QVERIFY(catalog.recorded().isEmpty());
        QVERIFY(CopiedPictures::removeAll(catalog.files, catalog.images()).isOk());
        QCOMPARE(readFile(own), QByteArray("own"));
    }

    void theLocalCopyReplacesAndReports()
    {
        QTemporaryDir folder;
        const QString source = folder.filePath(u"source.jpg"_qs);
        const QString target = folder.filePath(u"target.jpg"_qs);
        const QByteArray picture = QByteArray(200 * 1024, 'p') + "end"; // more than one block
        writeFile(source, picture);
        writeFile(target, QByteArray(500 * 1024, 'o'));
        FileSystem &files = localFileSystem();
        QVERIFY(files.copyFile(source, target).isOk());
        QCOMPARE(readFile(target), picture);
        const Status missing = files.copyFile(folder.filePath(u"none.jpg"_qs), target);
        QVERIFY(!missing.isOk());
        QVERIFY2(missing.description().contains(u"none.jpg"_qs), qPrintable(missing.description()));
        const Status noFolder = files.copyFile(source, folder.filePath(u"no/such/folder/x.jpg"_qs));
        QVERIFY(!noFolder.isOk());
        QVERIFY(!QFileInfo::exists(folder.filePath(u"no/such/folder/x.jpg"_qs)));
    }

    void aMissingWorkingDatabaseIsAFault()
    {
        Catalog catalog;
        const Status status = catalog.collect();
        QVERIFY(!status.isOk());
        QVERIFY(!status.description().isEmpty());
    }
};

ZORBIN_TEST_CLASS(ImageCollectionTest)
#include "ImageCollectionTest.moc"
