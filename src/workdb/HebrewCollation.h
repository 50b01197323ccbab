#pragma once

#include <QString>

struct sqlite3;

namespace zorbin {

// The order and equality of every text in the working database: Hebrew order (ICU, locale
// "he"), Latin letters without regard to their case, accents and vowel points significant.
// Two texts are equal only when they differ in letter case at most: a Hebrew final letter and
// its normal form (ך and כ) are different letters, though ICU alone would take them as equal
// at this strength, so ties are broken by the case-folded code points.
inline constexpr char HebrewCollationName[] = "HEBREW_CI";

// Registers the collation on an open SQLite connection under HebrewCollationName; the
// connection owns the collator from then on. Returns false with `error` filled when ICU or
// SQLite refuse.
bool registerHebrewCollation(sqlite3 *connection, QString *error);

// The collation's comparison of two texts, for tests and for code that sorts outside SQLite:
// negative, zero or positive.
int compareHebrew(const QString &left, const QString &right);

} // namespace zorbin
