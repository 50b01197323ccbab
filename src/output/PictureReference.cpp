#include "output/PictureReference.h"

#include "platform/FileSystem.h"

namespace zorbin {

bool namesPicture(const QString &reference)
{
    return !reference.isEmpty() && reference != NoPictureMark;
}

std::optional<QString> pictureSourceFile(const FileSystem &files, const QString &reference)
{
    if (!namesPicture(reference))
        return std::nullopt;
    return files.findFile(reference);
}

std::optional<QString> logoSourceFile(const FileSystem &files, const QString &logo)
{
    if (logo.isEmpty() || !files.fileExists(logo))
        return std::nullopt;
    return logo;
}

} // namespace zorbin
