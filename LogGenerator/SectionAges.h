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
    /// What stands at `path` of the display ("/" the root, "/Serving Cell", "/Serving Cell/ARFCN")
    /// was read then.
    void note(const std::string& path, Time read) {
        Time& noted = _read.try_emplace(path, read).first->second;
        noted = noted < read ? read : noted;
    }

    /// The packet time of the latest reading of what stands at `path`. Nothing where no packet has
    /// been read, where that is not known, and where the answer for the branch above holds.
    std::optional<Time> lastRead(std::string_view path) const {
        const auto found = _read.find(path);
        return found != _read.end() ? std::optional(found->second) : std::nullopt;
    }

private:
    std::map<std::string, Time, std::less<>> _read;
};

} // namespace pallax
