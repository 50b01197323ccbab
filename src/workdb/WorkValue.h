#pragma once

#include <QByteArray>
#include <QString>
#include <QVariant>
#include <cstdint>
#include <variant>

namespace zorbin {

// A value to be written into the working database as the engine stores it: Null, a whole
// number, a floating-point number or a text. A text is kept in UTF-8, as the engine stores
// it, or still in UTF-16, to be encoded when it is written: the encoding is the costly part of
// making a value, and the collection does it on whichever of its two threads has more time.
struct WorkValue
{
    std::variant<std::monostate, std::int64_t, double, QByteArray, QString> value;

    bool isNull() const { return std::holds_alternative<std::monostate>(value); }

    // A null QVariant is Null; a bool is -1 or 0; integers and floating-point numbers stay
    // numbers (an unsigned beyond the int64 range becomes a floating-point number); anything
    // else is its text, in UTF-8 when `encode` is set.
    static WorkValue from(const QVariant &variant, bool encode = true);
    // The value as the user reads it in a message: empty for Null.
    QString toText() const;
};

} // namespace zorbin
