#pragma once

#include <QByteArray>
#include <cstdint>
#include <optional>

class QIODevice;

namespace zorbin::images {

// Random access to the bytes of a picture file for the header readers, through a block buffer:
// asking for one byte at a time costs a device read only when the byte lies outside the block
// read last. The device must be open for reading, allow seeking, and outlive this object.
class HeaderBytes
{
public:
    static constexpr std::int64_t BlockSize = 4096;

    explicit HeaderBytes(QIODevice &device);

    // The length of the data in bytes (0 for a device that cannot seek).
    std::int64_t size() const { return m_size; }

    // The byte at `position`; nothing beyond the end or when the device fails.
    std::optional<std::uint8_t> byteAt(std::int64_t position);
    // `count` bytes (at most BlockSize) from `position`; nothing when the data is shorter or the
    // device fails. The pointer is valid until the next call.
    const std::uint8_t *bytesAt(std::int64_t position, std::int64_t count);

    // Reads and unsigned numbers of 16 and 32 bits, big-endian ("BE") or little-endian ("LE").
    std::optional<std::uint16_t> uint16BE(std::int64_t position);
    std::optional<std::uint16_t> uint16LE(std::int64_t position);
    std::optional<std::uint32_t> uint32BE(std::int64_t position);
    std::optional<std::uint32_t> uint32LE(std::int64_t position);

    // How many times the device was read (for tests of the buffering).
    int deviceReads() const { return m_deviceReads; }

private:
    bool load(std::int64_t position, std::int64_t count);

    QIODevice &m_device;
    std::int64_t m_size = 0;
    QByteArray m_block;
    std::int64_t m_blockStart = 0;
    int m_deviceReads = 0;
};

} // namespace zorbin::images
