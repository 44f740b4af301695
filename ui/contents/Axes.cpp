#include "ui/contents/Axes.h"

#include "text/NumberFormat.h"
#include "ui/contents/TimeOfDay.h"

#include <algorithm>
#include <array>
#include <cmath>

namespace pallax {

namespace {

constexpr std::size_t kMinutes = 5; // the length of "22:14"

constexpr auto kTimeSteps =
    std::to_array<int>({1,   2,    5,    10,   15,    30,    60,    120,   300,    600,
                        900, 1800, 3600, 7200, 10800, 21600, 43200, 86400, 172800, 604800});

/// The round step after `step`: 1, 2, 5, 10, 20, ...
double nextStep(double step) {
    const double power = std::pow(10.0, std::floor(std::log10(step) + 1e-9));
    const double digit = std::round(step / power);
    return power * (digit < 2 ? 2 : digit < 5 ? 5 : 10);
}

} // namespace

std::string ValueAxis::textOf(double label) const {
    NumberConversion conversion;
    conversion.precision = decimals;
    conversion.conversion = 'f';
    std::string text;
    appendConverted(text, conversion, label == 0 ? 0.0 : label); // no "-0"
    return text;
}

ValueAxis valueAxis(double least, double most, int count) {
    constexpr double kSmallest = 1e-6;
    constexpr double kGreatest = 1e15; // beyond it, doubles have no room for the labels between
    least = std::clamp(least, -kGreatest, kGreatest);
    most = std::clamp(most, least, kGreatest);
    count = std::max(count, 3); // two do not suffice around 0
    // Channels and cells have no halves.
    const bool areWhole = least == std::round(least) && most == std::round(most);
    if (least == most) { // a flat line in the middle
        least -= 1;
        most += 1;
    }
    double step = areWhole ? 1 : kSmallest;
    const auto first = [&] { return std::floor(least / step + kSmallest); };
    const auto last = [&] { return std::ceil(most / step - kSmallest); };
    while (last() - first() > count - 1 || first() + 1 == first()) {
        step = nextStep(step);
    }
    ValueAxis axis;
    axis.decimals = std::max(0, static_cast<int>(std::ceil(-std::log10(step) - kSmallest)));
    const double end = std::max(last(), first() + 1);
    for (double number = first(); number <= end; ++number) {
        axis.labels.push_back(number * step);
    }
    axis.least = axis.labels.front();
    axis.most = axis.labels.back();
    return axis;
}

std::vector<TimeLabel> timeLabels(Time from, Time to, std::chrono::seconds ahead, int columns) {
    using std::chrono::seconds;
    constexpr int kBetween = 4;
    constexpr int kMinute = 60;
    const double span = std::chrono::duration<double>(to - from).count();
    if (span <= 0 || columns <= 0) {
        return {};
    }
    const auto fits = [&](int step) {
        const int width = static_cast<int>(step < kMinute ? kMinutes + 3 : kMinutes);
        return step / span * columns >= width + kBetween;
    };
    const auto step = std::find_if(kTimeSteps.begin(), kTimeSteps.end(), fits);
    if (step == kTimeSteps.end()) {
        return {};
    }
    const seconds every(*step);
    const auto local = std::chrono::ceil<seconds>(from.time_since_epoch()) + ahead;
    std::vector<TimeLabel> labels;
    for (seconds at = (local + every - seconds(1)) / every * every;; at += every) {
        const Time time{at - ahead};
        if (time > to) {
            return labels;
        }
        std::string text = timeOfDay(time, ahead);
        text.resize(*step < kMinute ? text.size() : kMinutes);
        labels.push_back({time, std::move(text)});
    }
}

} // namespace pallax
