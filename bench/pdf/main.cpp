// The PDF benchmark. Collects the large demo database (100,000 items by default) from its file,
// gives the items 1,000 distinct pictures, and writes the catalog as a PDF: 8 x 3 cells a page,
// a picture and three lines (name, key, price), both bands and the logo, frames.
// Reports seconds, pages a second, the file's size, peak memory and how often pictures were
// decoded and stored.
//
//   pdf-benchmark [--items N] [--pictures N] [--keep FILE]
#include "collection/LargeDemo.h"
#include "model/CatalogSettings.h"
#include "model/ConnectionParams.h"
#include "model/RunContext.h"
#include "model/RunState.h"
#include "model/UserPort.h"
#include "output/BenchCatalog.h"
#include "output/MemoryUse.h"
#include "pdf/CatalogPdf.h"
#include "platform/FileSystem.h"
#include "testutil/AccountingFixture.h"
#include "workdb/CollectionRun.h"
#include "workdb/SqliteEngine.h"
#include "workdb/WorkDatabase.h"

#include <QCommandLineParser>
#include <QDir>
#include <QElapsedTimer>
#include <QFile>
#include <QFileInfo>
#include <QGuiApplication>
#include <QTemporaryDir>
#include <cstdio>
#include <ctime>

using namespace zorbin;
using namespace zorbin::bench;

namespace {

// Processor time of the process: on a machine that other work shares, the wall-clock figures
// vary from run to run and this much less.
double cpuSeconds()
{
    timespec now{};
    clock_gettime(CLOCK_PROCESS_CPUTIME_ID, &now);
    return static_cast<double>(now.tv_sec) + static_cast<double>(now.tv_nsec) / 1e9;
}

// How many image objects the PDF stores: Qt writes each one's dictionary uncompressed.
int storedImages(const QString &path)
{
    static const QByteArray mark("/Subtype /Image");
    QFile file(path);
    if (!file.open(QIODevice::ReadOnly))
        return -1;
    int count = 0;
    QByteArray carry;
    while (!file.atEnd()) {
        const QByteArray block = carry + file.read(4 << 20);
        for (qsizetype at = block.indexOf(mark); at >= 0; at = block.indexOf(mark, at + 1))
            ++count;
        carry = block.right(mark.size() - 1);
    }
    return count;
}

void chooseData(ChoiceList &list, int itemData)
{
    list.clear();
    list.setCurrentIndex(list.addEntry(QStringLiteral("list %1").arg(itemData), itemData));
}

// The collection: pictures from the file field, standard names, price list 1.
void collectionSettings(CatalogSettings &settings)
{
    settings.pictureSource = PictureSource::FileField;
    settings.itemName = ItemNameSource::Standard;
    settings.collectPrice1 = true;
    chooseData(settings.priceList1, 1);
}

// The catalog: 8 x 3, a picture line fitted into 120 x 90 pixels, name, key and price.
void catalogSettings(CatalogSettings &settings, const QString &logo)
{
    settings.rows = 8;
    settings.columns = 3;
    settings.pictureWidth = 120;
    settings.pictureHeight = 90;
    settings.topPercent = 10;
    settings.bottomPercent = 8;
    settings.topTitle = QStringLiteral("קטלוג מוצרים");
    settings.topTitle2 = QStringLiteral("מהדורת בדיקה");
    settings.bottomTitle = QStringLiteral("כל הזכויות שמורות");
    settings.logo = logo;
    settings.frameItems = true;
    const QStringList tags{QStringLiteral("0"), QStringLiteral("2"), QStringLiteral("1"),
                           QStringLiteral("4")};
    const QStringList captions{QString(), QString(), QStringLiteral("מק\"ט:"), QStringLiteral("מחיר:")};
    for (qsizetype i = 0; i < tags.size(); ++i) {
        CellLine &line = settings.lines[static_cast<std::size_t>(i)];
        line.field = fieldOfTag(tags.at(i));
        line.caption = captions.at(i);
    }
    settings.lines[1].format.weight = 2;
    settings.lines[1].format.size = 10;
}

} // namespace

