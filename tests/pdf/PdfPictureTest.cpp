// Pictures: EXIF orientation, scaling while decoding, transparency on white, broken and missing
// files, each picture stored once; and a stop that leaves no half-written PDF.
#include "PdfFixture.h"
#include "pdf/CatalogPdf.h"
#include "testutil/TestFiles.h"
#include "testutil/TestMain.h"
#include "testutil/WorkDatabaseFixture.h"

#include <QColor>
#include <QDir>
#include <QImage>
#include <QSet>
#include <QTemporaryDir>
#include <QTest>

using namespace zorbin;
using namespace zorbin::test;

namespace {

QString picture(const char *name)
{
    return QStringLiteral(ZORBIN_PDF_TEST_PICTURES "/") + QLatin1String(name);
}

bool near(QRgb pixel, QRgb wanted)
{
    return std::abs(qRed(pixel) - qRed(wanted)) < 40 && std::abs(qGreen(pixel) - qGreen(wanted)) < 40 &&
           std::abs(qBlue(pixel) - qBlue(wanted)) < 40;
}

} // namespace

class PdfPictureTest : public QObject
{
    Q_OBJECT

    QTemporaryDir m_folder;
    QString m_database;
    TestCatalog m_catalog;

    Result<PdfWritten> write(PdfRig &rig, const QString &file, const QString &database)
    {
        applyCatalog(m_catalog, rig.settings);
        return CreateCatPDF(rig.context, {file, database, PdfPageSize::A4});
    }

private Q_SLOTS:
    void initTestCase()
    {
        QVERIFY(m_folder.isValid());
        m_folder.setAutoRemove(!keepTestFiles(m_folder.path()));
        m_database = m_folder.filePath(QStringLiteral("work.db"));
        const QStringList pictures{picture("photo-exif.jpg"),  picture("photo-exif.jpg"),
                                   picture("transparent.png"), picture("broken.jpg"),
                                   picture("missing.jpg"),     QStringLiteral("?"),
                                   picture("photo-exif.jpg")};
        WorkRows rows;
        for (qsizetype i = 0; i < pictures.size(); ++i) {
            WorkItem item(QStringLiteral("P%1").arg(i));
            item.name = QStringLiteral("תמונה %1").arg(i);
            item.picture = pictures.at(i);
            rows.items << item;
        }
        QVERIFY(makeWorkDatabase(m_database, rows));
        m_catalog.rows = 2;
        m_catalog.columns = 4;
        m_catalog.lines = {{0, {}}, {2, {}}};
    }

    void picturesAreDecodedAndStoredOnce()
    {
        PdfRig rig;
        const QString pdf = m_folder.filePath(QStringLiteral("pictures.pdf"));
        const Result<PdfWritten> written = write(rig, pdf, m_database);
        QVERIFY2(written, qPrintable(written.status().description()));
        QCOMPARE(written->pages, 1);
        QCOMPARE(written->picturesDecoded, 3);    // the photograph, the PNG, the broken file; each once
        QCOMPARE(written->picturesHeldAtMost, 2); // each let go after its last item

        // Four pictures drawn (three items show the photograph), two stored, no transparency left.
        const QList<ImageRow> images = pdfImages(pdf);
        QSet<int> objects;
        for (const ImageRow &image : images) {
            QCOMPARE(image.type, QStringLiteral("image"));
            objects.insert(image.object);
        }
        QCOMPARE(images.size(), 4);
        QCOMPARE(objects.size(), 2);

        // Extract them: the photograph upright (its left half blue) and no larger than its box at
        // 300 dpi; the PNG at its own size with its transparent half white.
        QVERIFY(runTool(QStringLiteral("pdfimages"),
                        {QStringLiteral("-png"), pdf, m_folder.filePath(QStringLiteral("x"))})
                    .exitCode == 0);
        const QImage photo(m_folder.filePath(QStringLiteral("x-000.png")));
        QVERIFY(!photo.isNull());
        QVERIFY2(photo.width() < photo.height() && photo.height() < 1000,
                 qPrintable(QStringLiteral("%1 x %2").arg(photo.width()).arg(photo.height())));
        QVERIFY(near(photo.pixel(photo.width() / 4, photo.height() / 2), qRgb(0, 0, 255)));
        QVERIFY(near(photo.pixel(photo.width() * 3 / 4, photo.height() / 2), qRgb(255, 0, 0)));
        QImage flat;
        for (const QString &name : QDir(m_folder.path()).entryList({QStringLiteral("x-*.png")})) {
            const QImage image(m_folder.filePath(name));
            if (image.size() == QSize(300, 200))
                flat = image;
        }
        QVERIFY(!flat.isNull());
        QVERIFY(near(flat.pixel(20, 100), qRgb(255, 255, 255)));
        QVERIFY(near(flat.pixel(280, 100), qRgb(0, 192, 0)));
    }

