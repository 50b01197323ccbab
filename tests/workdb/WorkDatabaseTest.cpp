#include "workdb/WorkDatabase.h"

#include "platform/FileSystem.h"
#include "testutil/CaseTable.h"
#include "testutil/EdgeOfMemory.h"
#include "testutil/TestMain.h"
#include "testutil/WorkDatabaseFixture.h"
#include "workdb/BooleanLiterals.h"
#include "workdb/HebrewCollation.h"
#include "workdb/RowWriter.h"
#include "workdb/WorkDatabasePath.h"
#include "workdb/WorkSchema.h"

#include <QFileInfo>
#include <QTemporaryDir>
#include <cstdlib>
#include <limits>
#include <sqlite3.h>
#include <unicode/uclean.h>

using namespace zorbin;
using namespace zorbin::test;
using namespace Qt::Literals::StringLiterals;

namespace {

// Two texts are one key only when they differ in Latin letter case at most.
const struct Comparison
{
    const char *name, *left, *right;
    int order;
} Comparisons[] = {
    {"Hebrew letters", "א", "ב", -1},
    {"Hebrew before Latin", "ת", "A", -1},
    {"digits before letters", "9", "א", -1},
    {"Latin letter case", "Item", "ITEM", 0},
    {"a final letter", "ספך", "ספכ", -1},
    {"a final letter, reversed", "שלומ", "שלום", 1},
    {"vowel points", "בָּ", "ב", 1},
    {"an ignorable character more", "a\x01", "A", 1},
    {"an ignorable character less", "a", "A\x01", -1},
};

// ICU allocates through these from the start, so that a test can make it fail.
bool icuAllocationsFail = false;
const bool icuAllocator = [] {
    UErrorCode status = U_ZERO_ERROR;
    u_setMemoryFunctions(
        nullptr, [](const void *, size_t size) { return icuAllocationsFail ? nullptr : std::malloc(size); },
        [](const void *, void *block, size_t size) {
            return icuAllocationsFail ? nullptr : std::realloc(block, size);
        },
        [](const void *, void *block) { std::free(block); }, &status);
    return U_SUCCESS(status);
}();

// Run on every new connection while installed: takes the collation's name and keeps a statement
// running, so that the engine refuses to register the collation again.
sqlite3_stmt *running = nullptr;
int holdTheCollationName(sqlite3 *db, const char **, const sqlite3_api_routines *)
{
    sqlite3_create_collation(db, HebrewCollationName, SQLITE_UTF8, nullptr,
                             [](void *, int, const void *, int, const void *) { return 0; });
    sqlite3_prepare_v2(db, "SELECT 1 UNION ALL SELECT 2", -1, &running, nullptr);
    sqlite3_step(running);
    sqlite3_exec(db, "", nullptr, nullptr, nullptr); // the opening itself succeeds
    return SQLITE_OK;
}
const auto holdTheName = reinterpret_cast<void (*)()>(&holdTheCollationName);

} // namespace

// The rules of the working database's engine that the collection and the output rely on.
class WorkDatabaseTest : public QObject
{
    Q_OBJECT

    QTemporaryDir m_folder;
    QString m_path = m_folder.filePath(u"work.tmp"_s);
    std::unique_ptr<WorkDatabase> m_work;

    // The first column of a statement's rows, separated by blanks.
    QString column(const QString &sql)
    {
        Result<QSqlQuery> query = m_work->select(sql);
        QStringList values;
        while (query && query->next())
            values << query->value(0).toString();
        return query ? values.join(u' ') : u"error: "_s + query.status().description();
    }
    WriteOutcome insert(const QString &table, const QString &key)
    {
        return m_work->exec(u"INSERT INTO %1 (ItemKey) VALUES ('%2')"_s.arg(table, key));
    }

private Q_SLOTS:
    void init()
    {
        m_work.reset();
        const Status made = makeWorkDatabase(m_path);
        auto opened = made ? WorkDatabase::open(m_path) : made;
        QVERIFY2(opened, qPrintable(opened.status().description()));
        m_work = std::move(opened).value();
    }
    void cleanup() { m_work.reset(); }

