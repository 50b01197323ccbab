#pragma once

#include <QByteArray>
#include <QImage>
#include <QSize>
#include <optional>

namespace zorbin {

// The two thumbnails of one picture, ready to be written.
struct ThumbnailImages
{
    QImage single; // fitted into the box: the picture as a page shows it
    QImage twice;  // fitted into twice the box, for screens of two pixels a point; null when
                   // the picture is no larger than `single`
};

// The size at which a picture of `picture` pixels fits `box` without distortion, as the
// classic pages size it: unchanged when it fits, never enlarged. Both sides above 0.
QSize fittedThumbnailSize(QSize picture, QSize box);

// Decodes a picture from its file's bytes and makes its thumbnails: turned as its EXIF
// orientation says, fitted into `box` and into twice `box`, transparent parts on white. The
// decoder is asked for twice the larger thumbnail's size (a JPEG is then decoded at a fraction
// of its size), and the thumbnails are scaled smoothly from that. Nothing when the bytes are
// not a picture that can be decoded. `box` must be above 0 on both sides.
std::optional<ThumbnailImages> makeThumbnailImages(const QByteArray &bytes, QSize box);

// A thumbnail as the bytes of a JPEG file: quality 80, progressive. Empty when encoding failed.
QByteArray thumbnailJpeg(const QImage &image);

} // namespace zorbin
