#include "output/images/PictureCopier.h"

#include "platform/FileSystem.h"

#include <QFileInfo>

namespace zorbin::images {

PictureCopier::PictureCopier(FileSystem &files, QString imagesFolder)
    : m_files(files), m_record(files, std::move(imagesFolder))
{}

Status PictureCopier::copy(const QString &source, const QString &target)
{
    const auto copied = m_sourceOf.constFind(target);
    if (copied != m_sourceOf.cend() && copied.value() == source)
        return Status::ok();
    // A picture that already lives in the images folder under its own name is no copy: the
    // record would have the next run delete the original.
    if (QFileInfo(source).absoluteFilePath() == QFileInfo(target).absoluteFilePath())
        return Status::ok();
    if (const Status status = m_files.copyFile(source, target); !status)
        return status;
    ++m_copies;
    if (copied == m_sourceOf.cend()) {
        if (const Status recorded = m_record.add(QFileInfo(target).fileName()); !recorded)
            return recorded;
    }
    m_sourceOf.insert(target, source);
    return Status::ok();
}

} // namespace zorbin::images
