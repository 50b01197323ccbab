#include "output/images/HeaderBytes.h"

#include <QIODevice>
#include <QtEndian>

namespace zorbin::images {

HeaderBytes::HeaderBytes(QIODevice &device) : m_device(device)
{
    if (device.isOpen() && device.isReadable() && !device.isSequential())
        m_size = device.size();
}

bool HeaderBytes::load(std::int64_t position, std::int64_t count)
{
    if (position < 0 || count < 0 || count > BlockSize || position > m_size - count)
        return false;
    const std::int64_t blockEnd = m_blockStart + m_block.size();
    if (position >= m_blockStart && position + count <= blockEnd)
        return true;
    m_block.clear();
    m_blockStart = position;
    if (!m_device.seek(position))
        return false;
    ++m_deviceReads;
    m_block = m_device.read(std::min(BlockSize, m_size - position));
    return m_block.size() >= count;
}

const std::uint8_t *HeaderBytes::bytesAt(std::int64_t position, std::int64_t count)
{
    if (!load(position, count))
        return nullptr;
    return reinterpret_cast<const std::uint8_t *>(m_block.constData()) + (position - m_blockStart);
}

std::optional<std::uint8_t> HeaderBytes::byteAt(std::int64_t position)
{
    const std::uint8_t *byte = bytesAt(position, 1);
    if (!byte)
        return std::nullopt;
    return *byte;
}

namespace {

// The unsigned number of type T stored at `bytes` in either byte order.
template <typename T> std::optional<T> number(const std::uint8_t *bytes, bool bigEndian)
{
    if (!bytes)
        return std::nullopt;
    return bigEndian ? qFromBigEndian<T>(bytes) : qFromLittleEndian<T>(bytes);
}

} // namespace

std::optional<std::uint16_t> HeaderBytes::uint16BE(std::int64_t position)
{
    return number<std::uint16_t>(bytesAt(position, 2), true);
}

std::optional<std::uint16_t> HeaderBytes::uint16LE(std::int64_t position)
{
    return number<std::uint16_t>(bytesAt(position, 2), false);
}

std::optional<std::uint32_t> HeaderBytes::uint32BE(std::int64_t position)
{
    return number<std::uint32_t>(bytesAt(position, 4), true);
}

std::optional<std::uint32_t> HeaderBytes::uint32LE(std::int64_t position)
{
    return number<std::uint32_t>(bytesAt(position, 4), false);
}

} // namespace zorbin::images
