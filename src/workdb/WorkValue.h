#pragma once

#include <QByteArray>
#include <QVariant>
#include <cstdint>
#include <variant>

namespace zorbin {

// A value ready to be written into the working database as the engine stores it: Null, a whole
// number, a floating-point number or a text in UTF-8. Making one costs an allocation and an
// encoding; the collection makes them on the thread that reads the source.
struct WorkValue
{
    std::variant<std::monostate, std::int64_t, double, QByteArray> value;

    bool isNull() const { return std::holds_alternative<std::monostate>(value); }

    // A null QVariant is Null; a bool is -1 or 0; integers and floating-point numbers stay
    // numbers (an unsigned beyond the int64 range becomes a floating-point number); anything
    // else is its text.
    static WorkValue from(const QVariant &variant);
    // The value as the user reads it in a message: empty for Null.
    QString toText() const;
};

} // namespace zorbin
