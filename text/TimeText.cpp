#include "text/TimeText.h"

#include "text/Format.h"

#include <algorithm>
#include <array>
#include <cstdint>
#include <utility>

namespace pallax {

namespace {

using std::chrono::nanoseconds;
using std::chrono::seconds;

constexpr std::string_view kForms = "expected 14:03, 2023-11-14T14:03, +90s, -5m, start or end";
constexpr std::size_t kYearDigits = 4;
constexpr std::size_t kMostFractionDigits = 9;
constexpr std::size_t kMostDistanceDigits = 9;

bool isDigit(char character) {
    return character >= '0' && character <= '9';
}

/// `from + size`, limited to the range of recordings, in which `from` lies.
Time moved(Time from, nanoseconds size) {
    if (size.count() >= 0) {
        return size > kLatestTime - from ? kLatestTime : from + size;
    }
    return size < kEarliestTime - from ? kEarliestTime : from + size;
}

/// The times, in order, at which a local clock shows this one: one, or two different ones. If the
/// clock skips it, the time that it would be without the skip.
std::array<Time, 2> timesOfLocal(nanoseconds local, const ZoneRule& zone) {
    const auto at = [local](seconds offset) { return moved(kEarliestTime, local - offset); };
    // The zones before and after any change that is near.
    constexpr seconds kDay = std::chrono::days(1);
    const Time before = at(zone(at(kDay)));
    const Time after = at(zone(at(-kDay)));
    const bool fitsBefore = at(zone(before)) == before;
    const bool fitsAfter = at(zone(after)) == after;
    if (fitsBefore && fitsAfter) {
        return {std::min(before, after), std::max(before, after)};
    }
    const Time only = fitsAfter ? after : before;
    return {only, only};
}

} // namespace

/// Reads a text from left to right, up to the first error.
class TimeTextParser {
public:
    explicit TimeTextParser(std::string_view text) : _text(text) {}

    Result<TimeText, TimeTextError> parse() {
        TimeText time;
        time._text = _text;
        read(time);
        if (_at != _text.size()) {
            fail("nothing may follow");
        }
        if (_error) {
            return *_error;
        }
        return time;
    }

private:
    using Kind = TimeText::Kind;

    void read(TimeText& time);
    void readDated(TimeText& time);
    std::int64_t number(std::size_t least, std::size_t most, std::string_view what);
    std::int64_t part(std::size_t least, std::int64_t lowest, std::int64_t highest,
                      std::string_view what);
    nanoseconds fraction();
    nanoseconds distance();
    nanoseconds clock();
    seconds date();
    seconds zone();

    bool isAt(char character) const { return _at < _text.size() && _text[_at] == character; }
    bool take(char character) {
        const bool found = !_error && isAt(character);
        _at += found ? 1 : 0;
        return found;
    }
    std::size_t digitsHere() const {
        const auto rest = _text.substr(_at);
        return static_cast<std::size_t>(std::find_if_not(rest.begin(), rest.end(), isDigit) -
                                        rest.begin());
    }
    /// Only the first error counts.
    void failAt(std::size_t place, std::string_view reason) {
        if (!_error) {
            _error = {
                formatText("\"%@\" is not a time: %@ (character %d).", {_text, reason, place + 1}),
                place};
        }
    }
    void fail(std::string_view reason) { failAt(_at, reason); }

