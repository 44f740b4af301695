#include "app/DateFormatter.h"

#include "platform/Clock.h"

#include <algorithm>
#include <chrono>
#include <cstddef>
#include <cstdint>
#include <optional>
#include <utility>

namespace pallax {

namespace {

constexpr char kQuote = '\'';

/// The field of a pattern letter; nothing for any other character.
std::optional<std::int64_t> fieldOf(char letter, std::chrono::local_seconds local) {
    const auto day = std::chrono::floor<std::chrono::days>(local);
    const std::chrono::year_month_day date(day);
    const std::chrono::hh_mm_ss clock(local - day);
    switch (letter) {
    case 'y':
        return static_cast<int>(date.year());
    case 'M':
        return static_cast<unsigned>(date.month());
    case 'd':
        return static_cast<unsigned>(date.day());
    case 'H':
        return clock.hours().count();
    case 'm':
        return clock.minutes().count();
    case 's':
        return clock.seconds().count();
    default:
        return std::nullopt;
    }
}

void appendPadded(std::string& text, std::int64_t number, std::size_t width) {
    const std::string digits = std::to_string(number);
    text.append(width - std::min(width, digits.size()), '0');
    text += digits;
}

} // namespace

DateFormatter::DateFormatter(std::string pattern, const Clock& clock)
    : _pattern(std::move(pattern)), _clock(clock) {}

std::string DateFormatter::stringFromDate(Time time) const {
    const std::chrono::local_seconds local{dateOf(time).time_since_epoch() +
                                           _clock.zone(time).offset};
    std::string text;
    bool quoted = false;
    for (auto at = _pattern.begin(); at != _pattern.end();) {
        const char letter = *at;
        const auto runEnd =
            std::find_if(at, _pattern.end(), [letter](char other) { return other != letter; });
        if (letter == kQuote) {
            quoted = !quoted;
            ++at;
        } else if (const auto field = quoted ? std::nullopt : fieldOf(letter, local)) {
            appendPadded(text, *field, static_cast<std::size_t>(runEnd - at));
            at = runEnd;
        } else {
            text += letter;
            ++at;
        }
    }
    return text;
}

} // namespace pallax
