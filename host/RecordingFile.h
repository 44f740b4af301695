#pragma once

#include "host/Descriptor.h"
#include "host/Recording.h"
#include "text/Result.h"

#include <chrono>
#include <string>

namespace pallax {

/// What recordings are read from. A stream (a named pipe, a device, a shell's `<(command)`) can be
/// opened once and read once.
struct RecordingFile {
    /// So long a stream may give nothing before that is told.
    static constexpr std::chrono::milliseconds kPatience{2000};

    /// Whether the path leads to a stream; so does "-". False for what is not there.
    static bool isStream(const std::string& path);

    /// Opens a path (not "-"). A stream is returned once there is something to read, or its end;
    /// `waiting`, if any, hears that nobody has written yet.
    static Result<RecordingFile, RecordingError>
    open(const std::string& path, const Recording::Waiting& waiting,
         std::chrono::milliseconds patience = kPatience);

    Descriptor descriptor;
    bool readOnce = false; ///< it is a stream
};

} // namespace pallax
