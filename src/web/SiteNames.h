#pragma once

#include <QString>

namespace zorbin::site {

// The files of a web catalog, all inside its folder. Pages refer to each other and to these by
// these bare names only, so the folder works from disk and from any path of a web server.

inline const QString StylesheetName = QStringLiteral("site.css");
inline const QString ScriptName = QStringLiteral("site.js");
inline const QString SearchIndexName = QStringLiteral("search-index.js");
// The thumbnails and their cache record (see ThumbnailStore).
inline const QString PicturesFolderName = QStringLiteral("pictures");
// Where a run writes its pages before they replace the site's (see CreateCatSite).
inline const QString StagingFolderName = QStringLiteral(".zorbin-staging");

// The file of page `page` (from 1): "index.html" for the first, "page-<n>.html" for the others.
QString pageFileName(long long page);

// Whether a file name in the site folder is one that a run writes (a page, the stylesheet,
// the script or the search index): exactly these are replaced or removed by the next run;
// any other file in the folder is left alone.
bool isSiteFileName(const QString &name);

} // namespace zorbin::site
