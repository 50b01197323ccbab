#include "workdb/BooleanLiterals.h"

#include "testutil/EdgeOfMemory.h"
#include "testutil/TestMain.h"

#include <QTest>

using namespace zorbin;
using namespace zorbin::test;

// True and False in the statements on the working database become -1 and 0. Each statement
// ends at unreadable memory, so that a read past its end fails the test.
class BooleanLiteralsTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void translatesOnlyTheLiterals_data()
    {
        QTest::addColumn<QString>("sql");
        QTest::addColumn<QString>("expected");
        const char *cases[][3] = {
            {"false and letter case", "UPDATE tItems SET Include = FALSE WHERE Include=true",
             "UPDATE tItems SET Include = 0 WHERE Include=-1"},
            {"a literal at the end", "SELECT 1 FROM tItems WHERE tItems.Include = True",
             "SELECT 1 FROM tItems WHERE tItems.Include = -1"},
            {"a literal alone", "false", "0"},
            {"inside quotes", "SELECT 'True', \"False\", `True`, [True] FROM t WHERE a = 'it''s True'",
             "SELECT 'True', \"False\", `True`, [True] FROM t WHERE a = 'it''s True'"},
            {"a doubled quote mark at the end", "SELECT 'it''", "SELECT 'it''"},
            {"a quote at the end", "SELECT True, 'x'", "SELECT -1, 'x'"},
            {"a bracketed name ends at the first ]", "SELECT [a]]True", "SELECT [a]]-1"},
            {"part of a word", "SELECT TrueName, IsFalse, True_1, $True, tItems.True FROM t",
             "SELECT TrueName, IsFalse, True_1, $True, tItems.True FROM t"},
            {"comments", "SELECT 1 -- True\n, /* False */ True", "SELECT 1 -- True\n, /* False */ -1"},
            {"a comment at the end", "SELECT True -- False", "SELECT -1 -- False"},
            {"an unclosed comment", "SELECT True /* False", "SELECT -1 /* False"},
            {"a minus at the end", "SELECT True -", "SELECT -1 -"},
            {"a slash at the end", "SELECT True /", "SELECT -1 /"},
            {"after a minus", "SELECT -True", "SELECT - -1"},
            {"Hebrew text untouched", "SELECT 'כן True' WHERE x = True", "SELECT 'כן True' WHERE x = -1"},
            {"unclosed quote", "SELECT 'True", "SELECT 'True"},
            {"nothing to do", "", ""},
        };
        for (const auto &c : cases)
            QTest::newRow(c[0]) << QString::fromUtf8(c[1]) << QString::fromUtf8(c[2]);
    }
    void translatesOnlyTheLiterals()
    {
        QFETCH(QString, sql);
        QFETCH(QString, expected);
        for (const QString &guarded : atEdgesOfMemory(sql))
            QCOMPARE(translateBooleanLiterals(guarded), expected);
    }
};

ZORBIN_TEST_CLASS(BooleanLiteralsTest)
#include "BooleanLiteralsTest.moc"
