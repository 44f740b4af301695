#pragma once

#include "host/Descriptor.h"
#include "host/EmbeddedDigests.h"
#include "host/FileIdentity.h"
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
/// in nanoseconds. Each packet is written to the file in one piece before the next is taken: a
/// crash loses at most the last one, and if a packet cannot be written completely (a full disk) the
/// file is cut back to the previous packet.
///
/// A block with a digest follows every 1,024 packets and the last one (EmbeddedDigests).
///
/// A new file can be read by its user alone (0600). The file is locked while it is written. An
/// existing file keeps its content until the first packet arrives, and a new file that gets none is
/// removed at the end.
class PcapNgWriter {
public:
    /// The largest packet that capture readers accept.
    static constexpr std::size_t kLargestPacket = 262144;

    enum class Existing { Keep, Overwrite };

    /// `path` "-" is standard output. With Keep, an existing file is an error; a file locked by
    /// another writer always is.
    static Result<std::unique_ptr<PcapNgWriter>, HostError> create(const std::string& path,
                                                                   Existing existing);
    ~PcapNgWriter();
    PcapNgWriter(const PcapNgWriter&) = delete;
    PcapNgWriter& operator=(const PcapNgWriter&) = delete;

    /// Sets the interface's link type and name, for all packets. Once, before the first packet.
    std::optional<HostError> begin(int linkType, std::string_view name);
    /// Writes a packet of at most kLargestPacket bytes; a time before 1970 is written as 1970.
    /// Returns nothing on success, otherwise an error; then nothing more can be written.
    std::optional<HostError> write(Time time, Bytes packet);
    /// Writes the digest that ends the recording, if it has packets; then nothing more may be
    /// written. A recording that failed has no end.
    std::optional<HostError> finish();
    /// Nothing if the path still leads to the unchanged file; otherwise an error that the file was
    /// removed, moved, replaced or changed, so packets may be lost.
    std::optional<HostError> interference() const;

    const std::string& name() const { return _name; } ///< the path; "standard output" for "-"
    /// False for standard output, pipes and devices, which cannot have further files next to them.
    bool isFile() const { return _isFile; }
    std::uint64_t packets() const { return _packets; }
    /// Bytes in the file.
    std::uint64_t size() const { return _size; }
    /// The bytes in the file for a packet of `length` bytes.
    static std::uint64_t sizeOfPacket(std::size_t length);
    /// The bytes in the file if it ends after another packet.
    std::uint64_t sizeWith(std::size_t length) const;

private:
    PcapNgWriter(std::string name, Descriptor file, int number)
        : _name(std::move(name)), _file(std::move(file)), _number(number) {}
    std::optional<HostError> open(bool isNew);
    std::optional<HostError> beginSection();
    std::optional<std::uint64_t> sizeInPlace() const;
    std::optional<HostError> put(const ByteBuffer& block);
    std::optional<HostError> putHashed(const ByteBuffer& block, bool isPacket = false);

    std::string _name;
    Descriptor _file;     // empty for standard output
    int _number;          // the descriptor for writing
    bool _isFile = false; // it is a regular file
    FileIdentity _identity;
    bool _isNew = false;   // this writer created it
    bool _isBegun = false; // its old content is gone
    std::uint64_t _size = 0;
    std::uint64_t _packets = 0;
    EmbeddedDigests _digests;
    bool _hasFailed = false;
};

} // namespace pallax
