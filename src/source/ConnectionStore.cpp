#include "source/ConnectionStore.h"

#include "common/Numbers.h"
#include "model/SettingsPersistence.h"

#include <limits>

namespace zorbin {
namespace {

void loadText(SettingsStore &store, const QString &key, QString &field, const QString &fallback)
{
    const StoreValue value{[&field] { return field; },
                           [&field](const QString &text) {
                               field = text;
                               return true;
                           }};
    SetGetRegControlValue(LoadAction, store, StoreApp, StoreSection, key, value, fallback);
}

} // namespace

std::optional<std::int16_t> connTypeFromStoredIndex(const QString &storedIndex)
{
    const auto index = parseNumber(storedIndex);
    if (!index)
        return std::nullopt;
    const double type = *index + 1.0;
    constexpr double lowest = std::numeric_limits<std::int16_t>::min();
    constexpr double highest = std::numeric_limits<std::int16_t>::max();
    if (type < lowest - 0.5 || type > highest + 0.5)
        return std::nullopt;
    const std::int64_t rounded = roundHalfEven(type);
    if (rounded < lowest || rounded > highest)
        return std::nullopt;
    return static_cast<std::int16_t>(rounded);
}

void GetRegConnParams(SettingsStore &store, ConnectionParams &params)
{
    loadText(store, ConnServerKey, params.server, DefaultConnServer);
    loadText(store, ConnUserKey, params.user, DefaultConnUser);
    loadText(store, ConnPasswordKey, params.password, QString());
    loadText(store, ConnDatabaseKey, params.database, DefaultConnDatabase);
    QString storedIndex;
    loadText(store, ConnTypeKey, storedIndex, DefaultConnTypeIndex);
    if (const auto type = connTypeFromStoredIndex(storedIndex))
        params.kind = static_cast<ConnectionKind>(*type);
}

} // namespace zorbin
