#include "workdb/WorkDatabase.h"

#include "testutil/TestMain.h"
#include "testutil/WorkDatabaseFixture.h"
#include "workdb/HebrewCollation.h"
#include "workdb/RowWriter.h"
#include "workdb/WorkSchema.h"

#include <QSqlQuery>
#include <QSqlRecord>
#include <QTemporaryDir>
#include <QTest>

using namespace zorbin;
using namespace zorbin::test;

namespace {

QStringList column(WorkDatabase &work, const QString &sql)
{
    QStringList values;
    Result<QSqlQuery> query = work.select(sql);
    if (!query)
        return {QStringLiteral("error: ") + query.status().description()};
    while (query->next())
        values << (query->value(0).isNull() ? QStringLiteral("<null>") : query->value(0).toString());
    return values;
}

QVariantList row(std::initializer_list<QVariant> values)
{
    return QVariantList(values);
}

} // namespace

// The rules of the working database's engine that the collection and the output rely on.
class WorkDatabaseTest : public QObject
{
    Q_OBJECT

private:
    QTemporaryDir m_folder;
    QString m_path;
    std::unique_ptr<WorkDatabase> m_work;

    WriteOutcome insert(const QString &table, const QVariantList &values)
    {
        RowWriter writer(*m_work, table, findWorkTable(table)->columnNames());
        return writer.write(values);
    }
    WriteOutcome insertItem(const QString &key, const QVariant &name = QStringLiteral("?"))
    {
        WorkItem item;
        item.key = key;
        item.name = name;
        return insert(QStringLiteral("tItems"), item.values());
    }

private Q_SLOTS:
    void init()
    {
        QVERIFY(m_folder.isValid());
        m_work.reset();
        m_path = m_folder.filePath(QStringLiteral("work.tmp"));
        const Status made = makeWorkDatabase(m_path);
        QVERIFY2(made, qPrintable(made.description()));
        Result<std::unique_ptr<WorkDatabase>> opened = WorkDatabase::open(m_path);
        QVERIFY2(opened, qPrintable(opened.status().description()));
        m_work = std::move(opened).value();
    }
    void cleanup() { m_work.reset(); }

    void tablesAndColumnsAsDefined()
    {
        QCOMPARE(column(*m_work,
                        QStringLiteral("SELECT name FROM sqlite_master WHERE type = 'table' ORDER BY rowid")),
                 QStringList({QStringLiteral("tItems"), QStringLiteral("tItemPrice1"),
                              QStringLiteral("tItemPrice2"), QStringLiteral("tExtraNote1"),
                              QStringLiteral("tExtraNote2"), QStringLiteral("tItemSort")}));
        const QStringList expected = {
            QStringLiteral(
                "tItems: ItemKey TEXT pk, ItemName TEXT, ItemSort INT, Filter TEXT, Unit TEXT, SellPrice REAL, SellCoin TEXT, ItemPic TEXT, Include INT"),
            QStringLiteral("tItemPrice1: ItemKey TEXT pk, Coin TEXT, Price REAL"),
            QStringLiteral("tItemPrice2: ItemKey TEXT pk, Coin TEXT, Price REAL"),
            QStringLiteral("tExtraNote1: ItemKey TEXT pk, ExtraNote TEXT"),
            QStringLiteral("tExtraNote2: ItemKey TEXT pk, ExtraNote TEXT"),
            QStringLiteral("tItemSort: ItemSort INT pk, SortName TEXT"),
        };
        QStringList actual;
        for (const WorkTable &table : workTables()) {
            QStringList columns;
            Result<QSqlQuery> info = m_work->select(QStringLiteral("PRAGMA table_info(%1)").arg(table.name));
            QVERIFY(info);
            while (info->next()) {
                columns << info->value(QStringLiteral("name")).toString() + QLatin1Char(' ') +
                               info->value(QStringLiteral("type")).toString() +
                               (info->value(QStringLiteral("pk")).toInt() ? QStringLiteral(" pk")
                                                                          : QString());
            }
            actual << table.name + QStringLiteral(": ") + columns.join(QStringLiteral(", "));
        }
        QCOMPARE(actual, expected);
    }

