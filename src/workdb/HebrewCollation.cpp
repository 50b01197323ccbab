#include "workdb/HebrewCollation.h"

#include <memory>
#include <sqlite3.h>
#include <unicode/uchar.h>
#include <unicode/ucol.h>
#include <unicode/utf8.h>

namespace zorbin {
namespace {

struct CollatorCloser
{
    void operator()(UCollator *collator) const { ucol_close(collator); }
};
using CollatorHandle = std::unique_ptr<UCollator, CollatorCloser>;

// A Hebrew collator that ignores letter case: secondary strength keeps base letters, accents
// and vowel points apart and lets "A" and "a" meet.
CollatorHandle openCollator(QString *error)
{
    UErrorCode status = U_ZERO_ERROR;
    CollatorHandle collator(ucol_open("he", &status));
    if (U_FAILURE(status)) {
        if (error)
            *error = QStringLiteral("ICU cannot open the Hebrew collation: %1")
                         .arg(QLatin1String(u_errorName(status)));
        return nullptr;
    }
    ucol_setStrength(collator.get(), UCOL_SECONDARY);
    return collator;
}

// The code points of two UTF-8 texts compared one by one after simple case folding.
int compareFolded(const char *left, int leftLength, const char *right, int rightLength)
{
    int i = 0;
    int j = 0;
    while (i < leftLength && j < rightLength) {
        UChar32 a = 0;
        UChar32 b = 0;
        U8_NEXT(left, i, leftLength, a);
        U8_NEXT(right, j, rightLength, b);
        a = u_foldCase(a, U_FOLD_CASE_DEFAULT);
        b = u_foldCase(b, U_FOLD_CASE_DEFAULT);
        if (a != b)
            return a < b ? -1 : 1;
    }
    if (i < leftLength)
        return 1;
    if (j < rightLength)
        return -1;
    return 0;
}

int compareUtf8(UCollator *collator, const char *left, int leftLength, const char *right, int rightLength)
{
    UErrorCode status = U_ZERO_ERROR;
    const UCollationResult order = ucol_strcollUTF8(collator, left, leftLength, right, rightLength, &status);
    if (U_SUCCESS(status) && order != UCOL_EQUAL)
        return order == UCOL_LESS ? -1 : 1;
    return compareFolded(left, leftLength, right, rightLength);
}

int sqliteCompare(void *collator, int leftLength, const void *left, int rightLength, const void *right)
{
    return compareUtf8(static_cast<UCollator *>(collator), static_cast<const char *>(left), leftLength,
                       static_cast<const char *>(right), rightLength);
}

void closeCollator(void *collator)
{
    ucol_close(static_cast<UCollator *>(collator));
}

} // namespace

bool registerHebrewCollation(sqlite3 *connection, QString *error)
{
    CollatorHandle collator = openCollator(error);
    if (!collator)
        return false;
    // On success SQLite owns the collator and closes it with the connection; on failure the
    // destructor is not called, so the handle keeps it.
    const int rc = sqlite3_create_collation_v2(connection, HebrewCollationName, SQLITE_UTF8, collator.get(),
                                               &sqliteCompare, &closeCollator);
    if (rc != SQLITE_OK) {
        if (error)
            *error = QString::fromUtf8(sqlite3_errmsg(connection));
        return false;
    }
    collator.release();
    return true;
}

int compareHebrew(const QString &left, const QString &right)
{
    thread_local const CollatorHandle collator = openCollator(nullptr);
    const QByteArray a = left.toUtf8();
    const QByteArray b = right.toUtf8();
    if (!collator)
        return compareFolded(a.constData(), static_cast<int>(a.size()), b.constData(),
                             static_cast<int>(b.size()));
    return compareUtf8(collator.get(), a.constData(), static_cast<int>(a.size()), b.constData(),
                       static_cast<int>(b.size()));
}

} // namespace zorbin
