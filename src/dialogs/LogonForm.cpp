#include "dialogs/LogonForm.h"

#include "common/Numbers.h"
#include "model/SettingsPersistence.h"
#include "platform/SettingsStore.h"
#include "source/ConnectionStore.h"
#include "source/ConnectionString.h"
#include "source/SourceConnection.h"

#include <tuple>

namespace zorbin {

const QString LogonForm::RecommendTestText = QStringLiteral("מומלץ לבצע בדיקה לאחר שינוי ערכי ההתחברות!");
const QString LogonForm::TestSucceededText = QStringLiteral("הבדיקה הסתיימה בהצלחה");
const QString LogonForm::TestFailedText = QStringLiteral("הבדיקה לא הסתיימה בהצלחה");
const QString LogonForm::TestQuery = QStringLiteral("SELECT * FROM Accounts");

LogonForm::LogonForm()
    : CmbConnType(QStringList{QStringLiteral("MS-SQL Server Via ODBC"),
                              QStringLiteral("MS-SQL Server Via OLE-DB"),
                              QStringLiteral("DAO 4.0 Via OLE-DB")}),
      LblMsg(RecommendTestText)
{}

void LogonForm::Form_Load(const ConnectionParams &params)
{
    txtConnServer = params.server;
    txtConnUID = params.user;
    txtConnPWD = params.password;
    txtConnDatabase = params.database;
    CmbConnType.setCurrentIndex(static_cast<int>(params.kind) - 1);
}

ConnectionKind LogonForm::connectionKind() const
{
    return static_cast<ConnectionKind>(CmbConnType.currentIndex() + 1);
}

QString LogonForm::connectionString() const
{
    return BuildConnString(txtConnServer, txtConnUID, txtConnPWD, txtConnDatabase, connectionKind());
}

Status LogonForm::CmdCheck_Click()
{
    auto connection = SourceConnection::open(connectionString());
    Status outcome = connection ? Status::ok() : connection.status();
    if (connection) {
        auto accounts = connection.value()->select(TestQuery);
        if (!accounts)
            outcome = accounts.status();
    }
    LblMsg = outcome ? TestSucceededText : TestFailedText;
    return outcome;
}

void LogonForm::cmdOK_Click(ConnectionParams &params, SettingsStore &store)
{
    params.server = txtConnServer;
    params.user = txtConnUID;
    params.password = txtConnPWD;
    params.database = txtConnDatabase;
    params.kind = connectionKind();
    SetGetRegConnParams(SaveAction, store);
    store.flush();
}

void LogonForm::SetGetRegConnParams(std::uint8_t action, SettingsStore &store)
{
    auto text = [](QString &field) {
        return StoreValue{[&field] { return field; },
                          [&field](const QString &stored) {
                              field = stored;
                              return true;
                          }};
    };
    const StoreValue listIndex{[this] { return QString::number(CmbConnType.currentIndex()); },
                               [this](const QString &stored) {
                                   const auto index = toInt16(stored);
                                   return index && CmbConnType.setCurrentIndex(*index);
                               }};
    const std::tuple<QString, StoreValue, QString> values[] = {
        {ConnServerKey, text(txtConnServer), DefaultConnServer},
        {ConnUserKey, text(txtConnUID), DefaultConnUser},
        {ConnPasswordKey, text(txtConnPWD), QString()},
        {ConnDatabaseKey, text(txtConnDatabase), DefaultConnDatabase},
        {ConnTypeKey, listIndex, DefaultConnTypeIndex},
    };
    for (const auto &[key, value, fallback] : values)
        SetGetRegControlValue(action, store, StoreApp, StoreSection, key, value, fallback);
}

} // namespace zorbin
