#include "dialogs/SelectItemDialog.h"

#include "dialogs/ItemListModel.h"
#include "testutil/WorkDatabaseFixture.h"

#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QRegularExpression>
#include <QSignalSpy>
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
        keys << item.key + (item.include ? QString() : u" -"_qs);
    return keys;
}

// ItemKey -> Include as stored.
QMap<QString, bool> storedMarks(const QString &path)
{
    QMap<QString, bool> marks;
    for (const QVariantList &row : readWorkTable(path, u"tItems"_qs))
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
        QTest::failOnWarning(
            QRegularExpression(u"^(?!This plugin does not support)"_qs)); // none but the platform's
        m_path = m_folder.filePath(u"zorbindb.tmp"_qs);
        const std::tuple<const char *, const char *, bool> items[] = {
            {"ab200", "Abacus small", false}, {"x9", "Abacus", true},
            {"AB300", "לוח", true},           {"A100", "עט", true},
            {"א-5", "שולחן", false},          {"ב-10", "כיסא", true}};
        WorkRows rows;
        for (const auto &[key, name, marked] : items)
            rows.items << WorkItem{
                .key = QString::fromUtf8(key), .name = QString::fromUtf8(name), .include = marked};
        QVERIFY(makeWorkDatabase(m_path, rows).isOk());
    }

    // Marked items first, then by key: Hebrew keys before Latin ones, letter case not counted.
    void listsMarkedItemsFirstThenByKey()
    {
        frmSelectItem dialog(m_path);
        QCOMPARE(listedKeys(dialog),
                 (QStringList{u"ב-10"_qs, u"A100"_qs, u"AB300"_qs, u"x9"_qs, u"א-5 -"_qs, u"ab200 -"_qs}));
        QCOMPARE(dialog.model()->index(0, ItemListModel::NameColumn).data().toString(), u"כיסא"_qs);
        QCOMPARE(dialog.model()->index(4, ItemListModel::IncludeColumn).data(Qt::CheckStateRole),
                 QVariant(Qt::Unchecked));
    }

    void searchesFindAPrefixInEitherCase_data()
    {
        QTest::addColumn<bool>("byKey");
        QTest::addColumn<QString>("text");
        QTest::addColumn<int>("foundRow"); // -1: the current row stays
        QTest::newRow("key, small letters") << true << u"ab"_qs << 2;
        QTest::newRow("key, capitals") << true << u"AB2"_qs << 5;
        QTest::newRow("key, Hebrew") << true << u"א"_qs << 4;
        QTest::newRow("name, from the top") << false << u"ABAC"_qs << 3;
        QTest::newRow("name, Hebrew") << false << u"שול"_qs << 4;
        QTest::newRow("name, only in the middle") << false << u"bacus"_qs << -1;
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
        dialog.findChild<QLineEdit *>(byKey ? u"txtToItemkey"_qs : u"txtToItemName"_qs)->setText(text);
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
        QCOMPARE(listedKeys(dialog), (QStringList{u"ב-10 -"_qs, u"A100 -"_qs, u"AB300 -"_qs, u"x9 -"_qs}));
        QCOMPARE(storedMarks(m_path).values(), QList<bool>(6, false));
        click(dialog, "cmdShowMarked");
        QCOMPARE(dialog.model()->rowCount(), 0);

        click(dialog, "cmdShowAll");
        QSignalSpy changed(dialog.model(), &QAbstractItemModel::dataChanged);
        click(dialog, "CmdAllItems");
        QCOMPARE(storedMarks(m_path).values(), QList<bool>(6, true));
        // A view repaints the rows that the change names: all six.
        QCOMPARE(changed.size(), 1);
        QCOMPARE(changed.at(0).at(1).toModelIndex().row(), 5);
        QVERIFY(dialog.findChild<QLabel *>(u"DataItems"_qs)->text().contains(QLatin1Char('6')));
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
            QVERIFY(!storedMarks(m_path).value(u"A100"_qs));
            QCOMPARE(listedKeys(dialog).at(1), u"A100 -"_qs);
            click(dialog, "cmdClose");
            QCOMPARE(dialog.result(), int(QDialog::Accepted));
        }
        frmSelectItem again(m_path);
        QCOMPARE(listedKeys(again).at(4), u"A100 -"_qs);
    }

    void aMissingDatabaseLeavesTheListEmptyAndSaysWhy()
    {
        frmSelectItem dialog(m_folder.filePath(u"none.tmp"_qs));
        QCOMPARE(dialog.model()->rowCount(), 0);
        QVERIFY(!dialog.findChild<QLabel *>(u"DataItems"_qs)->text().isEmpty());
        click(dialog, "CmdAllItems"); // nothing to do, no fault
        QCOMPARE(dialog.model()->rowCount(), 0);
    }

    void listsLongerThanSixteenBitRowNumbers()
    {
        const int count = 33000;
        const QString path = m_folder.filePath(u"long.tmp"_qs);
        WorkRows rows;
        for (int i = 0; i < count; ++i)
            rows.items << WorkItem{u"K%1"_qs.arg(i, 6, 10, QLatin1Char('0'))};
        QVERIFY(makeWorkDatabase(path, rows).isOk());
        frmSelectItem dialog(path);
        QCOMPARE(dialog.model()->rowCount(), count);
        dialog.findChild<QLineEdit *>(u"txtToItemkey"_qs)->setText(u"k032999"_qs);
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
