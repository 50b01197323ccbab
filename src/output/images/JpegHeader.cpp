#include "output/images/HeaderBytes.h"
#include "output/images/PictureHeaders.h"

#include <algorithm>
#include <array>

namespace zorbin::images {
namespace {

constexpr std::uint8_t MarkerPrefix = 0xFF;
constexpr std::uint8_t StartOfImage = 0xD8;

// The start-of-frame markers, which carry the picture's size: C0 to CF, except C4 (Huffman
// tables), C8 (reserved) and CC (arithmetic coding conditioning).
bool isFrameHeader(std::uint8_t marker)
{
    return marker >= 0xC0 && marker <= 0xCF && marker != 0xC4 && marker != 0xC8 && marker != 0xCC;
}

} // namespace

std::int64_t FindJPEGStart(HeaderBytes &bytes)
{
    // A JPEG file starts with the marker sequence at position 0; the search also accepts it a
    // little later, behind a small wrapper that some tools put before the picture. It stops at
    // JpegSearchLimit so that a large file of another kind (a video or an archive named like a
    // picture) is not read to its end. It reads through the block buffer, each byte once (but two
    // at each block's edge).
    const std::int64_t lastStart = std::min(bytes.size() - 3, JpegSearchLimit - 1);
    constexpr std::array<std::uint8_t, 3> startSequence{MarkerPrefix, StartOfImage, MarkerPrefix};
    std::int64_t position = 0;
    while (position <= lastStart) {
        const std::int64_t length = std::min(HeaderBytes::BlockSize, lastStart + 3 - position);
        const std::uint8_t *chunk = bytes.bytesAt(position, length);
        if (!chunk)
            return -1;
        const std::uint8_t *found =
            std::search(chunk, chunk + length, startSequence.begin(), startSequence.end());
        if (found != chunk + length)
            return position + (found - chunk);
        // The next chunk overlaps this one by two bytes: a sequence may straddle them.
        position += length - 2;
    }
    return -1;
}

ImageInfo ReadJPEGInfo(HeaderBytes &bytes, std::int64_t start)
{
    const std::int64_t last = bytes.size() - 1;
    // `position` is at a marker prefix, a fill byte, or a marker code; every step moves it on
    // by at least one byte, so the walk ends at the frame header or the end of the data.
    std::int64_t position = start + 2;
    if (position > last)
        return {};
    for (;;) {
        const auto byte = bytes.byteAt(position);
        if (!byte)
            return {};
        if (isFrameHeader(*byte))
            break;
        if (*byte != MarkerPrefix) {
            // A segment: its big-endian length counts the two length bytes and its data.
            const auto length = bytes.uint16BE(position + 1);
            if (!length)
                return {};
            position += *length;
        }
        ++position;
        if (position > last)
            return {};
    }
    // The frame header: length (2 bytes), sample precision (1), height (2), width (2).
    const auto height = bytes.uint16BE(position + 4);
    const auto width = bytes.uint16BE(position + 6);
    if (!height || !width)
        return {};
    return {ImageInfo::JPEG, *width, *height};
}

} // namespace zorbin::images
