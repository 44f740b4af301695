#pragma once

#include "text/Date.h"

#include <string>

namespace pallax {

class Clock;

/// Formats times in local time by a pattern. A run of the letters y, M, d, H, m or s is the year,
/// month, day, hour (0 to 23), minute or second, with at least as many digits as letters. Text
/// between apostrophes and all other characters are copied.
class DateFormatter {
public:
    /// `clock` knows the local time zone and must outlive the formatter.
    DateFormatter(std::string pattern, const Clock& clock);

    std::string stringFromDate(Time time) const;

private:
    std::string _pattern;
    const Clock& _clock;
};

} // namespace pallax
