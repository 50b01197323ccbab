#include "dialogs/LogonDialog.h"

#include "source/ConnectionString.h"
#include "testutil/AccountingFixture.h"
#include "testutil/MemorySettingsStore.h"
#include "testutil/TestMain.h"

#include <QApplication>
#include <QComboBox>
#include <QGroupBox>
#include <QLabel>
#include <QLineEdit>
#include <QMessageBox>
#include <QPushButton>
#include <QStyle>
#include <QTemporaryDir>
#include <QTest>
#include <QTimer>

using namespace zorbin;
using namespace zorbin::test;

namespace {

// What a message box showed; the box is closed as soon as it appears.
struct ShownBox
{
    QString text;
    QString title;
    QMessageBox::Icon icon = QMessageBox::NoIcon;
    int count = 0;
};

// Watches for the first box. The watch also ends with `owner`, so a box that never came leaves
// no timer behind to write into `shown` after it is gone.
void closeBoxesAsTheyAppear(QObject *owner, ShownBox &shown)
{
    auto *timer = new QTimer(owner);
    QObject::connect(timer, &QTimer::timeout, timer, [&shown, timer] {
        if (auto *box = qobject_cast<QMessageBox *>(QApplication::activeModalWidget())) {
            shown.text = box->text();
            shown.title = box->windowTitle();
            shown.icon = box->icon();
            ++shown.count;
            box->accept();
            timer->deleteLater();
        }
    });
    timer->start(10);
}

template <typename T> T *child(frmLogon &dialog, const char *name)
{
    T *widget = dialog.findChild<T *>(QString::fromLatin1(name));
    if (!widget)
        QTest::qFail(name, __FILE__, __LINE__);
    return widget;
}

void typeInto(frmLogon &dialog, const char *name, const QString &text)
{
    child<QLineEdit>(dialog, name)->setText(text);
}

} // namespace

class LogonDialogTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void showsEveryCaption()
    {
        MemorySettingsStore store;
        ConnectionParams params;
        frmLogon dialog(store, params);
        QCOMPARE(dialog.windowTitle(), QStringLiteral("הגדרות התחברות לויזקאונט חלונות"));
        QCOMPARE(dialog.layoutDirection(), Qt::RightToLeft);
        QStringList groups;
        for (const auto *group : dialog.findChildren<QGroupBox *>())
            groups << group->title();
        QCOMPARE(groups, QStringList{QStringLiteral("ערכי התחברות")});
        QStringList labels;
        for (const auto *label : dialog.findChildren<QLabel *>())
            labels << label->text();
        for (const char *caption : {"שרת נתונים:", "משתמש:", "סיסמה:", "בסיס נתונים:", "סוג בסיס הנתונים:",
                                    "מומלץ לבצע בדיקה לאחר שינוי ערכי ההתחברות!"})
            QVERIFY2(labels.contains(QString::fromUtf8(caption)), caption);
        QCOMPARE(child<QPushButton>(dialog, "CmdCheck")->text(), QStringLiteral("בדיקה"));
        QCOMPARE(child<QPushButton>(dialog, "cmdOK")->text(), QStringLiteral("אישור"));
        QCOMPARE(child<QPushButton>(dialog, "cmdCancel")->text(), QStringLiteral("ביטול"));
        auto *types = child<QComboBox>(dialog, "CmbConnType");
        QCOMPARE(types->count(), 3);
        QCOMPARE(types->itemText(0), QStringLiteral("MS-SQL Server Via ODBC"));
        QCOMPARE(types->itemText(1), QStringLiteral("MS-SQL Server Via OLE-DB"));
        QCOMPARE(types->itemText(2), QStringLiteral("DAO 4.0 Via OLE-DB"));
    }

    void masksThePasswordWithStars()
    {
        MemorySettingsStore store;
        ConnectionParams params;
        params.password = QStringLiteral("secret");
        frmLogon dialog(store, params);
        dialog.show();
        auto *password = child<QLineEdit>(dialog, "txtConnPWD");
        QCOMPARE(password->echoMode(), QLineEdit::Password);
        QCOMPARE(password->style()->styleHint(QStyle::SH_LineEdit_PasswordCharacter, nullptr, password),
                 int('*'));
        QCOMPARE(password->displayText(), QStringLiteral("******"));
        QCOMPARE(password->text(), QStringLiteral("secret"));
    }

    void opensOnTheParameters_data()
    {
        QTest::addColumn<int>("type");
        QTest::addColumn<int>("index");
        QTest::newRow("ODBC") << 1 << 0;
        QTest::newRow("file") << 3 << 2;
        QTest::newRow("none") << 0 << -1;
    }
    void opensOnTheParameters()
    {
        QFETCH(int, type);
        QFETCH(int, index);
        MemorySettingsStore store;
        ConnectionParams params{QStringLiteral("srv"), QStringLiteral("u"), QStringLiteral("p"),
                                QStringLiteral("db"), static_cast<ConnectionKind>(type)};
        frmLogon dialog(store, params);
        QCOMPARE(child<QLineEdit>(dialog, "txtConnServer")->text(), QStringLiteral("srv"));
        QCOMPARE(child<QLineEdit>(dialog, "txtConnUID")->text(), QStringLiteral("u"));
        QCOMPARE(child<QLineEdit>(dialog, "txtConnPWD")->text(), QStringLiteral("p"));
        QCOMPARE(child<QLineEdit>(dialog, "txtConnDatabase")->text(), QStringLiteral("db"));
        QCOMPARE(child<QComboBox>(dialog, "CmbConnType")->currentIndex(), index);
    }

    // The test uses the typed values, reports in the message line, and saves nothing.
    void testsTheTypedValues()
    {
        QTemporaryDir folder;
        const ConnectionParams demo = fileConnection(copyDemoDatabase(folder.path()));
        MemorySettingsStore store;
        ConnectionParams params;
        ShownBox shown;
        frmLogon dialog(store, params);
        typeInto(dialog, "txtConnServer", demo.server);
        typeInto(dialog, "txtConnDatabase", demo.database);
        child<QComboBox>(dialog, "CmbConnType")->setCurrentIndex(2);
        closeBoxesAsTheyAppear(&dialog, shown);
        QTest::mouseClick(child<QPushButton>(dialog, "CmdCheck"), Qt::LeftButton);
        QCOMPARE(child<QLabel>(dialog, "LblMsg")->text(), QStringLiteral("הבדיקה הסתיימה בהצלחה"));
        QCOMPARE(shown.count, 0);

        typeInto(dialog, "txtConnDatabase", QStringLiteral("missing.db"));
        QTest::mouseClick(child<QPushButton>(dialog, "CmdCheck"), Qt::LeftButton);
        QCOMPARE(child<QLabel>(dialog, "LblMsg")->text(), QStringLiteral("הבדיקה לא הסתיימה בהצלחה"));
        QCOMPARE(shown.count, 1);
        QCOMPARE(shown.title, QStringLiteral("תקלה"));
        QCOMPARE(shown.icon, QMessageBox::Critical);
        QVERIFY2(shown.text.contains(QStringLiteral("missing.db")), qPrintable(shown.text));

        QTest::mouseClick(child<QPushButton>(dialog, "cmdCancel"), Qt::LeftButton);
        QCOMPARE(dialog.result(), int(QDialog::Rejected));
        QCOMPARE(store.writes, 0);
        QCOMPARE(params.server, QString());
        QCOMPARE(params.kind, ConnectionKind::None);
    }

    void aDatabaseWithoutAccountsFailsTheTest()
    {
        QTemporaryDir folder;
        const QString path = folder.filePath(QStringLiteral("accounting.db"));
        QVERIFY(makeAccountingFile(path, {QStringLiteral("DROP TABLE Accounts")}));
        LogonForm form;
        form.Form_Load(fileConnection(path));
        const Status outcome = form.CmdCheck_Click();
        QVERIFY(!outcome);
        QVERIFY2(outcome.description().contains(QStringLiteral("Accounts")),
                 qPrintable(outcome.description()));
        QCOMPARE(form.LblMsg, LogonForm::TestFailedText);
    }

    void okTakesAndSavesTheValues_data()
    {
        QTest::addColumn<int>("index");
        QTest::addColumn<QString>("storedType");
        QTest::addColumn<int>("type");
        QTest::newRow("OLE DB") << 1 << "1" << 2;
        QTest::newRow("no type chosen") << -1 << "-1" << 0;
    }
    void okTakesAndSavesTheValues()
    {
        QFETCH(int, index);
        QFETCH(QString, storedType);
        QFETCH(int, type);
        MemorySettingsStore store;
        ConnectionParams params;
        frmLogon dialog(store, params);
        typeInto(dialog, "txtConnServer", QStringLiteral("SRV\\SQL"));
        typeInto(dialog, "txtConnUID", QStringLiteral("catalog"));
        typeInto(dialog, "txtConnPWD", QStringLiteral("a;b"));
        typeInto(dialog, "txtConnDatabase", QStringLiteral("company"));
        child<QComboBox>(dialog, "CmbConnType")->setCurrentIndex(index);
        QTest::mouseClick(child<QPushButton>(dialog, "cmdOK"), Qt::LeftButton);
        QCOMPARE(dialog.result(), int(QDialog::Accepted));
        QCOMPARE(params.server, QStringLiteral("SRV\\SQL"));
        QCOMPARE(params.user, QStringLiteral("catalog"));
        QCOMPARE(params.password, QStringLiteral("a;b"));
        QCOMPARE(params.database, QStringLiteral("company"));
        QCOMPARE(int(params.kind), type);
        QCOMPARE(store.get(QStringLiteral("ConnServer")), QStringLiteral("SRV\\SQL"));
        QCOMPARE(store.get(QStringLiteral("ConnUID")), QStringLiteral("catalog"));
        QCOMPARE(store.get(QStringLiteral("ConnPWD")), QStringLiteral("a;b"));
        QCOMPARE(store.get(QStringLiteral("ConnDataBase")), QStringLiteral("company"));
        QCOMPARE(store.get(QStringLiteral("ConnType")), storedType);

        // What OK saved is what the next start-up loads.
        LogonForm reloaded;
        reloaded.SetGetRegConnParams(2, store);
        QCOMPARE(reloaded.txtConnPWD, QStringLiteral("a;b"));
        QCOMPARE(reloaded.CmbConnType.currentIndex(), index);
    }
};

ZORBIN_TEST_CLASS(LogonDialogTest)
#include "LogonDialogTest.moc"
