#pragma once

#include "common/Status.h"

#include <QHash>
#include <QSize>
#include <QString>

namespace zorbin {

// What is known of one picture's thumbnails: the picture file as it was when they were made,
// and their name.
struct RecordedThumbnail
{
    qint64 bytes = 0;    // the picture file's size
    qint64 modified = 0; // its modification time, milliseconds since the epoch
    QString name;        // the thumbnails' name without ".jpg"; empty: the placeholder stands in
    QSize size;          // pixels of the 1x thumbnail (of the placeholder: the box)
    bool twice = false;  // whether there is a 2x thumbnail ("<name>-2x.jpg")

    friend bool operator==(const RecordedThumbnail &, const RecordedThumbnail &) = default;
};

// The cache record of a thumbnail folder, one line per picture: its key (a hash of the
// picture's path and the recipe of its thumbnails, so that the record names no path), the
// file's size and time, the thumbnails' name, size and whether a 2x one exists. UTF-8 text.
using ThumbnailRecord = QHash<QString, RecordedThumbnail>;

// The record in the file; a missing file, and any line that is not a whole entry, is no entry:
// the picture is then made anew.
ThumbnailRecord readThumbnailRecord(const QString &path);
// Replaces the file with the record, whole or not at all.
Status writeThumbnailRecord(const QString &path, const ThumbnailRecord &record);

} // namespace zorbin