    void comparesTexts_data() { addCaseRows(Comparisons); }
    void comparesTexts()
    {
        const Comparison &c = fetchCase(Comparisons);
        const QString left = QString::fromUtf8(c.left);
        const QString right = QString::fromUtf8(c.right);
        QCOMPARE(compareHebrew(left, right), c.order);
        // The engine compares the keys, sorts and joins the same way.
        QVERIFY(insert(u"tItems"_s, left));
        QCOMPARE(insert(u"tItems"_s, right).isDuplicateKey(), c.order == 0);
        QVERIFY(insert(u"tItemPrice1"_s, right));
        QCOMPARE(
            column(u"SELECT count(*) FROM tItems, tItemPrice1 WHERE tItems.ItemKey = tItemPrice1.ItemKey"_s),
            u"1"_s);
        const QString ordered = c.order < 0 ? left + u' ' + right : right + u' ' + left;
        QCOMPARE(column(u"SELECT ItemKey FROM tItems ORDER BY ItemKey"_s), c.order == 0 ? left : ordered);
    }

    // Numbers stay numbers (an unsigned beyond the engine's whole numbers is a floating-point
    // number), texts are stored whole, encoded or not, and a Null stays Null; a key held already
    // is refused as such.
    void valuesAreStoredAsWritten()
    {
        RowWriter writer(*m_work, u"tItems"_s, {u"ItemKey"_s, u"ItemSort"_s, u"SellPrice"_s, u"ItemName"_s});
        QVERIFY(writer.write(QVariantList{u"a"_s, u"12"_s, u"3.25"_s, {}}));
        QVERIFY(writer.write(QVariantList{u"b"_s, qulonglong(std::numeric_limits<qint64>::max()),
                                          qulonglong(1) << 63, QString(QLatin1String(""))}));
        const QString withZero = u"a"_s + QChar(0) + u"b"_s;
        QVERIFY(writer.write(QVariantList{u"c"_s, 1, 1.0, withZero}));
        const std::vector<WorkValue> unencoded = {
            WorkValue::from(u"d"_s, false), {}, {}, WorkValue::from(u"שלום עולם"_s, false)};
        QVERIFY(writer.write(std::span<const WorkValue>(unencoded)));
        QCOMPARE(
            column(
                u"SELECT typeof(ItemSort) || typeof(SellPrice) || ifnull(length(ItemName), '') FROM tItems"_s),
            u"integerreal integerreal0 integerreal1 nullnull9"_s); // length() stops at a zero
        QCOMPARE(readWorkTable(m_path, u"tItems"_s).at(2).at(1), QVariant(withZero));
        const WriteOutcome sortText = writer.write(QVariantList{u"e"_s, u"abc"_s, 1.0, {}});
        QCOMPARE(sortText.refusal(), Refusal::WrongKind);
        QCOMPARE(sortText.description(), u"הערך אינו מתאים לשדה ItemSort בטבלה tItems, שמקבל רק מספרים."_s);
        QCOMPARE(writer.write(QVariantList{u"f"_s, 1.5, 1.0, {}}).refusal(), Refusal::WrongKind);
        QVERIFY(m_work->exec(u"INSERT INTO tItems (ItemKey) VALUES ('A')"_s).isDuplicateKey());
        QVERIFY(!m_work->exec(u"INSERT INTO tItems (Nonsense) VALUES ('g')"_s).isDuplicateKey());
    }

    // Up to five rows in one statement, with the effect of writing them one by one: a duplicate
    // is passed over; the first other refusal ends the group, and the rows after it stay unwritten.
    void aFewRowsAtOnceAsIfOneByOne()
    {
        RowWriter writer(*m_work, u"tItemSort"_s, {u"ItemSort"_s, u"SortName"_s});
        const auto write = [&writer](std::initializer_list<std::pair<std::int64_t, QString>> groups,
                                     std::size_t *failed) {
            std::vector<std::vector<WorkValue>> values;
            for (const auto &[code, name] : groups)
                values.push_back({{code}, WorkValue::from(name, code % 2 == 0)});
            const std::vector<RowWriter::Row> rows(values.begin(), values.end());
            return writer.writeSkippingDuplicates(rows, failed);
        };
        std::size_t failed = 99;
        QVERIFY(write({{1, u"a"_s}, {2, u"b"_s}, {3, u"c"_s}, {4, u"d"_s}, {5, u"e"_s}}, &failed));
        const WriteOutcome refused =
            write({{6, u"f"_s}, {1, u"again"_s}, {7, u"g"_s}, {8, QString(51, u'x')}, {9, u"i"_s}}, &failed);
        QCOMPARE(refused.refusal(), Refusal::TooLong);
        QCOMPARE(failed, std::size_t(3));
        QCOMPARE(column(u"SELECT ItemSort || SortName FROM tItemSort"_s), u"1a 2b 3c 4d 5e 6f 7g"_s);
    }

