#include "dialogs/SelectItemDialog.h"

#include "control/ItemSelection.h"
#include "dialogs/ItemListModel.h"
#include "model/CatalogSettings.h"
#include "output/CatalogQuery.h"
#include "testutil/TestMain.h"
#include "testutil/WorkDatabaseFixture.h"
#include "workdb/RowWriter.h"
#include "workdb/WorkDatabase.h"
#include "workdb/WorkSchema.h"

#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QSqlQuery>
#include <QTableView>
#include <QTemporaryDir>
#include <QTest>

using namespace zorbin;
using namespace zorbin::test;

namespace {

WorkItem item(const QString &key, const QString &name, bool include)
{
    WorkItem made(key);
    made.name = name;
    made.include = include;
    return made;
}

// Six items, four of them marked, Hebrew and Latin keys in mixed letter case.
WorkRows sampleItems()
{
    WorkRows rows;
    rows.items = {item(QStringLiteral("ab200"), QStringLiteral("Abacus small"), false),
                  item(QStringLiteral("x9"), QStringLiteral("Abacus"), true),
                  item(QStringLiteral("AB300"), QStringLiteral("לוח"), true),
                  item(QStringLiteral("A100"), QStringLiteral("עט"), true),
                  item(QStringLiteral("א-5"), QStringLiteral("שולחן"), false),
                  item(QStringLiteral("ב-10"), QStringLiteral("כיסא"), true)};
    return rows;
}

QStringList listedKeys(const ItemListModel &model)
{
    QStringList keys;
    for (int row = 0; row < model.rowCount(); ++row)
        keys << model.index(row, ItemListModel::KeyColumn).data().toString();
    return keys;
}

QList<bool> listedMarks(const ItemListModel &model)
{
    QList<bool> marks;
    for (int row = 0; row < model.rowCount(); ++row)
        marks << (model.index(row, ItemListModel::IncludeColumn).data(Qt::CheckStateRole).toInt() ==
                  Qt::Checked);
    return marks;
}

// ItemKey -> Include as stored.
QMap<QString, bool> storedMarks(const QString &path)
{
    QMap<QString, bool> marks;
    for (const QVariantList &row : readWorkTable(path, QStringLiteral("tItems")))
        marks.insert(row.at(0).toString(), row.at(8).toInt() != 0);
    return marks;
}

} // namespace

class SelectItemDialogTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void init()
    {
        QVERIFY(m_folder.isValid());
        m_path = m_folder.filePath(QStringLiteral("zorbindb.tmp"));
        const Status made = makeWorkDatabase(m_path, sampleItems());
        QVERIFY2(made.isOk(), qPrintable(made.description()));
    }

    void theListQueryIsTheOneTheDialogSends()
    {
        QCOMPARE(BuildItemListSQL(false),
                 QStringLiteral("SELECT ItemKey, ItemName, Include FROM tItems WHERE (1 > 0) "
                                "ORDER BY tItems.Include, tItems.Itemkey"));
        QCOMPARE(
            BuildItemListSQL(true),
            QStringLiteral("SELECT ItemKey, ItemName, Include FROM tItems WHERE (1 > 0) And Include = True "
                           "ORDER BY tItems.Include, tItems.Itemkey"));
    }

    void listsMarkedItemsFirstThenByKey()
    {
        frmSelectItem dialog(m_path);
        QCOMPARE(dialog.windowTitle(), QStringLiteral("בחירת פריטים להדפסה"));
        QCOMPARE(dialog.layoutDirection(), Qt::RightToLeft);
        const ItemListModel &model = *dialog.model();
        // Hebrew keys sort before Latin ones, and letter case does not count.
        QCOMPARE(listedKeys(model),
                 (QStringList{QStringLiteral("ב-10"), QStringLiteral("A100"), QStringLiteral("AB300"),
                              QStringLiteral("x9"), QStringLiteral("א-5"), QStringLiteral("ab200")}));
        QCOMPARE(listedMarks(model), (QList<bool>{true, true, true, true, false, false}));
        QCOMPARE(model.index(0, ItemListModel::NameColumn).data().toString(), QStringLiteral("כיסא"));
        QCOMPARE(model.headerData(0, Qt::Horizontal, Qt::DisplayRole).toString(),
                 QStringLiteral("מפתח פריט"));
        QCOMPARE(model.headerData(1, Qt::Horizontal, Qt::DisplayRole).toString(), QStringLiteral("שם פריט"));
        QCOMPARE(model.headerData(2, Qt::Horizontal, Qt::DisplayRole).toString(), QStringLiteral("להציג?"));
        QVERIFY(model.flags(model.index(0, ItemListModel::IncludeColumn)) & Qt::ItemIsUserCheckable);
        QVERIFY(!(model.flags(model.index(0, ItemListModel::KeyColumn)) & Qt::ItemIsEditable));
    }

    void searchesFindAPrefixInEitherCase_data()
    {
        QTest::addColumn<QString>("box");
        QTest::addColumn<QString>("button");
        QTest::addColumn<QString>("text");
        QTest::addColumn<QString>("foundKey");
        const QString byKey = QStringLiteral("txtToItemkey");
        const QString findKey = QStringLiteral("cmdFindKey");
        const QString byName = QStringLiteral("txtToItemName");
        const QString findName = QStringLiteral("cmdFindByDesc");
        QTest::newRow("key, small letters")
            << byKey << findKey << QStringLiteral("ab") << QStringLiteral("AB300");
        QTest::newRow("key, capitals")
            << byKey << findKey << QStringLiteral("AB2") << QStringLiteral("ab200");
        QTest::newRow("key, Hebrew") << byKey << findKey << QStringLiteral("א") << QStringLiteral("א-5");
        QTest::newRow("name, from the top")
            << byName << findName << QStringLiteral("ABAC") << QStringLiteral("x9");
        QTest::newRow("name, Hebrew") << byName << findName << QStringLiteral("שול") << QStringLiteral("א-5");
        QTest::newRow("name, only in the middle")
            << byName << findName << QStringLiteral("bacus") << QString();
        QTest::newRow("empty") << byKey << findKey << QString() << QString();
    }
    void searchesFindAPrefixInEitherCase()
    {
        QFETCH(QString, box);
        QFETCH(QString, button);
        QFETCH(QString, text);
        QFETCH(QString, foundKey);
        frmSelectItem dialog(m_path);
        QTableView *grid = dialog.grid();
        const QModelIndex before = dialog.model()->index(1, ItemListModel::NameColumn);
        grid->setCurrentIndex(before);
        dialog.findChild<QLineEdit *>(box)->setText(text);
        dialog.findChild<QPushButton *>(button)->click();
        if (foundKey.isEmpty()) {
            QCOMPARE(grid->currentIndex(), before);
            return;
        }
        QCOMPARE(grid->currentIndex().column(), int(ItemListModel::KeyColumn));
        QCOMPARE(grid->currentIndex().data().toString(), foundKey);
        // From the top again: the same row a second time.
        dialog.findChild<QPushButton *>(button)->click();
        QCOMPARE(grid->currentIndex().data().toString(), foundKey);
    }

    void clearAllInTheMarkedViewClearsWhatIsListed()
    {
        frmSelectItem dialog(m_path);
        dialog.findChild<QPushButton *>(QStringLiteral("cmdShowMarked"))->click();
        const QStringList marked = {QStringLiteral("ב-10"), QStringLiteral("A100"), QStringLiteral("AB300"),
                                    QStringLiteral("x9")};
        QCOMPARE(listedKeys(*dialog.model()), marked);
        dialog.findChild<QPushButton *>(QStringLiteral("cmdNoneItems"))->click();
        // The rows stay listed until the view is loaded again; every mark is stored at once.
        QCOMPARE(listedKeys(*dialog.model()), marked);
        QCOMPARE(listedMarks(*dialog.model()), (QList<bool>{false, false, false, false}));
        for (bool stored : storedMarks(m_path))
            QVERIFY(!stored);
        dialog.findChild<QPushButton *>(QStringLiteral("cmdShowMarked"))->click();
        QCOMPARE(dialog.model()->rowCount(), 0);

        // Mark all over every item marks every item.
        dialog.findChild<QPushButton *>(QStringLiteral("cmdShowAll"))->click();
        QCOMPARE(dialog.model()->rowCount(), 6);
        dialog.findChild<QPushButton *>(QStringLiteral("CmdAllItems"))->click();
        for (bool stored : storedMarks(m_path))
            QVERIFY(stored);
    }

    void aChangedMarkIsStoredAndKeptOutOfTheCatalog()
    {
        {
            frmSelectItem dialog(m_path);
            ItemListModel *model = dialog.model();
            const QModelIndex mark = model->index(1, ItemListModel::IncludeColumn); // A100
            QVERIFY(model->setData(mark, Qt::Unchecked, Qt::CheckStateRole));
            QVERIFY(!storedMarks(m_path).value(QStringLiteral("A100")));
            QCOMPARE(listedKeys(*model).at(1), QStringLiteral("A100")); // it keeps its row until a reload
            dialog.findChild<QPushButton *>(QStringLiteral("cmdClose"))->click();
            QCOMPARE(dialog.result(), int(QDialog::Accepted));
        }
        // The next opening shows the change: A100 among the unmarked items, after the Hebrew keys.
        frmSelectItem again(m_path);
        QCOMPARE(listedKeys(*again.model()),
                 (QStringList{QStringLiteral("ב-10"), QStringLiteral("AB300"), QStringLiteral("x9"),
                              QStringLiteral("א-5"), QStringLiteral("A100"), QStringLiteral("ab200")}));

        // The catalog's own statement leaves it out.
        CatalogSettings settings;
        settings.sortKey = SortKey::ItemKey;
        settings.sortDirection = SortDirection::Ascending;
        const QString sql = BuildFinalSQL(settings);
        auto database = WorkDatabase::open(m_path);
        QVERIFY(database.isOk());
        QStringList catalogKeys;
        {
            auto query = database.value()->select(sql);
            QVERIFY2(query.isOk(), qPrintable(query.status().description()));
            while (query->next())
                catalogKeys << query->value(QStringLiteral("ItemKey")).toString();
        }
        QCOMPARE(catalogKeys,
                 (QStringList{QStringLiteral("ב-10"), QStringLiteral("AB300"), QStringLiteral("x9")}));
    }

    void aMissingDatabaseLeavesTheListEmptyAndSaysWhy()
    {
        frmSelectItem dialog(m_folder.filePath(QStringLiteral("none.tmp")));
        QCOMPARE(dialog.model()->rowCount(), 0);
        QVERIFY(!dialog.findChild<QLabel *>(QStringLiteral("DataItems"))->text().isEmpty());
        dialog.findChild<QPushButton *>(QStringLiteral("CmdAllItems"))->click(); // nothing to do, no fault
        QCOMPARE(dialog.model()->rowCount(), 0);
    }

    void listsLongerThanSixteenBitRowNumbers()
    {
        const int count = 33000;
        const QString path = m_folder.filePath(QStringLiteral("long.tmp"));
        QVERIFY(makeWorkDatabase(path).isOk());
        {
            auto work = WorkDatabase::open(path);
            QVERIFY(work.isOk());
            QVERIFY(work.value()->begin().isOk());
            RowWriter writer(
                *work.value(), QStringLiteral("tItems"),
                {QStringLiteral("ItemKey"), QStringLiteral("ItemName"), QStringLiteral("Include")});
            for (int i = 0; i < count; ++i) {
                const QString key = QStringLiteral("K%1").arg(i, 6, 10, QLatin1Char('0'));
                const QVariantList row = {key, QStringLiteral("פריט %1").arg(i), WorkTrue};
                QVERIFY(writer.write(row));
            }
            QVERIFY(work.value()->commit().isOk());
        }

        frmSelectItem dialog(path);
        QCOMPARE(dialog.model()->rowCount(), count);
        dialog.findChild<QLineEdit *>(QStringLiteral("txtToItemkey"))->setText(QStringLiteral("k032999"));
        dialog.findChild<QPushButton *>(QStringLiteral("cmdFindKey"))->click();
        QCOMPARE(dialog.grid()->currentIndex().row(), count - 1);
        dialog.findChild<QPushButton *>(QStringLiteral("cmdNoneItems"))->click();
        const QMap<QString, bool> stored = storedMarks(path);
        QCOMPARE(stored.size(), count);
        QCOMPARE(stored.values().count(true), 0);
    }

private:
    QTemporaryDir m_folder;
    QString m_path;
};

ZORBIN_TEST_CLASS(SelectItemDialogTest)
#include "SelectItemDialogTest.moc"
