#pragma once

#include "host/DirectoryResources.h"
#include "masking/PacketMask.h"
#include "platform/RecordedTechnology.h"
#include "tests/doubles/RecordBuilder.h"

#include <string>
#include <string_view>

namespace pallax {

inline constexpr LogCode kSimFiles = 0xFF0000;

/// The plan for a technology by its name on the command line.
inline MaskPlan planFor(std::string_view technology, const MaskChoice& choice = {}) {
    const DirectoryResources resources(PALLAX_SOURCE_DIR "/resources");
    return {*technologyOfCommandName(technology), resources, choice};
}

inline ByteBuffer bytesOfText(std::string_view text) {
    return {text.begin(), text.end()};
}
inline std::string textOfBytes(Bytes bytes) {
    return {bytes.begin(), bytes.end()};
}

/// Keys of the lengths that key files have.
inline Replacement keyed(std::uint8_t seed) {
    constexpr std::size_t kLength = 32;
    return Replacement(ByteBuffer(kLength, seed));
}

/// The packet, masked with zeros, or as told.
struct MaskedPacket {
    ByteBuffer bytes;
    MaskReport report;
};
inline MaskedPacket masked(std::string_view technology, ByteBuffer packet,
                           const MaskChoice& choice = {},
                           const Replacement& identities = Replacement()) {
    const MaskPlan plan = planFor(technology, choice);
    const Replacements replacements{identities, keyed(7)};
    MaskedPacket result{std::move(packet), {}};
    PacketMask(plan, replacements).mask(result.bytes, result.report);
    return result;
}

} // namespace pallax
