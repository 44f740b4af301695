#pragma once

#include "host/CapturePieces.h"
#include "masking/IdentityFinder.h"
#include "masking/PacketMask.h"

#include <cstdint>
#include <functional>
#include <map>
#include <optional>
#include <string>

namespace pallax {

class Resources;

/// Something in a file that looks like a person's identity.
struct FileFind {
    std::uint64_t packet = 0; ///< from 1; 0 for a file without packets, or what is between them
    std::uint64_t byte = 0;   ///< of the packet or, without one, of the file's content
    std::string what;         ///< "IMSI in packed digits", or the name of a field

    std::string text() const; ///< "packet 17, byte 33: IMSI in packed digits"
};

/// Looks for identities anywhere in a file: in the fields that the registry marks, and in all
/// bytes, also those that are encoded in property lists. What `pallax mask` puts in their place is
/// not found. A file that is no recording is searched as its bytes.
class FileCheck {
public:
    using Found = std::function<void(const FileFind& find)>;

    FileCheck(const Resources& resources, Found found)
        : _resources(resources), _found(std::move(found)) {}

    /// Why the file cannot be searched to its end, if so.
    std::optional<RecordingError> run(RecordingContent content, const std::string& name);

private:
    std::optional<RecordingError> checkBytes(RecordingContent content, const std::string& name);
    void checkPacket(const CapturePiece& piece);
    /// The bytes, and what is encoded in them if they are a property list.
    void checkContent(Bytes bytes, std::uint64_t packet, std::uint64_t offset);
    const MaskPlan* planOf(std::int64_t linkType);

    const Resources& _resources;
    Found _found;
    std::map<std::int64_t, MaskPlan> _plans;
    std::uint64_t _packets = 0;
};

} // namespace pallax
