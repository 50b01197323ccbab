#pragma once

#include <QDate>
#include <QString>

namespace zorbin {

// The number and date formats of the catalog files, with the separators of the system.

// The separators of the system's locale (Qt's default locale, QLocale()). Where the locale has
// none of its own (the C locale), "," groups thousands, "." marks decimals and "/" separates
// the parts of a date.
struct Separators
{
    QString group = QStringLiteral(",");
    QString decimal = QStringLiteral(".");
    QString date = QStringLiteral("/");

    static Separators ofSystem();
};

// A number with the pattern "###,##0.00": thousands grouped, at least one digit before the
// decimal mark, exactly two after it, a half cent rounded away from zero (1234.5 gives
// "1,234.50", 0 gives "0.00", -3 gives "-3.00"; a value that rounds to zero has no sign).
// The value is rounded from its first 15 significant digits, the digits it was typed with, so
// that a typed half cent rounds as a half (2.675 gives "2.68"); any magnitude is written out.
QString formatAmount(double value, const Separators &separators);

// A date with the pattern "dd/mm/yyyy": two-digit day, two-digit month, four-digit year.
QString formatDate(const QDate &date, const Separators &separators);

// A number with the pattern "00.0" and a full stop as the decimal mark (a stylesheet's
// percentage): at least two digits before the mark, one after it, a half rounded away from
// zero (100 / 3 gives "33.3", 100 / 16 gives "06.3", 100 gives "100.0").
QString formatOneDecimal(double value);

} // namespace zorbin
