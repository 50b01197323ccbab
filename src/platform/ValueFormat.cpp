#include "platform/ValueFormat.h"

#include <QLocale>
#include <algorithm>
#include <charconv>
#include <cmath>

namespace zorbin {
namespace {

// Above this a double no longer holds every cent exactly; such amounts are printed as they are.
constexpr double ExactCentsLimit = 1e13;

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
    // Digits by hand rather than through QString::arg: a catalog formats a price in every cell.
    char digits[32];
    char *digitsEnd = digits;
    int cents = 0;
    bool negative = false;
    if (std::fabs(value) < ExactCentsLimit) {
        const long long all = std::llround(value * 100.0);
        negative = all < 0;
        const long long magnitude = negative ? -all : all;
        digitsEnd = std::to_chars(digits, digits + sizeof digits, magnitude / 100).ptr;
        cents = static_cast<int>(magnitude % 100);
    } else {
        negative = value < 0;
        const QByteArray fixed = QByteArray::number(std::fabs(value), 'f', 2);
        digitsEnd = std::copy(fixed.begin(), fixed.end() - 3, digits);
        cents = (fixed.at(fixed.size() - 2) - '0') * 10 + (fixed.at(fixed.size() - 1) - '0');
    }
    const qsizetype count = digitsEnd - digits;
    QString text;
    text.reserve(count + count / 3 * separators.group.size() + separators.decimal.size() + 3);
    if (negative)
        text += QLatin1Char('-');
    for (qsizetype i = 0; i < count; ++i) {
        if (i > 0 && (count - i) % 3 == 0)
            text += separators.group;
        text += QLatin1Char(digits[i]);
    }
    text += separators.decimal;
    text += QLatin1Char(static_cast<char>('0' + cents / 10));
    text += QLatin1Char(static_cast<char>('0' + cents % 10));
    return text;
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
