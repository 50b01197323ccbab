#pragma once

#include "common/Status.h"

#include <QByteArray>
#include <QByteArrayView>
#include <QFile>
#include <cstdint>
#include <memory>
#include <vector>

namespace zorbin {

// A file of records written into numbered streams in any interleaving and read back stream by
// stream, each stream in the order its records were written. The site's first pass writes each
// item into the stream of its section; the second pass, which writes the sections one after
// the other, then reads every stream from start to end in large blocks.
//
// Records wait in memory per stream and go to the file as a block when a stream has a block's
// worth or all waiting records pass a limit, so memory stays within a few megabytes whatever
// the number of records.
class ItemSpool
{
public:
    // Creates the file, replacing one of that name. The file is the caller's to remove.
    static Result<std::unique_ptr<ItemSpool>> create(const QString &path);

    // Appends a record to stream `stream` (from 0; streams are made as they are named).
    Status append(std::size_t stream, QByteArrayView record);
    // Writes the records still waiting; call once, after the last append().
    Status finish();
    // The next record of `stream`, valid until the next call; fails at the end of the stream.
    Result<QByteArrayView> next(std::size_t stream);

private:
    struct Block
    {
        qint64 offset = 0;
        qint64 size = 0;
    };
    struct Stream
    {
        QByteArray waiting;        // records not yet in the file
        std::vector<Block> blocks; // in the file, in order
        std::size_t block = 0;     // the block being read
        qsizetype at = 0;          // where its next record starts
    };

    explicit ItemSpool(const QString &path);
    Status write(Stream &stream);
    Status load(std::size_t stream, std::size_t block);
    Status failure() const;

    QFile m_file;
    std::vector<Stream> m_streams;
    qint64 m_waitingBytes = 0;
    qint64 m_end = 0;   // the file's size
    QByteArray m_block; // the block read last, of stream m_loaded.first, number m_loaded.second
    std::pair<std::size_t, std::size_t> m_loaded{SIZE_MAX, SIZE_MAX};
};

} // namespace zorbin
