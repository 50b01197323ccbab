#pragma once

#include "common/Status.h"
#include "pdf/CatalogPdf.h"
#include "web/CatalogSite.h"
#include "workdb/CollectionRun.h"

#include <QString>

namespace zorbin {

struct RunContext;

// The stages that the control's start-up and runs call, in the order the runs need them. The
// control decides when each runs, with which arguments, and what a failure means for the run;
// the stages do the work on the run context they are given and return their failures.
class CatalogStages
{
public:
    virtual ~CatalogStages() = default;

    // Start-up: the connection parameters from the store, then the lists filled from the
    // accounting database. None of them fails: what cannot be read stays as it was.
    virtual void GetRegConnParams(RunContext &context) = 0;
    virtual void FillCmbExtraNote(RunContext &context) = 0;
    virtual void FillCmbPriceField(RunContext &context) = 0;

    // The collection run (CollectionRun.h).
    virtual Result<CollectionReport> BuildAndCollectData(RunContext &context) = 0;
    // Copies the logo and the catalog's pictures into the images folder (file-per-page mode).
    virtual Status CollectCatImages(RunContext &context, const QString &imagesFolder,
                                    const QString &dbFile) = 0;
    // Writes the pages; the first page's file name, or the empty text when there are no items.
    virtual Result<QString> CreateCatHTML(RunContext &context, const QString &pagePrefix,
                                          const QString &dbFile, const QString &imagesFolder) = 0;
    virtual Status CreateCSS(RunContext &context, const QString &outputFolder, bool replace) = 0;
    virtual Status CreateListHTML(RunContext &context, const QString &fileName, const QString &dbFile) = 0;
    // Writes the catalog as a PDF (CatalogPdf.h).
    virtual Result<PdfWritten> CreateCatPDF(RunContext &context, const PdfRequest &request) = 0;
    // Writes the web catalog (CatalogSite.h): its first page, or the empty text.
    virtual Result<QString> CreateCatSite(RunContext &context, const SiteRequest &request) = 0;
};

} // namespace zorbin
