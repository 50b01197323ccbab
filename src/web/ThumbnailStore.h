#pragma once

#include "common/Status.h"
#include "web/ThumbnailRecord.h"

#include <QSet>
#include <QSize>
#include <QString>
#include <memory>

namespace zorbin {

// A picture as the pages show it.
struct Thumbnail
{
    QString file;      // the 1x file, relative to the site folder ("pictures/<name>.jpg")
    QString twiceFile; // the 2x file; empty when the picture is no larger than the 1x one
    QSize size;        // pixels of `file`: the width and height attributes of the image

    friend bool operator==(const Thumbnail &, const Thumbnail &) = default;
};

// The thumbnails of a site, in its pictures folder. A thumbnail's name is a hash of the
// picture's bytes and of the recipe (box, format, quality), so a changed picture or box gets a
// new name, and pictures with the same bytes share one. The cache record in the folder
// (ThumbnailRecord) maps each picture file, by its path, size and modification time, to its
// name: a picture that did not change is not read or decoded again.
//
// Works on the local file system. Files are written whole or not at all (a stop or a crash
// never leaves half a thumbnail under its name).
class ThumbnailStore
{
public:
    // The store of the site folder's pictures folder: creates the folder when missing and
    // reads the record (a missing or damaged one is empty). Fails when the folder cannot be made.
    static Result<std::unique_ptr<ThumbnailStore>> open(const QString &siteFolder);

    // The thumbnails of the picture file `source` (an existing file, a full path) fitted into
    // `box` (both sides above 0): the recorded ones when the file's size and time are as
    // recorded and the thumbnail files are there; otherwise made anew. A file that cannot be
    // read or decoded gets the placeholder. Fails only when a thumbnail cannot be written.
    Result<Thumbnail> thumbnailOf(const QString &source, QSize box);
    // The neutral placeholder shown at the size of `box`, for a picture that names no file.
    Result<Thumbnail> placeholder(QSize box);

    // Writes the record of the thumbnails used since open(); with `keepUnused` also the earlier
    // record's other entries, so that a run that did not finish loses nothing the next can reuse.
    Status saveRecord(bool keepUnused);
    // Deletes the thumbnails in the folder that were not used since open(), the placeholder
    // included; other files of the folder are left alone.
    Status removeUnused();

    // How many pictures were decoded since open().
    int decoded() const { return m_decoded; }

private:
    explicit ThumbnailStore(QString folder);
    Result<RecordedThumbnail> make(const QString &source, const QByteArray &bytes, const QString &recipe,
                                   QSize box);
    Result<Thumbnail> use(const QString &key, const RecordedThumbnail &entry);
    bool filesExist(const RecordedThumbnail &entry) const;
    Status writeFile(const QString &name, const QByteArray &bytes);

    QString m_folder; // with a separator at its end
    ThumbnailRecord m_earlier;
    ThumbnailRecord m_used;
    QSet<QString> m_usedFiles;
    int m_decoded = 0;
};

} // namespace zorbin
