#include "output/OutputFolder.h"

#include "model/CatalogSettings.h"
#include "output/CopiedPictures.h"
#include "platform/FileSystem.h"
#include "platform/Paths.h"

#include <QRegularExpression>

namespace zorbin {

QString outputFolderOf(const CatalogSettings &settings)
{
    const QString folder = settings.outputFolder.isEmpty() ? temporaryFolder() : settings.outputFolder;
    return withTrailingSeparator(folder);
}

QString imagesFolderOf(const QString &outputFolder)
{
    return withTrailingSeparator(outputFolder) + ImagesFolderName;
}

Status ensureFolder(FileSystem &files, const QString &folder)
{
    if (files.folderExists(folder))
        return Status::ok();
    return files.makeFolder(folder);
}

bool isCatalogPageName(const QString &fileName)
{
    static const QRegularExpression pages(QStringLiteral("^zo(index|\\d{6,})\\.htm$"),
                                          QRegularExpression::CaseInsensitiveOption);
    return pages.match(fileName).hasMatch() || fileName.compare(ListPageName, Qt::CaseInsensitive) == 0;
}

Status cleanCatalogOutput(FileSystem &files, const QString &outputFolder)
{
    const QString folder = withTrailingSeparator(outputFolder);
    for (const QString &name : files.fileNames(folder)) {
        if (!isCatalogPageName(name))
            continue;
        if (const Status removed = files.removeFile(folder + name); !removed)
            return removed;
    }
    const QString images = imagesFolderOf(folder);
    if (const Status made = ensureFolder(files, images); !made)
        return made;
    return CopiedPictures::removeAll(files, images);
}

} // namespace zorbin
