#pragma once

#include <chrono>
#include <functional>
#include <optional>
#include <string>

namespace pallax {

/// How long ago a value, or anything of a branch, was read from a packet.
struct ReadingAge {
    std::chrono::nanoseconds age{0};
    bool isOverdue = false; ///< the age exceeds the usual one
    bool operator==(const ReadingAge&) const = default;
};

/// Tells the age of the node at a path of the display; nothing if it was never read. An empty
/// function: the ages are unknown.
using ReadingAges = std::function<std::optional<ReadingAge>(const std::string& path)>;

} // namespace pallax
