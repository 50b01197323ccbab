// Times the collection run on a large demo database (100,000 items, two price lists, two note
// kinds by default) as a database file and through ODBC, against two floors: the same rows
// copied inside SQLite by INSERT ... SELECT, and the same statements merely fetched.
//
//   zorbin-bench-collection [--items N]
#include "FetchOnly.h"
#include "Floor.h"
#include "LargeDemo.h"
#include "SqliteOdbcDriver.h"
#include "StepClock.h"
#include "model/CatalogSettings.h"
#include "model/RunContext.h"
#include "model/RunState.h"
#include "platform/FileSystem.h"
#include "source/ConnectionString.h"
#include "testutil/AccountingFixture.h"
#include "workdb/CollectionRun.h"
#include "workdb/SourceStatements.h"
#include "workdb/SqliteEngine.h"
#include "workdb/WorkDatabase.h"
#include "workdb/WorkDatabasePath.h"

#include <QCoreApplication>
#include <QDir>
#include <QSqlQuery>
#include <cstdio>
#include <sys/resource.h>
#include <time.h>

using namespace zorbin;
using namespace zorbin::bench;

namespace {

// Processor time, in seconds, of the calling thread or of the whole process: on a machine
// that other work shares, the wall-clock figures vary from run to run and these much less.
double cpuSeconds(clockid_t clock)
{
    timespec now{};
    clock_gettime(clock, &now);
    return static_cast<double>(now.tv_sec) + static_cast<double>(now.tv_nsec) / 1e9;
}

double peakMegabytes()
{
    rusage usage{};
    getrusage(RUSAGE_SELF, &usage);
    return static_cast<double>(usage.ru_maxrss) / 1024.0; // kilobytes on Linux
}

void chooseData(ChoiceList &list, int itemData)
{
    list.clear();
    list.setCurrentIndex(list.addEntry(QStringLiteral("list %1").arg(itemData), itemData));
}

// Picture from the file field, standard name, both price lists and both note kinds.
void chooseEverything(CatalogSettings &settings)
{
    settings.pictureSource = PictureSource::FileField;
    settings.itemName = ItemNameSource::Standard;
    settings.collectPrice1 = true;
    chooseData(settings.priceList1, 1);
    settings.collectPrice2 = true;
    chooseData(settings.priceList2, 2);
    settings.collectNote1 = true;
    chooseData(settings.extraNote1, 1);
    settings.collectNote2 = true;
    chooseData(settings.extraNote2, 2);
}

QStringList statementsOf(const CatalogSettings &settings)
{
    return {buildItemStatement(settings).value(),         buildSortGroupStatement(),
            buildPriceStatement(settings, 1).value(),     buildPriceStatement(settings, 2).value(),
            buildExtraNoteStatement(settings, 1).value(), buildExtraNoteStatement(settings, 2).value()};
}

long long rowsIn(const QString &workPath, const QString &table)
{
    Result<std::unique_ptr<WorkDatabase>> work = WorkDatabase::open(workPath);
    if (!work)
        return -1;
    Result<QSqlQuery> counted = work.value()->select(QStringLiteral("SELECT count(*) FROM ") + table);
    return counted && counted->next() ? counted->value(0).toLongLong() : -1;
}

const char *const Tables[] = {
    "", "tItems", "tItemSort", "tItemPrice1", "tItemPrice2", "tExtraNote1", "tExtraNote2"};

struct Totals
{
    long long rows = 0;
    double seconds = 0;
    double threadCpu = 0;  // of the thread that ran it
    double processCpu = 0; // of every thread
};

struct CpuClock
{
    double thread = cpuSeconds(CLOCK_THREAD_CPUTIME_ID);
    double process = cpuSeconds(CLOCK_PROCESS_CPUTIME_ID);

