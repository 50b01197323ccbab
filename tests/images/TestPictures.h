#pragma once

#include "testutil/TestFiles.h"

namespace zorbin::test {

// A picture that ImageMagick made for these tests at build time (the target image-test-pictures).
inline QString testPicture(const QString &name)
{
    return QStringLiteral(ZORBIN_TEST_PICTURES "/") + name;
}

inline QByteArray testPictureBytes(const QString &name)
{
    return readFile(testPicture(name));
}

} // namespace zorbin::test
