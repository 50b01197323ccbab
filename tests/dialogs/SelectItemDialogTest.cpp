#include "dialogs/SelectItemDialog.h"

#include "dialogs/ItemListModel.h"
#include "testutil/WorkDatabaseFixture.h"
#include "workdb/RowWriter.h"
#include "workdb/WorkDatabase.h"
#include "workdb/WorkSchema.h"

#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QTableView>
#include <QTemporaryDir>
#include <QTest>

using namespace zorbin;
using namespace zorbin::test;

namespace {

QStringList listedKeys(const frmSelectItem &dialog)
{
    QStringList keys;
    for (const SelectableItem &item : dialog.model()->items())
        keys << item.key + (item.include ? QString() : QStringLiteral(" -"));
    return keys;
}

// ItemKey -> Include as stored.
QMap<QString, bool> storedMarks(const QString &path)
{
    QMap<QString, bool> marks;
    for (const QVariantList &row : readWorkTable(path, QStringLiteral("tItems")))
        marks.insert(row.at(0).toString(), row.at(8).toInt() != 0);
    return marks;
}

void click(const frmSelectItem &dialog, const char *button)
{
    dialog.findChild<QPushButton *>(QLatin1String(button))->click();
}

} // namespace

class SelectItemDialogTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    // Six items, four of them marked, Hebrew and Latin keys in mixed letter case.
    void init()
    {
        m_path = m_folder.filePath(QStringLiteral("zorbindb.tmp"));
        WorkRows rows;
        const QStringList keys = {QStringLiteral("ab200"), QStringLiteral("x9"),  QStringLiteral("AB300"),
                                  QStringLiteral("A100"),  QStringLiteral("א-5"), QStringLiteral("ב-10")};
        const QStringList names = {QStringLiteral("Abacus small"), QStringLiteral("Abacus"),
                                   QStringLiteral("לוח"),          QStringLiteral("עט"),
                                   QStringLiteral("שולחן"),        QStringLiteral("כיסא")};
        for (int i = 0; i < keys.size(); ++i) {
            rows.items << WorkItem(keys.at(i));
            rows.items.last().name = names.at(i);
            rows.items.last().include = i != 0 && i != 4;
        }
        QVERIFY(makeWorkDatabase(m_path, rows).isOk());
    }

    // Marked items first, then by key: Hebrew keys before Latin ones, letter case not counted.
    void listsMarkedItemsFirstThenByKey()
    {
        frmSelectItem dialog(m_path);
        QCOMPARE(listedKeys(dialog),
                 (QStringList{QStringLiteral("ב-10"), QStringLiteral("A100"), QStringLiteral("AB300"),
                              QStringLiteral("x9"), QStringLiteral("א-5 -"), QStringLiteral("ab200 -")}));
        QCOMPARE(dialog.model()->index(0, ItemListModel::NameColumn).data().toString(),
                 QStringLiteral("כיסא"));
        QCOMPARE(dialog.model()->index(4, ItemListModel::IncludeColumn).data(Qt::CheckStateRole),
                 QVariant(Qt::Unchecked));
    }

    void searchesFindAPrefixInEitherCase_data()
    {
        QTest::addColumn<bool>("byKey");
        QTest::addColumn<QString>("text");
        QTest::addColumn<int>("foundRow"); // -1: the current row stays
        QTest::newRow("key, small letters") << true << QStringLiteral("ab") << 2;
        QTest::newRow("key, capitals") << true << QStringLiteral("AB2") << 5;
        QTest::newRow("key, Hebrew") << true << QStringLiteral("א") << 4;
        QTest::newRow("name, from the top") << false << QStringLiteral("ABAC") << 3;
        QTest::newRow("name, Hebrew") << false << QStringLiteral("שול") << 4;
        QTest::newRow("name, only in the middle") << false << QStringLiteral("bacus") << -1;
        QTest::newRow("empty") << true << QString() << -1;
    }
    void searchesFindAPrefixInEitherCase()
    {
        QFETCH(bool, byKey);
        QFETCH(QString, text);
        QFETCH(int, foundRow);
        frmSelectItem dialog(m_path);
        QTableView *grid = dialog.grid();
        const QModelIndex before = dialog.model()->index(1, ItemListModel::NameColumn);
        grid->setCurrentIndex(before);
        dialog
            .findChild<QLineEdit *>(byKey ? QStringLiteral("txtToItemkey") : QStringLiteral("txtToItemName"))
            ->setText(text);
        for (int search = 0; search < 2; ++search) { // from the top again: the same row a second time
            click(dialog, byKey ? "cmdFindKey" : "cmdFindByDesc");
            QCOMPARE(grid->currentIndex(),
                     foundRow < 0 ? before : dialog.model()->index(foundRow, ItemListModel::KeyColumn));
        }
    }

    // Clear all in the marked view clears what it lists, stored at once; the rows stay listed
    // until the view is loaded again. A row the reload took away has no data any more.
    void clearAllInTheMarkedViewClearsWhatIsListed()
    {
        frmSelectItem dialog(m_path);
        const QModelIndex fifth = dialog.model()->index(4, ItemListModel::KeyColumn);
        click(dialog, "cmdShowMarked");
        QCOMPARE(dialog.model()->rowCount(), 4);
        QCOMPARE(dialog.model()->data(fifth, Qt::TextAlignmentRole), QVariant());
        click(dialog, "cmdNoneItems");
        QCOMPARE(listedKeys(dialog), (QStringList{QStringLiteral("ב-10 -"), QStringLiteral("A100 -"),
                                                  QStringLiteral("AB300 -"), QStringLiteral("x9 -")}));
        QCOMPARE(storedMarks(m_path).values(), QList<bool>(6, false));
        click(dialog, "cmdShowMarked");
        QCOMPARE(dialog.model()->rowCount(), 0);

        click(dialog, "cmdShowAll");
        click(dialog, "CmdAllItems");
        QCOMPARE(storedMarks(m_path).values(), QList<bool>(6, true));
        QVERIFY(dialog.findChild<QLabel *>(QStringLiteral("DataItems"))->text().contains(QLatin1Char('6')));
    }

    // A mark changed in the list is stored at once; the item keeps its row until a reload, and
    // the next opening lists it among the unmarked items.
    void aChangedMarkIsStored()
    {
        {
            frmSelectItem dialog(m_path);
            ItemListModel *model = dialog.model();
            QVERIFY(model->setData(model->index(1, ItemListModel::IncludeColumn), Qt::Unchecked,
                                   Qt::CheckStateRole));
            QVERIFY(!model->setData(model->index(1, ItemListModel::KeyColumn), Qt::Unchecked,
                                    Qt::CheckStateRole));
            QVERIFY(!storedMarks(m_path).value(QStringLiteral("A100")));
            QCOMPARE(listedKeys(dialog).at(1), QStringLiteral("A100 -"));
            click(dialog, "cmdClose");
            QCOMPARE(dialog.result(), int(QDialog::Accepted));
        }
        frmSelectItem again(m_path);
        QCOMPARE(listedKeys(again).at(4), QStringLiteral("A100 -"));
    }

    void aMissingDatabaseLeavesTheListEmptyAndSaysWhy()
    {
        frmSelectItem dialog(m_folder.filePath(QStringLiteral("none.tmp")));
        QCOMPARE(dialog.model()->rowCount(), 0);
        QVERIFY(!dialog.findChild<QLabel *>(QStringLiteral("DataItems"))->text().isEmpty());
        click(dialog, "CmdAllItems"); // nothing to do, no fault
        QCOMPARE(dialog.model()->rowCount(), 0);
    }

    void listsLongerThanSixteenBitRowNumbers()
    {
        const int count = 33000;
        const QString path = m_folder.filePath(QStringLiteral("long.tmp"));
        QVERIFY(makeWorkDatabase(path).isOk());
        {
            auto work = WorkDatabase::open(path);
            QVERIFY(work.isOk() && work.value()->begin().isOk());
            RowWriter writer(
                *work.value(), QStringLiteral("tItems"),
                {QStringLiteral("ItemKey"), QStringLiteral("ItemName"), QStringLiteral("Include")});
            for (int i = 0; i < count; ++i)
                QVERIFY(writer.write(QVariantList{QStringLiteral("K%1").arg(i, 6, 10, QLatin1Char('0')),
                                                  QString(), WorkTrue}));
            QVERIFY(work.value()->commit().isOk());
        }
        frmSelectItem dialog(path);
        QCOMPARE(dialog.model()->rowCount(), count);
        dialog.findChild<QLineEdit *>(QStringLiteral("txtToItemkey"))->setText(QStringLiteral("k032999"));
        click(dialog, "cmdFindKey");
        QCOMPARE(dialog.grid()->currentIndex().row(), count - 1);
        click(dialog, "cmdNoneItems");
        QCOMPARE(storedMarks(path).values().count(false), count);
    }

private:
    QTemporaryDir m_folder;
    QString m_path;
};

QTEST_MAIN(SelectItemDialogTest)
#include "SelectItemDialogTest.moc"
