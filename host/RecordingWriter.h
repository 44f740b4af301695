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
/// packets give the same bytes. Unless packets are written in blocks, each packet is in the file
/// before the next is taken, so a crash loses at most the last one.
class RecordingWriter {
public:
    /// InBlocks: for packets that can be generated again; call `flush` after the last one. A block
    /// is written while the packets of the next one are made; the `write` that completes the next
    /// one, or `flush`, returns its error.
    enum class Flush { EachPacket, InBlocks };

    /// The largest packet that capture readers accept.
    static constexpr std::size_t kLargestPacket = 262144;
    /// The size at which a block is written. Each block starts a thread; smaller blocks cost more.
    static constexpr std::size_t kBlockSize = std::size_t{1} << 20U;

    /// Replaces an existing file; `path` "-" is standard output.
    static Result<std::unique_ptr<RecordingWriter>, HostError>
    create(const std::string& path, int linkType, Flush flush = Flush::EachPacket);
    ~RecordingWriter();
    RecordingWriter(const RecordingWriter&) = delete;
    RecordingWriter& operator=(const RecordingWriter&) = delete;

    /// Nothing if the packet is written, or waits for its block; otherwise the error. A packet
    /// refused for its size or time (1970 to 2106) leaves the recording unchanged.
    std::optional<HostError> write(Time time, Bytes packet);
    /// Writes everything to the file.
    std::optional<HostError> flush();

private:
    RecordingWriter(std::string name, std::FILE* file, Flush flush)
        : _name(std::move(name)), _file(file), _flush(flush) {}

    /// Starts to write the pending packets, in parallel with the caller.
    std::optional<HostError> beginBlock();
    /// Waits until the block is written.
    std::optional<HostError> finishBlock();

    std::string _name;
    std::FILE* _file;
    Flush _flush;
    ByteBuffer _pending;
    ByteBuffer _block;         // being written, or written
    std::future<int> _writing; // the errno, or 0
};

} // namespace pallax
