#include "output/ImageCollection.h"

#include "model/CatalogSettings.h"
#include "model/ProgressMeter.h"
#include "model/RunContext.h"
#include "output/CatalogQuery.h"
#include "output/FileNaming.h"
#include "output/PictureReference.h"
#include "output/images/PictureCopier.h"
#include "platform/FileSystem.h"
#include "workdb/WorkDatabase.h"

#include <QHash>
#include <QSqlError>
#include <QSqlRecord>
#include <QStringList>

namespace zorbin {
namespace {

// The picture references of the catalog items in catalog order; an empty list when no cell
// line shows the picture (the statement then has no ItemPic column).
Result<QStringList> pictureReferences(const CatalogSettings &settings, const QString &dbFile)
{
    const QString sql = BuildFinalSQL(settings);
    auto database = WorkDatabase::open(dbFile);
    if (!database)
        return database.status();
    QStringList references;
    {
        Result<QSqlQuery> query = database.value()->select(sql);
        if (!query)
            return query.status();
        const int column = query->record().indexOf(QStringLiteral("ItemPic"));
        if (column < 0)
            return references;
        while (query->next()) {
            const QVariant value = query->value(column);
            references << (value.isNull() ? QString() : value.toString());
        }
        // A read that fails ends the rows as their end does.
        if (const QSqlError error = query->lastError(); error.isValid())
            return Status::fault(error.text());
    }
    return references;
}

} // namespace

Status CollectCatImages(RunContext &context, const QString &imagesFolder, const QString &dbFile)
{
    ProgressMeter progress(context.user, context.state);
    progress.reset();
    images::PictureCopier copier(context.files, imagesFolder);

    const QString &logo = context.settings.logo;
    if (const std::optional<QString> source = logoSourceFile(context.files, logo)) {
        if (const Status copied = copier.copy(*source, ImageFileName(imagesFolder, logo)); !copied)
            return copied;
    }

    const Result<QStringList> references = pictureReferences(context.settings, dbFile);
    if (!references)
        return references.status();
    const auto total = static_cast<std::int64_t>(references->size());
    std::int64_t done = 0;
    QHash<QString, std::optional<QString>> sources;
    for (const QString &reference : references.value()) {
        ++done;
        // References are looked up literally: "?" marks an item without a picture, and no
        // reference is a pattern that could match some other file.
        if (namesPicture(reference)) {
            // Items share pictures: each reference is looked up once.
            auto known = sources.constFind(reference);
            if (known == sources.cend())
                known = sources.insert(reference, pictureSourceFile(context.files, reference));
            if (const std::optional<QString> &source = known.value()) {
                // The copy takes the name the pages give it, so that they find it wherever
                // file names are case-sensitive.
                if (const Status copied = copier.copy(*source, ImageFileName(imagesFolder, reference));
                    !copied)
                    return copied;
            }
        }
        // A stop leaves the bar where it is and keeps the copies made so far.
        if (progress.tick(done, total))
            return Status::ok();
    }
    progress.reset();
    return Status::ok();
}

} // namespace zorbin
