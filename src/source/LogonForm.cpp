#include "source/LogonForm.h"

#include "model/SettingsPersistence.h"
#include "platform/SettingsStore.h"
#include "source/ConnectionStore.h"
#include "source/ConnectionString.h"
#include "source/SourceConnection.h"

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
    CmbConnType.setCurrentIndex(params.type - 1);
}

std::int16_t LogonForm::connectionType() const
{
    return static_cast<std::int16_t>(CmbConnType.currentIndex() + 1);
}

QString LogonForm::connectionString() const
{
    return BuildConnString(txtConnServer, txtConnUID, txtConnPWD, txtConnDatabase, connectionType());
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
    params.type = connectionType();
    SetGetRegConnParams(SaveAction, store);
    store.flush();
}

void LogonForm::SetGetRegConnParams(std::uint8_t action, SettingsStore &store)
{
    using P = ControlProperty;
    const StoredSetting values[] = {
        {ConnServerKey, P::text(txtConnServer), DefaultConnServer},
        {ConnUserKey, P::text(txtConnUID), DefaultConnUser},
        {ConnPasswordKey, P::text(txtConnPWD), QString()},
        {ConnDatabaseKey, P::text(txtConnDatabase), DefaultConnDatabase},
        {ConnTypeKey, P::listIndex(CmbConnType), DefaultConnTypeIndex},
    };
    for (const StoredSetting &value : values)
        SetGetRegControlValue(action, store, StoreApp, StoreSection, value.key, value.property,
                              value.fallback);
}

} // namespace zorbin
