// The output benchmark. Writes the catalog of a working database of 100,000 items (8 x 3 cells
// a page, a picture line with size attributes and four text lines, about 1,000 distinct
// pictures) in both page modes, and measures, in the same run and the same folder, how fast
// this machine writes the same number of bytes: the floor that the writers are held against.
//
//   output-benchmark [--items N] [--pictures N] [--folder DIR]
#include "BenchCatalog.h"
#include "CountingFileSystem.h"
#include "MemoryUse.h"
#include "control/CatalogSettings.h"
#include "control/OutputFolder.h"
#include "control/RunContext.h"
#include "control/RunState.h"
#include "control/UserPort.h"
#include "output/CatalogPages.h"
#include "output/ImageCollection.h"
#include "output/Stylesheet.h"
#include "source/ConnectionParams.h"

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

// A user who watches: the progress bar is kept, nothing is asked, nothing stops the run.
class QuietUserPort final : public UserPort
{
public:
    Answer ask(const QString &, const QString &, QuestionButtons) override { return Answer::Yes; }
    void tell(const QString &text, const QString &, MessageIcon) override
    {
        std::fprintf(stderr, "%s\n", qPrintable(text));
    }
    void showStatus(const QString &) override {}
    int progressFrameWidth() const override { return 1000; }
    int progressFillWidth() const override { return m_fill; }
    void setProgressFillWidth(int width) override { m_fill = width; }
    void yield() override {}
    Status openBrowser(const QString &) override { return Status::ok(); }

private:
    int m_fill = 0;
};

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

// Writes `bytes` bytes into one new file in `folder`, 64 kB a write, and removes it again.
double floorSeconds(const QString &folder, qint64 bytes)
{
    const QByteArray block(64 * 1024, 'x');
    const QString path = folder + QStringLiteral("floor.bin");
    QElapsedTimer timer;
    timer.start();
    QFile file(path);
    if (!file.open(QIODevice::WriteOnly | QIODevice::Truncate))
        qFatal("cannot write %s", qPrintable(path));
    for (qint64 left = bytes; left > 0; left -= block.size())
        file.write(block.constData(), std::min<qint64>(left, block.size()));
    file.close();
    const double seconds = timer.nsecsElapsed() / 1e9;
    QFile::remove(path);
    return seconds;
}

void fail(const Status &status)
{
    if (!status)
        qFatal("%s", qPrintable(status.description()));
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
    parser.addOptions({itemsOption, picturesOption, folderOption});
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

    std::printf("\n%-14s %8s %9s %10s %8s %10s %9s %10s %8s %9s\n", "mode", "pages", "seconds", "pages/s",
                "MB", "MB/s", "floor MB/s", "x floor", "headers", "peak MB");
    for (const int mode : {0, 1}) {
        settings.cmbPageSplit.setCurrentIndex(mode);
        fail(cleanCatalogOutput(files, output));
        files.clear();
        resetPeakMemory();

        QElapsedTimer timer;
        timer.start();
        if (mode == 1)
            fail(CollectCatImages(context, images, database));
        const Result<QString> first = CreateCatHTML(context, output + PagePrefixName, database, images);
        fail(first.status());
        fail(CreateCSS(context, output, true));
        Measure measure = folderContents(output);
        measure.seconds = timer.nsecsElapsed() / 1e9;
        const long peakKb = peakMemoryKb();

        const double floor = floorSeconds(output, measure.bytes);
        const double megabytes = measure.bytes / 1e6;
        const long long pages = (items + 23) / 24;
        std::printf("%-14s %8lld %9.2f %10.0f %8.1f %10.1f %9.1f %10.2f %8d %9.1f\n",
                    mode == 0 ? "one file" : "file per page", pages, measure.seconds, pages / measure.seconds,
                    megabytes, megabytes / measure.seconds, megabytes / floor, measure.seconds / floor,
                    static_cast<int>(files.distinctReadings.size()), peakKb / 1024.0);
        if (files.readings != static_cast<int>(files.distinctReadings.size()))
            std::printf("  %d picture headers were read more than once (%d readings)\n",
                        files.readings - static_cast<int>(files.distinctReadings.size()), files.readings);
        if (mode == 1)
            std::printf("  %d pictures copied\n", files.copies);
    }
    return 0;
}
