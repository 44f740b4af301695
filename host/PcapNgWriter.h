#pragma once

#include "host/Descriptor.h"
#include "host/HostError.h"
#include "platform/Bytes.h"
#include "platform/Date.h"
#include "platform/Result.h"

#include <cstdint>
#include <map>
#include <memory>
#include <optional>
#include <string>
#include <string_view>

namespace pallax {

/// Writes a recording as pcapng, little-endian on every machine: one section, an interface for
/// each technology from its first packet on, stamps in nanoseconds. Each packet reaches the file
/// before the next is taken, in one piece: a crash loses at most the last one, and where a packet
/// cannot be written whole (a full disk) the file is cut back to the packet before.
class PcapNgWriter {
public:
    /// The largest packet that readers of captures accept.
    static constexpr std::size_t kLargestPacket = 262144;

    enum class Existing { Keep, Overwrite };

    /// `path` "-" is standard output. With Keep, a file that exists is an error.
    static Result<std::unique_ptr<PcapNgWriter>, HostError> create(const std::string& path,
                                                                   Existing existing);
    ~PcapNgWriter() = default;
    PcapNgWriter(const PcapNgWriter&) = delete;
    PcapNgWriter& operator=(const PcapNgWriter&) = delete;

    /// The number of the interface with that link type and name, which is added when it is new.
    Result<std::uint32_t, HostError> interfaceFor(int linkType, std::string_view name);
    /// A packet of at most kLargestPacket bytes; a time before 1970 is written as 1970. Nothing
    /// when it is written, else why it is not; then nothing more can be written.
    std::optional<HostError> write(std::uint32_t interface, Time time, Bytes packet);

    /// Bytes in the file.
    std::uint64_t size() const { return _size; }
    /// How many bytes a packet of `length` bytes takes.
    static std::uint64_t sizeOfPacket(std::size_t length);

private:
    PcapNgWriter(std::string name, Descriptor file, int number)
        : _name(std::move(name)), _file(std::move(file)), _number(number) {}
    std::optional<HostError> put(const ByteBuffer& block);

    std::string _name;
    Descriptor _file; // empty for standard output
    int _number;      // of the descriptor that is written to
    std::uint64_t _size = 0;
    std::map<std::string, std::uint32_t, std::less<>> _interfaces; // numbers by name
};

} // namespace pallax
