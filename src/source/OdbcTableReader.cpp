#include "source/OdbcTableReader.h"

#include <cstdint>
#include <sql.h>
#include <sqlext.h>

namespace zorbin {
namespace {

constexpr SQLSMALLINT NameBufferSize = 512;
constexpr SQLLEN ChunkSize = 8192;

SQLPOINTER integerAttribute(std::uintptr_t value)
{
    return reinterpret_cast<SQLPOINTER>(value);
}

QString fromDriver(const SQLCHAR *text, qsizetype length = -1)
{
    return QString::fromLocal8Bit(reinterpret_cast<const char *>(text), length);
}

// The diagnostic records of a handle, one per line, in the driver's words.
QString diagnostics(SQLSMALLINT handleType, SQLHANDLE handle)
{
    QStringList lines;
    for (SQLSMALLINT record = 1;; ++record) {
        SQLCHAR state[6] = {};
        SQLINTEGER nativeError = 0;
        SQLCHAR message[SQL_MAX_MESSAGE_LENGTH + 1] = {};
        SQLSMALLINT length = 0;
        if (!SQL_SUCCEEDED(SQLGetDiagRec(handleType, handle, record, state, &nativeError, message,
                                         sizeof message, &length)))
            break;
        const QString line = fromDriver(message).trimmed();
        if (!line.isEmpty())
            lines << line;
    }
    return lines.join(QLatin1Char('\n'));
}

// What a failure says when the driver gave no words of its own.
QString cannotListTables()
{
    return QStringLiteral("לא ניתן לקרוא את רשימת הטבלאות.");
}

QString cannotReadTable(const QString &table)
{
    return QStringLiteral("לא ניתן לקרוא את הטבלה %1.").arg(table);
}

Status failure(SQLSMALLINT handleType, SQLHANDLE handle, const QString &whenEmpty)
{
    const QString text = diagnostics(handleType, handle);
    return Status::fault(text.isEmpty() ? whenEmpty : text);
}

OdbcTableReader::ColumnKind kindOf(SQLSMALLINT sqlType)
{
    switch (sqlType) {
    case SQL_BIT:
    case SQL_TINYINT:
    case SQL_SMALLINT:
    case SQL_INTEGER:
    case SQL_BIGINT:
        return OdbcTableReader::ColumnKind::Integer;
    case SQL_REAL:
    case SQL_FLOAT:
    case SQL_DOUBLE:
    case SQL_DECIMAL:
    case SQL_NUMERIC:
        return OdbcTableReader::ColumnKind::Real;
    case SQL_BINARY:
    case SQL_VARBINARY:
    case SQL_LONGVARBINARY:
        return OdbcTableReader::ColumnKind::Binary;
    default:
        return OdbcTableReader::ColumnKind::Text;
    }
}

// A statement handle that frees itself.
class Statement
{
public:
    explicit Statement(SQLHDBC connection) { SQLAllocHandle(SQL_HANDLE_STMT, connection, &m_handle); }
    ~Statement()
    {
        if (m_handle != SQL_NULL_HSTMT)
            SQLFreeHandle(SQL_HANDLE_STMT, m_handle);
    }
    Statement(const Statement &) = delete;
    Statement &operator=(const Statement &) = delete;

