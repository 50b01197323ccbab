#include "control/StandardStages.h"

#include "model/RunContext.h"
#include "output/CatalogPages.h"
#include "output/ImageCollection.h"
#include "output/ListPage.h"
#include "output/Stylesheet.h"
#include "source/ChoiceLists.h"
#include "source/ConnectionStore.h"

namespace zorbin {
namespace {

class StandardStages final : public CatalogStages
{
public:
    explicit StandardStages(SettingsStore &store) : m_store(store) {}

    void GetRegConnParams(RunContext &context) override
    {
        zorbin::GetRegConnParams(m_store, context.connection);
    }
    void FillCmbExtraNote(RunContext &context) override
    {
        zorbin::FillCmbExtraNote(context.connection, context.settings);
    }
    void FillCmbPriceField(RunContext &context) override
    {
        zorbin::FillCmbPriceField(context.connection, context.settings);
    }
    Result<CollectionReport> BuildAndCollectData(RunContext &context) override
    {
        return zorbin::BuildAndCollectData(context);
    }
    Status CollectCatImages(RunContext &context, const QString &imagesFolder, const QString &dbFile) override
    {
        return zorbin::CollectCatImages(context, imagesFolder, dbFile);
    }
    Result<QString> CreateCatHTML(RunContext &context, const QString &pagePrefix, const QString &dbFile,
                                  const QString &imagesFolder) override
    {
        return zorbin::CreateCatHTML(context, pagePrefix, dbFile, imagesFolder);
    }
    Status CreateCSS(RunContext &context, const QString &outputFolder, bool replace) override
    {
        return zorbin::CreateCSS(context, outputFolder, replace);
    }
    Status CreateListHTML(RunContext &context, const QString &fileName, const QString &dbFile) override
    {
        return zorbin::CreateListHTML(context, fileName, dbFile);
    }
    Result<PdfWritten> CreateCatPDF(RunContext &context, const PdfRequest &request) override
    {
        return zorbin::CreateCatPDF(context, request);
    }
    Result<QString> CreateCatSite(RunContext &context, const SiteRequest &request) override
    {
        return zorbin::CreateCatSite(context, request);
    }

private:
    SettingsStore &m_store;
};

} // namespace

std::unique_ptr<CatalogStages> makeStandardStages(SettingsStore &store)
{
    return std::make_unique<StandardStages>(store);
}

} // namespace zorbin
