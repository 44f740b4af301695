#pragma once

#include "text/Date.h"

#include <map>
#include <optional>
#include <string>
#include <string_view>

namespace pallax {

/// When the values of the display were last read from a packet, changed or not.
class SectionAges {
public:
    /// Notes when the node at `path` of the display was read ("/" for the root, "/Serving Cell",
    /// "/Serving Cell/ARFCN").
    void note(const std::string& path, Time read) {
        Time& noted = _read.try_emplace(path, read).first->second;
        noted = noted < read ? read : noted;
    }

    /// The time of the packet from which the node at `path` was last read. Nothing if there is no
    /// such packet, if the time is unknown, or if the time of the branch above applies.
    std::optional<Time> lastRead(std::string_view path) const {
        const auto found = _read.find(path);
        return found != _read.end() ? std::optional(found->second) : std::nullopt;
    }

    /// All times that were noted, by path.
    const std::map<std::string, Time, std::less<>>& all() const { return _read; }

private:
    std::map<std::string, Time, std::less<>> _read;
};

} // namespace pallax
