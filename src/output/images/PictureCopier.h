#pragma once

#include "common/Status.h"
#include "output/CopiedPictures.h"

#include <QHash>
#include <QString>

namespace zorbin {
class FileSystem;
}

namespace zorbin::images {

// Copies pictures into the images folder for one catalog run, and records each copy in the
// folder's record (CopiedPictures) right after making it, so that the next run deletes
// exactly these files. A source is copied to a name once per run, however many items show it;
// when two sources share a file name the later one replaces the copy, as it would when every
// item were copied in turn. The file system must outlive the copier.
class PictureCopier
{
public:
    PictureCopier(FileSystem &files, QString imagesFolder);

    // Copies the file `source` (an existing file) to `target` in the images folder.
    Status copy(const QString &source, const QString &target);

    // How many files were copied (for the benchmark and tests).
    int copies() const { return m_copies; }

private:
    FileSystem &m_files;
    CopiedPictures m_record;
    QHash<QString, QString> m_sourceOf; // target -> the source last copied there
    int m_copies = 0;
};

} // namespace zorbin::images
