#pragma once

#include "host/HostError.h"
#include "text/Bytes.h"
#include "text/Date.h"
#include "text/Result.h"

#include <cstdio>
#include <future>
#include <memory>
#include <optional>
#include <string>

namespace pallax {

/// Writes a recording: pcap with nanosecond stamps, little-endian on every machine, so the same
/// packets give the same bytes. Each packet reaches the file before the next is taken, so that a
/// crash loses at most the last one, unless packets are to be written in blocks.
class RecordingWriter {
public:
    /// InBlocks: for packets that can be made again; `flush` has to follow the last one. A block is
    /// written while the packets of the next one are made; what goes wrong is told by the `write`
    /// that completes the next one, or by `flush`.
    enum class Flush { EachPacket, InBlocks };

    /// The largest packet that readers of captures accept.
    static constexpr std::size_t kLargestPacket = 262144;
    /// From so many bytes on a block is written. A thread is begun for each: smaller ones cost
    /// more.
    static constexpr std::size_t kBlockSize = std::size_t{1} << 20U;

    /// An existing file is replaced; `path` "-" is standard output.
    static Result<std::unique_ptr<RecordingWriter>, HostError>
    create(const std::string& path, int linkType, Flush flush = Flush::EachPacket);
    ~RecordingWriter();
    RecordingWriter(const RecordingWriter&) = delete;
    RecordingWriter& operator=(const RecordingWriter&) = delete;

    /// Nothing when the packet is written, or waits for its block; else why it is not, and the
    /// recording is as before where the packet was refused for its size or time (1970 to 2106).
    std::optional<HostError> write(Time time, Bytes packet);
    /// Brings everything to the file.
    std::optional<HostError> flush();

private:
    RecordingWriter(std::string name, std::FILE* file, Flush flush)
        : _name(std::move(name)), _file(file), _flush(flush) {}

    /// Has the pending packets written, which takes its time beside the caller's.
    std::optional<HostError> beginBlock();
    /// Waits for the block that is being written.
    std::optional<HostError> finishBlock();

    std::string _name;
    std::FILE* _file;
    Flush _flush;
    ByteBuffer _pending;
    ByteBuffer _block;         // is being written, or has been
    std::future<int> _writing; // gives errno, or 0
};

} // namespace pallax
