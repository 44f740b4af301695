#pragma once

#include "text/Date.h"

#include <chrono>
#include <string>
#include <vector>

namespace pallax {

/// A range of values whose ends and labels are round numbers.
struct ValueAxis {
    double least = 0;
    double most = 1;
    std::vector<double> labels; ///< ascending, from `least` to `most`
    int decimals = 0;           ///< of the labels

    std::string textOf(double label) const;
};

/// An axis that contains both values, with at most `count` labels (at least 3).
ValueAxis valueAxis(double least, double most, int count);

/// A time with its clock time.
struct TimeLabel {
    Time time;
    std::string text; ///< "22:09", or "22:09:30" if the labels are less than a minute apart
};

/// The round times from `from` to `to` in local time, which is so much ahead of UTC. Labels have
/// room in `columns` columns.
std::vector<TimeLabel> timeLabels(Time from, Time to, std::chrono::seconds ahead, int columns);

} // namespace pallax
