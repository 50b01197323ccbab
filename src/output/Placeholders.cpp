// Stand-ins until the output writers are written.
#include "output/ImageCollection.h"

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

} // namespace zorbin
