#pragma once

#include "common/Status.h"

#include <QString>
#include <QStringList>

namespace zorbin {

class FileSystem;

// The hidden folder inside the site folder (site::StagingFolderName) where a run writes its
// pages, stylesheet, script and search index, so that the site in the folder stays whole
// until the run has written everything: only then do the new files take the old ones' place.
class SiteStaging
{
public:
    // Removes what a run that never finished left in the staging folder of `siteFolder` (an
    // existing folder) and makes the staging folder anew.
    static Result<SiteStaging> prepare(const QString &siteFolder);

    // The full path of a file in the staging folder.
    QString path(const QString &name) const;

    // Moves the staged files `names` into the site folder, each replacing the file of its name
    // at once (a reader sees the old file or the new, never none), then removes the site's files
    // (site::isSiteFileName) that this run did not write, and the staging folder. A failure
    // half way leaves a mixture of old and new pages, which the next run replaces.
    Status publish(FileSystem &files, const QStringList &names) const;
    // Removes the staging folder and everything in it; the site folder is as it was.
    void discard() const;

private:
    SiteStaging(QString siteFolder, QString staging);

    QString m_siteFolder; // each with a separator at its end
    QString m_staging;
};

} // namespace zorbin
