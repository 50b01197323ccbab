// The output benchmark. Writes the catalog of a working database of 100,000 items (8 x 3 cells
// a page, a picture line with size attributes and four text lines, about 1,000 distinct
// pictures) in both page modes, and measures, in the same run and the same folder, how fast
// this machine writes the same number of bytes: the floor that the writers are held against.
//
//   output-benchmark [--items N] [--pictures N] [--folder DIR] [--mode one-file|file-per-page|both]
#include "BenchCatalog.h"
#include "CountingFileSystem.h"
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

#include <QCommandLineParser>
#include <QCoreApplication>
#include <QDir>
#include <QElapsedTimer>
#include <QFile>
#include <QFileInfo>
#include <QTemporaryDir>
#include <cstdio>

using namespace zorbin;
using namespace zorbin::bench;

namespace {

struct Measure
{
    double seconds = 0;
    qint64 bytes = 0;
    qint64 files = 0;
};

Measure folderContents(const QString &folder)
{
    Measure measure;
    for (const QString &sub : {folder, folder + ImagesFolderName}) {
        for (const QFileInfo &file : QDir(sub).entryInfoList(QDir::Files)) {
            measure.bytes += file.size();
            ++measure.files;
        }
    }
    return measure;
}

// Writes `bytes` bytes into `files` new files in `folder`, 64 kB a write, and removes them again.
double floorSeconds(const QString &folder, qint64 bytes, qint64 files)
{
    const QByteArray block(64 * 1024, 'x');
    QStringList paths;
    QElapsedTimer timer;
    timer.start();
    for (qint64 i = 0; i < files; ++i) {
        paths << folder + QStringLiteral("floor%1.bin").arg(i);
        QFile file(paths.last());
        if (!file.open(QIODevice::WriteOnly | QIODevice::Truncate))
            qFatal("cannot write %s", qPrintable(paths.last()));
        const qint64 share = bytes / files + (i < bytes % files ? 1 : 0);
        for (qint64 left = share; left > 0; left -= block.size())
            file.write(block.constData(), std::min<qint64>(left, block.size()));
    }
    const double seconds = timer.nsecsElapsed() / 1e9;
    for (const QString &path : paths)
        QFile::remove(path);
    return seconds;
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
    const QCommandLineOption folderOption(QStringLiteral("folder"),
                                          QStringLiteral("work folder (default: a new temporary one)"),
                                          QStringLiteral("DIR"));
    const QCommandLineOption modeOption(QStringLiteral("mode"),
                                        QStringLiteral("one-file, file-per-page or both"),
                                        QStringLiteral("MODE"), QStringLiteral("both"));
    parser.addOptions({itemsOption, picturesOption, folderOption, modeOption});
    parser.process(app);
    const int items = parser.value(itemsOption).toInt();
    const int pictureCount = parser.value(picturesOption).toInt();

    QTemporaryDir temporary;
    const QString work = parser.isSet(folderOption) ? parser.value(folderOption) : temporary.path();
    QDir(work).mkpath(QStringLiteral("pictures"));
    const QString output = work + QStringLiteral("/catalog/");
    const QString images = imagesFolderOf(output);
    const QString database = work + QStringLiteral("/zorbindb.tmp");

    QElapsedTimer preparing;
    preparing.start();
    Result<QStringList> pictures = makePictures(work + QStringLiteral("/pictures"), pictureCount);
    fail(pictures.status());
    const QString logo = pictures->takeLast();
    fail(makeWorkDatabase(database, items, pictures.value()));
    std::printf("Prepared %d items and %d pictures in %s in %.1f s\n", items, pictureCount, qPrintable(work),
                preparing.nsecsElapsed() / 1e9);

    CatalogSettings settings;
    useBenchSettings(settings, output, logo);
    ConnectionParams connection;
    RunState state;
    QuietUserPort user;
    CountingFileSystem files;
    RunContext context{settings, connection, state, user, files};
    fail(ensureFolder(files, output));

    const QString modes = parser.value(modeOption);
    for (const int mode : {0, 1}) {
        if (modes != QLatin1String("both") &&
            modes != QLatin1String(mode == 0 ? "one-file" : "file-per-page"))
            continue;
        settings.pageSplit = static_cast<PageSplit>(mode);
        fail(cleanCatalogOutput(files, output));
        files.clear();
        resetPeakMemory();

        QElapsedTimer timer;
        timer.start();
        double copying = 0;
        if (mode == 1) {
            fail(CollectCatImages(context, images, database));
            copying = timer.nsecsElapsed() / 1e9;
        }
        const Result<QString> first = CreateCatHTML(context, output + PagePrefixName, database, images);
        fail(first.status());
        fail(CreateCSS(context, output, true));
        Measure measure = folderContents(output);
        measure.seconds = timer.nsecsElapsed() / 1e9;
        const long peakKb = peakMemoryKb();

        const double oneFile = floorSeconds(output, measure.bytes, 1);
        const double sameFiles = floorSeconds(output, measure.bytes, measure.files);
        const double megabytes = measure.bytes / 1e6;
        const long long pages = (items + 23) / 24;
        std::printf("\n%s: %lld pages in %.2f s = %.0f pages/s; %lld files, %.1f MB = %.1f MB/s; "
                    "%d picture headers read; peak memory %.1f MB\n",
                    mode == 0 ? "One file" : "File per page", pages, measure.seconds, pages / measure.seconds,
                    measure.files, megabytes, megabytes / measure.seconds,
                    static_cast<int>(files.distinctReadings.size()), peakKb / 1024.0);
        std::printf("  floor, the same bytes in 1 file: %.3f s = %.0f MB/s (output %.1fx the floor)\n",
                    oneFile, megabytes / oneFile, measure.seconds / oneFile);
        std::printf("  floor, the same bytes in %lld files: %.3f s = %.0f MB/s (output %.1fx the floor)\n",
                    measure.files, sameFiles, megabytes / sameFiles, measure.seconds / sameFiles);
        if (files.readings != static_cast<int>(files.distinctReadings.size()))
            std::printf("  %d picture headers were read more than once (%d readings)\n",
                        files.readings - static_cast<int>(files.distinctReadings.size()), files.readings);
        if (mode == 1)
            std::printf("  %d pictures copied in %.2f s\n", files.copies, copying);
    }
    return 0;
}
