#include "model/ControlProperty.h"

#include "common/Numbers.h"

namespace zorbin {

ControlProperty ControlProperty::text(QString &value)
{
    return {PropertyKind::Text, [&value] { return value; },
            [&value](const QString &stored) {
                value = stored;
                return true;
            }};
}

ControlProperty ControlProperty::caption(QString &value)
{
    ControlProperty property = text(value);
    property.m_kind = PropertyKind::Caption;
    return property;
}

ControlProperty ControlProperty::listIndex(ChoiceList &list)
{
    return {PropertyKind::ListIndex, [&list] { return QString::number(list.currentIndex()); },
            [&list](const QString &stored) {
                const auto index = toInt16(stored);
                return index && list.setCurrentIndex(*index);
            }};
}

ControlProperty ControlProperty::check(CheckValue &value)
{
    return {PropertyKind::Value, [&value] { return QString::number(static_cast<int>(value)); },
            [&value](const QString &stored) {
                const auto number = toInt16(stored);
                if (!number || *number < 0 || *number > 2)
                    return false;
                value = static_cast<CheckValue>(*number);
                return true;
            }};
}

ControlProperty ControlProperty::option(OptionGroup<3> &group, int index)
{
    return {PropertyKind::Value, [&group, index] { return optionStoreText(group.value(index)); },
            [&group, index](const QString &stored) {
                const auto state = optionFromStoreText(stored);
                if (!state)
                    return false;
                group.setValue(index, *state);
                return true;
            }};
}

ControlProperty ControlProperty::tag(QString &value)
{
    return {PropertyKind::Tag, [&value] { return value; },
            [&value](const QString &stored) {
                // A tag that names no field would break every run; it is refused like any
                // other value that its widget cannot take.
                if (!stored.isEmpty() && !fieldOfTag(stored))
                    return false;
                value = stored;
                return true;
            }};
}

ControlProperty ControlProperty::byte(std::uint8_t &value)
{
    return {PropertyKind::Value, [&value] { return QString::number(value); },
            [&value](const QString &stored) {
                const auto number = toByte(stored);
                if (!number)
                    return false;
                value = *number;
                return true;
            }};
}

QString optionStoreText(bool value)
{
    return value ? QStringLiteral("True") : QStringLiteral("False");
}

std::optional<bool> optionFromStoreText(const QString &text)
{
    const QString trimmed = text.trimmed();
    if (trimmed.compare(QLatin1String("True"), Qt::CaseInsensitive) == 0)
        return true;
    if (trimmed.compare(QLatin1String("False"), Qt::CaseInsensitive) == 0)
        return false;
    if (const auto number = parseNumber(trimmed))
        return *number != 0.0;
    return std::nullopt;
}

} // namespace zorbin
