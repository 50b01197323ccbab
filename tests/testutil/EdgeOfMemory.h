#pragma once

#include <QList>
#include <QString>

namespace zorbin::test {

// Two copies of `text`: one that ends where unreadable memory begins, one that starts where
// unreadable memory ends. Code that reads a character past either end stops the test with a
// segmentation fault, in a release build too (there a QString's own text ends in a zero, which
// hides such a read). For the boundary tests of the parsers that index a text. The memory is
// never given back. Where pages cannot be guarded (not a Unix system), plain copies.
QList<QString> atEdgesOfMemory(const QString &text);

} // namespace zorbin::test
