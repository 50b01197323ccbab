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

// The whole cents of a magnitude below ExactCentsLimit, a half cent rounded up. The half is
// judged on the fifteen significant digits that a double holds faithfully, as the amount was
// typed: 1.005 is stored as 1.00499999999999989... and must still give 101 cents.
long long roundedCents(double magnitude)
{
    char text[32];
    const char *const end =
        std::to_chars(text, text + sizeof text, magnitude, std::chars_format::scientific, 14).ptr;
    long long digits = 0; // the fifteen digits of "d.dddddddddddddde±x", without the point
    const char *c = text;
    for (; c != end && *c != 'e'; ++c) {
        if (*c != '.')
            digits = digits * 10 + (*c - '0');
    }
    int exponent = 0;
    std::from_chars(*(c + 1) == '+' ? c + 2 : c + 1, end, exponent);
    // cents = digits x 10^(exponent - 12); the power is positive only for an amount that
    // rounds up to the limit itself.
    int dropped = 12 - exponent;
    for (; dropped < 0; ++dropped)
        digits *= 10;
    if (dropped > 15)
        return 0;
    long long divisor = 1;
    for (int i = 0; i < dropped; ++i)
        divisor *= 10;
    const long long cents = digits / divisor;
    return digits % divisor * 2 >= divisor ? cents + 1 : cents;
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
        const long long all = roundedCents(std::fabs(value));
        negative = value < 0 && all != 0;
        digitsEnd = std::to_chars(digits, digits + sizeof digits, all / 100).ptr;
        cents = static_cast<int>(all % 100);
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