    void oneUniqueIndexPerTableOverItsKey()
    {
        for (const WorkTable &table : workTables()) {
            Result<QSqlQuery> indexes =
                m_work->select(QStringLiteral("PRAGMA index_list(%1)").arg(table.name));
            QVERIFY(indexes);
            QStringList found;
            while (indexes->next()) {
                found << indexes->value(QStringLiteral("name")).toString();
                QCOMPARE(indexes->value(QStringLiteral("unique")).toInt(), 1);
                QCOMPARE(indexes->value(QStringLiteral("origin")).toString(), QStringLiteral("pk"));
            }
            QCOMPARE(found.size(), 1);
            QCOMPARE(column(*m_work,
                            QStringLiteral("SELECT name FROM pragma_index_info('%1')").arg(found.first())),
                     QStringList{table.key().name});
        }
    }

    void textSortsHebrewFirstAndIgnoresLatinCase()
    {
        const QStringList keys = {QStringLiteral("b"),  QStringLiteral("A"), QStringLiteral("ב"),
                                  QStringLiteral("a1"), QStringLiteral("א"), QStringLiteral("C"),
                                  QStringLiteral("10"), QStringLiteral("9")};
        for (const QString &key : keys)
            QVERIFY(insertItem(key, key));
        const QStringList expected = {QStringLiteral("10"), QStringLiteral("9"), QStringLiteral("א"),
                                      QStringLiteral("ב"),  QStringLiteral("A"), QStringLiteral("a1"),
                                      QStringLiteral("b"),  QStringLiteral("C")};
        QCOMPARE(column(*m_work, QStringLiteral("SELECT ItemKey FROM tItems ORDER BY ItemKey")), expected);
        QCOMPARE(column(*m_work, QStringLiteral("SELECT ItemName FROM tItems ORDER BY tItems.ItemName ASC")),
                 expected);
    }

    void keysDifferingInLatinCaseAreOneKey()
    {
        QVERIFY(insertItem(QStringLiteral("ab"), QStringLiteral("first")));
        const WriteOutcome second = insertItem(QStringLiteral("AB"), QStringLiteral("second"));
        QCOMPARE(second.refusal(), Refusal::DuplicateKey);
        QVERIFY(second.isDuplicateKey());
        QCOMPARE(column(*m_work, QStringLiteral("SELECT ItemName FROM tItems WHERE ItemKey = 'aB'")),
                 QStringList{QStringLiteral("first")});
        // Joins by key meet across letter case as well.
        QVERIFY(insert(QStringLiteral("tItemPrice1"), row({QStringLiteral("AB"), QStringLiteral("$"), 5.5})));
        QCOMPARE(
            column(
                *m_work,
                QStringLiteral(
                    "SELECT (Select Price From tItemPrice1 Where tItemPrice1.ItemKey = tItems.ItemKey) FROM tItems")),
            QStringList{QStringLiteral("5.5")});
    }

    void hebrewFinalLettersStayDistinct()
    {
        QVERIFY(insertItem(QStringLiteral("ספך")));
        QVERIFY(insertItem(QStringLiteral("ספכ")));
        QVERIFY(insertItem(QStringLiteral("שלום")));
        QVERIFY(insertItem(QStringLiteral("שלומ")));
        QCOMPARE(column(*m_work, QStringLiteral("SELECT count(*) FROM tItems")),
                 QStringList{QStringLiteral("4")});
        QCOMPARE(column(*m_work, QStringLiteral("SELECT ItemKey FROM tItems WHERE ItemKey = 'ספך'")),
                 QStringList{QStringLiteral("ספך")});
        QVERIFY(compareHebrew(QStringLiteral("ספך"), QStringLiteral("ספכ")) != 0);
        QCOMPARE(compareHebrew(QStringLiteral("Item"), QStringLiteral("ITEM")), 0);
        QVERIFY(compareHebrew(QStringLiteral("בָּ"), QStringLiteral("ב")) != 0); // vowel points count
    }

