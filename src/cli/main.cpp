// zorbin-cli: the catalog runs without a window.
#include "cli/Commands.h"
#include "control/Program.h"

#include <QCoreApplication>
#include <QTextStream>
#include <cstdio>

int main(int argc, char *argv[])
{
    zorbin::prepareProcess();
    QCoreApplication app(argc, argv);
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
