#include "web/ThumbnailImages.h"

#include "output/ImageDimensions.h"

#include <QBuffer>
#include <QImageReader>
#include <QImageWriter>
#include <QPainter>

namespace zorbin {
namespace {

constexpr int JpegQuality = 80;

// A picture's transparent parts on white: JPEG has no transparency, and a browser would show
// the black that the colour values hold there.
QImage onWhite(const QImage &image)
{
    if (!image.hasAlphaChannel())
        return image.convertToFormat(QImage::Format_RGB32);
    QImage flat(image.size(), QImage::Format_RGB32);
    flat.fill(Qt::white);
    QPainter painter(&flat);
    painter.drawImage(0, 0, image);
    painter.end();
    return flat;
}

QImage scaledTo(const QImage &image, QSize size)
{
    if (image.size() == size)
        return image;
    return image.scaled(size, Qt::IgnoreAspectRatio, Qt::SmoothTransformation);
}

} // namespace

QSize fittedThumbnailSize(QSize picture, QSize box)
{
    ImageInfo info;
    info.Kind = ImageInfo::PNG; // any recognised kind: only the size takes part in fitting
    info.Width = picture.width();
    info.Height = picture.height();
    return fittedImageSize(info, box.width(), box.height()).value_or(QSize(1, 1));
}

std::optional<ThumbnailImages> makeThumbnailImages(const QByteArray &bytes, QSize box)
{
    QBuffer buffer;
    buffer.setData(bytes);
    if (!buffer.open(QIODevice::ReadOnly))
        return std::nullopt;
    QImageReader reader(&buffer);
    reader.setAutoTransform(true);
    QSize upright = reader.size();
    if (upright.isValid() && !upright.isEmpty()) {
        // The decoder scales the picture as it is stored; the turn comes after.
        const bool turned = reader.transformation().testFlag(QImageIOHandler::TransformationRotate90);
        if (turned)
            upright.transpose();
        const QSize decoded = fittedThumbnailSize(upright, box * 2) * 2;
        if (decoded.width() < upright.width() && decoded.height() < upright.height())
            reader.setScaledSize(turned ? decoded.transposed() : decoded);
    }
    const QImage image = reader.read();
    if (image.isNull() || image.width() <= 0 || image.height() <= 0)
        return std::nullopt;
    if (!upright.isValid() || upright.isEmpty())
        upright = image.size();
    const QImage flat = onWhite(image);
    // Fitted from the picture's own size, as the classic pages fit it, not from the decoded one.
    const QSize single = fittedThumbnailSize(upright, box);
    const QSize twice = fittedThumbnailSize(upright, box * 2);
    ThumbnailImages made;
    made.single = scaledTo(flat, single);
    if (twice != single)
        made.twice = scaledTo(flat, twice);
    return made;
}

QByteArray thumbnailJpeg(const QImage &image)
{
    QByteArray bytes;
    QBuffer buffer(&bytes);
    if (!buffer.open(QIODevice::WriteOnly))
        return {};
    QImageWriter writer(&buffer, "jpeg");
    writer.setQuality(JpegQuality);
    writer.setProgressiveScanWrite(true);
    if (!writer.write(image))
        return {};
    return bytes;
}

} // namespace zorbin
