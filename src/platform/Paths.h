#pragma once

#include <QString>

// Where the program puts its files on this platform.
namespace zorbin {

// The folder separator of the platform: "\" on Windows, "/" elsewhere. Output folders and
// picture references are written and split with it.
QChar pathSeparator();

// `folder` with one separator at its end (an empty text stays empty).
QString withTrailingSeparator(const QString &folder);

// The user's temporary folder: the "Temp" variable on Windows, TMPDIR elsewhere; when the
// variable is not set, on Windows the platform's own temporary folder, elsewhere the user's own
// folder "zorbin" in the cache folder (~/.cache/zorbin, made readable by its owner only), or the
// system's temporary folder when that cannot be made (never the file-system root).
// No trailing separator.
QString temporaryFolder();

// The home-based stand-ins for the Windows defaults "c:\photos\" and "c:\output".
QString defaultPictureFolder();
QString defaultOutputFolder();

} // namespace zorbin
