#pragma once

#include <string>
#include <string_view>

namespace pallax {

/// Why something of the host could not be had: one clear sentence for the user, without a newline.
struct HostError {
    std::string sentence;
    /// What was written to is a pipe that nobody reads any more: a reason to end quietly.
    bool readerHasGone = false;
};

/// That a recording cannot be written, as the system's error number tells.
HostError unwritableRecording(std::string_view name, int error);

} // namespace pallax
