#pragma once

#include "common/Status.h"

#include <QString>
#include <QVariant>
#include <cstdint>

namespace zorbin {

// The names of the files a catalog writes, and the conversions of working-database values into
// page text that every writer shares.

// The file of catalog page `Z` (from 1): `pPrefix` + "index.htm" for page 1, otherwise
// `pPrefix` + the page number with at least six digits + ".htm" (page 2 is "zo000002.htm").
// `pPrefix` is the output folder followed by "zo". No upper limit on the page number.
QString HTMLFileName(const QString &pPrefix, std::int64_t Z);

// Where the copy of a picture lives in the images folder: `pImagePath` + the platform's folder
// separator + the file name part of `pOrigImage` (everything after its last separator, or all
// of it). The empty reference gives the empty text; a reference ending in a separator gives
// the images folder and a separator alone.
QString ImageFileName(const QString &pImagePath, const QString &pOrigImage);

// A working-database value as page text: "&nbsp;" for null, otherwise the value's text with
// the markup characters escaped (see escapeHtml), so that a value can neither break the page
// nor add markup to it. An empty text stays empty.
QString HTMLText(const QVariant &value);

// Whether the text holds a Hebrew letter (alef to tav, final forms included; windows-1255
// codes 224 to 250). Points, cantillation and Hebrew punctuation do not count.
bool HasHebrew(const QString &text);

// A working-database value as a number: 0 for null. A text that is not a number fails with a
// message that quotes it.
Result<double> NumOrZero(const QVariant &value);

// The text with "&", "<", ">", "\"" and "'" replaced by their character references
// ("&amp;", "&lt;", "&gt;", "&quot;", "&#39;").
QString escapeHtml(const QString &text);

// A picture, logo or link reference as it goes inside a src or href attribute between
// apostrophes, escaped as by escapeHtml. A file path has the marks that a URL reads as its own
// syntax ("%", "#", "?") percent-encoded first, so that it keeps naming the same file; a URL (a
// scheme followed by "://", such as "http://host/p.php?id=5&s=1#x") keeps them, since they are
// part of its target.
QString attributeFileReference(const QString &path);

} // namespace zorbin
