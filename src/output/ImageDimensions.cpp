#include "output/ImageDimensions.h"

#include "common/Numbers.h"
#include "output/images/HeaderBytes.h"
#include "output/images/PictureHeaders.h"
#include "platform/FileSystem.h"

#include <QIODevice>
#include <algorithm>
#include <array>

namespace zorbin {

using images::HeaderBytes;

ImageInfo GetImageInfo(QIODevice &device)
{
    HeaderBytes bytes(device);
    ImageInfo result;
    if (const std::uint8_t *head = bytes.bytesAt(0, 3)) {
        const std::array<std::uint8_t, 3> first{head[0], head[1], head[2]};
        if (first[0] == 137 && first[1] == 'P' && first[2] == 'N')
            result = images::ReadPNGInfo(bytes);
        else if (first[0] == 'G' && first[1] == 'I' && first[2] == 'F')
            result = images::ReadGIFInfo(bytes);
        else if (first[0] == 'B' && first[1] == 'M')
            result = images::ReadBMPInfo(bytes);
    }
    if (!result.recognised()) {
        if (const std::int64_t start = images::FindJPEGStart(bytes); start >= 0)
            result = images::ReadJPEGInfo(bytes, start);
    }
    return result;
}

ImageInfo GetImageInfo(const FileSystem &files, const QString &path)
{
    if (path.isEmpty())
        return {};
    auto device = files.openForReading(path);
    if (!device)
        return {};
    return GetImageInfo(*device.value());
}

ImageInfo GetImageInfo(const QString &path)
{
    return GetImageInfo(localFileSystem(), path);
}

std::optional<QSize> fittedImageSize(const ImageInfo &info, int maxWidth, int maxHeight)
{
    if (!info.recognised() || info.Width <= 0 || info.Height <= 0 || maxWidth <= 0 || maxHeight <= 0)
        return std::nullopt;
    const std::int32_t width = info.Width;
    const std::int32_t height = info.Height;
    if (width <= maxWidth && height <= maxHeight)
        return QSize(width, height);
    const double widthRatio = static_cast<double>(width) / maxWidth;
    const double heightRatio = static_cast<double>(height) / maxHeight;
    // The computed side of a very long, thin picture would round to 0 and hide it.
    auto scaled = [](double side, int limit) {
        return static_cast<int>(std::clamp<std::int64_t>(roundHalfEven(side), 1, limit));
    };
    if (widthRatio <= heightRatio)
        return QSize(scaled(static_cast<double>(width) / height * maxHeight, maxWidth), maxHeight);
    return QSize(maxWidth, scaled(static_cast<double>(height) / width * maxWidth, maxHeight));
}

QString ImageSizeAttr(const FileSystem &files, const QString &path, int maxWidth, int maxHeight)
{
    return ImageSizes(files).sizeAttr(path, maxWidth, maxHeight);
}

QString ImageSizeAttr(const QString &path, int maxWidth, int maxHeight)
{
    return ImageSizeAttr(localFileSystem(), path, maxWidth, maxHeight);
}

ImageSizes::ImageSizes(const FileSystem &files) : m_files(files) {}

ImageInfo ImageSizes::info(const QString &path)
{
    if (const auto known = m_known.constFind(path); known != m_known.cend())
        return known.value();
    ImageInfo info;
    if (!path.isEmpty() && m_files.fileExists(path)) {
        info = GetImageInfo(m_files, path);
        ++m_headersRead;
    }
    m_known.insert(path, info);
    return info;
}

QString ImageSizes::sizeAttr(const QString &path, int maxWidth, int maxHeight)
{
    if (maxWidth <= 0 || maxHeight <= 0)
        return {};
    const std::optional<QSize> size = fittedImageSize(info(path), maxWidth, maxHeight);
    if (!size)
        return {};
    return QStringLiteral(" width=%1 height=%2").arg(size->width()).arg(size->height());
}

} // namespace zorbin
