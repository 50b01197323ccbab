#include "cli/Commands.h"

#include "cli/CliUserPort.h"
#include "cli/DemoFiles.h"
#include "control/Program.h"
#include "control/Statements.h"
#include "platform/Browser.h"
#include "platform/SettingsStore.h"

#include <QCommandLineParser>
#include <QDir>
#include <QFileInfo>
#include <QTextStream>
#include <cstdio>

namespace zorbin::cli {
namespace {

QTextStream &out()
{
    static QTextStream stream(stdout);
    return stream;
}

QTextStream &err()
{
    static QTextStream stream(stderr);
    return stream;
}

const QString SettingsOption = QStringLiteral("settings");
const QString UseMarkedOption = QStringLiteral("use-marked");
const QString OnlyWithPictureOption = QStringLiteral("only-with-picture");
const QString OpenOption = QStringLiteral("open");
const QString OutOption = QStringLiteral("out");

void addSettingsOption(QCommandLineParser &parser)
{
    parser.addOption(
        {SettingsOption,
         QStringLiteral("Read the settings from FILE, an INI file with a [Params] section holding the "
                        "keys of the settings store, instead of the user's settings."),
         QStringLiteral("FILE")});
}

void addRunOptions(QCommandLineParser &parser)
{
    addSettingsOption(parser);
    parser.addOption(
        {UseMarkedOption, QStringLiteral("Keep the last working database and the items marked by hand "
                                         "in it instead of collecting the items anew.")});
    parser.addOption({OnlyWithPictureOption, QStringLiteral("Only items that have a picture.")});
    parser.addOption({OpenOption, QStringLiteral("Open the result in a new browser window.")});
}

// Parses the subcommand's options; on --help or a bad option prints and returns an exit code.
std::optional<int> parse(QCommandLineParser &parser, const QStringList &arguments)
{
    parser.addHelpOption();
    if (!parser.parse(arguments)) {
        err() << parser.errorText() << "\n\n" << parser.helpText();
        return UsageError;
    }
    if (parser.isSet(QStringLiteral("help"))) {
        out() << parser.helpText();
        return Success;
    }
    if (!parser.positionalArguments().isEmpty()) {
        err() << "Unexpected argument: " << parser.positionalArguments().constFirst() << "\n\n"
              << parser.helpText();
        return UsageError;
    }
    return std::nullopt;
}

std::unique_ptr<SettingsStore> openStore(const QCommandLineParser &parser)
{
    if (!parser.isSet(SettingsOption))
        return openUserSettingsStore();
    return openIniSettingsStore(parser.value(SettingsOption));
}

std::optional<int> checkSettingsFile(const QCommandLineParser &parser)
{
    if (parser.isSet(SettingsOption) && !QFileInfo(parser.value(SettingsOption)).isFile()) {
        err() << "The settings file " << parser.value(SettingsOption) << " does not exist.\n";
        return UsageError;
    }
    return std::nullopt;
}

// The exit status of a run's outcome. What was written is printed whichever way the run ended:
// a catalog written from the rows collected before a failed step does not hold everything the
// settings asked for, and the exit status says so.
int finish(const RunOutcome &outcome)
{
    if (!outcome.file.isEmpty()) {
        out() << QDir::toNativeSeparators(outcome.file) << '\n';
        out().flush();
    }
    switch (outcome.ending) {
    case RunOutcome::Ending::Complete:
        return Success;
    case RunOutcome::Ending::NoItems:
        return EmptyCatalog;
    case RunOutcome::Ending::Partial:
    case RunOutcome::Ending::Stopped:
    case RunOutcome::Ending::Failed:
    case RunOutcome::Ending::Declined:
        break;
    }
    return Failure;
}

// What a run command asks for.
struct RunRequest
{
    enum class Output { Catalog, List, Pdf, Site };
    Output output = Output::Catalog;
    bool useMarked = false;
    bool onlyWithPicture = false;
    bool open = false;
    QString outputFolder; // empty: the settings' own
    QString file;         // the PDF or the site's folder: empty for the one in the output folder
    PdfPageSize pageSize = PdfPageSize::A4;
};

RunRequest requestOf(RunRequest::Output output, const QCommandLineParser &parser)
{
    RunRequest request;
    request.output = output;
    request.useMarked = parser.isSet(UseMarkedOption);
    request.onlyWithPicture = parser.isSet(OnlyWithPictureOption);
    request.open = parser.isSet(OpenOption);
    return request;
}

// The run on the given store.
int runOutput(SettingsStore &store, const RunRequest &request)
{
    std::unique_ptr<Browser> browser = request.open ? makeSystemBrowser() : nullptr;
    CliUserPort user(browser.get());
    const auto control = assembleControl(user, store);
    control->startUp();
    CatalogSettings &settings = control->settings();
    if (request.useMarked)
        control->useLastCollection();
    if (request.onlyWithPicture)
        settings.onlyWithPicture = true;
    if (!request.outputFolder.isEmpty())
        settings.outputFolder = request.outputFolder;
    switch (request.output) {
    case RunRequest::Output::Catalog:
        return finish(control->makeCatalog());
    case RunRequest::Output::List:
        return finish(control->makeList(!request.useMarked));
    case RunRequest::Output::Pdf:
        return finish(control->makePdf(request.pageSize, request.file));
    case RunRequest::Output::Site:
        return finish(control->makeSite(request.file));
    }
    return Failure;
}

int catalogOrList(RunRequest::Output output, const QStringList &arguments)
{
    QCommandLineParser parser;
    parser.setApplicationDescription(
        output == RunRequest::Output::Catalog
            ? QStringLiteral("Writes the catalog and prints the path of its first page.")
            : QStringLiteral("Writes the item list page and prints its path."));
    addRunOptions(parser);
    if (const auto exit = parse(parser, arguments))
        return *exit;
    if (const auto exit = checkSettingsFile(parser))
        return *exit;
    auto store = openStore(parser);
    return runOutput(*store, requestOf(output, parser));
}

int demo(const QStringList &arguments)
{
    QCommandLineParser parser;
    parser.setApplicationDescription(QStringLiteral(
        "Writes the catalog of the bundled demo accounting database and prints its first page."));
    parser.addOption(
        {OutOption, QStringLiteral("The folder to write into (default: catalog-demo in the current folder)."),
         QStringLiteral("DIR"), QStringLiteral("catalog-demo")});
    parser.addOption({OpenOption, QStringLiteral("Open the catalog in a new browser window.")});
    if (const auto exit = parse(parser, arguments))
        return *exit;
    const auto files = findDemoFiles();
    if (!files) {
        err() << files.status().description() << '\n';
        return Failure;
    }
    const QString folder = QFileInfo(parser.value(OutOption)).absoluteFilePath();
    if (!QDir().mkpath(folder)) {
        err() << "Cannot create the folder " << QDir::toNativeSeparators(folder) << '\n';
        return Failure;
    }
    auto store = openIniSettingsStore(files->settingsFile);
    RunRequest request;
    request.open = parser.isSet(OpenOption);
    request.outputFolder = QDir::toNativeSeparators(folder);
    return runOutput(*store, request);
}

// The PDF and the web catalog: to the file or folder of --out when given, else to their place in
// the output folder.
int runToChosenFile(const QCommandLineParser &parser, RunRequest request)
{
    if (parser.isSet(OutOption))
        request.file = QFileInfo(parser.value(OutOption)).absoluteFilePath();
    auto store = openStore(parser);
    return runOutput(*store, request);
}

// The PDF run: collects (unless the items were marked by hand) and writes the catalog as a PDF.
int pdf(const QStringList &arguments)
{
    QCommandLineParser parser;
    parser.setApplicationDescription(QStringLiteral("Writes the catalog as a PDF file and prints its path."));
    addRunOptions(parser);
    parser.addOption({OutOption, QStringLiteral("The PDF file (default: zorbin.pdf in the output folder)."),
                      QStringLiteral("FILE")});
    const QString pageSizeOption = QStringLiteral("page-size");
    parser.addOption({pageSizeOption, QStringLiteral("a4 (the default) or letter."), QStringLiteral("SIZE"),
                      QStringLiteral("a4")});
    if (const auto exit = parse(parser, arguments))
        return *exit;
    if (const auto exit = checkSettingsFile(parser))
        return *exit;
    const QString size = parser.value(pageSizeOption).toLower();
    if (size != QLatin1String("a4") && size != QLatin1String("letter")) {
        err() << "The page size is a4 or letter, not " << parser.value(pageSizeOption) << ".\n";
        return UsageError;
    }
    RunRequest request = requestOf(RunRequest::Output::Pdf, parser);
    request.pageSize = size == QLatin1String("letter") ? PdfPageSize::Letter : PdfPageSize::A4;
    return runToChosenFile(parser, request);
}

// The web catalog: collects (unless the items were marked by hand) and writes the site.
int web(const QStringList &arguments)
{
    QCommandLineParser parser;
    parser.setApplicationDescription(
        QStringLiteral("Writes the web catalog and prints the path of its first page."));
    addRunOptions(parser);
    parser.addOption({OutOption, QStringLiteral("The site's folder (default: site in the output folder)."),
                      QStringLiteral("DIR")});
    if (const auto exit = parse(parser, arguments))
        return *exit;
    if (const auto exit = checkSettingsFile(parser))
        return *exit;
    RunRequest request = requestOf(RunRequest::Output::Site, parser);
    return runToChosenFile(parser, request);
}

int sql(const QStringList &arguments)
{
    QCommandLineParser parser;
    parser.setApplicationDescription(QStringLiteral(
        "Prints every statement a catalog run would send, one per line as 'label: statement'."));
    addSettingsOption(parser);
    if (const auto exit = parse(parser, arguments))
        return *exit;
    if (const auto exit = checkSettingsFile(parser))
        return *exit;
    auto store = openStore(parser);
    CliUserPort user(nullptr);
    const auto control = assembleControl(user, *store);
    control->startUp();
    const auto statements = runStatements(control->context());
    if (!statements) {
        err() << statements.status().description() << '\n';
        return Failure;
    }
    for (const auto &[label, statement] : statements.value())
        out() << label << ": " << statement << '\n';
    return Success;
}

} // namespace

QString overview()
{
    return QStringLiteral("Usage: zorbin-cli <command> [options]\n"
                          "\n"
                          "Makes the HTML product catalog of the accounting database without a window.\n"
                          "\n"
                          "Commands:\n"
                          "  catalog   write the catalog and print the path of its first page\n"
                          "  list      write the plain item list and print its path\n"
                          "  pdf       write the catalog as a PDF file and print its path\n"
                          "  web       write the web catalog and print the path of its first page\n"
                          "  demo      write the catalog of the bundled demo database\n"
                          "  sql       print every statement a run would send\n"
                          "\n"
                          "'zorbin-cli <command> --help' describes a command's options.\n");
}

int run(const QString &command, const QStringList &arguments)
{
    if (command == QLatin1String("catalog"))
        return catalogOrList(RunRequest::Output::Catalog, arguments);
    if (command == QLatin1String("list"))
        return catalogOrList(RunRequest::Output::List, arguments);
    if (command == QLatin1String("pdf"))
        return pdf(arguments);
    if (command == QLatin1String("web"))
        return web(arguments);
    if (command == QLatin1String("demo"))
        return demo(arguments);
    if (command == QLatin1String("sql"))
        return sql(arguments);
    err() << "Unknown command: " << command << "\n\n" << overview();
    return UsageError;
}

} // namespace zorbin::cli
