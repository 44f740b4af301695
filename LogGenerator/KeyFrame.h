#pragma once

#include "LogGenerator/Records/ReadTimes.h"
#include "plist/PropertyList.h"

#include <cstddef>
#include <cstdint>
#include <optional>
#include <string>
#include <unordered_map>
#include <vector>

namespace pallax {

/// Everything of the packets up to one that the packets after it build on. With it a new generator
/// of the same technology goes on as if it had read them. It shares nothing with the generator that
/// gave it. History and raw capture are left out.
struct KeyFrame {
    /// What the records keep beside the display.
    struct Record {
        ReadTimes times;
        std::unordered_map<std::int64_t, std::int64_t> remembered;
    };
    /// What an object stream keeps beside its latest message.
    struct Paths {
        std::vector<std::string> known;   ///< by number
        std::vector<std::uint32_t> shown; ///< in the latest message, outside lists
        std::optional<Time> read;
    };

    PropertyList display; ///< of an object stream: the latest message; null: none yet
    Dictionary running;   ///< CDMA's running values
    std::vector<Record> records;
    Paths paths;

    /// About how many bytes it takes.
    std::size_t bytes() const;
};

} // namespace pallax