    SQLHSTMT handle() const { return m_handle; }
    bool isValid() const { return m_handle != SQL_NULL_HSTMT; }

private:
    SQLHSTMT m_handle = SQL_NULL_HSTMT;
};

// One column of the current row, read in chunks: mdbtools converts only to character data, so
// everything but binary data is read as text (UTF-8 from the driver) and converted here.
Result<QVariant> readValue(SQLHSTMT statement, SQLUSMALLINT column, OdbcTableReader::ColumnKind kind)
{
    const bool binary = kind == OdbcTableReader::ColumnKind::Binary;
    const SQLSMALLINT target = binary ? SQL_C_BINARY : SQL_C_CHAR;
    QByteArray bytes;
    char buffer[ChunkSize];
    for (;;) {
        SQLLEN indicator = 0;
        const SQLRETURN result = SQLGetData(statement, column, target, buffer, ChunkSize, &indicator);
        if (result == SQL_NO_DATA)
            break;
        if (!SQL_SUCCEEDED(result))
            return failure(SQL_HANDLE_STMT, statement, QStringLiteral("קריאת ערך מבסיס הנתונים נכשלה."));
        if (indicator == SQL_NULL_DATA)
            return QVariant();
        const SQLLEN room = binary ? ChunkSize : ChunkSize - 1; // text chunks end with a zero byte
        if (result == SQL_SUCCESS_WITH_INFO && (indicator == SQL_NO_TOTAL || indicator > room)) {
            bytes.append(buffer, static_cast<qsizetype>(room));
            continue;
        }
        const SQLLEN length =
            indicator == SQL_NO_TOTAL ? static_cast<SQLLEN>(qstrnlen(buffer, ChunkSize)) : indicator;
        bytes.append(buffer, static_cast<qsizetype>(qMin(length, room)));
        break;
    }
    if (binary)
        return QVariant(bytes);
    const QString text = QString::fromUtf8(bytes);
    bool ok = false;
    if (kind == OdbcTableReader::ColumnKind::Integer) {
        const qint64 number = text.trimmed().toLongLong(&ok);
        if (ok)
            return QVariant(number);
    } else if (kind == OdbcTableReader::ColumnKind::Real) {
        const double number = text.trimmed().toDouble(&ok);
        if (ok)
            return QVariant(number);
    }
    return QVariant(text);
}

} // namespace

struct OdbcTableReader::Handles
{
    SQLHENV environment = SQL_NULL_HENV;
    SQLHDBC connection = SQL_NULL_HDBC;
    bool connected = false;

