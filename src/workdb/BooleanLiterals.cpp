#include "workdb/BooleanLiterals.h"

#include "workdb/WorkSchema.h"

namespace zorbin {
namespace {

bool isWordCharacter(QChar c)
{
    return c.isLetterOrNumber() || c == QLatin1Char('_') || c == QLatin1Char('$');
}

// The index just past the quoted part that opens at `start` with `open` and ends with `close`
// (a doubled closing mark inside stays inside), or the end of the text.
qsizetype skipQuoted(const QString &sql, qsizetype start, QChar close)
{
    qsizetype i = start + 1;
    while (i < sql.size()) {
        if (sql[i] == close) {
            if (i + 1 < sql.size() && sql[i + 1] == close && close != QLatin1Char(']')) {
                i += 2;
                continue;
            }
            return i + 1;
        }
        ++i;
    }
    return i;
}

qsizetype skipComment(const QString &sql, qsizetype start)
{
    if (sql[start + 1] == QLatin1Char('-')) {
        const qsizetype end = sql.indexOf(QLatin1Char('\n'), start);
        return end < 0 ? sql.size() : end;
    }
    const qsizetype end = sql.indexOf(QLatin1String("*/"), start + 2);
    return end < 0 ? sql.size() : end + 2;
}

bool opensComment(const QString &sql, qsizetype i)
{
    if (i + 1 >= sql.size())
        return false;
    return (sql[i] == QLatin1Char('-') && sql[i + 1] == QLatin1Char('-')) ||
           (sql[i] == QLatin1Char('/') && sql[i + 1] == QLatin1Char('*'));
}

} // namespace

QString translateBooleanLiterals(const QString &sql)
{
    QString result;
    result.reserve(sql.size() + 8);
    qsizetype i = 0;
    while (i < sql.size()) {
        const QChar c = sql[i];
        qsizetype next = i + 1;
        if (c == QLatin1Char('\'') || c == QLatin1Char('"') || c == QLatin1Char('`')) {
            next = skipQuoted(sql, i, c);
        } else if (c == QLatin1Char('[')) {
            next = skipQuoted(sql, i, QLatin1Char(']'));
        } else if (opensComment(sql, i)) {
            next = skipComment(sql, i);
        } else if (isWordCharacter(c)) {
            while (next < sql.size() && isWordCharacter(sql[next]))
                ++next;
            const QStringView word = QStringView(sql).mid(i, next - i);
            const bool qualified = i > 0 && sql[i - 1] == QLatin1Char('.');
            const bool isTrue = word.compare(QLatin1String("True"), Qt::CaseInsensitive) == 0;
            const bool isFalse = word.compare(QLatin1String("False"), Qt::CaseInsensitive) == 0;
            if (!qualified && (isTrue || isFalse)) {
                if (result.endsWith(QLatin1Char('-'))) // "-True" must not become the comment "--1"
                    result += QLatin1Char(' ');
                result += QString::number(isTrue ? WorkTrue : WorkFalse);
                i = next;
                continue;
            }
        }
        result += QStringView(sql).mid(i, next - i);
        i = next;
    }
    return result;
}

} // namespace zorbin
