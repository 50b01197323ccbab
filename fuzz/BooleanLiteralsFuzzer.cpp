// Feeds arbitrary SQL text to the translation of Boolean literals, and checks what it promises:
// a text without the words True or False is left as it is, and a translated text has nothing
// left to translate.
#include "workdb/BooleanLiterals.h"

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
    const QString sql = QString::fromUtf8(reinterpret_cast<const char *>(data), static_cast<qsizetype>(size));
    const QString translated = zorbin::translateBooleanLiterals(sql);
    if (!sql.contains(QLatin1String("true"), Qt::CaseInsensitive) &&
        !sql.contains(QLatin1String("false"), Qt::CaseInsensitive))
        require(translated == sql);
    require(zorbin::translateBooleanLiterals(translated) == translated);
    return 0;
}
