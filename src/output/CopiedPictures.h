#pragma once

#include "common/Status.h"

#include <QIODevice>
#include <QString>
#include <QStringList>
#include <memory>

namespace zorbin {

class FileSystem;

// The record, kept in the images folder, of the pictures that catalog runs copied there, one
// file name per line (UTF-8). The next catalog run deletes exactly these files, so pictures
// that somebody else put into the folder survive while no copy of an earlier run remains.
// Each name is added as soon as its copy is made, so a run that stops or fails half way still
// leaves a complete record.
class CopiedPictures
{
public:
    static inline const QString RecordName = QStringLiteral("zorbin-copies.lst");

    static QString recordPath(const QString &imagesFolder);
    static QStringList read(const FileSystem &files, const QString &imagesFolder);
    // Deletes every recorded file, then the record.
    static Status removeAll(FileSystem &files, const QString &imagesFolder);

    // Adds names to the record of `imagesFolder`.
    CopiedPictures(FileSystem &files, QString imagesFolder);
    Status add(const QString &fileName);

private:
    FileSystem &m_files;
    QString m_imagesFolder;
    std::unique_ptr<QIODevice> m_record;
};

} // namespace zorbin
