#include "web/SeriesJson.h"

#include "report/Figures.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <chrono>
#include <cmath>
#include <cstdint>

namespace pallax {

namespace {

/// Ticks that are farther apart have time missing between them.
constexpr std::chrono::seconds kHole{10};

template <class Number>
void appendNumber(std::string& out, Number number) {
    if (std::isnan(number)) {
        out += "null";
        return;
    }
    std::array<char, 32> digits{};
    const auto result = std::to_chars(digits.data(), digits.data() + digits.size(), number);
    out.append(digits.data(), result.ptr);
}

template <class Number>
void appendNumbers(std::string& out, const std::vector<Number>& numbers) {
    out += '[';
    for (std::size_t index = 0; index < numbers.size(); ++index) {
        out += index == 0 ? "" : ",";
        appendNumber(out, numbers[index]);
    }
    out += ']';
}

/// The ticks of the range whose times ascend.
std::vector<std::uint32_t> ascendingTicks(const std::vector<Time>& ticks,
                                          const SeriesRange& range) {
    std::vector<std::uint32_t> kept;
    for (std::size_t index = range.first; index < std::min(range.end, ticks.size()); ++index) {
        const Time time = ticks[index];
        if (time >= range.from && time <= range.to && (kept.empty() || time > ticks[kept.back()])) {
            kept.push_back(static_cast<std::uint32_t>(index));
        }
    }
    return kept;
}

/// The value of a series at each of these ticks, which ascend.
std::vector<float> valuesAt(const HeldSeries& series, const std::vector<std::uint32_t>& ticks) {
    std::vector<float> values;
    values.reserve(ticks.size());
    auto next = series.changes().begin();
    float value = std::nanf("");
    for (const std::uint32_t tick : ticks) {
        for (; next != series.changes().end() && next->tick <= tick; ++next) {
            value = next->value;
        }
        values.push_back(value);
    }
    return values;
}

/// Ticks that are drawn as one or two instants.
struct Run {
    std::size_t begin; ///< among the drawn ticks
    std::size_t end;
    bool isBeforeHole = false; ///< time is missing after it
};

std::vector<Run> runsOf(const std::vector<Time>& ticks, const std::vector<std::uint32_t>& drawn,
                        std::size_t most) {
    std::vector<Run> runs;
    for (std::size_t index = 0; index < drawn.size(); ++index) {
        const bool isAfterHole = index > 0 && ticks[drawn[index]] - ticks[drawn[index - 1]] > kHole;
        if (isAfterHole) {
            runs.back().isBeforeHole = true;
        }
        if (runs.empty() || isAfterHole || index - runs.back().begin == most) {
            runs.push_back({index, index});
        }
        runs.back().end = index + 1;
    }
    return runs;
}

/// Of a run, the least and the greatest value, in the order in which they come.
std::pair<float, float> extremesOf(std::span<const float> run) {
    auto least = run.end();
    auto greatest = run.end();
    for (auto each = run.begin(); each != run.end(); ++each) {
        if (!std::isnan(*each)) {
            least = least == run.end() || *each < *least ? each : least;
            greatest = greatest == run.end() || *each > *greatest ? each : greatest;
        }
    }
    if (least == run.end()) {
        return {std::nanf(""), std::nanf("")};
    }
    return least < greatest ? std::pair(*least, *greatest) : std::pair(*greatest, *least);
}

/// What is drawn of the values: one or two of each run, and nothing in a hole.
std::vector<float> thinned(const std::vector<float>& values, const std::vector<Run>& runs) {
    std::vector<float> kept;
    for (const Run& run : runs) {
        const std::span<const float> all(&values[run.begin], run.end - run.begin);
        if (all.size() > 2) {
            const auto extremes = extremesOf(all);
            kept.push_back(extremes.first);
            kept.push_back(extremes.second);
        } else {
            kept.insert(kept.end(), all.begin(), all.end());
        }
        if (run.isBeforeHole) {
            kept.push_back(std::nanf(""));
        }
    }
    return kept;
}

/// The instants at which these are drawn: the first and the last tick of a run, and one in a hole.
std::vector<double> instantsOf(const std::vector<Time>& ticks,
                               const std::vector<std::uint32_t>& drawn,
                               const std::vector<Run>& runs) {
    constexpr double kMillisecond = 0.001;
    std::vector<double> times;
    for (const Run& run : runs) {
        times.push_back(pageSeconds(ticks[drawn[run.begin]]));
        const double last = pageSeconds(ticks[drawn[run.end - 1]]);
        if (run.end - run.begin > 1) {
            times.push_back(last);
        }
        if (run.isBeforeHole) {
            times.push_back(last + kMillisecond);
        }
    }
    return times;
}

} // namespace

std::string seriesJson(const std::vector<Time>& ticks, std::span<const HeldSeries* const> series,
                       const SeriesRange& range) {
    const std::vector<std::uint32_t> all = ascendingTicks(ticks, range);
    const std::size_t most = std::max<std::size_t>(range.points, 2);
    const std::size_t longest = all.size() <= most ? 1 : (2 * all.size() + most - 1) / most;
    const std::vector<Run> runs = runsOf(ticks, all, longest);
    std::string out = "{\"times\":";
    appendNumbers(out, instantsOf(ticks, all, runs));
    out += ",\"values\":[";
    for (std::size_t index = 0; index < series.size(); ++index) {
        out += index == 0 ? "" : ",";
        const std::vector<float> values = valuesAt(*series[index], all);
        appendNumbers(out, thinned(values, runs));
    }
    return out + "]}";
}

} // namespace pallax