    std::string_view _text;
    std::size_t _at = 0;
    std::optional<TimeTextError> _error;
};

void TimeTextParser::read(TimeText& time) {
    if (_text == "start" || _text == "end") {
        _at = _text.size();
        time._kind = _text == "start" ? Kind::AfterStart : Kind::BeforeEnd;
    } else if (take('+')) {
        time._size = distance();
    } else if (take('-')) {
        time._kind = Kind::BeforeEnd;
        time._size = distance();
    } else if (digitsHere() >= kYearDigits) {
        readDated(time);
    } else if (digitsHere() > 0) {
        time._kind = Kind::Clock;
        time._size = clock();
    } else {
        fail(kForms);
    }
}

void TimeTextParser::readDated(TimeText& time) {
    time._kind = Kind::Local;
    time._size = date();
    if (!take('T') && !take(' ')) {
        return;
    }
    time._size += clock();
    if (isAt('Z') || isAt('+') || isAt('-')) {
        time._kind = Kind::Utc;
        time._size -= zone();
    }
}

/// A number of at least and at most so many digits.
std::int64_t TimeTextParser::number(std::size_t least, std::size_t most, std::string_view what) {
    const std::size_t digits = std::min(digitsHere(), most);
    if (digits < least) {
        failAt(_at + digits, formatText("expected %@", {what}));
        return 0;
    }
    std::int64_t value = 0;
    for (const char digit : _text.substr(_at, digits)) {
        value = value * 10 + (digit - '0');
    }
    _at += digits;
    return value;
}

/// A number of at most two digits.
std::int64_t TimeTextParser::part(std::size_t least, std::int64_t lowest, std::int64_t highest,
                                  std::string_view what) {
    const std::size_t place = _at;
    const std::int64_t value = number(least, 2, what);
    if (value < lowest || value > highest) {
        failAt(place, formatText("%@ are from %02d to %02d", {what, lowest, highest}));
    }
    return value;
}

/// ".5", if it is there.
nanoseconds TimeTextParser::fraction() {
    if (!take('.')) {
        return {};
    }
    const std::size_t begin = _at;
    std::int64_t value = number(1, kMostFractionDigits, "digits");
    for (std::size_t digits = _at - begin; digits < kMostFractionDigits; ++digits) {
        value *= 10;
    }
    return nanoseconds(value);
}

/// "1h30m", "90s", "0.5s": hours, minutes and seconds in this order.
nanoseconds TimeTextParser::distance() {
    struct Unit {
        char name;
        std::int64_t seconds;
    };
    constexpr std::array<Unit, 3> kUnits = {{{'h', 3600}, {'m', 60}, {'s', 1}}};
    const auto* next = kUnits.begin();
    seconds whole{0};
    nanoseconds rest{0};
    do {
        if (digitsHere() > kMostDistanceDigits) {
            fail("numbers have at most 9 digits");
            return {};
        }
        const std::int64_t value = number(1, kMostDistanceDigits, "a number");
        const std::size_t placeOfFraction = _at;
        const bool hasFraction = isAt('.');
        rest = fraction();
        const std::size_t place = _at;
        const auto* unit =
            std::find_if(next, kUnits.end(), [this](const Unit& each) { return take(each.name); });
        if (unit == kUnits.end() || (hasFraction && unit->name != 's')) {
            failAt(hasFraction ? placeOfFraction : place,
                   hasFraction ? "only seconds have a fraction"
                               : "expected the unit h, m or s, in this order");
            return {};
        }
        next = unit + 1;
        whole += seconds(value * unit->seconds);
    } while (!_error && _at < _text.size());
    return std::min<seconds>(whole, dateOf(kLatestTime).time_since_epoch()) + rest;
}

/// "14:03", "14:03:20.5": since midnight.
nanoseconds TimeTextParser::clock() {
    constexpr std::string_view kColon = "expected a colon";
    nanoseconds time = std::chrono::hours(part(1, 0, 23, "hours"));
    if (!take(':')) {
        fail(kColon);
    }
    time += std::chrono::minutes(part(2, 0, 59, "minutes"));
    if (take(':')) {
        time += seconds(part(2, 0, 59, "seconds"));
        time += fraction();
    }
    return time;
}

/// "2023-11-14": since the epoch.
seconds TimeTextParser::date() {
    constexpr int kFirstYear = 1970;
    constexpr int kLastYear = 2255;
    const std::size_t place = _at;
    const std::int64_t year = number(kYearDigits, kYearDigits, "a year");
    if (year < kFirstYear || year > kLastYear) {
        failAt(place, formatText("years are from %d to %d", {kFirstYear, kLastYear}));
    }
    if (!take('-')) {
        fail("expected a hyphen");
    }
    const std::int64_t month = part(2, 1, 12, "months");
    if (!take('-')) {
        fail("expected a hyphen");
    }
    const std::size_t placeOfDay = _at;
    const std::int64_t day = part(2, 1, 31, "days");
    const std::chrono::year_month_day date(std::chrono::year(static_cast<int>(year)),
                                           std::chrono::month(static_cast<unsigned>(month)),
                                           std::chrono::day(static_cast<unsigned>(day)));
    if (_error || !date.ok()) {
        failAt(placeOfDay, "the month has no such day");
        return {};
    }
    return std::chrono::sys_days(date).time_since_epoch();
}

/// "Z", "+02:00", "-0330", "+02".
seconds TimeTextParser::zone() {
    if (take('Z')) {
        return {};
    }
    const bool isWest = take('-');
    (void)take('+');
    seconds offset = std::chrono::hours(part(2, 0, 23, "hours"));
    const bool hasColon = take(':');
    if (hasColon || digitsHere() > 0) {
        offset += std::chrono::minutes(part(2, 0, 59, "minutes"));
    }
    return isWest ? -offset : offset;
}

Result<TimeText, TimeTextError> TimeText::parse(std::string_view text) {
    return TimeTextParser(text).parse();
}

Result<Time, TimeTextError> TimeText::timeIn(const TimeSpan& span, const ZoneRule& zone) const {
    switch (_kind) {
    case Kind::AfterStart:
        return moved(span.begin, _size);
    case Kind::BeforeEnd:
        if (!span.end) {
            return TimeTextError{
                formatText("\"%@\" cannot be used: the end of a stream is not known before it "
                           "has been read.",
                           {_text}),
                0};
        }
        return moved(*span.end, -_size);
    case Kind::Local:
        return timesOfLocal(_size, zone).front();
    case Kind::Utc:
        return moved(kEarliestTime, _size);
    case Kind::Clock:
        break;
    }
    return clockIn(span, zone);
}

Result<Time, TimeTextError> TimeText::clockIn(const TimeSpan& span, const ZoneRule& zone) const {
    TimeSpan::Stretch whole{span.begin, span.end.value_or(kLatestTime)};
    for (const TimeSpan::Stretch& stretch : span.stretches) {
        if (const auto time = firstIn(stretch, zone)) {
            return *time;
        }
        whole.begin = std::min(whole.begin, stretch.begin);
    }
    if (const auto time = firstIn(whole, zone)) { // between stretches
        return *time;
    }
    return errorOutside(span, zone);
}

TimeTextError TimeText::errorOutside(const TimeSpan& span, const ZoneRule& zone) const {
    Time begin = span.begin;
    for (const TimeSpan::Stretch& stretch : span.stretches) {
        begin = std::min(begin, stretch.begin);
    }
    const auto local = [&zone](Time time) { return localDateText(time, zone(time)); };
    return TimeTextError{formatText("\"%@\" is no time of the recording, which lasts from %@ "
                                    "to %@.",
                                    {_text, local(begin), local(span.end.value_or(kLatestTime))}),
                         0};
}

std::optional<Time> TimeText::firstIn(const TimeSpan::Stretch& stretch,
                                      const ZoneRule& zone) const {
    const auto today = std::chrono::floor<std::chrono::days>(stretch.begin + zone(stretch.begin))
                           .time_since_epoch();
    std::optional<std::pair<bool, Time>> first; // on a day whose clock skips it, only if need be
    // Each day has the time, so the first that fits is near, or none does.
    for (int day = -1; day <= 2; ++day) {
        const nanoseconds local = today + std::chrono::days(day) + _size;
        for (const Time time : timesOfLocal(local, zone)) {
            const std::pair found(time + zone(time) != kEarliestTime + local, time);
            if (time >= stretch.begin && time <= stretch.end && (!first || found < *first)) {
                first = found;
            }
        }
    }
    return first ? std::optional(first->second) : std::nullopt;
}

} // namespace pallax
