#include "workdb/BooleanLiterals.h"

#include "testutil/TestMain.h"

#include <QTest>

using namespace zorbin;

class BooleanLiteralsTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void translatesOnlyTheLiterals_data()
    {
        QTest::addColumn<QString>("sql");
        QTest::addColumn<QString>("expected");
        QTest::newRow("catalog query")
            << QStringLiteral(
                   "SELECT tItems.ItemKey FROM tItems WHERE tItems.Include = True ORDER BY tItems.ItemKey ASC")
            << QStringLiteral(
                   "SELECT tItems.ItemKey FROM tItems WHERE tItems.Include = -1 ORDER BY tItems.ItemKey ASC");
        QTest::newRow("selection list")
            << QStringLiteral(
                   "SELECT ItemKey, ItemName, Include FROM tItems WHERE (1 > 0) And Include = True ORDER BY tItems.Include, tItems.Itemkey")
            << QStringLiteral(
                   "SELECT ItemKey, ItemName, Include FROM tItems WHERE (1 > 0) And Include = -1 ORDER BY tItems.Include, tItems.Itemkey");
        QTest::newRow("false and letter case")
            << QStringLiteral("UPDATE tItems SET Include = FALSE WHERE Include=true")
            << QStringLiteral("UPDATE tItems SET Include = 0 WHERE Include=-1");
        QTest::newRow("inside quotes")
            << QStringLiteral("SELECT 'True', \"False\", [True] FROM t WHERE a = 'it''s True'")
            << QStringLiteral("SELECT 'True', \"False\", [True] FROM t WHERE a = 'it''s True'");
        QTest::newRow("part of a word")
            << QStringLiteral("SELECT TrueName, IsFalse, True_1, tItems.True FROM t")
            << QStringLiteral("SELECT TrueName, IsFalse, True_1, tItems.True FROM t");
        QTest::newRow("comments") << QStringLiteral("SELECT 1 -- True\n, /* False */ True")
                                  << QStringLiteral("SELECT 1 -- True\n, /* False */ -1");
        QTest::newRow("after a minus") << QStringLiteral("SELECT -True") << QStringLiteral("SELECT - -1");
        QTest::newRow("Hebrew text untouched") << QStringLiteral("SELECT 'כן True' WHERE x = True")
                                               << QStringLiteral("SELECT 'כן True' WHERE x = -1");
        QTest::newRow("unclosed quote") << QStringLiteral("SELECT 'True") << QStringLiteral("SELECT 'True");
        QTest::newRow("nothing to do") << QString() << QString();
    }
    void translatesOnlyTheLiterals()
    {
        QFETCH(QString, sql);
        QFETCH(QString, expected);
        QCOMPARE(translateBooleanLiterals(sql), expected);
    }
};

ZORBIN_TEST_CLASS(BooleanLiteralsTest)
#include "BooleanLiteralsTest.moc"
