#pragma once

#include "decoding/RecordingDecoder.h"
#include "host/Recording.h"
#include "text/Date.h"
#include "text/Result.h"

#include <cstdint>
#include <map>
#include <string>
#include <vector>

namespace pallax {

/// What a recording is, in digests (SHA-256, in hexadecimal digits): they show damage, and a
/// decoder that has changed. Anyone can compute them, so they do not show forgery.
struct RecordingDigest {
    /// The packets of a block, except for the last.
    static constexpr std::uint64_t kPacketsOfBlock = 1024;

    /// Of a minute of recording time, counted from the first packet, and the name of a field. What
    /// cannot be read has the name `kUnreadable`.
    struct Decoded {
        std::int64_t minute;
        std::string field;

        friend auto operator<=>(const Decoded&, const Decoded&) = default;
    };
    static constexpr const char* kUnreadable = "unreadable";

    std::string decoder;    ///< the version that has decoded it
    std::string technology; ///< the name on the command line
    std::uint64_t packets = 0;
    Time first = {};                        ///< of the first packet
    std::vector<std::string> blocks;        ///< of stamps, lengths and bytes
    std::map<Decoded, std::string> decoded; ///< of the values that were read, with their packets
};

/// Reads the recording to its end. An error if that cannot be reached, or nothing can decode it.
Result<RecordingDigest, RecordingError> digestOf(Recording& recording,
                                                 const DecoderEnvironment& environment);

} // namespace pallax
