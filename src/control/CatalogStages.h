#pragma once

#include "common/Status.h"

#include <QString>

namespace zorbin {

// The stages that the control's start-up and runs call, in the order the runs need them.
// The control decides when each runs and with which arguments; the stages do the work.
// Each implementation works on the RunContext it was made with.
class CatalogStages
{
public:
    virtual ~CatalogStages() = default;

    // Start-up: the connection parameters from the store, then the source-dependent lists.
    // None of them reports a failure.
    virtual void GetRegConnParams() = 0;
    virtual void FillCmbExtraNote() = 0;
    virtual void FillCmbPriceField() = 0;

    // The collection run. Step failures are reported by the steps and set CollectFailed; a
    // failure returned here escaped the steps and ends the run that started the collection.
    virtual Status BuildAndCollectData() = 0;
    // Copies the logo and the catalog's pictures into the images folder (file-per-page mode).
    virtual Status CollectCatImages(const QString &imagesFolder, const QString &dbFile) = 0;
    // Writes the pages; the first page's file name, or the empty text when there are no items.
    virtual Result<QString> CreateCatHTML(const QString &pagePrefix, const QString &dbFile,
                                          const QString &imagesFolder) = 0;
    virtual Status CreateCSS(const QString &outputFolder, bool replace) = 0;
    virtual Status CreateListHTML(const QString &fileName, const QString &dbFile) = 0;
};

} // namespace zorbin
