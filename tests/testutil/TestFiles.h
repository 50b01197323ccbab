#pragma once

#include <QByteArray>
#include <QFile>
#include <QString>
#include <QTest>

namespace zorbin::test {

// Creates (or replaces) a file with the given bytes; fails the test when it cannot.
inline void writeFile(const QString &path, const QByteArray &content = QByteArray("x"))
{
    QFile file(path);
    if (!file.open(QIODevice::WriteOnly | QIODevice::Truncate))
        QFAIL(qPrintable(QStringLiteral("cannot write %1").arg(path)));
    file.write(content);
}

// The file's bytes; empty when it cannot be read.
inline QByteArray readFile(const QString &path)
{
    QFile file(path);
    return file.open(QIODevice::ReadOnly) ? file.readAll() : QByteArray();
}

// The folder of the demo database built with the project (the build tree's demo folder).
inline QString demoFolder()
{
    return QStringLiteral(ZORBIN_DEMO_BUILD_DIR);
}

} // namespace zorbin::test
