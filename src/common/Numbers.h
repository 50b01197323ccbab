#pragma once

#include <QString>
#include <cstdint>
#include <optional>

// Conversions of stored and typed texts to numbers. The settings keep numbers as the text the
// user typed or the store holds; these are the only places where such a text becomes a number.
namespace zorbin {

// Rounds to the nearest whole number, a half to the even neighbour (2.5 -> 2, 3.5 -> 4, -2.5 -> -2).
std::int64_t roundHalfEven(double value);

// The number a text stands for: optional blanks, an optional sign, digits with an optional
// "." fraction and an optional exponent. Anything else (empty text included) is not a number.
std::optional<double> parseNumber(const QString &text);

// A text converted to a whole number of the given range, rounding a fraction half to even,
// as a typed setting is read ("12.5" -> 12, "13.5" -> 14). Out of range or not a number: nothing.
std::optional<std::int64_t> toWholeNumber(const QString &text, std::int64_t lowest, std::int64_t highest);

std::optional<std::int16_t> toInt16(const QString &text);
std::optional<std::uint8_t> toByte(const QString &text);

} // namespace zorbin
