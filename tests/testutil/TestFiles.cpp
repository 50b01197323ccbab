#include "testutil/TestFiles.h"

#include <QFile>
#include <QTest>

namespace zorbin::test {

void writeFile(const QString &path, const QByteArray &content)
{
    QFile file(path);
    if (!file.open(QIODevice::WriteOnly | QIODevice::Truncate))
        QFAIL(qPrintable(QStringLiteral("cannot write %1").arg(path)));
    file.write(content);
}

QByteArray readFile(const QString &path)
{
    QFile file(path);
    if (!file.open(QIODevice::ReadOnly))
        return {};
    return file.readAll();
}

QString demoFolder()
{
    return QStringLiteral(ZORBIN_DEMO_BUILD_DIR);
}

QString testDataFolder()
{
    const QString fromEnvironment = qEnvironmentVariable("ZORBIN_TESTDATA_DIR");
    return fromEnvironment.isEmpty() ? QStringLiteral(ZORBIN_SOURCE_DIR "/tests/data") : fromEnvironment;
}

} // namespace zorbin::test
