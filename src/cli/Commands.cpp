#include "cli/Commands.h"

#include "cli/CliUserPort.h"
#include "cli/DemoFiles.h"
#include "control/Statements.h"
#include "control/CatalogControl.h"
#include "control/Program.h"
#include "model/SettingsPersistence.h"
#include "output/OutputFolder.h"
#include "platform/Browser.h"
#include "platform/FileSystem.h"
#include "platform/SettingsStore.h"
#include "web/CatalogSite.h"

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

int finish(const RunOutcome &outcome, const RunState &state)
{
    // A collection step that failed has told its fault; whatever was written from the rows
    // collected before it does not hold everything the settings asked for.
    const int collected = state.CollectFailed ? Failure : Success;
    switch (outcome.ending) {
    case RunOutcome::Ending::Shown:
        out() << QDir::toNativeSeparators(outcome.file) << '\n';
        out().flush();
        return collected;
    case RunOutcome::Ending::NoItems:
        return state.CollectFailed ? Failure : EmptyCatalog;
    case RunOutcome::Ending::Failed:
        if (!outcome.file.isEmpty())
            out() << QDir::toNativeSeparators(outcome.file) << '\n';
        return Failure;
    case RunOutcome::Ending::Declined:
        break;
    }
    return Failure;
}

// What a catalog or list command asks for.
struct RunRequest
{
    bool catalog = true;
    bool useMarked = false;
    bool onlyWithPicture = false;
    bool open = false;
    QString outputFolder; // empty: the settings' own
};

RunRequest requestOf(bool catalog, const QCommandLineParser &parser)
{
    return {catalog,
            parser.isSet(UseMarkedOption),
            parser.isSet(OnlyWithPictureOption),
            parser.isSet(OpenOption),
            {}};
}

// The catalog or list run on the given store.
int runOutput(SettingsStore &store, const RunRequest &request)
{
    std::unique_ptr<Browser> browser = request.open ? makeSystemBrowser() : nullptr;
    CliUserPort user(browser.get());
    CatalogControl control(user, store, localFileSystem());
    control.UserControl_Initialize();
    CatalogSettings &settings = control.settings();
    if (request.useMarked) {
        settings.ChkSelectAccount = CheckValue::Checked;
        control.runState().WorkDBFile = lastWorkDatabase();
    }
    if (request.onlyWithPicture)
        settings.ChkOnlyWithPic = CheckValue::Checked;
    if (!request.outputFolder.isEmpty())
        settings.txtPagingPath = request.outputFolder;
    const RunOutcome outcome =
        request.catalog ? control.produceCatalog() : control.produceList(!request.useMarked);
    return finish(outcome, control.runState());
}

int catalogOrList(bool catalog, const QStringList &arguments)
{
    QCommandLineParser parser;
    parser.setApplicationDescription(
        catalog ? QStringLiteral("Writes the catalog and prints the path of its first page.")
                : QStringLiteral("Writes the item list page and prints its path."));
    addRunOptions(parser);
    if (const auto exit = parse(parser, arguments))
        return *exit;
    if (const auto exit = checkSettingsFile(parser))
        return *exit;
    auto store = openStore(parser);
    return runOutput(*store, requestOf(catalog, parser));
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

// The web catalog on the control as it is: collects unless the items were marked by hand, then
// writes the site; "sections by sort group" is the store's WebSections ("0" off, on otherwise).
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
    auto store = openStore(parser);
    std::unique_ptr<Browser> browser = parser.isSet(OpenOption) ? makeSystemBrowser() : nullptr;
    CliUserPort user(browser.get());
    CatalogControl control(user, *store, localFileSystem());
    control.UserControl_Initialize();
    CatalogSettings &settings = control.settings();
    RunState &state = control.runState();
    if (parser.isSet(UseMarkedOption)) {
        settings.ChkSelectAccount = CheckValue::Checked;
        state.WorkDBFile = lastWorkDatabase();
    }
    if (parser.isSet(OnlyWithPictureOption))
        settings.ChkOnlyWithPic = CheckValue::Checked;
    if (!parser.isSet(UseMarkedOption)) {
        if (const Status collected = control.collect(); !collected) {
            err() << collected.description() << '\n';
            return Failure;
        }
    }
    const QString folder = parser.isSet(OutOption) ? QFileInfo(parser.value(OutOption)).absoluteFilePath()
                                                   : outputFolderOf(settings) + QStringLiteral("site");
    if (!QDir().mkpath(QFileInfo(folder).absolutePath())) {
        err() << "Cannot create the folder " << QDir::toNativeSeparators(folder) << '\n';
        return Failure;
    }
    const SiteRequest request{folder, state.WorkDBFile,
                              store->read(StoreApp, StoreSection, QStringLiteral("WebSections"), QString()) !=
                                  QLatin1String("0")};
    const Result<QString> first = CreateCatSite(control.context(), request);
    if (!first) {
        err() << first.status().description() << '\n';
        return Failure;
    }
    const int collected = state.CollectFailed ? Failure : Success;
    if (first->isEmpty())
        return state.CollectFailed ? Failure : EmptyCatalog;
    out() << QDir::toNativeSeparators(first.value()) << '\n';
    out().flush();
    if (const Status opened = user.openBrowser(first.value()); !opened) {
        err() << opened.description() << '\n';
        return Failure;
    }
    return collected;
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
    CatalogControl control(user, *store, localFileSystem());
    control.UserControl_Initialize();
    const auto statements = runStatements(control.context());
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
                          "  web       write the web catalog and print the path of its first page\n"
                          "  demo      write the catalog of the bundled demo database\n"
                          "  sql       print every statement a run would send\n"
                          "\n"
                          "'zorbin-cli <command> --help' describes a command's options.\n");
}

int run(const QString &command, const QStringList &arguments)
{
    if (command == QLatin1String("catalog"))
        return catalogOrList(true, arguments);
    if (command == QLatin1String("list"))
        return catalogOrList(false, arguments);
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
