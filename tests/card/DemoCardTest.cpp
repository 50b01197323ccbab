// The desktop program's whole runs on the demo accounting database, from its buttons.
#include "dialogs/ItemListModel.h"
#include "dialogs/SelectItemDialog.h"
#include "tests/card/CardRig.h"
#include "testutil/DemoScratch.h"
#include "testutil/TestFiles.h"
#include "testutil/TestMain.h"

#include <QCheckBox>
#include <QComboBox>
#include <QFileInfo>
#include <QLineEdit>
#include <QPushButton>
#include <QTableView>

using namespace zorbin;
using namespace zorbin::test;

class DemoCardTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void initTestCase() { qputenv("ZORBIN_BROWSER", "true"); }

    void theRunButtonsWriteTheCatalogAndTheList()
    {
        DemoScratch demo;
        AssembledProgram program(*demo.store);
        MainCard card(*program.control, program.user);
        // The stored choice of a list the demo database fills.
        QCOMPARE(card.findChild<QComboBox *>(QStringLiteral("cmbPriceField"))->currentText(),
                 QStringLiteral("מחירון סיטונאי"));
        ModalAnswerer answerer;
        answerer.buttons = {QMessageBox::Yes};
        card.findChild<QPushButton *>(QStringLiteral("cmdRunMailing"))->click();
        QCOMPARE(answerer.texts, QStringList{QStringLiteral("להתחיל בהכנת הקטלוג?")}); // and no fault
        QCOMPARE(firstItemKey(demo.out(QStringLiteral("zoindex.htm"))), QStringLiteral("00010"));
        for (const char *name : {"zo000034.htm", "tarnik.css", "images/item-11.jpg"})
            QVERIFY2(QFileInfo::exists(demo.out(QLatin1String(name))), name);

        card.findChild<QPushButton *>(QStringLiteral("CmdPreview"))->click();
        QCOMPARE(answerer.texts.size(), 1);
        QCOMPARE(listRows(demo.out(QStringLiteral("zorbin3.htm"))), 301);
    }

    // The user unmarks an item in the selection dialog; the catalog leaves it out. The dialog
    // opened again without a new collection still has the mark.
    void itemsMarkedByHandMakeTheCatalog()
    {
        DemoScratch demo;
        AssembledProgram program(*demo.store);
        MainCard card(*program.control, program.user);
        ModalAnswerer answerer;
        answerer.buttons = {QMessageBox::No, QMessageBox::Yes};
        QList<int> marked;
        answerer.onDialog = [&](QDialog *shown) {
            auto *dialog = qobject_cast<frmSelectItem *>(shown);
            ItemListModel *model = dialog->model();
            if (marked.isEmpty()) {
                dialog->findChild<QLineEdit *>(QStringLiteral("txtToItemkey"))
                    ->setText(QStringLiteral("h0007"));
                dialog->findChild<QPushButton *>(QStringLiteral("cmdFindKey"))->click();
                const QModelIndex found = dialog->grid()->currentIndex();
                QVERIFY(model->setData(found.siblingAtColumn(ItemListModel::IncludeColumn), Qt::Unchecked,
                                       Qt::CheckStateRole));
            }
            marked << int(std::count_if(model->items().cbegin(), model->items().cend(),
                                        [](const SelectableItem &item) { return item.include; }));
            dialog->findChild<QPushButton *>(QStringLiteral("cmdClose"))->click();
        };
        auto *select = card.findChild<QPushButton *>(QStringLiteral("cmdSelectAccount"));
        select->click();
        QVERIFY(card.findChild<QCheckBox *>(QStringLiteral("ChkSelectAccount"))->isChecked());
        select->click(); // "No": no new collection
        QCOMPARE(marked, (QList<int>{300, 300}));

        card.findChild<QPushButton *>(QStringLiteral("cmdRunMailing"))->click(); // "Yes"
        QCOMPARE(answerer.texts.size(), 2); // the two questions, and no fault after them
        QByteArray pages = readFile(demo.out(QStringLiteral("zoindex.htm")));
        for (int page = 2; page <= 34; ++page)
            pages += readFile(demo.out(QStringLiteral("zo%1.htm").arg(page, 6, 10, QLatin1Char('0'))));
        QVERIFY(pages.contains(">A0008<"));
        QVERIFY(!pages.contains(">H0007<"));
    }
};

ZORBIN_TEST_CLASS(DemoCardTest)
#include "DemoCardTest.moc"
