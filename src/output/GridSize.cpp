#include "output/GridSize.h"

#include "common/Numbers.h"
#include "model/CatalogSettings.h"

#include <limits>

namespace zorbin {
namespace {

Result<int> countOf(const QString &text, const QString &what)
{
    const auto number = toWholeNumber(text, 1, std::numeric_limits<int>::max());
    if (!number)
        return Status::fault(QStringLiteral("%1 בעמוד הקטלוג (\"%2\") צריך להיות מספר שלם גדול מאפס. יש לתקן "
                                            "אותו בלשונית \"הגדרת עמוד בקטלוג\".")
                                 .arg(what, text));
    return static_cast<int>(*number);
}

} // namespace

Result<GridSize> readGridSize(const CatalogSettings &settings)
{
    const auto rows = countOf(settings.txtRows, QStringLiteral("מספר השורות"));
    if (!rows)
        return rows.status();
    const auto columns = countOf(settings.txtCols, QStringLiteral("מספר העמודות"));
    if (!columns)
        return columns.status();
    return GridSize{rows.value(), columns.value()};
}

} // namespace zorbin
