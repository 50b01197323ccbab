#include "model/GridSize.h"

#include "model/CatalogSettings.h"

#include <QLocale>

namespace zorbin {
namespace {

// A count with its thousands grouped, as a person reads it in a message.
QString grouped(long long count)
{
    return QLocale(QLocale::English, QLocale::UnitedStates).toString(count);
}

} // namespace

std::optional<QString> gridCountProblem(GridCount count, const std::optional<int> &value)
{
    if (value && *value >= 1)
        return std::nullopt;
    const QString field = count == GridCount::Rows ? QStringLiteral("שורות") : QStringLiteral("עמודות");
    return QStringLiteral("השדה \"%1\" בלשונית \"הגדרת עמוד בקטלוג\" צריך להכיל מספר שלם מ-1 עד 32767: "
                          "מספר התאים %2 בעמוד הקטלוג.")
        .arg(field, count == GridCount::Rows ? QStringLiteral("לאורך") : QStringLiteral("לרוחב"));
}

Result<GridSize> readGridSize(const CatalogSettings &settings)
{
    if (const auto problem = gridCountProblem(GridCount::Rows, settings.rows))
        return Status::fault(*problem);
    if (const auto problem = gridCountProblem(GridCount::Columns, settings.columns))
        return Status::fault(*problem);
    const GridSize grid{*settings.rows, *settings.columns};
    if (grid.cellsPerPage() > MaxCellsPerPage)
        return Status::fault(
            QStringLiteral("בעמוד הקטלוג %1 שורות ו-%2 עמודות, %3 תאים: יותר מדי. עמוד יכול "
                           "להכיל לכל היותר %4 תאים. יש להקטין את \"שורות\" או את \"עמודות\" "
                           "בלשונית \"הגדרת עמוד בקטלוג\".")
                .arg(grid.rows)
                .arg(grid.columns)
                .arg(grouped(grid.cellsPerPage()), grouped(MaxCellsPerPage)));
    return grid;
}

} // namespace zorbin
