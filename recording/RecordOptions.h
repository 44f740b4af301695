#pragma once

#include "recording/RecordingFiles.h"
#include "sources/Source.h"

#include <optional>

namespace pallax {

struct RecordedTechnology;

struct RecordOptions {
    RecordingFiles::Options files;
    /// What the modem must speak; null: whatever it answers.
    const RecordedTechnology* technology = nullptr;
    /// Recorded in place of the service's modem.
    std::optional<LocalModem> modem;
    std::optional<int> logLevel; ///< system-log lines up to it go to standard error
};

} // namespace pallax
