#pragma once

#include <QJsonObject>
#include <QSize>
#include <QString>

namespace zorbin::test {

// Debian's Chromium without a screen: a fresh profile for every call, no network of its own.
class HeadlessChromium
{
public:
    // `profileFolder` is created when missing; it must not be shared with a running browser.
    explicit HeadlessChromium(QString profileFolder);

    // Opens inspect-catalog.html on `page` (a local file), waits until it has written its
    // findings, and returns them; on failure an object with the single key "error".
    QJsonObject inspectCatalog(const QString &page, const QString &workFolder) const;

    // Opens inspect-site.html on the web catalog page `page` in a frame of `window` pixels,
    // types `key` into its search box, and returns the findings; "console" lists what the site's
    // pages wrote to the browser's console (errors included).
    QJsonObject inspectSite(const QString &page, const QString &workFolder, QSize window,
                            const QString &key) const;

    // Writes a picture of the page as the browser shows it in a window of that size.
    bool screenshot(const QString &page, const QString &png, int width, int height) const;

private:
    QStringList commonArguments() const;
    QString m_profile;
};

} // namespace zorbin::test
