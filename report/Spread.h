#pragma once

#include "knowledge/Quality.h"

#include <cstdint>
#include <map>
#include <vector>

namespace pallax {

/// How long a number had which value. Values are kept to a hundredth.
class Spread {
public:
    void add(double value, double seconds);

    bool isEmpty() const { return _seconds.empty(); }
    double total() const { return _total; }
    double least() const;
    double most() const;
    /// The least value that the number did not exceed for at least this share of the time. Only if
    /// it is not empty.
    double quantile(double share) const;
    /// The share of the time in each grade, the best first.
    struct Share {
        Grade grade;
        double share;
    };
    std::vector<Share> shares(const Borders& borders) const;

private:
    std::map<std::int32_t, double> _seconds; ///< by value, in hundredths
    double _total = 0;
};

} // namespace pallax
