#include "HeadlessChromium.h"

#include "testutil/TestFiles.h"

#include <QDir>
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

// Runs the browser; its standard output, or nothing when it failed or took too long.
std::optional<QByteArray> runBrowser(const QStringList &arguments, QString &diagnosis)
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
    return browser.readAllStandardOutput();
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
    const QByteArray wrapper = readFile(QStringLiteral(ZORBIN_BROWSER_TEST_DIR "/inspect-catalog.html"));
    if (wrapper.isEmpty())
        return failure(QStringLiteral("inspect-catalog.html is missing"));
    const QString inspector = QDir(workFolder).filePath(QStringLiteral("inspect-catalog.html"));
    writeFile(inspector, QByteArray(wrapper).replace("@PAGE@", QUrl::fromLocalFile(page).toEncoded()));

    QStringList arguments = commonArguments();
    // The inspector reads the frame's document: file pages must count as one origin.
    arguments << QStringLiteral("--allow-file-access-from-files")
              << QStringLiteral("--virtual-time-budget=15000") << QStringLiteral("--dump-dom")
              << QUrl::fromLocalFile(inspector).toString();
    QString diagnosis;
    const auto dom = runBrowser(arguments, diagnosis);
    if (!dom)
        return failure(diagnosis);
    const qsizetype start = dom->indexOf("RESULT:");
    const qsizetype end = dom->indexOf(":END", start);
    if (start < 0 || end < 0)
        return failure(
            QStringLiteral("the inspector wrote no result: %1").arg(QString::fromUtf8(dom->left(2000))));
    const QByteArray json = QByteArray::fromPercentEncoding(dom->mid(start + 7, end - start - 7));
    QJsonParseError error;
    const QJsonDocument document = QJsonDocument::fromJson(json, &error);
    if (!document.isObject())
        return failure(QStringLiteral("the inspector's result is not JSON: %1").arg(error.errorString()));
    return document.object();
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
