#include "web/SeriesJson.h"

#include "report/Figures.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <cmath>
#include <cstdint>

namespace pallax {

namespace {

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
    for (std::size_t index = 0; index < ticks.size(); ++index) {
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

/// Of each run, the least and the greatest value, in the order in which they come; of one tick, its
/// value.
std::vector<float> extremesOf(const std::vector<float>& values, std::size_t run) {
    std::vector<float> kept;
    for (std::size_t first = 0; first < values.size(); first += run) {
        const auto begin = values.begin() + static_cast<std::ptrdiff_t>(first);
        const auto end = begin + static_cast<std::ptrdiff_t>(std::min(run, values.size() - first));
        auto least = end;
        auto greatest = end;
        for (auto each = begin; each != end; ++each) {
            if (!std::isnan(*each)) {
                least = least == end || *each < *least ? each : least;
                greatest = greatest == end || *each > *greatest ? each : greatest;
            }
        }
        const auto [one, other] = std::minmax(least, greatest);
        kept.push_back(one == end ? std::nanf("") : *one);
        if (end - begin > 1) {
            kept.push_back(other == end ? std::nanf("") : *other);
        }
    }
    return kept;
}

/// The times at which the extremes of a run are drawn: its first tick, and one in its middle.
std::vector<std::uint32_t> placesOf(const std::vector<std::uint32_t>& ticks, std::size_t run) {
    std::vector<std::uint32_t> kept;
    for (std::size_t first = 0; first < ticks.size(); first += run) {
        const std::size_t count = std::min(run, ticks.size() - first);
        kept.push_back(ticks[first]);
        if (count > 1) {
            kept.push_back(ticks[first + count / 2]);
        }
    }
    return kept;
}

} // namespace

std::string seriesJson(const std::vector<Time>& ticks, std::span<const HeldSeries* const> series,
                       const SeriesRange& range) {
    const std::vector<std::uint32_t> all = ascendingTicks(ticks, range);
    const std::size_t most = std::max<std::size_t>(range.points, 2);
    const std::size_t run = all.size() <= most ? 1 : (2 * all.size() + most - 1) / most;
    std::vector<double> times;
    for (const std::uint32_t tick : placesOf(all, run)) {
        times.push_back(pageSeconds(ticks[tick]));
    }
    std::string out = "{\"times\":";
    appendNumbers(out, times);
    out += ",\"values\":[";
    for (std::size_t index = 0; index < series.size(); ++index) {
        out += index == 0 ? "" : ",";
        const std::vector<float> values = valuesAt(*series[index], all);
        appendNumbers(out, extremesOf(values, run));
    }
    return out + "]}";
}

} // namespace pallax