    // Many distinct pictures, each shown twice, half the catalog apart, so that all are kept at
    // once: every one decoded and stored once, drawn from where it was kept (a cache that moved
    // its pictures as it grew drew freed memory).
    void manyPicturesEachStoredOnce()
    {
        const QString database = m_folder.filePath(QStringLiteral("many.db"));
        WorkRows rows;
        for (int i = 0; i < 128; ++i) {
            const QString file = m_folder.filePath(QStringLiteral("many%1.png").arg(i % 64));
            QImage image(40 + i % 64, 30, QImage::Format_RGB32);
            image.fill(QColor::fromHsv(i % 64 * 5, 200, 200));
            QVERIFY(i >= 64 || image.save(file));
            WorkItem item(QStringLiteral("M%1").arg(i, 3, 10, QLatin1Char('0')));
            item.picture = file;
            rows.items << item;
        }
        QVERIFY(makeWorkDatabase(database, rows));
        PdfRig rig;
        const QString pdf = m_folder.filePath(QStringLiteral("many.pdf"));
        const Result<PdfWritten> written = write(rig, pdf, database);
        QVERIFY(written);
        QCOMPARE(written->picturesDecoded, 64);
        QCOMPARE(written->picturesHeldAtMost, 64);
        QSet<int> objects;
        const QList<ImageRow> images = pdfImages(pdf);
        for (const ImageRow &image : images)
            objects.insert(image.object);
        QCOMPARE(images.size(), 128);
        QCOMPARE(objects.size(), 64);
    }

    // A stop keeps the older file as it was and leaves nothing else behind.
    void stopLeavesNoHalfWrittenFile()
    {
        QTemporaryDir folder;
        const QString pdf = folder.filePath(QStringLiteral("catalog.pdf"));
        writeFile(pdf, "an older catalog");
        PdfRig rig;
        rig.user.onYield = [&rig] { rig.state.StopRequested = true; };
        m_catalog.rows = 1;
        m_catalog.columns = 1; // a page an item: the stop comes at the fifth cell, on page 5
        const Result<PdfWritten> written = write(rig, pdf, m_database);
        m_catalog.rows = 2;
        m_catalog.columns = 4;
        QVERIFY(written);
        QCOMPARE(written->ending, PdfWritten::Ending::Stopped);
        QVERIFY(written->file.isEmpty());
        QCOMPARE(readFile(pdf), QByteArray("an older catalog"));
        QCOMPARE(QDir(folder.path()).entryList(QDir::Files | QDir::Hidden),
                 QStringList{QStringLiteral("catalog.pdf")});
        QVERIFY(rig.user.fillWidth > 0); // the bar stays where the run stopped
    }

    void noItemsWritesNothing()
    {
        const QString database = m_folder.filePath(QStringLiteral("empty.db"));
        WorkRows rows;
        WorkItem hidden(QStringLiteral("H1"));
        hidden.include = false;
        rows.items << hidden;
        QVERIFY(makeWorkDatabase(database, rows));
        PdfRig rig;
        const QString pdf = m_folder.filePath(QStringLiteral("none.pdf"));
        const Result<PdfWritten> written = write(rig, pdf, database);
        QVERIFY(written);
        QCOMPARE(written->ending, PdfWritten::Ending::NoItems);
        QVERIFY(!QFileInfo::exists(pdf));
    }
};

ZORBIN_TEST_CLASS(PdfPictureTest)
#include "PdfPictureTest.moc"
