#pragma once

#include "testutil/TestFiles.h"

#include <QByteArray>
#include <QString>

namespace zorbin::test {

// A picture that ImageMagick made for these tests at build time.
inline QString testPicture(const QString &name)
{
    return QStringLiteral(ZORBIN_TEST_PICTURES "/") + name;
}

// Its bytes; ends the tests when it is missing.
inline QByteArray testPictureBytes(const QString &name)
{
    const QByteArray bytes = readFile(testPicture(name));
    if (bytes.isEmpty())
        qFatal("The test picture %s is missing: build the target image-test-pictures.", qPrintable(name));
    return bytes;
}

} // namespace zorbin::test
