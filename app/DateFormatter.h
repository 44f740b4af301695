#pragma once

#include "text/Date.h"

#include <string>

namespace pallax {

class Clock;

/// Writes moments in local time by a pattern: a run of the letters y, M, d, H, m or s is the year,
/// month, day, hour (0 to 23), minute or second with at least as many digits as letters; what
/// stands between apostrophes, and every other character, is itself.
class DateFormatter {
public:
    /// `clock` knows the local time zone; it outlives the formatter.
    DateFormatter(std::string pattern, const Clock& clock);

    std::string stringFromDate(Time time) const;

private:
    std::string _pattern;
    const Clock& _clock;
};

} // namespace pallax
