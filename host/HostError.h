#pragma once

#include <string>
#include <string_view>

namespace pallax {

/// Why the host could not provide something: one sentence for the user, without a newline.
struct HostError {
    std::string sentence;
    /// The reader of a pipe has gone, or has not read in time after a signal: exit quietly.
    bool readerHasGone = false;
};

/// The error of a recording that cannot be written, from the system's error number.
HostError unwritableRecording(std::string_view name, int error);
/// The error of a recording whose reader does not read although the program must end; `isWhole` if
/// the reader received only whole packets.
HostError untakenRecording(std::string_view name, bool isWhole);

} // namespace pallax
