#include "web/ItemSpool.h"

#include <QDir>
#include <cstring>

namespace zorbin {
namespace {

// A stream's records go to the file in blocks of this size, read back in one call each.
constexpr qsizetype BlockSize = 64 * 1024;
// All streams' waiting records together: past this, every stream writes what it holds.
constexpr qint64 WaitingLimit = 4 * 1024 * 1024;

using Length = qint32;

} // namespace

Result<std::unique_ptr<ItemSpool>> ItemSpool::create(const QString &path)
{
    std::unique_ptr<ItemSpool> spool(new ItemSpool(path));
    // Unbuffered: blocks are written and read whole, and a buffer would only copy them again.
    if (!spool->m_file.open(QIODevice::ReadWrite | QIODevice::Truncate | QIODevice::Unbuffered))
        return spool->failure();
    return spool;
}

ItemSpool::ItemSpool(const QString &path) : m_file(path) {}

Status ItemSpool::append(std::size_t stream, QByteArrayView record)
{
    if (stream >= m_streams.size())
        m_streams.resize(stream + 1);
    Stream &into = m_streams[stream];
    const auto length = static_cast<Length>(record.size());
    into.waiting.append(reinterpret_cast<const char *>(&length), sizeof length);
    into.waiting.append(record.data(), record.size());
    m_waitingBytes += static_cast<qint64>(sizeof length) + record.size();
    if (into.waiting.size() >= BlockSize)
        return write(into);
    if (m_waitingBytes > WaitingLimit)
        return finish();
    return Status::ok();
}

Status ItemSpool::finish()
{
    for (Stream &stream : m_streams) {
        if (const Status written = write(stream); !written)
            return written;
    }
    return Status::ok();
}

Status ItemSpool::write(Stream &stream)
{
    if (stream.waiting.isEmpty())
        return Status::ok();
    if (!m_file.seek(m_end) || m_file.write(stream.waiting) != stream.waiting.size())
        return failure();
    stream.blocks.push_back({m_end, stream.waiting.size()});
    m_end += stream.waiting.size();
    m_waitingBytes -= stream.waiting.size();
    stream.waiting.truncate(0);
    return Status::ok();
}

Result<QByteArrayView> ItemSpool::next(std::size_t stream)
{
    const auto ended = [this] {
        return Status::fault(
            QStringLiteral("הקובץ %1 נקטע באמצעו.").arg(QDir::toNativeSeparators(m_file.fileName())));
    };
    if (stream >= m_streams.size())
        return ended();
    Stream &from = m_streams[stream];
    if (from.block < from.blocks.size() && from.at >= from.blocks[from.block].size) {
        ++from.block;
        from.at = 0;
    }
    if (from.block >= from.blocks.size())
        return ended();
    if (m_loaded != std::pair(stream, from.block)) {
        if (const Status loaded = load(stream, from.block); !loaded)
            return loaded;
    }
    Length length = 0;
    std::memcpy(&length, m_block.constData() + from.at, sizeof length);
    const QByteArrayView record(m_block.constData() + from.at + sizeof length, length);
    from.at += static_cast<qsizetype>(sizeof length) + length;
    return record;
}

Status ItemSpool::load(std::size_t stream, std::size_t block)
{
    const Block &where = m_streams[stream].blocks[block];
    m_block.resize(where.size);
    m_loaded = {SIZE_MAX, SIZE_MAX};
    if (!m_file.seek(where.offset) || m_file.read(m_block.data(), m_block.size()) != m_block.size())
        return failure();
    m_loaded = {stream, block};
    return Status::ok();
}

Status ItemSpool::failure() const
{
    return Status::fault(QStringLiteral("לא ניתן לכתוב את הקובץ %1: %2")
                             .arg(QDir::toNativeSeparators(m_file.fileName()), m_file.errorString()));
}

} // namespace zorbin
