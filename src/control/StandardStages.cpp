#include "control/StandardStages.h"

#include "model/RunContext.h"
#include "output/CatalogPages.h"
#include "output/ImageCollection.h"
#include "output/ListPage.h"
#include "output/Stylesheet.h"
#include "source/ChoiceLists.h"
#include "source/ConnectionStore.h"
#include "workdb/CollectionRun.h"

namespace zorbin {
namespace {

class StandardStages final : public CatalogStages
{
public:
    StandardStages(RunContext &context, SettingsStore &store) : m_context(context), m_store(store) {}

    void GetRegConnParams() override { zorbin::GetRegConnParams(m_store, m_context.connection); }
    void FillCmbExtraNote() override { zorbin::FillCmbExtraNote(m_context.connection, m_context.settings); }
    void FillCmbPriceField() override { zorbin::FillCmbPriceField(m_context.connection, m_context.settings); }
    Status BuildAndCollectData() override { return zorbin::BuildAndCollectData(m_context); }
    Status CollectCatImages(const QString &imagesFolder, const QString &dbFile) override
    {
        return zorbin::CollectCatImages(m_context, imagesFolder, dbFile);
    }
    Result<QString> CreateCatHTML(const QString &pagePrefix, const QString &dbFile,
                                  const QString &imagesFolder) override
    {
        return zorbin::CreateCatHTML(m_context, pagePrefix, dbFile, imagesFolder);
    }
    Status CreateCSS(const QString &outputFolder, bool replace) override
    {
        return zorbin::CreateCSS(m_context, outputFolder, replace);
    }
    Status CreateListHTML(const QString &fileName, const QString &dbFile) override
    {
        return zorbin::CreateListHTML(m_context, fileName, dbFile);
    }

private:
    RunContext &m_context;
    SettingsStore &m_store;
};

} // namespace

std::unique_ptr<CatalogStages> makeStandardStages(RunContext &context, SettingsStore &store)
{
    return std::make_unique<StandardStages>(context, store);
}

} // namespace zorbin
