#pragma once

#include <QList>
#include <QString>
#include <cstring>

#ifdef Q_OS_UNIX
#include <sys/mman.h>
#include <unistd.h>
#endif

namespace zorbin::test {

// Two copies of `text`: one that ends where unreadable memory begins, one that starts where
// unreadable memory ends. Code that reads a character past either end stops the test with a
// segmentation fault, in a release build too (there a QString's own text ends in a zero, which
// hides such a read). For the boundary tests of the parsers that index a text. The memory is
// never given back. Where pages cannot be guarded (not a Unix system), plain copies.
inline QList<QString> atEdgesOfMemory(const QString &text)
{
    QList<QString> copies;
    for ([[maybe_unused]] const bool guardAfter : {true, false}) {
#ifdef Q_OS_UNIX
        const auto page = std::size_t(sysconf(_SC_PAGESIZE));
        const std::size_t bytes = std::size_t(text.size()) * sizeof(QChar);
        const std::size_t readable = (bytes + page - 1) / page * page;
        void *mapped =
            mmap(nullptr, readable + page, PROT_READ | PROT_WRITE, MAP_PRIVATE | MAP_ANONYMOUS, -1, 0);
        char *guard =
            mapped == MAP_FAILED ? nullptr : static_cast<char *>(mapped) + (guardAfter ? readable : 0);
        if (guard && mprotect(guard, page, PROT_NONE) == 0) {
            char *characters = guardAfter ? guard - bytes : guard + page;
            std::memcpy(characters, text.constData(), bytes);
            copies << QString::fromRawData(reinterpret_cast<const QChar *>(characters), text.size());
            continue;
        }
#endif
        copies << QString(text.constData(), text.size());
    }
    return copies;
}

} // namespace zorbin::test
