#include "source/SourceCriteria.h"

#include "model/CatalogSettings.h"

#include <QRegularExpression>

namespace zorbin {
namespace {

// A text between apostrophes in the accounting database's SQL.
QString quoted(const QString &text)
{
    QString escaped = text;
    escaped.replace(QLatin1Char('\''), QStringLiteral("''"));
    return QLatin1Char('\'') + escaped + QLatin1Char('\'');
}

bool isWholeNumber(const QString &text)
{
    static const QRegularExpression whole(QStringLiteral("^[+-]?[0-9]+$"));
    return whole.match(text).hasMatch();
}

// Appends one sort-group bound; `fieldName` is how the settings page labels the box.
Status appendSortBound(QString &criteria, const QString &typed, const QString &comparison,
                       const QString &fieldName)
{
    const QString bound = typed.trimmed();
    if (bound.isEmpty())
        return Status::ok();
    if (!isWholeNumber(bound))
        return Status::fault(QStringLiteral("בשדה \"%1\" של טווח קודי המיון כתוב \"%2\", וזה אינו מספר שלם. "
                                            "יש להקליד קוד מיון בספרות בלבד, או להשאיר את השדה ריק.")
                                 .arg(fieldName, bound));
    criteria += QStringLiteral(" And Items.SortGroup ") + comparison + QLatin1Char(' ') + bound;
    return Status::ok();
}

void appendKeyBound(QString &criteria, const QString &typed, const QString &comparison)
{
    const QString bound = typed.trimmed();
    if (!bound.isEmpty())
        criteria += QStringLiteral(" And Items.ItemKey ") + comparison + QLatin1Char(' ') + quoted(bound);
}

// One piece per position of the filter field: the typed text, or "_" for any character.
// Nothing when no position is set.
QString filterPattern(const CatalogSettings &settings)
{
    QString pattern;
    bool anySet = false;
    for (const QString &box : settings.cutOff) {
        const QString text = box.trimmed();
        if (text.isEmpty() || text == QLatin1String("*")) {
            pattern += QLatin1Char('_');
        } else {
            pattern += text;
            anySet = true;
        }
    }
    return anySet ? pattern : QString();
}

} // namespace

Result<QString> BuildSourceDBCriteria(const CatalogSettings &settings)
{
    QString criteria = QStringLiteral(" And Items.ItemKey <> '#' And Items.ItemKey <> '*'");
    if (settings.sortCodeRange) {
        if (Status status = appendSortBound(criteria, settings.sortCodeFrom, QStringLiteral(">="),
                                            QStringLiteral("מקוד מיון"));
            !status)
            return status;
        if (Status status = appendSortBound(criteria, settings.sortCodeTo, QStringLiteral("<="),
                                            QStringLiteral("עד קוד מיון"));
            !status)
            return status;
    }
    if (settings.cutOffFilter) {
        if (const QString pattern = filterPattern(settings); !pattern.isEmpty())
            criteria += QStringLiteral(" And Items.Filter Like ") + quoted(pattern);
    }
    if (settings.itemKeyRange) {
        appendKeyBound(criteria, settings.itemKeyFrom, QStringLiteral(">="));
        appendKeyBound(criteria, settings.itemKeyTo, QStringLiteral("<="));
    }
    return criteria;
}

} // namespace zorbin
