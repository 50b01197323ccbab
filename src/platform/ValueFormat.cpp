#include "platform/ValueFormat.h"

#include <QLocale>
#include <cmath>

namespace zorbin {
namespace {

// Above this a double no longer holds every cent exactly; such amounts are printed as they are.
constexpr double ExactCentsLimit = 1e13;

QString groupedDigits(const QString &digits, const QString &group)
{
    QString grouped;
    grouped.reserve(digits.size() + digits.size() / 3 * group.size());
    const qsizetype count = digits.size();
    for (qsizetype i = 0; i < count; ++i) {
        if (i > 0 && (count - i) % 3 == 0)
            grouped += group;
        grouped += digits.at(i);
    }
    return grouped;
}

// The date separator of a locale's short date format: the first mark between its fields.
QString dateSeparatorOf(const QLocale &locale)
{
    const QString format = locale.dateFormat(QLocale::ShortFormat);
    for (const QChar c : format) {
        if (!c.isLetter() && !c.isSpace() && c != QLatin1Char('\''))
            return c;
    }
    return {};
}

} // namespace

Separators Separators::ofSystem()
{
    Separators separators;
    const QLocale locale;
    if (locale.language() == QLocale::C)
        return separators;
    if (!locale.groupSeparator().isEmpty())
        separators.group = locale.groupSeparator();
    if (!locale.decimalPoint().isEmpty())
        separators.decimal = locale.decimalPoint();
    if (const QString date = dateSeparatorOf(locale); !date.isEmpty())
        separators.date = date;
    return separators;
}

QString formatAmount(double value, const Separators &separators)
{
    if (!std::isfinite(value))
        return QString::number(value);
    QString digits;
    QString cents;
    bool negative = false;
    if (std::fabs(value) < ExactCentsLimit) {
        const long long all = std::llround(value * 100.0);
        negative = all < 0;
        const long long magnitude = negative ? -all : all;
        digits = QString::number(magnitude / 100);
        cents = QStringLiteral("%1").arg(magnitude % 100, 2, 10, QLatin1Char('0'));
    } else {
        negative = value < 0;
        const QString fixed = QString::number(std::fabs(value), 'f', 2);
        digits = fixed.left(fixed.size() - 3);
        cents = fixed.right(2);
    }
    return (negative ? QStringLiteral("-") : QString()) + groupedDigits(digits, separators.group) +
           separators.decimal + cents;
}

QString formatDate(const QDate &date, const Separators &separators)
{
    return QStringLiteral("%1").arg(date.day(), 2, 10, QLatin1Char('0')) + separators.date +
           QStringLiteral("%1").arg(date.month(), 2, 10, QLatin1Char('0')) + separators.date +
           QStringLiteral("%1").arg(date.year(), 4, 10, QLatin1Char('0'));
}

QString formatOneDecimal(double value)
{
    const long long tenths = std::llround(value * 10.0);
    const bool negative = tenths < 0;
    const long long magnitude = negative ? -tenths : tenths;
    return (negative ? QStringLiteral("-") : QString()) +
           QStringLiteral("%1").arg(magnitude / 10, 2, 10, QLatin1Char('0')) + QLatin1Char('.') +
           QString::number(magnitude % 10);
}

} // namespace zorbin
