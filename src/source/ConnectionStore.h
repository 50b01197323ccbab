#pragma once

#include "model/ConnectionParams.h"

#include <QString>
#include <optional>

namespace zorbin {

class SettingsStore;

// The store keys of the connection parameters (application "Zorbin", section "Params") and the
// value each field takes when its key is absent. The type is stored as the `CmbConnType` list
// index, the type minus 1 ("-1" when no type was chosen).
inline const QString ConnServerKey = QStringLiteral("ConnServer");
inline const QString ConnUserKey = QStringLiteral("ConnUID");
inline const QString ConnPasswordKey = QStringLiteral("ConnPWD");
inline const QString ConnDatabaseKey = QStringLiteral("ConnDataBase");
inline const QString ConnTypeKey = QStringLiteral("ConnType");
inline const QString DefaultConnServer = QStringLiteral("server");
inline const QString DefaultConnUser = QStringLiteral("sa");
inline const QString DefaultConnDatabase = QStringLiteral("tarnik02");
inline const QString DefaultConnTypeIndex = QStringLiteral("0");

// Loads the connection parameters from the store; a value that cannot be read leaves its field
// as it was. Never reports anything.
void GetRegConnParams(SettingsStore &store, ConnectionParams &params);

// The connection type a stored list index stands for: the text read as a number, plus 1,
// rounded half to even to a 16-bit whole number ("0" gives 1, "-1" gives 0, "1.5" gives 2).
// Nothing when the text is not a number or the result does not fit.
std::optional<std::int16_t> connTypeFromStoredIndex(const QString &storedIndex);

} // namespace zorbin