    void textLongerThanItsColumnIsRefused_data()
    {
        QTest::addColumn<QString>("table");
        QTest::addColumn<int>("columnIndex");
        QTest::addColumn<int>("size");
        for (const WorkTable &table : workTables()) {
            for (std::size_t i = 0; i < table.columns.size(); ++i) {
                const WorkColumn &c = table.columns[i];
                if (c.type == WorkColumn::Text)
                    QTest::addRow("%s.%s", qPrintable(table.name), qPrintable(c.name))
                        << table.name << int(i) << c.size;
            }
        }
    }
    void textLongerThanItsColumnIsRefused()
    {
        QFETCH(QString, table);
        QFETCH(int, columnIndex);
        QFETCH(int, size);
        const WorkTable &definition = *findWorkTable(table);
        auto rowWith = [&](const QString &text, int keySeed) {
            QVariantList values;
            for (const WorkColumn &c : definition.columns) {
                Q_UNUSED(c);
                values << QVariant();
            }
            values[0] = definition.key().type == WorkColumn::Text ? QVariant(QString::number(keySeed))
                                                                  : QVariant(keySeed);
            values[columnIndex] = text;
            if (definition.name == QLatin1String("tItems"))
                values[8] = WorkTrue;
            return values;
        };
        // Characters, not bytes: Hebrew letters take two bytes each.
        const QString fits(size, QChar(0x05D0));
        QVERIFY(insert(table, rowWith(fits, 1)));
        const WriteOutcome tooLong = insert(table, rowWith(fits + QLatin1Char('x'), 2));
        QCOMPARE(tooLong.refusal(), Refusal::TooLong);
        QCOMPARE(tooLong.description(), QStringLiteral("הטקסט ארוך מדי לשדה %1, שמקבל עד %2 תווים.")
                                            .arg(definition.columns[std::size_t(columnIndex)].name)
                                            .arg(size));
    }

    void duplicateKeyRefusedInEveryTable()
    {
        for (const WorkTable &table : workTables()) {
            QVariantList first;
            for (const WorkColumn &c : table.columns)
                first << (c.type == WorkColumn::Text      ? QVariant(QStringLiteral("x"))
                          : c.type == WorkColumn::Boolean ? QVariant(WorkTrue)
                                                          : QVariant(1));
            first[0] = table.key().type == WorkColumn::Text ? QVariant(QStringLiteral("k")) : QVariant(7);
            QVERIFY2(insert(table.name, first), qPrintable(table.name));
            QVariantList second = first;
            second[0] = table.key().type == WorkColumn::Text ? QVariant(QStringLiteral("K")) : QVariant(7);
            second[1] =
                table.columns[1].type == WorkColumn::Text ? QVariant(QStringLiteral("y")) : QVariant(2);
            const WriteOutcome refused = insert(table.name, second);
            QVERIFY2(refused.isDuplicateKey(), qPrintable(table.name + refused.description()));
            QCOMPARE(
                column(*m_work, QStringLiteral("SELECT %1 FROM %2").arg(table.columns[1].name, table.name)),
                QStringList{table.columns[1].type == WorkColumn::Text ? QStringLiteral("x")
                                                                      : QStringLiteral("1")});
        }
        // The same refusal through a statement of our own.
        const WriteOutcome viaSql =
            m_work->exec(QStringLiteral("INSERT INTO tItemSort (ItemSort) VALUES (7)"));
        QVERIFY(viaSql.isDuplicateKey());
        QVERIFY(
            !m_work->exec(QStringLiteral("INSERT INTO tItemSort (Nonsense) VALUES (7)")).isDuplicateKey());
    }

