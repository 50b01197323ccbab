// Feeds arbitrary texts to the connection-string parser and builder, and checks what they
// promise: any text splits without a fault into parts that lie inside it, and a user and a
// password come back out of a built string as they went in, whatever they hold.
#include "source/ConnectionString.h"

#include <cstddef>
#include <cstdint>
#include <cstdlib>

namespace {

void require(bool condition)
{
    if (!condition)
        std::abort();
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t *data, std::size_t size)
{
    using namespace zorbin;
    const QString text =
        QString::fromUtf8(reinterpret_cast<const char *>(data), static_cast<qsizetype>(size));

    for (const ConnectionPart &part : splitConnString(text)) {
        require(part.valueStart >= 0 && part.valueLength >= 0);
        require(part.valueStart + part.valueLength <= text.size());
    }
    (void)maskConnStringPassword(text);
    (void)odbcConnStringForOleDb(text);

    // The first line is the user, the rest the password.
    const qsizetype cut = text.indexOf(QLatin1Char('\n'));
    const QString user = cut < 0 ? text : text.left(cut);
    const QString password = cut < 0 ? QString() : text.mid(cut + 1);
    const QString odbc =
        BuildConnString(QStringLiteral("srv"), user, password, QStringLiteral("db"), ConnectionKind::Odbc);
    require(connStringValue(odbc, QStringLiteral("uid")) == user);
    require(connStringValue(odbc, QStringLiteral("pwd")) == password);
    require(connStringValue(odbc, QStringLiteral("database")) == QLatin1String("db"));

    // OLE DB trims a value that is not quoted, as its providers do.
    const QString oleDb = BuildConnString(QStringLiteral("srv"), QStringLiteral("u"), password,
                                          QStringLiteral("db"), ConnectionKind::OleDb);
    const QString expected = oleDbConnValue(password) == password ? password.trimmed() : password;
    require(connStringValue(oleDb, QStringLiteral("Password")) == expected);
    require(connStringValue(oleDb, QStringLiteral("Initial Catalog")) == QLatin1String("db"));
    return 0;
}
