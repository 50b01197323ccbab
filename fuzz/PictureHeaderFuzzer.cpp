// Feeds arbitrary bytes to the picture header reader, from memory, and checks what it promises:
// it never fails, an unrecognised picture has no size, and a fitted size lies within the box.
#include "output/ImageDimensions.h"

#include <QBuffer>
#include <cstddef>
#include <cstdint>
#include <cstdlib>

namespace {

void require(bool condition)
{
    if (!condition)
        std::abort();
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t *data, std::size_t size)
{
    QByteArray bytes =
        QByteArray::fromRawData(reinterpret_cast<const char *>(data), static_cast<qsizetype>(size));
    QBuffer buffer(&bytes);
    buffer.open(QIODevice::ReadOnly);
    const zorbin::ImageInfo info = zorbin::GetImageInfo(buffer);

    require(info.Width >= 0 && info.Height >= 0);
    if (!info.recognised())
        require(info.Width == 0 && info.Height == 0);
    if (const auto fitted = zorbin::fittedImageSize(info, 120, 90)) {
        require(fitted->width() >= 1 && fitted->width() <= 120);
        require(fitted->height() >= 1 && fitted->height() <= 90);
    }
    return 0;
}
