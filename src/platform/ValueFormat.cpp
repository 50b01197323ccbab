#include "platform/ValueFormat.h"

#include <QLocale>
#include <algorithm>
#include <array>
#include <charconv>
#include <cmath>
#include <limits>

namespace zorbin {
namespace {

// The digits of a double that are the digits of the number it was made from (DBL_DIG).
constexpr int SignificantDigits = std::numeric_limits<double>::digits10;

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
    // The value to 15 significant digits, "d.dddddddddddddde+x": the double nearest to a typed
    // half cent lies a hair below or above it (2.675 is stored as 2.67499999...), and at these
    // digits it is the half again, rounded as a half.
    char scientific[32];
    const char *const scientificEnd =
        std::to_chars(scientific, scientific + sizeof scientific, std::fabs(value),
                      std::chars_format::scientific, SignificantDigits - 1)
            .ptr;
    const char *exponentText = scientific + SignificantDigits + 2;
    if (*exponentText == '+')
        ++exponentText;
    int exponent = 0;
    std::from_chars(exponentText, scientificEnd, exponent);
    // The significant digit whose place value is 10 to the given power, 0 beyond them.
    const auto digitAt = [&](int power) {
        const int index = exponent - power;
        if (index < 0 || index >= SignificantDigits)
            return '0';
        return scientific[index == 0 ? 0 : index + 1];
    };

    // The digits from the highest place (at least the units) down to the cents, with room for
    // a carry into a new highest place.
    std::array<char, std::numeric_limits<double>::max_exponent10 + 5> digits;
    char *const first = digits.data() + 1;
    char *last = first;
    for (int power = std::max(exponent, 0); power >= -2; --power)
        *last++ = digitAt(power);
    char *begin = first;
    if (digitAt(-3) >= '5') { // a half cent or more: away from zero
        char *digit = last;
        while (digit != first && *(digit - 1) == '9')
            *--digit = '0';
        if (digit == first)
            *--begin = '1';
        else
            ++*(digit - 1);
    }
    const qsizetype wholeCount = (last - begin) - 2;
    const bool negative = value < 0 && std::any_of(begin, last, [](char d) { return d != '0'; });

    QString text;
    text.reserve(wholeCount + wholeCount / 3 * separators.group.size() + separators.decimal.size() + 3);
    if (negative)
        text += QLatin1Char('-');
    for (qsizetype i = 0; i < wholeCount; ++i) {
        if (i > 0 && (wholeCount - i) % 3 == 0)
            text += separators.group;
        text += QLatin1Char(begin[i]);
    }
    text += separators.decimal;
    text += QLatin1Char(begin[wholeCount]);
    text += QLatin1Char(begin[wholeCount + 1]);
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
