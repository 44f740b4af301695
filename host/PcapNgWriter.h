#pragma once

#include "host/Descriptor.h"
#include "host/HostError.h"
#include "text/Bytes.h"
#include "text/Date.h"
#include "text/Result.h"

#include <cstdint>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <sys/types.h>

namespace pallax {

/// Writes a recording as pcapng, little-endian on every machine: one section, one interface, stamps
/// in nanoseconds. Each packet reaches the file before the next is taken, in one piece: a crash
/// loses at most the last one, and where a packet cannot be written whole (a full disk) the file is
/// cut back to the packet before.
///
/// A file is locked while it is written. A file that was there before keeps its content until the
/// first packet comes, and a new file that gets none is removed at the end.
class PcapNgWriter {
public:
    /// The largest packet that readers of captures accept.
    static constexpr std::size_t kLargestPacket = 262144;

    enum class Existing { Keep, Overwrite };

    /// `path` "-" is standard output. With Keep, a file that exists is an error; a file that
    /// another writer has locked always is.
    static Result<std::unique_ptr<PcapNgWriter>, HostError> create(const std::string& path,
                                                                   Existing existing);
    ~PcapNgWriter();
    PcapNgWriter(const PcapNgWriter&) = delete;
    PcapNgWriter& operator=(const PcapNgWriter&) = delete;

    /// What all packets are of: the interface's link type and name. Once, before the first of them.
    std::optional<HostError> begin(int linkType, std::string_view name);
    /// A packet of at most kLargestPacket bytes; a time before 1970 is written as 1970. Nothing
    /// when it is written, else why it is not; then nothing more can be written.
    std::optional<HostError> write(Time time, Bytes packet);
    /// Nothing while the path leads to what was written; else that the file was removed, moved,
    /// replaced or changed meanwhile, so that its packets may be lost.
    std::optional<HostError> interference() const;

    const std::string& name() const { return _name; } ///< the path; "standard output" for "-"
    /// False for standard output, pipes and devices, beside which no other file belongs.
    bool isFile() const { return _isFile; }
    std::uint64_t packets() const { return _packets; }
    /// Bytes in the file.
    std::uint64_t size() const { return _size; }
    /// How many bytes a packet of `length` bytes takes.
    static std::uint64_t sizeOfPacket(std::size_t length);

private:
    PcapNgWriter(std::string name, Descriptor file, int number)
        : _name(std::move(name)), _file(std::move(file)), _number(number) {}
    std::optional<HostError> open(bool isNew);
    std::optional<HostError> beginSection();
    std::optional<std::uint64_t> sizeInPlace() const;
    std::optional<HostError> put(const ByteBuffer& block);

    std::string _name;
    Descriptor _file;     // empty for standard output
    int _number;          // of the descriptor that is written to
    bool _isFile = false; // a regular one
    dev_t _device = 0;    // which one
    ino_t _inode = 0;
    bool _isNew = false;   // made here
    bool _isBegun = false; // what was in it before is gone
    std::uint64_t _size = 0;
    std::uint64_t _packets = 0;
};

} // namespace pallax
