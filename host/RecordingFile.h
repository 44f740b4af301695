#pragma once

#include "host/Descriptor.h"
#include "host/Recording.h"
#include "text/Result.h"

#include <chrono>
#include <string>

namespace pallax {

/// The input of a recording. A stream (a named pipe, a device, a shell's `<(command)`) can be
/// opened once and read once.
struct RecordingFile {
    /// How long a stream may be silent before that is reported.
    static constexpr std::chrono::milliseconds kPatience{2000};

    /// Whether the path leads to a stream; true for "-", false if nothing is there.
    static bool isStream(const std::string& path);

    /// Opens a path (not "-"). For a stream, returns once there is data to read, or its end;
    /// `waiting` (may be empty) gets a sentence while there is no writer.
    static Result<RecordingFile, RecordingError>
    open(const std::string& path, const Recording::Waiting& waiting,
         std::chrono::milliseconds patience = kPatience);

    Descriptor descriptor;
    bool readOnce = false; ///< it is a stream
};

} // namespace pallax
