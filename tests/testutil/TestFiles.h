#pragma once

#include <QByteArray>
#include <QString>

namespace zorbin::test {

// Creates (or replaces) a file with the given bytes; fails the test when it cannot.
void writeFile(const QString &path, const QByteArray &content = QByteArray("x"));
QByteArray readFile(const QString &path);

// The folder of the demo database built with the project (the build tree's demo folder).
QString demoFolder();
// The shared sample files of the project (Jet and Access databases).
QString testDataFolder();

} // namespace zorbin::test
