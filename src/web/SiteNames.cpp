#include "web/SiteNames.h"

#include <QRegularExpression>

namespace zorbin::site {

QString pageFileName(long long page)
{
    if (page == 1)
        return QStringLiteral("index.html");
    return QStringLiteral("page-") + QString::number(page) + QStringLiteral(".html");
}

bool isSiteFileName(const QString &name)
{
    static const QRegularExpression pages(QStringLiteral("^(index|page-[1-9][0-9]*)\\.html$"));
    return pages.match(name).hasMatch() || name == StylesheetName || name == ScriptName ||
           name == SearchIndexName;
}

} // namespace zorbin::site