    void includeIsFalseUnlessWrittenAndTrueSelectsMarked()
    {
        QVERIFY(m_work->exec(QStringLiteral("INSERT INTO tItems (ItemKey) VALUES ('unwritten')")));
        QVERIFY(insertItem(QStringLiteral("marked")));
        WorkItem unmarked;
        unmarked.key = QStringLiteral("unmarked");
        unmarked.include = false;
        QVERIFY(insert(QStringLiteral("tItems"), unmarked.values()));
        QCOMPARE(column(*m_work, QStringLiteral("SELECT Include FROM tItems WHERE ItemKey = 'unwritten'")),
                 QStringList{QStringLiteral("0")});
        QCOMPARE(column(*m_work, QStringLiteral("SELECT ItemKey FROM tItems WHERE tItems.Include = True")),
                 QStringList{QStringLiteral("marked")});
        QCOMPARE(
            column(*m_work,
                   QStringLiteral(
                       "SELECT ItemKey FROM tItems WHERE (1 > 0) ORDER BY tItems.Include, tItems.Itemkey")),
            QStringList({QStringLiteral("marked"), QStringLiteral("unmarked"), QStringLiteral("unwritten")}));
        // A bool from Qt is written as the engine's true; a 1 or a Null is refused, never stored.
        RowWriter writer(*m_work, QStringLiteral("tItems"),
                         {QStringLiteral("ItemKey"), QStringLiteral("Include")});
        QVERIFY(writer.write(row({QStringLiteral("bool"), true})));
        QCOMPARE(column(*m_work, QStringLiteral("SELECT Include FROM tItems WHERE ItemKey = 'bool'")),
                 QStringList{QStringLiteral("-1")});
        QCOMPARE(writer.write(row({QStringLiteral("one"), 1})).refusal(), Refusal::WrongKind);
        QCOMPARE(writer.write(row({QStringLiteral("null"), QVariant()})).refusal(), Refusal::WrongKind);
        QVERIFY(m_work->exec(QStringLiteral("UPDATE tItems SET Include = False WHERE ItemKey = 'marked'")));
        QCOMPARE(column(*m_work, QStringLiteral("SELECT count(*) FROM tItems WHERE Include = True")),
                 QStringList{QStringLiteral("1")});
    }

    void nullAcceptedOutsideInclude()
    {
        for (const WorkTable &table : workTables()) {
            QStringList columns = table.columnNames();
            columns.removeAll(QStringLiteral("Include"));
            QVariantList values(columns.size());
            values[0] = table.key().type == WorkColumn::Text ? QVariant(QStringLiteral("n")) : QVariant(3);
            RowWriter writer(*m_work, table.name, columns);
            QVERIFY2(writer.write(values), qPrintable(table.name));
        }
        QCOMPARE(column(*m_work, QStringLiteral("SELECT SortName FROM tItemSort")),
                 QStringList{QStringLiteral("<null>")});
    }

    void numbersStayNumbersAndTextIsRefused()
    {
        RowWriter writer(
            *m_work, QStringLiteral("tItems"),
            {QStringLiteral("ItemKey"), QStringLiteral("ItemSort"), QStringLiteral("SellPrice")});
        QVERIFY(writer.write(row({QStringLiteral("a"), QStringLiteral("12"), QStringLiteral("3.25")})));
        QCOMPARE(column(*m_work,
                        QStringLiteral("SELECT typeof(ItemSort) || ' ' || typeof(SellPrice) FROM tItems")),
                 QStringList{QStringLiteral("integer real")});
        const WriteOutcome sortText = writer.write(row({QStringLiteral("b"), QStringLiteral("abc"), 1.0}));
        QCOMPARE(sortText.refusal(), Refusal::WrongKind);
        QCOMPARE(sortText.description(),
                 QStringLiteral("הערך אינו מתאים לשדה ItemSort בטבלה tItems, שמקבל רק מספרים."));
        QCOMPARE(writer.write(row({QStringLiteral("c"), 1, QStringLiteral("x")})).refusal(),
                 Refusal::WrongKind);
        QCOMPARE(writer.write(row({QStringLiteral("d"), 1.5, 1.0})).refusal(), Refusal::WrongKind);
    }

