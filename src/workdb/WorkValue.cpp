#include "workdb/WorkValue.h"

#include "workdb/WorkSchema.h"

#include <limits>

namespace zorbin {

WorkValue WorkValue::from(const QVariant &variant, bool encode)
{
    if (variant.isNull())
        return {};
    switch (variant.typeId()) {
    case QMetaType::Bool:
        return {std::int64_t{variant.toBool() ? WorkTrue : WorkFalse}};
    case QMetaType::Int:
    case QMetaType::Short:
    case QMetaType::Char:
    case QMetaType::SChar:
    case QMetaType::UChar:
    case QMetaType::UShort:
    case QMetaType::UInt:
    case QMetaType::Long:
    case QMetaType::LongLong:
        return {std::int64_t{variant.toLongLong()}};
    case QMetaType::ULong:
    case QMetaType::ULongLong:
        if (variant.toULongLong() <= static_cast<qulonglong>(std::numeric_limits<std::int64_t>::max()))
            return {std::int64_t{variant.toLongLong()}};
        return {variant.toDouble()};
    case QMetaType::Double:
    case QMetaType::Float:
        return {variant.toDouble()};
    case QMetaType::QString: {
        const QString &text = *static_cast<const QString *>(variant.constData());
        return encode ? WorkValue{text.toUtf8()} : WorkValue{text};
    }
    default:
        return encode ? WorkValue{variant.toString().toUtf8()} : WorkValue{variant.toString()};
    }
}

QString WorkValue::toText() const
{
    if (const auto *text = std::get_if<QByteArray>(&value))
        return QString::fromUtf8(*text);
    if (const auto *text = std::get_if<QString>(&value))
        return *text;
    if (const auto *whole = std::get_if<std::int64_t>(&value))
        return QString::number(*whole);
    if (const auto *real = std::get_if<double>(&value))
        return QString::number(*real);
    return {};
}

} // namespace zorbin
