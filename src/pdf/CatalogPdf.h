#pragma once

#include "common/Status.h"

#include <QString>

namespace zorbin {

struct RunContext;

enum class PdfPageSize { A4, Letter };

// What a PDF run writes.
struct PdfRequest
{
    QString file;   // the PDF file; an existing file is replaced only when the new one is whole
    QString dbFile; // the working database the catalog rows come from
    PdfPageSize pageSize = PdfPageSize::A4;
};

// How a PDF run ended, when it did not fail.
struct PdfWritten
{
    enum class Ending {
        Written, // the PDF is at `file`
        NoItems, // the catalog query has no rows: nothing was written, an older file is untouched
        Stopped, // the stop request ended the run: nothing was written, an older file is untouched
    };
    Ending ending = Ending::Written;
    QString file;               // the written file; empty unless Written
    long long pages = 0;        // pages written (Written only)
    int picturesDecoded = 0;    // distinct picture files decoded (each at most once a run)
    int picturesHeldAtMost = 0; // the most pictures kept decoded at once (each until its last item)
};

// Writes the catalog of `request.dbFile` under `context.settings` as a PDF into `request.file`:
// pages of rows x columns cells (first column at the right) with the cell lines, pictures, frames,
// top and bottom bands of the settings, A4 or Letter portrait with 10 mm margins, every font
// embedded. Needs a QGuiApplication (fonts); without one it fails before anything is written.
//
// The PDF goes to a temporary file beside `request.file` that is renamed over it at the very
// end, so that neither a stop nor a failure leaves a half-written PDF, and an older file is kept
// until the new one is whole.
//
// Progress: the bar starts at 0 and shows cells drawn out of all cells of all pages (empty
// cells after the last item included) at every fifth cell; the host's events are handled there
// and `context.state.StopRequested` ends the run with Ending::Stopped, the bar left where it
// stopped. A run that ends normally puts the bar back to 0; a failure leaves it where it was.
//
// Fails (nothing written, an older file kept) when the settings' grid or lines are not valid,
// the working database cannot be read, a price is not a number (as the pages do), or the file
// cannot be written; the fault's text names the cause. A picture that is missing or cannot be
// decoded is not a failure: its box stays empty.
Result<PdfWritten> CreateCatPDF(RunContext &context, const PdfRequest &request);

} // namespace zorbin
