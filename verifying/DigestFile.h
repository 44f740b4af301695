#pragma once

#include "text/Result.h"
#include "verifying/RecordingDigest.h"

#include <string>
#include <string_view>

namespace pallax {

/// The digests of a recording as a text, in lines:
///
///   pallax-verify 1                             the version of this format
///   decoder 0.1.0
///   technology lte
///   packets 2400
///   first 1700000000000000000                   nanoseconds since 1970
///   block DIGEST                                for each block of packets
///   decoded MINUTE FIELD DIGEST                 in the order of minutes and fields
///   end                                         so that a cut file is none
std::string textOfDigest(const RecordingDigest& digest);

/// What is wrong with a text of digests: "line 3 is no line of digests".
struct DigestFileError {
    std::string reason;
};

Result<RecordingDigest, DigestFileError> digestInText(std::string_view text);

/// The file beside a recording.
std::string digestFileOf(const std::string& recording);

} // namespace pallax
