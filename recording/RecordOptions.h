#pragma once

#include "recording/RecordingFiles.h"
#include "sources/Source.h"

#include <optional>
#include <string>

namespace pallax {

struct RecordedTechnology;

struct RecordOptions {
    RecordingFiles::Options files;
    /// What the modem must speak; null: whatever it answers.
    const RecordedTechnology* technology = nullptr;
    /// Recorded in place of the service's modem.
    std::optional<LocalModem> modem;
    std::optional<int> logLevel; ///< system-log lines up to it go to standard error
    std::string service = {};    ///< of the live modem; empty: the one without a name
};

} // namespace pallax
