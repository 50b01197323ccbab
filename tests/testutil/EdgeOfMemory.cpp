#include "testutil/EdgeOfMemory.h"

#include <cstring>

#ifdef Q_OS_UNIX
#include <sys/mman.h>
#include <unistd.h>
#endif

namespace zorbin::test {
namespace {

// A copy whose end (or start) touches a page that cannot be read.
QString guardedCopy(const QString &text, bool guardAfter)
{
#ifdef Q_OS_UNIX
    const std::size_t page = static_cast<std::size_t>(sysconf(_SC_PAGESIZE));
    const std::size_t bytes = static_cast<std::size_t>(text.size()) * sizeof(QChar);
    const std::size_t readable = (bytes + page - 1) / page * page;
    void *mapped = mmap(nullptr, readable + page, PROT_READ | PROT_WRITE, MAP_PRIVATE | MAP_ANONYMOUS, -1, 0);
    if (mapped == MAP_FAILED)
        return text;
    char *start = static_cast<char *>(mapped);
    char *guard = guardAfter ? start + readable : start;
    char *characters = guardAfter ? guard - bytes : guard + page;
    if (mprotect(guard, page, PROT_NONE) != 0)
        return text;
    if (bytes > 0)
        std::memcpy(characters, text.constData(), bytes);
    return QString::fromRawData(reinterpret_cast<const QChar *>(characters), text.size());
#else
    Q_UNUSED(guardAfter);
    return QString(text.constData(), text.size());
#endif
}

} // namespace

QList<QString> atEdgesOfMemory(const QString &text)
{
    return {guardedCopy(text, true), guardedCopy(text, false)};
}

} // namespace zorbin::test
