#pragma once

#include "travel/Travel.h"

#include <cstddef>
#include <cstdint>
#include <optional>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

namespace pallax {

/// The parts of a line, for a front end whose characters differ in width.
struct ChangeParts {
    std::size_t depth = 0; ///< how many blanks are before it: 0 for a section
    std::string name;      ///< "Measured RSRP"
    std::string change;    ///< "-77.75 dBm → -81.00 dBm (-3.25 dB)"; may be empty
};
ChangeParts changeParts(std::string_view line);

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
