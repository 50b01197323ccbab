#pragma once

#include <QString>

namespace zorbin {

// The catalog query and the item-selection list compare Boolean columns with the literals
// True and False, which mean -1 and 0 in the working database but 1 and 0 to SQLite. This
// rewrites every True and False (any letter case) that stands as a word of its own outside
// quoted text, quoted or bracketed names and comments as -1 and 0; nothing else changes.
QString translateBooleanLiterals(const QString &sql);

} // namespace zorbin
