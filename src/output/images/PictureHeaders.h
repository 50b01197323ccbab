#pragma once

#include "output/ImageDimensions.h"

#include <cstdint>

namespace zorbin::images {

class HeaderBytes;

// The readers of the four picture formats. Each is given the whole file and returns the
// format's Kind with the size from its header, or Kind Unknown (size 0) when the header is cut
// short or invalid. GetImageInfo decides which to run from the first bytes.

// PNG: the 32-bit big-endian width and height of the header chunk; colour type 0, 2, 3, 4 or 6.
ImageInfo ReadPNGInfo(HeaderBytes &bytes);
// GIF: the 16-bit little-endian logical screen size.
ImageInfo ReadGIFInfo(HeaderBytes &bytes);
// BMP: the 32-bit little-endian width and height of the bitmap header (the height of a
// top-down picture is stored negative), or the 16-bit ones of the old 12-byte core header.
ImageInfo ReadBMPInfo(HeaderBytes &bytes);

// The position of the JPEG start marker sequence FF D8 FF, looked for from the start of the
// file up to JpegSearchLimit; -1 when there is none within that reach.
std::int64_t FindJPEGStart(HeaderBytes &bytes);
// JPEG: walks the marker segments from the start marker at `start` to the first frame header
// (markers C0 to CF except C4, C8 and CC) and reads its 16-bit big-endian height and width.
ImageInfo ReadJPEGInfo(HeaderBytes &bytes, std::int64_t start);

} // namespace zorbin::images
