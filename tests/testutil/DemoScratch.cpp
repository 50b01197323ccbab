#include "testutil/DemoScratch.h"

#include "testutil/AccountingFixture.h"
#include "testutil/TestFiles.h"

#include <QDir>
#include <QRegularExpression>

namespace zorbin::test {

DemoScratch::DemoScratch()
    : settingsFile(QDir(folder.path()).filePath(QStringLiteral("demo-settings.ini"))),
      output(QDir(folder.path()).filePath(QStringLiteral("catalog"))), store(copyDemoSettings(folder.path()))
{
    store->write(QStringLiteral("Zorbin"), QStringLiteral("Params"), QStringLiteral("PagingPath"), output);
    store->flush();
}

QString DemoScratch::out(const QString &name) const
{
    return QDir(output).filePath(name);
}

QString firstItemKey(const QString &page)
{
    static const QRegularExpression key(QStringLiteral("dir=ltr>([^<]+)<"));
    return key.match(QString::fromLatin1(readFile(page))).captured(1);
}

qsizetype listRows(const QString &page)
{
    return QString::fromLatin1(readFile(page)).count(QStringLiteral("<tr bgcolor='#FFFFFF'"));
}

} // namespace zorbin::test
