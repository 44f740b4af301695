#pragma once

#include "host/Recording.h"
#include "host/RecordingContent.h"

#include <cstdint>
#include <optional>
#include <string>
#include <vector>

namespace pallax {

/// What the digests within a recording tell of it.
struct EmbeddedCheck {
    std::uint64_t packets = 0;
    std::uint64_t uncovered = 0; ///< of them, those at the end that no digest is about
    bool hasDigests = false;
    bool isRecorded = false;             ///< by `pallax record`, or copied from such a recording
    bool hasEnd = false;                 ///< the recorder has ended it
    std::vector<std::string> faults;     ///< a sentence for each change
    std::optional<RecordingError> error; ///< why it could not be read to its end

    /// Nothing is wrong, as far as can be told.
    bool isSound() const { return faults.empty() && !error; }
    bool isWhole() const { return isSound() && hasEnd; }
};

/// Reads a capture to its end. Takes the content; `name` is for messages.
EmbeddedCheck checkEmbeddedDigests(RecordingContent content, const std::string& name);

} // namespace pallax
