// zorbin-cli: the catalog runs without a window.
#include "cli/Commands.h"
#include "control/Program.h"

#include <QCoreApplication>
#include <QGuiApplication>
#include <QTextStream>
#include <cstdio>
#include <cstring>
#include <memory>

int main(int argc, char *argv[])
{
    zorbin::prepareProcess();
    // The PDF command draws (fonts, pictures): it needs a GUI application, on the offscreen
    // platform when there is no display to connect to.
    const bool draws = argc > 1 && std::strcmp(argv[1], "pdf") == 0;
    if (draws && qEnvironmentVariableIsEmpty("DISPLAY") && qEnvironmentVariableIsEmpty("WAYLAND_DISPLAY") &&
        qEnvironmentVariableIsEmpty("QT_QPA_PLATFORM"))
        qputenv("QT_QPA_PLATFORM", "offscreen");
    const std::unique_ptr<QCoreApplication> app = draws ? std::make_unique<QGuiApplication>(argc, argv)
                                                        : std::make_unique<QCoreApplication>(argc, argv);
    QCoreApplication::setApplicationName(QStringLiteral("zorbin-cli"));
    QCoreApplication::setApplicationVersion(QStringLiteral(ZORBIN_VERSION));

    QStringList arguments = QCoreApplication::arguments();
    const QString command = arguments.size() > 1 ? arguments.at(1) : QString();
    if (command.isEmpty() || command == QLatin1String("--help") || command == QLatin1String("-h") ||
        command == QLatin1String("help")) {
        QTextStream(stdout) << zorbin::cli::overview();
        return command.isEmpty() ? zorbin::cli::UsageError : 0;
    }
    if (command == QLatin1String("--version")) {
        QTextStream(stdout) << "zorbin-cli " << QCoreApplication::applicationVersion() << '\n';
        return 0;
    }
    arguments.removeAt(1); // the subcommand's own parser sees "zorbin-cli <options>"
    return zorbin::cli::run(command, arguments);
}
