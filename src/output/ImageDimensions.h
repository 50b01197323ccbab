#pragma once

#include <QHash>
#include <QSize>
#include <QString>
#include <cstdint>
#include <optional>

class QIODevice;

namespace zorbin {

class FileSystem;

// The kind and pixel size of a picture, read from its file header without decoding it.
struct ImageInfo
{
    static constexpr std::uint8_t PNG = 1;
    static constexpr std::uint8_t GIF = 2;
    static constexpr std::uint8_t JPEG = 3;
    static constexpr std::uint8_t BMP = 4;
    static constexpr std::uint8_t Unknown = 255;

    std::uint8_t Kind = Unknown;
    // Pixels; 0 when the kind is unknown. Always 0 or more.
    std::int32_t Width = 0, Height = 0;

    bool recognised() const { return Kind != Unknown; }
    friend bool operator==(const ImageInfo &, const ImageInfo &) = default;
};

// How far into a file the start of a JPEG picture is looked for (see FindJPEGStart).
inline constexpr std::int64_t JpegSearchLimit = 64 * 1024;

// Reads the header of a PNG, GIF, BMP or JPEG picture from an open, random-access device
// (a file, or bytes in memory). Never fails: anything unreadable or unrecognised gives Kind
// Unknown with width and height 0. Reads only the header bytes it needs; for a JPEG that is
// not at the start of the data, it looks for the start within the first JpegSearchLimit bytes.
ImageInfo GetImageInfo(QIODevice &device);
// The same for a file; a file that is missing or cannot be opened gives Kind Unknown.
ImageInfo GetImageInfo(const FileSystem &files, const QString &path);
ImageInfo GetImageInfo(const QString &path); // on the local file system

// The size at which a picture is shown so that it fits a box of at most maxWidth by maxHeight
// pixels without distortion. A picture within the box keeps its size; a larger one is scaled
// down along its tighter side (a tie counts as the height), the other side rounded half to
// even and never below one pixel. Nothing when the picture is not recognised, has no size, or
// the box is not above 0 on both sides: the page then gives no size at all.
std::optional<QSize> fittedImageSize(const ImageInfo &info, int maxWidth, int maxHeight);

// The size attributes of an image element for a picture file: " width=W height=H" as fitted
// into the box, or the empty text when the file does not exist (looked up literally), is not a
// recognised picture, or the box is not above 0 on both sides.
QString ImageSizeAttr(const FileSystem &files, const QString &path, int maxWidth, int maxHeight);
QString ImageSizeAttr(const QString &path, int maxWidth, int maxHeight); // on the local file system

// ImageSizeAttr for one run of a page writer: each picture file's header is read at most once,
// however many items show it. The file system must outlive the object. Files are assumed not
// to change during the run.
class ImageSizes
{
public:
    explicit ImageSizes(const FileSystem &files);

    QString sizeAttr(const QString &path, int maxWidth, int maxHeight);
    // The picture's header as read (or remembered) for this run.
    ImageInfo info(const QString &path);

    // How many picture headers were read from files (each distinct existing path once).
    int headersRead() const { return m_headersRead; }

private:
    const FileSystem &m_files;
    QHash<QString, ImageInfo> m_known;
    int m_headersRead = 0;
};

} // namespace zorbin
