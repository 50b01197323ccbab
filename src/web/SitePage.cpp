#include "web/SitePage.h"

#include "output/FileNaming.h"
#include "web/SiteLayout.h"
#include "web/SiteNames.h"
#include "web/SiteSections.h"
#include "web/ThumbnailStore.h"

#include <QRegularExpression>
#include <algorithm>

namespace zorbin {
namespace {

// The pages linked by number on each side of the current one.
constexpr long long NearbyPages = 2;

QByteArray utf8(const QString &text)
{
    return text.toUtf8();
}

// The document title: the top title without its markup, for the title bar and bookmarks.
QByteArray documentTitle(const SiteLayout &layout, long long page)
{
    static const QRegularExpression tags(QStringLiteral("<[^>]*>"));
    QString title = QString(layout.topTitle).remove(tags).simplified();
    if (title.isEmpty())
        title = QStringLiteral("קטלוג מוצרים");
    if (page > 1)
        title += QStringLiteral(" - עמוד ") + QString::number(page);
    return utf8(title.replace(QLatin1Char('<'), QStringLiteral("&lt;")));
}

QByteArray pictureElement(const Thumbnail &picture, const QByteArray &className, const QByteArray &alt)
{
    QByteArray element =
        "<img class=\"" + className + "\" alt=\"" + alt + "\" src=\"" + utf8(picture.file) + '"';
    if (!picture.twiceFile.isEmpty())
        element += " srcset=\"" + utf8(picture.file) + " 1x, " + utf8(picture.twiceFile) + " 2x\"";
    return element + " width=\"" + QByteArray::number(picture.size.width()) + "\" height=\"" +
           QByteArray::number(picture.size.height()) + "\">";
}

QByteArray pageLink(long long page, const QByteArray &text, const QByteArray &rel = {})
{
    QByteArray link = "<a href=\"" + utf8(site::pageFileName(page)) + '"';
    if (!rel.isEmpty())
        link += " rel=\"" + rel + '"';
    return link + '>' + text + "</a>";
}

} // namespace

long long pageOfItem(long long place, long long itemsPerPage)
{
    return place / itemsPerPage + 1;
}

QByteArray pageStart(const SiteLayout &layout, long long page, const Thumbnail *logo)
{
    QByteArray html = "<!DOCTYPE html>\n<html lang=\"he\" dir=\"rtl\">\n<head>\n<meta charset=\"utf-8\">\n"
                      "<meta name=\"viewport\" content=\"width=device-width, initial-scale=1\">\n<title>" +
                      documentTitle(layout, page) + "</title>\n<link rel=\"stylesheet\" href=\"" +
                      utf8(site::StylesheetName) + "\">\n<script src=\"" + utf8(site::ScriptName) +
                      "\" defer></script>\n</head>\n<body>\n";
    if (layout.topBand) {
        html += "<header class=\"top\">\n<div class=\"titles\">\n<h1 class=\"Top1\">" +
                utf8(layout.topTitle) + "</h1>\n<p class=\"Top2\">" + utf8(layout.topTitle2) +
                "</p>\n</div>\n";
        if (logo)
            html += pictureElement(*logo, "logo", "לוגו") + '\n';
        html += "</header>\n";
    }
    html +=
        "<form class=\"search\" role=\"search\" hidden><input type=\"search\" id=\"search\" "
        "placeholder=\"חיפוש לפי שם או מק&quot;ט\" aria-label=\"חיפוש פריטים\" autocomplete=\"off\"></form>\n"
        "<p id=\"found\" class=\"found\" hidden></p>\n<div id=\"results\" class=\"grid\" hidden></div>\n";
    return html;
}

QByteArray sectionList(const std::vector<Section> &sections, long long itemsPerPage)
{
    QByteArray html = "<nav class=\"sections\" aria-label=\"קבוצות\">\n<ul>\n";
    for (const Section &section : sections) {
        const long long page = pageOfItem(section.first, itemsPerPage);
        const QByteArray target = page == 1 ? QByteArray() : utf8(site::pageFileName(page));
        html += "<li><a href=\"" + target + '#' + utf8(section.anchor()) + "\">" +
                utf8(escapeHtml(section.title)) + "</a> <span class=\"count\">(" +
                QByteArray::number(section.count) + ")</span></li>\n";
    }
    return html + "</ul>\n</nav>\n";
}

QByteArray sectionStart(const Section &section)
{
    return "<section class=\"group\" id=\"" + utf8(section.anchor()) + "\">\n<h2>" +
           utf8(escapeHtml(section.title)) + "</h2>\n<div class=\"grid\">\n";
}

QByteArray pageEnd(const SiteLayout &layout, long long page, long long pageCount)
{
    QByteArray html;
    if (pageCount > 1) {
        html += "<nav class=\"pages\" aria-label=\"עמודים\">\n";
        if (page > 1)
            html += pageLink(page - 1, "לעמוד הקודם", "prev") + '\n';
        std::vector<long long> numbers{1};
        for (long long number = std::max(2LL, page - NearbyPages);
             number <= std::min(pageCount - 1, page + NearbyPages); ++number)
            numbers.push_back(number);
        numbers.push_back(pageCount);
        long long shown = 0; // the last page number written
        for (const long long number : numbers) {
            if (number > shown + 1)
                html += "<span class=\"gap\">…</span>\n";
            if (number == page)
                html += "<span class=\"current\" aria-current=\"page\">" + QByteArray::number(number) +
                        "</span>\n";
            else
                html += pageLink(number, QByteArray::number(number)) + '\n';
            shown = number;
        }
        if (page < pageCount)
            html += pageLink(page + 1, "לעמוד הבא", "next") + '\n';
        html += "</nav>\n";
    }
    if (layout.bottomBand)
        html += "<footer class=\"Bot1\">" + utf8(layout.bottomTitle) + "</footer>\n";
    return html + "</body>\n</html>\n";
}

} // namespace zorbin
