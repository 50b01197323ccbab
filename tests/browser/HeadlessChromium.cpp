#include "HeadlessChromium.h"

#include "testutil/TestFiles.h"

#include <QDir>
#include <QFileInfo>
#include <QJsonArray>
#include <QJsonDocument>
#include <QProcess>
#include <QUrl>

namespace zorbin::test {
namespace {

constexpr int BrowserTimeoutMs = 120000;

QJsonObject failure(const QString &text)
{
    return QJsonObject{{QStringLiteral("error"), text}};
}

// Runs the browser; its standard output, or nothing when it failed or took too long. Its
// standard error goes to `errors` when given.
std::optional<QByteArray> runBrowser(const QStringList &arguments, QString &diagnosis,
                                     QByteArray *errors = nullptr)
{
    QProcess browser;
    // The browser puts its single-instance socket under TMPDIR; a test's own temporary folder
    // in a deep checkout passes the 107 bytes a socket path may have, and the browser aborts.
    QProcessEnvironment environment = QProcessEnvironment::systemEnvironment();
    environment.insert(QStringLiteral("TMPDIR"), QStringLiteral("/tmp"));
    browser.setProcessEnvironment(environment);
    browser.start(QStringLiteral(ZORBIN_CHROMIUM), arguments);
    if (!browser.waitForStarted()) {
        diagnosis = QStringLiteral("%1 did not start: %2")
                        .arg(QStringLiteral(ZORBIN_CHROMIUM), browser.errorString());
        return std::nullopt;
    }
    if (!browser.waitForFinished(BrowserTimeoutMs)) {
        browser.kill();
        browser.waitForFinished();
        diagnosis = QStringLiteral("the browser did not finish within %1 s").arg(BrowserTimeoutMs / 1000);
        return std::nullopt;
    }
    if (browser.exitStatus() != QProcess::NormalExit || browser.exitCode() != 0) {
        diagnosis = QStringLiteral("the browser ended with %1: %2")
                        .arg(browser.exitCode())
                        .arg(QString::fromLocal8Bit(browser.readAllStandardError().right(2000)));
        return std::nullopt;
    }
    if (errors)
        *errors = browser.readAllStandardError();
    return browser.readAllStandardOutput();
}

// The findings an inspector page wrote into the dumped document.
QJsonObject findingsOf(const QByteArray &dom)
{
    const qsizetype start = dom.indexOf("RESULT:");
    const qsizetype end = dom.indexOf(":END", start);
    if (start < 0 || end < 0)
        return failure(
            QStringLiteral("the inspector wrote no result: %1").arg(QString::fromUtf8(dom.left(2000))));
    const QByteArray json = QByteArray::fromPercentEncoding(dom.mid(start + 7, end - start - 7));
    QJsonParseError error;
    const QJsonDocument document = QJsonDocument::fromJson(json, &error);
    if (!document.isObject())
        return failure(QStringLiteral("the inspector's result is not JSON: %1").arg(error.errorString()));
    return document.object();
}

// The inspector page `name` with its marks replaced, written into the work folder.
QString writeInspector(const QString &name, const QString &workFolder,
                       const QList<std::pair<QByteArray, QByteArray>> &marks)
{
    QByteArray wrapper = readFile(QStringLiteral(ZORBIN_BROWSER_TEST_DIR "/") + name);
    if (wrapper.isEmpty())
        return {};
    for (const auto &[mark, value] : marks)
        wrapper.replace(mark, value);
    const QString inspector = QDir(workFolder).filePath(name);
    writeFile(inspector, wrapper);
    return inspector;
}

} // namespace

HeadlessChromium::HeadlessChromium(QString profileFolder) : m_profile(std::move(profileFolder))
{
    QDir().mkpath(m_profile);
}

QStringList HeadlessChromium::commonArguments() const
{
    return {QStringLiteral("--headless"),
            QStringLiteral("--no-sandbox"),
            QStringLiteral("--disable-gpu"),
            QStringLiteral("--no-first-run"),
            QStringLiteral("--disable-background-networking"),
            QStringLiteral("--disable-component-update"),
            QStringLiteral("--disable-sync"),
            QStringLiteral("--user-data-dir=") + m_profile};
}

QJsonObject HeadlessChromium::inspectCatalog(const QString &page, const QString &workFolder) const
{
    const QString inspector = writeInspector(QStringLiteral("inspect-catalog.html"), workFolder,
                                             {{"@PAGE@", QUrl::fromLocalFile(page).toEncoded()}});
    if (inspector.isEmpty())
        return failure(QStringLiteral("inspect-catalog.html is missing"));
    QStringList arguments = commonArguments();
    // The inspector reads the frame's document: file pages must count as one origin.
    arguments << QStringLiteral("--allow-file-access-from-files")
              << QStringLiteral("--virtual-time-budget=15000") << QStringLiteral("--dump-dom")
              << QUrl::fromLocalFile(inspector).toString();
    QString diagnosis;
    const auto dom = runBrowser(arguments, diagnosis);
    if (!dom)
        return failure(diagnosis);
    return findingsOf(dom.value());
}

QJsonObject HeadlessChromium::inspectSite(const QString &page, const QString &workFolder, QSize window,
                                          const QString &key) const
{
    const QString inspector = writeInspector(QStringLiteral("inspect-site.html"), workFolder,
                                             {{"@PAGE@", QUrl::fromLocalFile(page).toEncoded()},
                                              {"@WIDTH@", QByteArray::number(window.width())},
                                              {"@HEIGHT@", QByteArray::number(window.height())},
                                              {"@KEY@", key.toUtf8()}});
    if (inspector.isEmpty())
        return failure(QStringLiteral("inspect-site.html is missing"));
    QStringList arguments = commonArguments();
    // Every console message goes to standard error, with the address of the page that wrote it.
    arguments << QStringLiteral("--allow-file-access-from-files") << QStringLiteral("--enable-logging=stderr")
              << QStringLiteral("--v=0") << QStringLiteral("--virtual-time-budget=15000")
              << QStringLiteral("--dump-dom") << QUrl::fromLocalFile(inspector).toString();
    QString diagnosis;
    QByteArray errors;
    const auto dom = runBrowser(arguments, diagnosis, &errors);
    if (!dom)
        return failure(diagnosis);
    QJsonObject findings = findingsOf(dom.value());
    const QByteArray site = QUrl::fromLocalFile(QFileInfo(page).absolutePath()).toEncoded();
    QJsonArray console;
    for (const QByteArray &line : errors.split('\n')) {
        if (line.contains(":CONSOLE") && line.contains(site))
            console << QString::fromUtf8(line);
    }
    findings.insert(QStringLiteral("console"), console);
    return findings;
}

bool HeadlessChromium::screenshot(const QString &page, const QString &png, int width, int height) const
{
    QStringList arguments = commonArguments();
    arguments << QStringLiteral("--hide-scrollbars") << QStringLiteral("--screenshot=") + png
              << QStringLiteral("--window-size=%1,%2").arg(width).arg(height)
              << QUrl::fromLocalFile(page).toString();
    QString diagnosis;
    if (!runBrowser(arguments, diagnosis)) {
        qWarning("%s", qPrintable(diagnosis));
        return false;
    }
    return QFileInfo(png).size() > 0;
}

} // namespace zorbin::test
