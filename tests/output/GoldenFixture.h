#pragma once

#include "common/Status.h"

#include <QByteArray>
#include <QMap>
#include <QString>

namespace zorbin {
struct CatalogSettings;
}

namespace zorbin::test {

// The golden cases of the output writers (folders under tests/output/golden/).
//
// The cases run in one temporary folder ROOT: ROOT/pictures holds the pictures of
// golden/pictures, a working database of makeGoldenWorkDatabase() lies in ROOT, and ROOT/out
// is the output folder, emptied before each case. In the file-per-page mode the test copies
// the pictures into ROOT/out/images as the picture step of a catalog run would. Pages hold full paths, so
// ROOT is written as "{root}" both in a case's settings.ini and in the expected files: the produced files are
// compared after ROOT is replaced by "{root}" in them.
QString goldenFolder();
// The case folders (names), in name order.
QStringList goldenCases();

// Writes the working database of the golden cases at `path`: nine items (two left out of the
// catalog) whose names, units, currencies and notes hold markup characters, Hebrew, an emoji,
// Chinese and nulls; their pictures are files under `root`/pictures. With `noneIncluded` no
// item is marked for the catalog.
Status makeGoldenWorkDatabase(const QString &path, const QString &root, bool noneIncluded = false);

// Loads a case's settings.ini ("{root}" replaced by `root`) into `settings` the way the
// control loads the user's store, after giving the source-dependent lists two entries each.
// The section [Test] holds what the store does not: OnlyWithPic=1 ticks ChkOnlyWithPic.
Status loadGoldenSettings(const QString &caseName, const QString &root, CatalogSettings &settings);
// A key of the case's [Test] section; the empty text when absent.
QString goldenTestValue(const QString &caseName, const QString &key);

// The files of a folder (top level only) by name, ROOT replaced by "{root}".
QMap<QString, QByteArray> producedFiles(const QString &folder, const QString &root);
// The expected files of a case: every file of its folder except settings.ini.
QMap<QString, QByteArray> expectedFiles(const QString &caseName);

} // namespace zorbin::test
