#include "workdb/WriteOutcome.h"

#include "workdb/WorkSchema.h"

#include <QRegularExpression>
#include <sqlite3.h>

namespace zorbin {
namespace {

// "tItems.ItemKey" at the end of an engine message: the table and the column it names.
std::pair<QString, QString> namedColumn(const QString &message)
{
    static const QRegularExpression pattern(QStringLiteral("(\\w+)\\.(\\w+)\\s*$"));
    const QRegularExpressionMatch match = pattern.match(message);
    if (!match.hasMatch())
        return {};
    return {match.captured(1), match.captured(2)};
}

// The constraint named at the end of "CHECK constraint failed: Name".
QString failedCheck(const QString &message)
{
    const qsizetype colon = message.lastIndexOf(QLatin1Char(':'));
    return colon < 0 ? QString() : message.mid(colon + 1).trimmed();
}

QString booleanMessage()
{
    return QStringLiteral("השדה Include מקבל רק אמת (%1) או שקר (%2).").arg(WorkTrue).arg(WorkFalse);
}

WriteOutcome checkFailure(const QString &message)
{
    const QString column = failedCheck(message);
    if (column == QLatin1String("Include"))
        return WriteOutcome::refused(Refusal::WrongKind, booleanMessage());
    if (const std::optional<int> size = workTextSize(column))
        return WriteOutcome::refused(
            Refusal::TooLong,
            QStringLiteral("הטקסט ארוך מדי לשדה %1, שמקבל עד %2 תווים.").arg(column).arg(*size));
    return WriteOutcome::refused(Refusal::Other, message);
}

WriteOutcome datatypeFailure(const QString &message)
{
    const auto [table, column] = namedColumn(message);
    if (table.isEmpty())
        return WriteOutcome::refused(Refusal::WrongKind, message);
    const bool wantsText = message.contains(QLatin1String("TEXT column"));
    const QString text = wantsText ? QStringLiteral("הערך אינו מתאים לשדה %1 בטבלה %2, שמקבל רק טקסט.")
                                   : QStringLiteral("הערך אינו מתאים לשדה %1 בטבלה %2, שמקבל רק מספרים.");
    return WriteOutcome::refused(Refusal::WrongKind, text.arg(column, table));
}

} // namespace

WriteOutcome WriteOutcome::fromEngine(int extendedCode, const QString &engineMessage)
{
    switch (extendedCode) {
    case SQLITE_CONSTRAINT_PRIMARYKEY:
    case SQLITE_CONSTRAINT_UNIQUE: {
        const auto [table, column] = namedColumn(engineMessage);
        return refused(
            Refusal::DuplicateKey,
            QStringLiteral("בטבלה %1 כבר קיימת רשומה עם אותו ערך בשדה המפתח %2.").arg(table, column));
    }
    case SQLITE_CONSTRAINT_CHECK:
        return checkFailure(engineMessage);
    case SQLITE_CONSTRAINT_DATATYPE:
        return datatypeFailure(engineMessage);
    case SQLITE_CONSTRAINT_NOTNULL: {
        const auto [table, column] = namedColumn(engineMessage);
        if (column == QLatin1String("Include"))
            return refused(Refusal::WrongKind, booleanMessage());
        if (!column.isEmpty())
            return refused(Refusal::Other,
                           QStringLiteral("השדה %1 בטבלה %2 אינו יכול להישאר ריק.").arg(column, table));
        return refused(Refusal::Other, engineMessage);
    }
    default:
        return refused(Refusal::Other, engineMessage.isEmpty()
                                           ? QStringLiteral("שגיאה לא ידועה בבסיס הנתונים הזמני.")
                                           : engineMessage);
    }
}

} // namespace zorbin
