#include "common/Numbers.h"

#include <QRegularExpression>
#include <cmath>
#include <limits>

namespace zorbin {

std::int64_t roundHalfEven(double value)
{
    return static_cast<std::int64_t>(std::nearbyint(value)); // the default rounding mode is half to even
}

std::optional<double> parseNumber(const QString &text)
{
    static const QRegularExpression number(
        QStringLiteral("^\\s*[+-]?(\\d+\\.?\\d*|\\.\\d+)([eE][+-]?\\d+)?\\s*$"));
    if (!number.match(text).hasMatch())
        return std::nullopt;
    bool ok = false;
    const double value = text.trimmed().toDouble(&ok);
    if (!ok || !std::isfinite(value))
        return std::nullopt;
    return value;
}

std::optional<std::int64_t> toWholeNumber(const QString &text, std::int64_t lowest, std::int64_t highest)
{
    const auto number = parseNumber(text);
    if (!number)
        return std::nullopt;
    // Compare as doubles first so that a huge value cannot overflow the conversion.
    if (*number < static_cast<double>(lowest) - 0.5 || *number > static_cast<double>(highest) + 0.5)
        return std::nullopt;
    const std::int64_t whole = roundHalfEven(*number);
    if (whole < lowest || whole > highest)
        return std::nullopt;
    return whole;
}

std::optional<std::int16_t> toInt16(const QString &text)
{
    const auto whole = toWholeNumber(text, std::numeric_limits<std::int16_t>::min(),
                                     std::numeric_limits<std::int16_t>::max());
    if (!whole)
        return std::nullopt;
    return static_cast<std::int16_t>(*whole);
}

std::optional<std::uint8_t> toByte(const QString &text)
{
    const auto whole = toWholeNumber(text, 0, 255);
    if (!whole)
        return std::nullopt;
    return static_cast<std::uint8_t>(*whole);
}

} // namespace zorbin
