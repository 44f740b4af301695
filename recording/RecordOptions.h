#pragma once

#include "recording/RecordingFiles.h"

#include <optional>
#include <string>

namespace pallax {

struct RecordedTechnology;

struct RecordOptions {
    RecordingFiles::Options files;
    /// What the modem must speak; null: whatever it answers.
    const RecordedTechnology* technology = nullptr;
    std::optional<int> logLevel; ///< system-log lines up to it go to standard error
    std::string service = {};    ///< of the live modem; empty: the one without a name
};

} // namespace pallax
