// Copying the logo and the catalog's pictures into the images folder.
#include "output/ImageCollection.h"

#include "output/CopiedPictures.h"
#include "platform/ForwardingFileSystem.h"
#include "testutil/DamagedWorkDatabase.h"
#include "testutil/FaultyFileSystem.h"
#include "testutil/OutputContext.h"
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

// The real file system, failing the paths of `inner.failingPaths` and naming the copies it
// makes, in order.
class CountingFileSystem final : public ForwardingFileSystem
{
public:
    CountingFileSystem() : ForwardingFileSystem(inner) {}

    Status copyFile(const QString &from, const QString &to) override
    {
        copies << QFileInfo(to).fileName();
        return ForwardingFileSystem::copyFile(from, to);
    }

    QStringList copies;
    FaultyFileSystem inner;
};

// A catalog run's surroundings: a pictures folder, an empty images folder and a working
// database whose items show the picture and the key, sorted by key.
struct Catalog
{
    Catalog()
    {
        QDir(root.path()).mkpath(u"pictures"_qs);
        QDir(root.path()).mkpath(u"images"_qs);
        output.settings.lines[0].field = 0;
        output.settings.lines[1].field = 2;
        output.settings.sortKey = SortKey::ItemKey;
        output.settings.sortDirection = SortDirection::Ascending;
    }

    QString picture(const QString &name) const { return root.filePath(u"pictures/"_qs + name); }
    QString images() const { return root.filePath(u"images"_qs); }
    QString database() const { return root.filePath(u"zorbindb.tmp"_qs); }
    QStringList imageFiles() const
    {
        QStringList names = QDir(images()).entryList(QDir::Files, QDir::Name);
        names.removeAll(CopiedPictures::RecordName);
        return names;
    }
    QStringList recorded() const { return CopiedPictures::read(files, images()); }

    // Picture files "p01.jpg" to `count` in the pictures folder, each holding its own name.
    QStringList pictures(int count) const
    {
        QStringList references;
        for (int i = 1; i <= count; ++i) {
            const QString name = u"p%1.jpg"_qs.arg(i, 2, 10, QLatin1Char('0'));
            writeFile(picture(name), name.toLatin1());
            references << picture(name);
        }
        return references;
    }

    // Items "A01", "A02", ... showing the given references (a null text: null); the items at
    // the places `leftOut` are not in the catalog.
    void makeItems(const QStringList &references, const QList<int> &leftOut = {})
    {
        WorkRows rows;
        for (qsizetype i = 0; i < references.size(); ++i) {
            WorkItem item(u"A%1"_qs.arg(i + 1, 2, 10, QLatin1Char('0')));
            item.picture = references.at(i).isNull() ? QVariant() : QVariant(references.at(i));
            item.include = !leftOut.contains(i);
            rows.items << item;
        }
        QVERIFY(makeWorkDatabase(database(), rows).isOk());
    }

    Status collect() { return CollectCatImages(output.context, images(), database()); }

    QTemporaryDir root;
    CountingFileSystem files;
    OutputContext output{files};
};

} // namespace

class ImageCollectionTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    // The logo, then each picture once, in catalog order; references are looked up literally,
    // and those that name no file are no fault.
    void copiesTheCatalogsPictures()
    {
        Catalog catalog;
        const QStringList p = catalog.pictures(4);
        const QByteArray large = QByteArray(100 * 1024, 'p') + "end"; // more than one block of the copy
        writeFile(p[3], large);
        writeFile(catalog.picture(u"?"_qs)); // a file named as the no-picture mark
        writeFile(catalog.picture(u"logo.png"_qs), "logo");
        catalog.output.settings.logo = catalog.picture(u"logo.png"_qs);
        catalog.makeItems({p[3], p[0], p[2], p[0], catalog.picture(u"missing.jpg"_qs), u"?"_qs, QString(),
                           u""_qs, catalog.picture(u"p?1.jpg"_qs), catalog.picture(u"*.jpg"_qs),
                           catalog.root.path(), catalog.picture(u"P02.JPG"_qs)},
                          {2});
        catalog.output.settings.sortDirection = SortDirection::Descending;
        const QString previous = QDir::currentPath();
        QDir::setCurrent(catalog.picture(QString())); // where a relative "?" would be looked up
        const Status status = catalog.collect();
        QDir::setCurrent(previous);
        QVERIFY2(status.isOk(), qPrintable(status.description()));
        // "P02.JPG" is found as "p02.jpg" and copied under the name the pages give it.
        const QStringList copied{u"logo.png"_qs, u"P02.JPG"_qs, u"p01.jpg"_qs, u"p04.jpg"_qs};
        QCOMPARE(catalog.files.copies, copied);
        QCOMPARE(catalog.recorded(), copied);
        QCOMPARE(readFile(catalog.images() + u"/p04.jpg"_qs), large);
        QCOMPARE(readFile(catalog.images() + u"/P02.JPG"_qs), QByteArray("p02.jpg"));
        // 11 items: after items 5 and 10, 5/11 and 10/11 of the frame of 1000, then back to 0.
        QCOMPARE(catalog.output.user.widths, (QList<int>{0, 455, 909, 0}));
        QCOMPARE(catalog.output.user.yields, 2);
    }

    void aStopKeepsTheCopiesMadeSoFar()
    {
        Catalog catalog;
        catalog.makeItems(catalog.pictures(12));
        catalog.output.settings.logo = catalog.picture(u"no-logo.png"_qs); // a missing logo is no fault
        catalog.output.user.onYield = [&catalog] { catalog.output.state.StopRequested = true; };
        QVERIFY(catalog.collect().isOk());
        QCOMPARE(catalog.imageFiles(),
                 (QStringList{u"p01.jpg"_qs, u"p02.jpg"_qs, u"p03.jpg"_qs, u"p04.jpg"_qs, u"p05.jpg"_qs}));
        QCOMPARE(catalog.recorded(), catalog.imageFiles());
        // The bar stays where the stop found it.
        QCOMPARE(catalog.output.user.widths, (QList<int>{0, 417}));
    }

    void aFailedCopyKeepsTheCopiesMadeSoFar()
    {
        Catalog catalog;
        catalog.makeItems(catalog.pictures(6));
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

    void anUnreadableWorkingDatabaseIsAFault()
    {
        Catalog catalog;
        QVERIFY(!catalog.collect().isOk()); // none at all
        // The engine fails reading the last item: not the end of the catalog's pictures.
        catalog.makeItems(catalog.pictures(3));
        QVERIFY(breakReadingAt(catalog.database(), u"A03"_qs).isOk());
        catalog.output.settings.lines[2].field = 4;
        const Status status = catalog.collect();
        QVERIFY(!status.isOk());
        QVERIFY2(status.description().contains(u"overflow"_qs), qPrintable(status.description()));
    }
};

ZORBIN_TEST_CLASS(ImageCollectionTest)
#include "ImageCollectionTest.moc"