    void stop(Totals &totals) const
    {
        totals.threadCpu = cpuSeconds(CLOCK_THREAD_CPUTIME_ID) - thread;
        totals.processCpu = cpuSeconds(CLOCK_PROCESS_CPUTIME_ID) - process;
    }
};

void printCpu(const Totals &totals)
{
    std::printf("  processor time: %.2f s in the run's own thread, %.2f s in all threads\n", totals.threadCpu,
                totals.processCpu);
}

Totals runCollection(const char *label, CatalogSettings &settings, ConnectionParams connection)
{
    RunState state;
    StepClock clock;
    RunContext context{settings, connection, state, clock, localFileSystem()};
    const CpuClock cpu;
    clock.start();
    const Result<CollectionReport> collected = BuildAndCollectData(context);
    clock.finish();
    const Status failure = collected ? collected->stepFailure : collected.status();
    if (!failure || clock.messageCount() > 0) {
        std::fprintf(stderr, "The collection (%s) failed: %s\n", label, qPrintable(failure.description()));
        return {};
    }
    std::printf("\nCollection, %s\n  %-28s %9s %9s %11s\n", label, "step", "rows", "seconds", "rows/s");
    Totals totals;
    const auto &steps = clock.steps();
    for (std::size_t i = 0; i < steps.size(); ++i) {
        const bool copies = i > 0 && i < std::size(Tables);
        const long long rows = copies ? rowsIn(state.WorkDBFile, QLatin1String(Tables[i])) : 0;
        totals.rows += rows;
        totals.seconds += steps[i].seconds;
        std::printf("  %-28s %9lld %9.3f %11.0f\n", copies ? Tables[i] : (i == 0 ? "create" : "end"), rows,
                    steps[i].seconds, steps[i].seconds > 0 && rows > 0 ? rows / steps[i].seconds : 0.0);
    }
    std::printf("  %-28s %9lld %9.3f %11.0f\n", "whole collection", totals.rows, totals.seconds,
                totals.rows / totals.seconds);
    cpu.stop(totals);
    printCpu(totals);
    std::printf("  events handled %d times at %d progress points: %.2f s\n", clock.eventRounds(),
                clock.yields(), clock.yieldSeconds());
    return totals;
}

Totals runFetch(const char *label, const QString &connectionString, const QStringList &statements)
{
    const CpuClock cpu;
    Result<std::vector<FetchTiming>> fetched = measureFetch(connectionString, statements);
    if (!fetched) {
        std::fprintf(stderr, "Fetching (%s) failed: %s\n", label, qPrintable(fetched.status().description()));
        return {};
    }
    std::printf("\nStatements merely fetched, %s\n  %-28s %9s %9s %11s %9s\n", label, "statement", "rows",
                "seconds", "rows/s", "count s");
    Totals totals;
    for (std::size_t i = 0; i < fetched->size(); ++i) {
        const FetchTiming &timing = fetched.value()[i];
        totals.rows += timing.rows;
        totals.seconds += timing.fetchSeconds;
        std::printf("  %-28s %9lld %9.3f %11.0f %9.3f\n", Tables[i + 1], timing.rows, timing.fetchSeconds,
                    timing.rows / timing.fetchSeconds, timing.countSeconds);
    }
    std::printf("  %-28s %9lld %9.3f %11.0f\n", "all statements", totals.rows, totals.seconds,
                totals.rows / totals.seconds);
    cpu.stop(totals);
    printCpu(totals);
    return totals;
}

Totals runFloor(const CatalogSettings &settings, const QString &sourcePath, const QString &workPath)
{
    const CpuClock cpu;
    Result<std::vector<TableTiming>> floor = measureFloor(settings, sourcePath, workPath);
    if (!floor) {
        std::fprintf(stderr, "The floor failed: %s\n", qPrintable(floor.status().description()));
        return {};
    }
    std::printf("\nFloor: INSERT ... SELECT inside SQLite from the attached source\n  %-28s %9s %9s %11s\n",
                "table", "rows", "seconds", "rows/s");
    Totals totals;
    for (const TableTiming &timing : floor.value()) {
        totals.rows += timing.rows;
        totals.seconds += timing.seconds;
        std::printf("  %-28s %9lld %9.3f %11.0f\n", qPrintable(timing.name), timing.rows, timing.seconds,
                    timing.rows > 0 ? timing.rows / timing.seconds : 0.0);
    }
    std::printf("  %-28s %9lld %9.3f %11.0f\n", "whole floor", totals.rows, totals.seconds,
                totals.rows / totals.seconds);
    cpu.stop(totals);
    printCpu(totals);
    return totals;
}

} // namespace

