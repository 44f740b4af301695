#pragma once

#include "cli/RecordingFiles.h"

#include <cstdint>
#include <optional>
#include <string>

namespace pallax {

struct RecordedTechnology;

struct RecordOptions {
    RecordingFiles::Options files;
    /// What the modem must speak; null: whatever it answers.
    const RecordedTechnology* technology = nullptr;
    std::optional<int> logLevel; ///< system-log lines up to it go to standard error
};

/// "4096", "64k", "100M", "2G": bytes, in powers of 1024. Nothing for anything else, and for 0.
std::optional<std::uint64_t> parseSize(const std::string& text);

} // namespace pallax
