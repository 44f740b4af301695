#include "report/Spread.h"

#include <algorithm>
#include <cmath>

namespace pallax {

namespace {

constexpr double kHundredths = 100;
/// No radio measures beyond it; records of any content can hold more.
constexpr double kGreatest = 10000;

double valueOf(std::int32_t hundredths) {
    return hundredths / kHundredths;
}

} // namespace

void Spread::add(double value, double seconds) {
    if (std::isnan(value) || seconds <= 0) {
        return;
    }
    const double limited = std::clamp(value, -kGreatest, kGreatest);
    _seconds[static_cast<std::int32_t>(std::lround(limited * kHundredths))] += seconds;
    _total += seconds;
}

double Spread::least() const {
    return valueOf(_seconds.begin()->first);
}

double Spread::most() const {
    return valueOf(_seconds.rbegin()->first);
}

double Spread::quantile(double share) const {
    const double wanted = share * _total;
    double sum = 0;
    for (const auto& [value, seconds] : _seconds) {
        sum += seconds;
        if (sum >= wanted) {
            return valueOf(value);
        }
    }
    return most(); // the sum was rounded
}

std::vector<Spread::Share> Spread::shares(const Borders& borders) const {
    std::map<Grade, double> seconds;
    for (const auto& border : borders.borders) {
        seconds[border.grade] = 0;
    }
    seconds[Grade::None] = 0;
    for (const auto& [value, held] : _seconds) {
        seconds[borders.gradeOf(valueOf(value))] += held;
    }
    std::vector<Share> shares;
    for (auto each = seconds.rbegin(); each != seconds.rend(); ++each) {
        shares.push_back({each->first, _total > 0 ? each->second / _total : 0});
    }
    return shares;
}

} // namespace pallax