int main(int argc, char *argv[])
{
    zorbin::setUpSqliteEngine();
    QCoreApplication app(argc, argv);
    int items = 100000;
    const QStringList arguments = app.arguments();
    if (const qsizetype at = arguments.indexOf(QStringLiteral("--items"));
        at > 0 && at + 1 < arguments.size())
        items = arguments[at + 1].toInt();
    if (items < 1) {
        std::fprintf(stderr, "usage: zorbin-bench-collection [--items N]\n");
        return 2;
    }
    const QString folder = QStringLiteral(ZORBIN_BENCH_DATA_DIR);
    QDir().mkpath(folder);
    const Result<QString> source = largeDemoDatabase(folder, items);
    if (!source) {
        std::fprintf(stderr, "%s\n", qPrintable(source.status().description()));
        return 1;
    }
    if (Status registered = registerSqliteOdbcAsSqlServer(); !registered) {
        std::fprintf(stderr, "%s\n", qPrintable(registered.description()));
        return 1;
    }
    const QString workFolder = QDir(folder).filePath(QStringLiteral("work"));
    QDir().mkpath(workFolder);
    qputenv("TMPDIR", QFile::encodeName(workFolder));

    CatalogSettings settings;
    chooseEverything(settings);
    std::printf("Source: %s (%d items)\n", qPrintable(source.value()), items);

    const ConnectionParams file = test::fileConnection(source.value());
    const ConnectionParams odbc = test::odbcConnection(source.value());
    // For profiling one path alone: --only file, --only odbc.
    if (const qsizetype at = arguments.indexOf(QStringLiteral("--only"));
        at > 0 && at + 1 < arguments.size()) {
        const bool viaOdbc = arguments[at + 1] == QLatin1String("odbc");
        runCollection(viaOdbc ? "ODBC" : "database file", settings, viaOdbc ? odbc : file);
        if (!viaOdbc)
            runFloor(settings, source.value(), QDir(workFolder).filePath(QStringLiteral("floor.tmp")));
        return 0;
    }
    const Totals fileRun = runCollection("database file (Qt SQLite driver)", settings, file);
    const Totals odbcRun = runCollection("ODBC (SQLite3 ODBC driver as \"SQL Server\")", settings, odbc);
    const double collectionPeak = peakMegabytes();

    const QStringList statements = statementsOf(settings);
    const Totals odbcFetch = runFetch("ODBC", BuildConnString(odbc), statements);
    const Totals floor =
        runFloor(settings, source.value(), QDir(workFolder).filePath(QStringLiteral("floor.tmp")));

    std::printf("\nSummary\n");
    std::printf("  database file: whole collection %.2f s, floor %.2f s: %.2fx the floor (goal: within 2x)\n",
                fileRun.seconds, floor.seconds, fileRun.seconds / floor.seconds);
    const double odbcRate = odbcRun.rows / odbcRun.seconds;
    const double fetchRate = odbcFetch.rows / odbcFetch.seconds;
    std::printf(
        "  ODBC: collection %.0f rows/s, statements fetched %.0f rows/s: %.0f%% (goal: at least 80%%)\n",
        odbcRate, fetchRate, 100.0 * odbcRate / fetchRate);
    std::printf(
        "  peak memory during the two collections: %.1f MB (goal: under 150 MB); at the end %.1f MB\n",
        collectionPeak, peakMegabytes());
    return 0;
}
