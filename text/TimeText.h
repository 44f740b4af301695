#pragma once

#include "text/Date.h"
#include "text/Result.h"

#include <chrono>
#include <cstddef>
#include <functional>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

/// Times as people write them on a command line:
///
///   start, end                 of the recording
///   +90s, +1h30m               after its start; -5m, before its end
///   14:03, 14:03:20.5          local time, the first that lies in the recording or, where its
///                              clock was set back, in the first stretch that has it
///   2023-11-14T14:03:20.5      local time; also with a blank in place of the T, or the date alone
///   2023-11-14T14:03Z, …+0200  with a zone
namespace pallax {

/// What a recording's times lie between, all within kEarliestTime to kLatestTime.
struct TimeSpan {
    /// A part in which the clock was not set back.
    struct Stretch {
        Time begin;
        Time end;
    };

    Time begin;                          ///< of the first packet
    std::optional<Time> end;             ///< the latest; nothing while not known, as for a pipe
    std::vector<Stretch> stretches = {}; ///< in their order; may be empty if there is only one
};

/// Local time minus UTC, at a time.
using ZoneRule = std::function<std::chrono::seconds(Time time)>;

struct TimeTextError {
    std::string sentence; ///< quotes the text and names the place
    std::size_t place;    ///< the index of the first byte that is wrong
};

/// A time as it was written, by itself. Which time it is depends on the recording.
class TimeText {
public:
    /// Any text that is not a time is refused.
    static Result<TimeText, TimeTextError> parse(std::string_view text);

    /// The time, limited to kEarliestTime to kLatestTime. An error if a local time lies in no part
    /// of the recording, or if the end is needed but not known. A local time that its zone skips
    /// or has twice is the first that the clock can have meant.
    Result<Time, TimeTextError> timeIn(const TimeSpan& span, const ZoneRule& zone) const;

    /// Whether it is the same time in every recording.
    bool isAbsolute() const { return _kind == Kind::Local || _kind == Kind::Utc; }
    /// Whether it is the end of the recording.
    bool isEnd() const { return beforeEnd() == std::chrono::nanoseconds(0); }
    /// How long before the end of the recording it is; nothing if it is not counted from there.
    std::optional<std::chrono::nanoseconds> beforeEnd() const {
        return _kind == Kind::BeforeEnd ? std::optional(_size) : std::nullopt;
    }
    /// Whether `timeIn` depends on the end of the recording.
    bool needsEnd() const { return _kind == Kind::BeforeEnd || _kind == Kind::Clock; }
    /// The error for a time that lies in no part of the recording, whose end is known.
    TimeTextError errorOutside(const TimeSpan& span, const ZoneRule& zone) const;

private:
    friend class TimeTextParser;
    enum class Kind { AfterStart, BeforeEnd, Clock, Local, Utc };
    Result<Time, TimeTextError> clockIn(const TimeSpan& span, const ZoneRule& zone) const;
    std::optional<Time> firstIn(const TimeSpan::Stretch& stretch, const ZoneRule& zone) const;

    std::string _text;
    Kind _kind = Kind::AfterStart;
    /// The distance from start or end; the time since midnight; since the epoch, local or UTC.
    std::chrono::nanoseconds _size{0};
};

} // namespace pallax
