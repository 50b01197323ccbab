// The web catalog benchmark. Writes the web catalog of a working database of 100,000 items
// (8 x 3 a page, a picture box of 120 x 90, four text lines, 1,000 distinct JPEG pictures of
// 1600 x 1200) twice into the same folder: the first run makes the thumbnails, the second
// reuses them. Next to it, the classic catalog run on the same data (a file per page with its
// pictures copied, as the catalog button writes it), each timed with its peak memory.
//
//   web-benchmark [--items N] [--pictures N] [--folder DIR] [--sections on|off]
#include "BenchCatalog.h"
#include "CameraPictures.h"
#include "MemoryUse.h"
#include "model/CatalogSettings.h"
#include "model/ConnectionParams.h"
#include "model/RunContext.h"
#include "model/RunState.h"
#include "model/UserPort.h"
#include "output/CatalogPages.h"
#include "output/ImageCollection.h"
#include "output/OutputFolder.h"
#include "output/Stylesheet.h"
#include "platform/FileSystem.h"
#include "web/CatalogSite.h"

#include <QCommandLineParser>
#include <QCoreApplication>
#include <QDateTime>
#include <QDir>
#include <QElapsedTimer>
#include <QTemporaryDir>
#include <cstdio>
#include <ctime>
#include <functional>

using namespace zorbin;
using namespace zorbin::bench;

namespace {

struct Timing
{
    double seconds = 0;
    double cpuSeconds = 0; // the process's own, less swayed by other programs on the machine
    double peakMb = 0;
};

Timing measure(const std::function<void()> &run)
{
    resetPeakMemory();
    QElapsedTimer timer;
    timer.start();
    const std::clock_t cpu = std::clock();
    run();
    return {timer.nsecsElapsed() / 1e9, static_cast<double>(std::clock() - cpu) / CLOCKS_PER_SEC,
            peakMemoryKb() / 1024.0};
}

// Files in the folder (not below it) changed since `since`, and their total size.
std::pair<int, double> filesSince(const QString &folder, const QDateTime &since)
{
    int count = 0;
    double megabytes = 0;
    for (const QFileInfo &file : QDir(folder).entryInfoList(QDir::Files)) {
        if (file.lastModified() >= since) {
            ++count;
            megabytes += file.size() / 1e6;
        }
    }
    return {count, megabytes};
}

} // namespace

int main(int argc, char *argv[])
{
    QCoreApplication app(argc, argv);
    QCommandLineParser parser;
    parser.addHelpOption();
    const QCommandLineOption itemsOption(QStringLiteral("items"), QStringLiteral("catalog items"),
                                         QStringLiteral("N"), QStringLiteral("100000"));
    const QCommandLineOption picturesOption(QStringLiteral("pictures"), QStringLiteral("distinct pictures"),
                                            QStringLiteral("N"), QStringLiteral("1000"));
    const QCommandLineOption folderOption(
        QStringLiteral("folder"),
        QStringLiteral("work folder, its pictures kept (default: a new temporary one)"),
        QStringLiteral("DIR"));
    const QCommandLineOption sectionsOption(QStringLiteral("sections"), QStringLiteral("on or off"),
                                            QStringLiteral("ON"), QStringLiteral("on"));
    parser.addOptions({itemsOption, picturesOption, folderOption, sectionsOption});
    parser.process(app);
    const int items = parser.value(itemsOption).toInt();

    QTemporaryDir temporary;
    const QString work = parser.isSet(folderOption) ? parser.value(folderOption) : temporary.path();
    QDir(work).mkpath(QStringLiteral("pictures"));
    const QString output = work + QStringLiteral("/catalog/");
    const QString site = work + QStringLiteral("/site");
    const QString database = work + QStringLiteral("/zorbindb.tmp");

    QElapsedTimer preparing;
    preparing.start();
    const Result<QStringList> pictures = makeCameraPictures(
        work + QStringLiteral("/pictures"), parser.value(picturesOption).toInt(), QSize(1600, 1200));
    fail(pictures.status());
    fail(makeWorkDatabase(database, items, pictures.value()));
    std::printf("Prepared %d items and %lld pictures of 1600 x 1200 in %s in %.1f s\n", items,
                static_cast<long long>(pictures->size()), qPrintable(work), preparing.nsecsElapsed() / 1e9);

    CatalogSettings settings;
    useBenchSettings(settings, output, pictures->constFirst());
    settings.pageSplit = PageSplit::FilePerPage;
    ConnectionParams connection;
    RunState state;
    QuietUserPort user;
    RunContext context{settings, connection, state, user, localFileSystem()};
    fail(ensureFolder(context.files, output));

    // The classic run as the catalog button makes it: clean, copy the pictures, pages, stylesheet.
    const auto classic = [&] {
        const QString images = imagesFolderOf(output);
        fail(cleanCatalogOutput(context.files, output));
        fail(CollectCatImages(context, images, database));
        fail(CreateCatHTML(context, output + PagePrefixName, database, images).status());
        fail(CreateCSS(context, output, true));
    };
    const auto classicRun = [&](int round) {
        const Timing timing = measure(classic);
        std::printf("Classic catalog run %d: %.2f s (CPU %.2f s), peak memory %.1f MB\n", round,
                    timing.seconds, timing.cpuSeconds, timing.peakMb);
        return timing;
    };
    classicRun(1);

    QDir(site).removeRecursively();
    const SiteRequest request{site, database, parser.value(sectionsOption) != QLatin1String("off")};
    const auto webRun = [&](int round) {
        const QDateTime start = QDateTime::currentDateTime().addMSecs(-20);
        const Timing timing = measure([&] { fail(CreateCatSite(context, request).status()); });
        const auto [thumbnails, megabytes] = filesSince(site + QStringLiteral("/pictures"), start);
        const auto [pages, pageMegabytes] = filesSince(site, start);
        std::printf(
            "Web catalog run %d, sections %s: %.2f s (CPU %.2f s), peak memory %.1f MB; %d files %.1f MB "
            "written into the site folder, %d into its pictures folder (%.1f MB)\n",
            round, request.sections ? "on" : "off", timing.seconds, timing.cpuSeconds, timing.peakMb, pages,
            pageMegabytes, thumbnails, megabytes);
        return timing;
    };
    webRun(1); // the thumbnails are made
    // Then the two alternately, so that both meet the same moods of a shared machine.
    for (int round = 2; round <= 4; ++round) {
        const Timing classicTiming = classicRun(round);
        const Timing webTiming = webRun(round);
        std::printf("  web run %d against classic run %d: %.2fx (CPU %.2fx)\n", round, round,
                    webTiming.seconds / classicTiming.seconds,
                    webTiming.cpuSeconds / classicTiming.cpuSeconds);
    }
    return 0;
}