    ~Handles()
    {
        if (connected)
            SQLDisconnect(connection);
        if (connection != SQL_NULL_HDBC)
            SQLFreeHandle(SQL_HANDLE_DBC, connection);
        if (environment != SQL_NULL_HENV)
            SQLFreeHandle(SQL_HANDLE_ENV, environment);
    }
};

OdbcTableReader::OdbcTableReader(std::unique_ptr<Handles> handles) : m_handles(std::move(handles)) {}

OdbcTableReader::~OdbcTableReader() = default;

Result<std::unique_ptr<OdbcTableReader>> OdbcTableReader::connect(const QString &connectionText,
                                                                  int loginTimeoutSeconds)
{
    auto handles = std::make_unique<Handles>();
    const QString noDriverManager = QStringLiteral("מנהל ההתקנים של ODBC אינו זמין.");
    if (!SQL_SUCCEEDED(SQLAllocHandle(SQL_HANDLE_ENV, SQL_NULL_HANDLE, &handles->environment)))
        return Status::fault(noDriverManager);
    SQLSetEnvAttr(handles->environment, SQL_ATTR_ODBC_VERSION, integerAttribute(SQL_OV_ODBC3), 0);
    if (!SQL_SUCCEEDED(SQLAllocHandle(SQL_HANDLE_DBC, handles->environment, &handles->connection)))
        return failure(SQL_HANDLE_ENV, handles->environment, noDriverManager);
    SQLSetConnectAttr(handles->connection, SQL_ATTR_LOGIN_TIMEOUT,
                      integerAttribute(static_cast<std::uintptr_t>(loginTimeoutSeconds)), 0);
    QByteArray text = connectionText.toLocal8Bit();
    const SQLRETURN result =
        SQLDriverConnect(handles->connection, nullptr, reinterpret_cast<SQLCHAR *>(text.data()), SQL_NTS,
                         nullptr, 0, nullptr, SQL_DRIVER_NOPROMPT);
    if (!SQL_SUCCEEDED(result))
        return failure(SQL_HANDLE_DBC, handles->connection, QStringLiteral("ההתחברות לבסיס הנתונים נכשלה."));
    handles->connected = true;
    return std::unique_ptr<OdbcTableReader>(new OdbcTableReader(std::move(handles)));
}

Result<QStringList> OdbcTableReader::tableNames()
{
    Statement statement(m_handles->connection);
    if (!statement.isValid())
        return failure(SQL_HANDLE_DBC, m_handles->connection, cannotListTables());
    SQLCHAR tableType[] = "TABLE";
    if (!SQL_SUCCEEDED(SQLTables(statement.handle(), nullptr, 0, nullptr, 0, nullptr, 0, tableType, SQL_NTS)))
        return failure(SQL_HANDLE_STMT, statement.handle(), cannotListTables());
    QStringList names;
    for (;;) {
        const SQLRETURN fetched = SQLFetch(statement.handle());
        if (fetched == SQL_NO_DATA)
            break;
        // Stopping quietly would pass a table left unlisted off as one the file does not have.
        if (!SQL_SUCCEEDED(fetched))
            return failure(SQL_HANDLE_STMT, statement.handle(), cannotListTables());
        auto name = readValue(statement.handle(), 3, ColumnKind::Text); // TABLE_NAME
        if (!name)
            return name.status();
        auto type = readValue(statement.handle(), 4, ColumnKind::Text); // TABLE_TYPE
        if (!type)
            return type.status();
        // mdbtools lists its system tables as tables too.
        const QString tableName = name->toString();
        if (type->toString() == QLatin1String("TABLE") && !tableName.startsWith(QLatin1String("MSys")))
            names << tableName;
    }
    return names;
}

Status OdbcTableReader::readTable(const QString &table,
                                  const std::function<Status(const QList<Column> &)> &columns,
                                  const std::function<Status(const QVariantList &)> &row)
{
    Statement statement(m_handles->connection);
    if (!statement.isValid())
        return failure(SQL_HANDLE_DBC, m_handles->connection, cannotReadTable(table));
    QByteArray sql = QStringLiteral("SELECT * FROM [%1]").arg(table).toLocal8Bit();
    if (!SQL_SUCCEEDED(SQLExecDirect(statement.handle(), reinterpret_cast<SQLCHAR *>(sql.data()), SQL_NTS)))
        return failure(SQL_HANDLE_STMT, statement.handle(), cannotReadTable(table));
    SQLSMALLINT count = 0;
    if (!SQL_SUCCEEDED(SQLNumResultCols(statement.handle(), &count)))
        return failure(SQL_HANDLE_STMT, statement.handle(), cannotReadTable(table));
    QList<Column> described;
    for (SQLUSMALLINT i = 1; i <= count; ++i) {
        SQLCHAR name[NameBufferSize] = {};
        SQLSMALLINT nameLength = 0;
        SQLSMALLINT sqlType = 0;
        SQLULEN size = 0;
        SQLSMALLINT decimals = 0;
        SQLSMALLINT nullable = 0;
        if (!SQL_SUCCEEDED(SQLDescribeCol(statement.handle(), i, name, NameBufferSize, &nameLength, &sqlType,
                                          &size, &decimals, &nullable)))
            return failure(SQL_HANDLE_STMT, statement.handle(), cannotReadTable(table));
        described << Column{fromDriver(name), kindOf(sqlType)};
    }
    if (Status status = columns(described); !status)
        return status;
    for (;;) {
        const SQLRETURN fetched = SQLFetch(statement.handle());
        if (fetched == SQL_NO_DATA)
            break;
        if (!SQL_SUCCEEDED(fetched))
            return failure(SQL_HANDLE_STMT, statement.handle(), cannotReadTable(table));
        QVariantList values;
        values.reserve(count);
        for (SQLUSMALLINT i = 1; i <= count; ++i) {
            auto value = readValue(statement.handle(), i, described.at(i - 1).kind);
            if (!value)
                return value.status();
            values << std::move(value).value();
        }
        if (Status status = row(values); !status)
            return status;
    }
    return Status::ok();
}

QStringList registeredOdbcDrivers()
{
    SQLHENV environment = SQL_NULL_HENV;
    if (!SQL_SUCCEEDED(SQLAllocHandle(SQL_HANDLE_ENV, SQL_NULL_HANDLE, &environment)))
        return {};
    SQLSetEnvAttr(environment, SQL_ATTR_ODBC_VERSION, integerAttribute(SQL_OV_ODBC3), 0);
    QStringList drivers;
    SQLUSMALLINT direction = SQL_FETCH_FIRST;
    for (;;) {
        SQLCHAR name[NameBufferSize] = {};
        SQLSMALLINT nameLength = 0;
        SQLCHAR attributes[2048] = {};
        SQLSMALLINT attributesLength = 0;
        if (!SQL_SUCCEEDED(SQLDrivers(environment, direction, name, NameBufferSize, &nameLength, attributes,
                                      sizeof attributes, &attributesLength)))
            break;
        drivers << fromDriver(name);
        direction = SQL_FETCH_NEXT;
    }
    SQLFreeHandle(SQL_HANDLE_ENV, environment);
    return drivers;
}

} // namespace zorbin
