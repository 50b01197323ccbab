#pragma once

#include "common/Status.h"

#include <QString>

namespace zorbin {

struct RunContext;

// What a web catalog run is asked to write.
struct SiteRequest
{
    QString folder;       // the site folder, a full path; created when missing (its parent must exist)
    QString dbFile;       // the working database to read the catalog items from
    bool sections = true; // the items under a heading per sort group, with a list of them on page 1
};

// Writes the web catalog of the working database's catalog items (CatalogRows: the catalog's
// order and its rules for marked items and items with a picture) into request.folder, with the
// settings of context.settings: the pages "index.html", "page-2.html", ..., "site.css",
// "site.js", "search-index.js" and the thumbnails in "pictures/" (see ThumbnailStore). Returns
// the first page's full path, or the empty text when the catalog has no items; then no page
// is written and the pages of an earlier run are removed.
//
// Files in the folder that a run does not write are left alone. The pages are written into a
// staging folder first and take the old pages' place only when all are written (SiteStaging);
// thumbnails that no page refers to any more are removed after that.
//
// Progress follows the protocol of ProgressMeter: the items are read and thumbnails made, then
// the pages written, each half of the bar. A stop (context.state.StopRequested at a progress
// point) ends the run with the folder's site as it was before the run, and the bar where it
// stopped: only the new thumbnails stay, recorded, for the next run to reuse. The result is
// then the first page of that earlier site, or the empty text when there is none; the caller
// tells a stop from an empty catalog by StopRequested. A failure leaves the folder likewise.
Result<QString> CreateCatSite(RunContext &context, const SiteRequest &request);

} // namespace zorbin
