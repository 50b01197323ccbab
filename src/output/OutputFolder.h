#pragma once

#include "common/Status.h"

#include <QString>
#include <QStringList>

namespace zorbin {

struct CatalogSettings;
class FileSystem;

// The file names a catalog run writes into its output folder.
inline const QString PagePrefixName = QStringLiteral("zo");
inline const QString StylesheetName = QStringLiteral("tarnik.css");
inline const QString ListPageName = QStringLiteral("zorbin3.htm");
inline const QString ImagesFolderName = QStringLiteral("images");
inline const QString PdfFileName = QStringLiteral("zorbin.pdf");
inline const QString SiteFolderName = QStringLiteral("site");

// The output folder of the settings, with a separator at its end: `txtPagingPath`, or the
// temporary folder when that is empty.
QString outputFolderOf(const CatalogSettings &settings);
// The images folder inside an output folder (no separator at its end).
QString imagesFolderOf(const QString &outputFolder);

// Creates the output folder when it is missing (one level; a missing parent is a fault).
Status ensureFolder(FileSystem &files, const QString &folder);

// Removes what an earlier catalog or list run wrote into the output folder, and nothing else:
// the page files ("zoindex.htm", "zo" + six or more digits + ".htm"), the list page, and the
// pictures recorded as copied into the images folder (see CopiedPictures). The images folder
// is created when missing.
Status cleanCatalogOutput(FileSystem &files, const QString &outputFolder);

// Whether a file name is one of the catalog's page files or its list page.
bool isCatalogPageName(const QString &fileName);

} // namespace zorbin
