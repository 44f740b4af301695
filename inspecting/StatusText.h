#pragma once

#include "overview/Status.h"

#include <string>
#include <string_view>

namespace pallax {

/// Where and when a status is from.
struct StatusOrigin {
    std::string name; ///< of the recording
    std::string_view technology;
    std::string_view title;        ///< of the technology: "GSM/UMTS"
    std::chrono::seconds ahead{0}; ///< local time minus UTC
    std::optional<std::uint64_t> packet = std::nullopt;
};

/// At most ten lines of at most 80 columns; a line without data is left out.
void appendStatusText(std::string& out, const StatusOrigin& origin, const Status& status);
/// One line with a JSON object; what is not known is null or empty.
void appendStatusJson(std::string& out, const StatusOrigin& origin, const Status& status);

} // namespace pallax
