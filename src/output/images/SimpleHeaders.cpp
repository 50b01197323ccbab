// The formats whose size stands at a fixed place in the header: PNG, GIF and BMP.
#include "output/images/HeaderBytes.h"
#include "output/images/PictureHeaders.h"

#include <limits>

namespace zorbin::images {
namespace {

constexpr std::uint32_t LargestSide = std::numeric_limits<std::int32_t>::max();

ImageInfo sized(std::uint8_t kind, std::uint32_t width, std::uint32_t height)
{
    if (width > LargestSide || height > LargestSide)
        return {};
    return {kind, static_cast<std::int32_t>(width), static_cast<std::int32_t>(height)};
}

bool isPngColourType(std::uint8_t type)
{
    return type == 0 || type == 2 || type == 3 || type == 4 || type == 6;
}

} // namespace

ImageInfo ReadPNGInfo(HeaderBytes &bytes)
{
    const auto width = bytes.uint32BE(16);
    const auto height = bytes.uint32BE(20);
    const auto colourType = bytes.byteAt(25);
    if (!width || !height || !colourType || !isPngColourType(*colourType))
        return {};
    return sized(ImageInfo::PNG, *width, *height);
}

ImageInfo ReadGIFInfo(HeaderBytes &bytes)
{
    const auto width = bytes.uint16LE(6);
    const auto height = bytes.uint16LE(8);
    if (!width || !height)
        return {};
    return sized(ImageInfo::GIF, *width, *height);
}

ImageInfo ReadBMPInfo(HeaderBytes &bytes)
{
    // The size of the bitmap header tells its layout: 12 bytes for the old core header with
    // 16-bit sides, 40 or more for the headers with signed 32-bit sides.
    constexpr std::uint32_t CoreHeaderSize = 12;
    const auto headerSize = bytes.uint32LE(14);
    if (!headerSize)
        return {};
    if (*headerSize == CoreHeaderSize) {
        const auto width = bytes.uint16LE(18);
        const auto height = bytes.uint16LE(20);
        if (!width || !height)
            return {};
        return sized(ImageInfo::BMP, *width, *height);
    }
    const auto width = bytes.uint32LE(18);
    const auto height = bytes.uint32LE(22);
    if (!width || !height)
        return {};
    const auto signedHeight = static_cast<std::int32_t>(*height);
    // A top-down picture stores its height negative; the lowest value has no positive partner.
    if (signedHeight == std::numeric_limits<std::int32_t>::min())
        return {};
    return sized(ImageInfo::BMP, *width,
                 static_cast<std::uint32_t>(signedHeight < 0 ? -signedHeight : signedHeight));
}

} // namespace zorbin::images
