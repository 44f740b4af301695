#pragma once

#include "travel/Travel.h"

#include <cstdint>
#include <optional>
#include <string>
#include <utility>
#include <vector>

namespace pallax {

/// What differs between the marked instant and the one that is shown.
class ChangesContent {
public:
    /// Turns to the instant that is shown now.
    void update(const Travel& travel);
    /// The timeline is another one.
    void forget() { *this = {}; }

    const std::string& title() const { return _title; } ///< "Changes from 22:13:50 to 22:14:06"
    /// Empty: nothing differs. The lines of a section are indented below its name.
    const std::vector<std::string>& lines() const { return _lines; }

private:
    std::string _title;
    std::vector<std::string> _lines;
    std::optional<std::pair<std::uint64_t, std::uint64_t>> _compared; ///< whose changes are known
};

} // namespace pallax
