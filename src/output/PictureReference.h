#pragma once

#include <QString>
#include <optional>

namespace zorbin {

class FileSystem;

// How a catalog run turns the picture references of the working database (the ItemPic column)
// and the logo setting into picture files. The picture step of the catalog run copies exactly
// these files, so that the pages show them; the PDF writer draws them.

// The working database's mark for an item without a picture.
inline const QString NoPictureMark = QStringLiteral("?");

// Whether a reference names a picture at all: neither empty nor the mark.
bool namesPicture(const QString &reference);

// The file an item's picture reference names, looked up literally (no wildcards) as
// FileSystem::findFile does, so that where names are case-sensitive a name that differs only
// in letter case is found too. Nothing when the reference names no picture or no such file.
std::optional<QString> pictureSourceFile(const FileSystem &files, const QString &reference);

// The logo file of the settings: the path as typed when such a file exists, otherwise nothing.
std::optional<QString> logoSourceFile(const FileSystem &files, const QString &logo);

} // namespace zorbin