int main(int argc, char *argv[])
{
    zorbin::setUpSqliteEngine();
    if (qEnvironmentVariableIsEmpty("DISPLAY") && qEnvironmentVariableIsEmpty("WAYLAND_DISPLAY") &&
        qEnvironmentVariableIsEmpty("QT_QPA_PLATFORM"))
        qputenv("QT_QPA_PLATFORM", "offscreen");
    QGuiApplication app(argc, argv);
    QCommandLineParser parser;
    parser.addHelpOption();
    const QCommandLineOption itemsOption(QStringLiteral("items"), QStringLiteral("catalog items"),
                                         QStringLiteral("N"), QStringLiteral("100000"));
    const QCommandLineOption picturesOption(QStringLiteral("pictures"), QStringLiteral("distinct pictures"),
                                            QStringLiteral("N"), QStringLiteral("1000"));
    const QCommandLineOption keepOption(QStringLiteral("keep"), QStringLiteral("keep the PDF as FILE"),
                                        QStringLiteral("FILE"));
    parser.addOptions({itemsOption, picturesOption, keepOption});
    parser.process(app);
    const int items = parser.value(itemsOption).toInt();
    const int pictureCount = parser.value(picturesOption).toInt();
    if (items < 1 || pictureCount < 1)
        parser.showHelp(2);

    const QString data = QStringLiteral(ZORBIN_BENCH_DATA_DIR);
    QDir().mkpath(data);
    const Result<QString> source = largeDemoDatabase(data, items);
    fail(source.status());
    QTemporaryDir work;
    qputenv("TMPDIR", QFile::encodeName(work.path())); // the working database goes there

    QElapsedTimer preparing;
    preparing.start();
    CatalogSettings settings;
    ConnectionParams connection = test::fileConnection(source.value());
    RunState state;
    QuietUserPort user;
    RunContext context{settings, connection, state, user, localFileSystem()};
    collectionSettings(settings);
    const Result<CollectionReport> collected = BuildAndCollectData(context);
    fail(collected ? collected->stepFailure : collected.status());

    // The pictures: made once into the benchmark data folder, then reused.
    const QString pictureFolder = QDir(data).filePath(QStringLiteral("pdf-pictures-%1").arg(pictureCount));
    const QString made = pictureFolder + QStringLiteral("/.complete");
    QDir().mkpath(pictureFolder);
    if (!QFileInfo::exists(made)) {
        fail(makePictures(pictureFolder, pictureCount).status());
        QFile(made).open(QIODevice::WriteOnly);
    }
    {
        auto database = WorkDatabase::open(state.WorkDBFile);
        fail(database.status());
        // Item K0000001 shows picture 1, ... item i picture i % N, as makePictures names them.
        const WriteOutcome updated = database.value()->exec(
            QStringLiteral(
                "UPDATE tItems SET ItemPic = '%1/pic' || printf('%04d', CAST(substr(ItemKey, 2) AS "
                "INTEGER) % %2) || CASE CAST(substr(ItemKey, 2) AS INTEGER) % %2 % 2 WHEN 0 THEN "
                "'.png' ELSE '.jpg' END")
                .arg(pictureFolder)
                .arg(pictureCount));
        if (!updated)
            qFatal("%s", qPrintable(updated.description()));
    }
    catalogSettings(settings, pictureFolder + QStringLiteral("/logo.png"));
    std::printf("Prepared %d items (%s) and %d pictures in %.1f s\n", items, qPrintable(source.value()),
                pictureCount, preparing.nsecsElapsed() / 1e9);

    const QString pdf =
        parser.isSet(keepOption) ? parser.value(keepOption) : work.filePath(QStringLiteral("catalog.pdf"));
    resetPeakMemory();
    QElapsedTimer timer;
    const double cpuStart = cpuSeconds();
    timer.start();
    const Result<PdfWritten> written = CreateCatPDF(context, {pdf, state.WorkDBFile, PdfPageSize::A4});
    const double seconds = timer.nsecsElapsed() / 1e9;
    const double cpu = cpuSeconds() - cpuStart;
    const long peakKb = peakMemoryKb();
    fail(written.status());
    if (written->ending != PdfWritten::Ending::Written)
        qFatal("no PDF was written");
    const double megabytes = QFileInfo(pdf).size() / 1e6;
    std::printf(
        "PDF: %lld pages in %.2f s = %.0f pages/s (processor time %.2f s); %.1f MB; peak memory %.1f MB\n",
        written->pages, seconds, written->pages / seconds, cpu, megabytes, peakKb / 1024.0);
    std::printf(
        "  %d picture files decoded (each once), at most %d kept at once; %d image objects stored for %d "
        "distinct pictures and the logo\n",
        written->picturesDecoded, written->picturesHeldAtMost, storedImages(pdf), pictureCount);
    std::printf("  goals: under 30 s (%s), under 300 MB (%s)\n", seconds < 30 ? "met" : "missed",
                peakKb / 1024.0 < 300 ? "met" : "missed");
    return 0;
}
