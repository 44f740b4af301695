#pragma once

#include <string>
#include <string_view>

namespace pallax {

/// Why something of the host could not be had: one clear sentence for the user, without a newline.
struct HostError {
    std::string sentence;
    /// What was written to is a pipe that nobody reads any more, or not in time once a signal has
    /// asked for the end: a reason to end quietly.
    bool readerHasGone = false;
};

/// That a recording cannot be written, as the system's error number tells.
HostError unwritableRecording(std::string_view name, int error);
/// That the reader of a recording does not take it, although the program has to end; `isWhole`
/// where it has got whole packets.
HostError untakenRecording(std::string_view name, bool isWhole);

} // namespace pallax