    // Without TMPDIR the working database is not put into the temporary folder that every user
    // shares, where another user's file of the same name would stop the run.
    void withoutTmpdirTheFolderIsTheUsersOwn()
    {
#ifdef Q_OS_WIN
        QSKIP("The temporary folder of Windows is the user's own.");
#endif
        QTemporaryDir cache;
        const QByteArray oldCache = qgetenv("XDG_CACHE_HOME");
        const QByteArray oldTemp = qgetenv("TMPDIR");
        qputenv("XDG_CACHE_HOME", QFile::encodeName(cache.path()));
        qunsetenv("TMPDIR");
        const QString path = workDatabasePath();
        qputenv("TMPDIR", oldTemp);
        qputenv("XDG_CACHE_HOME", oldCache);
        QCOMPARE(path, cache.filePath(u"zorbin/zorbindb.tmp"_s));
        const auto everyone = QFileDevice::Permissions::fromInt(0x7077); // owner, group, others
        QCOMPARE(QFileInfo(cache.filePath(u"zorbin"_s)).permissions() & everyone,
                 QFileDevice::ReadOwner | QFileDevice::WriteOwner | QFileDevice::ExeOwner);
    }

    void aFolderThatCannotBeWrittenIsAFault()
    {
        const Status created =
            createWorkDatabase(localFileSystem(), m_folder.filePath(u"no such folder/db.tmp"_s));
        QVERIFY2(!created && created.description().contains(u"לא ניתן לפתוח את בסיס הנתונים הזמני"_s),
                 qPrintable(created.description()));
    }

    // The rows of an open transaction are kept: a commit refused while another connection reads
    // leaves the transaction open for a later commit, and closing the connection commits.
    void rowsOfAnOpenTransactionAreKept()
    {
        QVERIFY(m_work->begin() && insert(u"tItems"_s, u"later"_s));
        sqlite3 *other = nullptr;
        sqlite3_stmt *reading = nullptr;
        sqlite3_open_v2(QFile::encodeName(m_path).constData(), &other, SQLITE_OPEN_READONLY, nullptr);
        sqlite3_prepare_v2(other, "SELECT name FROM sqlite_master", -1, &reading, nullptr);
        QCOMPARE(sqlite3_step(reading), SQLITE_ROW);
        QVERIFY(!m_work->commit());
        sqlite3_finalize(reading);
        sqlite3_close(other);
        QVERIFY(m_work->commit() && m_work->begin() && insert(u"tItems"_s, u"kept"_s));
        m_work.reset();
        QCOMPARE(readWorkTable(m_path, u"tItems"_s).size(), 2);
    }

    // True and False in the statements on the working database become -1 and 0. Each statement
    // ends at unreadable memory, so that a read past its end fails the test.
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

    // The opening fails without the file, or without the collation: the working database would
    // compare keys as bytes.
    void anOpeningThatFails_data()
    {
        QTest::addColumn<QString>("path");
        QTest::addColumn<QString>("why");
        QTest::newRow("no file") << u"missing.tmp"_s << u"בסיס הנתונים הזמני %1 לא נמצא."_s;
        QTest::newRow("no collection yet") << QString() << u"בסיס הנתונים הזמני עדיין לא נוצר"_s;
        QTest::newRow("ICU refuses the collation")
            << u"work.tmp"_s << u"לא ניתן להגדיר את סדר המיון העברי בבסיס הנתונים הזמני: ICU cannot open"_s;
        QTest::newRow("the engine refuses the collation")
            << u"work.tmp"_s << u"לא ניתן להגדיר את סדר המיון העברי בבסיס הנתונים הזמני: unable to delete"_s;
    }
    void anOpeningThatFails()
    {
        QFETCH(QString, path);
        QFETCH(QString, why);
        m_work.reset();
        if (!path.isEmpty())
            path = m_folder.filePath(path);
        if (why.contains(u"unable to"_s))
            sqlite3_auto_extension(holdTheName);
        icuAllocationsFail = why.contains(u"ICU"_s);
        QVERIFY(icuAllocator);
        const Result<std::unique_ptr<WorkDatabase>> opened = WorkDatabase::open(path);
        icuAllocationsFail = false;
        sqlite3_cancel_auto_extension(holdTheName);
        if (running) {
            sqlite3 *held = sqlite3_db_handle(running);
            sqlite3_finalize(std::exchange(running, nullptr));
            sqlite3_close(held);
        }
        QVERIFY(!opened);
        QVERIFY2(opened.status().description().startsWith(why.replace(u"%1"_s, path)),
                 qPrintable(opened.status().description()));
        QVERIFY(path.isEmpty() || QFile::exists(path) == path.endsWith(u"work.tmp"_s));
    }
};

ZORBIN_TEST_CLASS(WorkDatabaseTest)
#include "WorkDatabaseTest.moc"
