// Stand-ins until the output writers are written.
#include "output/CatalogPages.h"
#include "output/ImageCollection.h"
#include "output/ListPage.h"

namespace zorbin {
namespace {
Status missing()
{
    return Status::fault(QStringLiteral("כתיבת הקטלוג עדיין אינה זמינה בגרסה זו."));
}
} // namespace

Status CollectCatImages(RunContext &, const QString &, const QString &)
{
    return missing();
}
Result<QString> CreateCatHTML(RunContext &, const QString &, const QString &, const QString &)
{
    return missing();
}
Status CreateListHTML(RunContext &, const QString &, const QString &)
{
    return missing();
}

} // namespace zorbin
