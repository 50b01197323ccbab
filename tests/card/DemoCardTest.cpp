// The desktop control on the demo accounting database, with the real stages: the lists it
// fills, the item selection, and a stop during a long collection.
#include "card/MainCard.h"
#include "dialogs/ItemListModel.h"
#include "dialogs/SelectItemDialog.h"
#include "platform/SettingsStore.h"
#include "tests/card/CardRig.h"
#include "testutil/AccountingFixture.h"
#include "testutil/TestFiles.h"
#include "testutil/TestMain.h"
#include "testutil/WorkDatabaseFixture.h"

#include <QCheckBox>
#include <QComboBox>
#include <QDir>
#include <QLabel>
#include <QLineEdit>
#include <QProcess>
#include <QPushButton>
#include <QTableView>

using namespace zorbin;
using namespace zorbin::test;

namespace {

QStringList entries(const QComboBox *list)
{
    QStringList texts;
    for (int i = 0; i < list->count(); ++i)
        texts << list->itemText(i);
    return texts;
}

// The text of every catalog page in `folder`, as written (windows-1255; the keys are Latin).
QByteArray allPages(const QString &folder)
{
    QByteArray pages;
    const QDir dir(folder);
    for (const QString &name : dir.entryList({QStringLiteral("zo*.htm")}, QDir::Files))
        pages += readFile(dir.filePath(name));
    return pages;
}

void setStored(SettingsStore &store, const QString &key, const QString &value)
{
    store.write(QStringLiteral("Zorbin"), QStringLiteral("Params"), key, value);
}

} // namespace

class DemoCardTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void initTestCase() { qputenv("ZORBIN_BROWSER", "true"); }

    void theDemoListsShowWithTheStoredChoices()
    {
        QTemporaryDir folder;
        const auto store = copyDemoSettings(folder.path());
        AssembledProgram program(*store);
        MainCard card(*program.control, program.user);
        auto *prices = card.findChild<QComboBox *>(QStringLiteral("cmbPriceField"));
        auto *notes = card.findChild<QComboBox *>(QStringLiteral("cmbExtraNote1"));
        auto *pictureNote = card.findChild<QComboBox *>(QStringLiteral("cmbPicExtraNote"));
        for (const QString &name : {QStringLiteral("מחירון סיטונאי"), QStringLiteral("מחירון קמעונאי"),
                                    QStringLiteral("Export prices"), QStringLiteral("מבצע חורף")})
            QVERIFY2(entries(prices).contains(name), qPrintable(entries(prices).join(QLatin1Char('|'))));
        for (const QString &name :
             {QStringLiteral("צבע"), QStringLiteral("חומר"), QStringLiteral("תמונה נוספת")})
            QVERIFY2(entries(notes).contains(name), qPrintable(entries(notes).join(QLatin1Char('|'))));
        // The stored indexes ("PriceField" 1, "ExtraNote1" 1, "PicExtraNote" 2) select from the
        // filled lists: the lists came first.
        QCOMPARE(prices->currentIndex(), 1);
        QCOMPARE(notes->currentIndex(), 1);
        QCOMPARE(pictureNote->currentIndex(), 2);
        CatalogSettings &settings = card.control().settings();
        QCOMPARE(prices->currentText(), settings.priceList1.entry(1).text);
        QVERIFY(card.control().persistence().unappliedKeys().isEmpty());
        QCOMPARE(card.findChild<QLineEdit *>(QStringLiteral("txtTopTitle"))->text(),
                 QStringLiteral("קטלוג לדוגמה"));
        QCOMPARE(card.tabs()->currentIndex(), int(MainCard::RangePage));
    }

    void itemsMarkedByHandMakeTheCatalog()
    {
        QTemporaryDir folder;
        const auto store = copyDemoSettings(folder.path());
        const QString output = QDir(folder.path()).filePath(QStringLiteral("catalog"));
        setStored(*store, QStringLiteral("PagingPath"), output);
        AssembledProgram program(*store);
        MainCard card(*program.control, program.user);
        ModalAnswerer answerer;
        answerer.buttons = {QMessageBox::No, QMessageBox::Yes};
        int opening = 0;
        int itemCount = 0;
        answerer.onDialog = [&](QDialog *shown) {
            auto *dialog = qobject_cast<frmSelectItem *>(shown);
            QVERIFY(dialog);
            ++opening;
            ItemListModel *model = dialog->model();
            auto click = [dialog](const char *name) {
                dialog->findChild<QPushButton *>(QLatin1String(name))->click();
            };
            if (opening == 1) {
                // Freshly collected: every item listed and marked.
                itemCount = model->rowCount();
                QCOMPARE(itemCount,
                         int(readWorkTable(card.control().runState().WorkDBFile, QStringLiteral("tItems"))
                                 .size()));
                QVERIFY(itemCount > 100);
                for (const SelectableItem &item : model->items())
                    QVERIFY(item.include);
                // A key prefix in small letters finds the capitals; a name prefix likewise.
                dialog->findChild<QLineEdit *>(QStringLiteral("txtToItemkey"))
                    ->setText(QStringLiteral("h0007"));
                click("cmdFindKey");
                QCOMPARE(dialog->grid()->currentIndex().data().toString(), QStringLiteral("H0007"));
                dialog->findChild<QLineEdit *>(QStringLiteral("txtToItemName"))
                    ->setText(QStringLiteral("RUG OAK"));
                click("cmdFindByDesc");
                const int found = dialog->grid()->currentIndex().row();
                QCOMPARE(model->index(found, ItemListModel::KeyColumn).data().toString(),
                         QStringLiteral("H0007"));
                QVERIFY(model->setData(model->index(found, ItemListModel::IncludeColumn), Qt::Unchecked,
                                       Qt::CheckStateRole));
                // Reloaded, the unmarked item comes after every marked one.
                click("cmdShowAll");
                QCOMPARE(model->items().constLast().key, QStringLiteral("H0007"));
                QVERIFY(!model->items().constLast().include);
            } else {
                // Opened again without collecting: the mark is still there. Clear all in the
                // marked view clears what it lists, and the rows stay listed; mark all gives the
                // marks back to those rows only.
                QCOMPARE(model->items().constLast().key, QStringLiteral("H0007"));
                click("cmdShowMarked");
                QCOMPARE(model->rowCount(), itemCount - 1);
                click("cmdNoneItems");
                QCOMPARE(model->rowCount(), itemCount - 1);
                for (const SelectableItem &item : model->items())
                    QVERIFY(!item.include);
                click("CmdAllItems");
            }
            click("cmdClose");
        };

        card.findChild<QPushButton *>(QStringLiteral("cmdSelectAccount"))->click();
        QCOMPARE(opening, 1);
        QVERIFY(card.findChild<QCheckBox *>(QStringLiteral("ChkSelectAccount"))->isChecked());
        card.findChild<QPushButton *>(QStringLiteral("cmdSelectAccount"))->click(); // "No": no new collection
        QCOMPARE(opening, 2);
        QCOMPARE(answerer.texts.value(0), QStringLiteral("לסרוק מחדש את רשימת הפריטים?"));

        card.findChild<QPushButton *>(QStringLiteral("cmdRunMailing"))->click(); // "Yes"
        QCOMPARE(answerer.texts.size(), 2); // the question, and no fault after it
        const QByteArray pages = allPages(output);
        QVERIFY(pages.contains("B0001"));
        QVERIFY(!pages.contains("H0007"));
    }

    void aStopDuringALargeCollectionKeepsTheRowsSoFar()
    {
        QTemporaryDir folder;
        const QString large = QDir(folder.path()).filePath(QStringLiteral("large"));
        const int items = 20000;
        QCOMPARE(QProcess::execute(QStringLiteral("bash"),
                                   {QStringLiteral(ZORBIN_DEMO_SCRIPT), QStringLiteral("--items"),
                                    QString::number(items), large}),
                 0);
        const auto store = openIniSettingsStore(QDir(large).filePath(QStringLiteral("demo-settings.ini")));
        const QString output = QDir(folder.path()).filePath(QStringLiteral("catalog"));
        setStored(*store, QStringLiteral("PagingPath"), output);
        AssembledProgram program(*store);
        MainCard card(*program.control, program.user);
        auto *stop = card.findChild<QPushButton *>(QStringLiteral("cmdStop"));
        // The user presses stop as soon as the run is under way; the click reaches the control
        // when the collection yields at its first progress point.
        QObject::connect(&card, &MainCard::busyChanged, stop, [stop](bool busy) {
            if (busy)
                QTimer::singleShot(0, stop, [stop] { stop->click(); });
        });
        ModalAnswerer answerer;
        answerer.buttons = {QMessageBox::Yes};
        card.findChild<QPushButton *>(QStringLiteral("cmdRunMailing"))->click();

        const QString workDB = card.control().runState().WorkDBFile;
        QVERIFY(!workDB.isEmpty());
        const qsizetype collected = readWorkTable(workDB, QStringLiteral("tItems")).size();
        QVERIFY2(collected > 0 && collected < items, qPrintable(QString::number(collected)));
        // The catalog was written from the rows collected before the stop.
        QVERIFY(QFileInfo::exists(QDir(output).filePath(QStringLiteral("zoindex.htm"))));
        QCOMPARE(answerer.texts.size(), 1);
        QVERIFY(card.findChild<QPushButton *>(QStringLiteral("cmdRunMailing"))->isEnabled());
        QVERIFY(!stop->isEnabled());
    }
};

ZORBIN_TEST_CLASS(DemoCardTest)
#include "DemoCardTest.moc"