    void aFewRowsAtOnceAsIfOneByOne()
    {
        RowWriter writer(*m_work, QStringLiteral("tItemSort"),
                         {QStringLiteral("ItemSort"), QStringLiteral("SortName")});
        const auto group = [](std::int64_t code, const char *name) {
            return std::vector<WorkValue>{{code}, {QByteArray(name)}};
        };
        // All five accepted: one statement.
        std::vector<std::vector<WorkValue>> first = {group(1, "a"), group(2, "b"), group(3, "c"),
                                                     group(4, "d"), group(5, "e")};
        std::vector<RowWriter::Row> rows(first.begin(), first.end());
        std::size_t failed = 99;
        QVERIFY(writer.writeSkippingDuplicates(rows, &failed));
        // A duplicate is passed over; the first other refusal ends the group, and the rows after it stay
        // unwritten.
        std::vector<std::vector<WorkValue>> second = {
            group(6, "f"), group(1, "again"), group(7, "g"),
            group(8, QString(51, QLatin1Char('x')).toUtf8().constData()), group(9, "i")};
        rows.assign(second.begin(), second.end());
        const WriteOutcome refused = writer.writeSkippingDuplicates(rows, &failed);
        QCOMPARE(refused.refusal(), Refusal::TooLong);
        QCOMPARE(failed, std::size_t(3));
        QCOMPARE(column(*m_work, QStringLiteral("SELECT ItemSort || SortName FROM tItemSort")),
                 QStringList({QStringLiteral("1a"), QStringLiteral("2b"), QStringLiteral("3c"),
                              QStringLiteral("4d"), QStringLiteral("5e"), QStringLiteral("6f"),
                              QStringLiteral("7g")}));
    }

    void textsAreStoredWhole()
    {
        const QString withZero = QStringLiteral("a") + QChar(0) + QStringLiteral("b");
        RowWriter writer(*m_work, QStringLiteral("tExtraNote1"),
                         {QStringLiteral("ItemKey"), QStringLiteral("ExtraNote")});
        QVERIFY(writer.write(row({QStringLiteral("zero"), withZero})));
        const std::vector<WorkValue> unencoded = {WorkValue::from(QStringLiteral("utf16"), false),
                                                  WorkValue::from(QStringLiteral("שלום עולם"), false)};
        QVERIFY(writer.write(std::span<const WorkValue>(unencoded)));
        QCOMPARE(readWorkTable(m_path, QStringLiteral("tExtraNote1")),
                 QList<QVariantList>({{QStringLiteral("utf16"), QStringLiteral("שלום עולם")},
                                      {QStringLiteral("zero"), withZero}}));
    }

    void emptyTextIsStored()
    {
        QVERIFY(insertItem(QStringLiteral("e"), QString(QLatin1String(""))));
        QCOMPARE(column(*m_work, QStringLiteral("SELECT length(ItemName) FROM tItems")),
                 QStringList{QStringLiteral("0")});
    }

    void openingAMissingFileCreatesNothing()
    {
        const QString missing = m_folder.filePath(QStringLiteral("missing.tmp"));
        const Result<std::unique_ptr<WorkDatabase>> opened = WorkDatabase::open(missing);
        QVERIFY(!opened);
        QVERIFY(opened.status().description().contains(QStringLiteral("לא נמצא")));
        QVERIFY(!QFile::exists(missing));
        QVERIFY(!WorkDatabase::open(QString()));
    }

    void rowsOfAnOpenTransactionAreKeptWhenTheConnectionCloses()
    {
        QVERIFY(m_work->begin());
        QVERIFY(insertItem(QStringLiteral("kept")));
        m_work.reset();
        QCOMPARE(readWorkTable(m_path, QStringLiteral("tItems")).size(), 1);
    }
};

ZORBIN_TEST_CLASS(WorkDatabaseTest)
#include "WorkDatabaseTest.moc"
