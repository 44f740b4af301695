#pragma once

#include <chrono>
#include <optional>
#include <string>
#include <string_view>

namespace pallax {

/// A moment, in whole seconds of UTC: what a property list's date holds.
using Date = std::chrono::sys_seconds;

/// A moment as a recording stamps it.
using Time = std::chrono::sys_time<std::chrono::nanoseconds>;

/// The times that recordings and their sources may have: from the epoch to the year 2255. Within
/// them no difference, and no sum with a display interval, overflows.
inline constexpr Time kEarliestTime{};
inline constexpr Time kLatestTime{std::chrono::seconds(9'000'000'000)};

/// "2023-11-14 22:13:20 +0000": the standard textual description, in UTC.
std::string dateText(Date date);

/// "2023-11-14T22:13:20Z", the form of XML property lists. Years 0000 to 9999 only; an earlier
/// or later date gives nothing.
std::optional<std::string> isoDateText(Date date);

/// "2023-11-14T22:13:20.000Z", cut to milliseconds.
std::string isoTimeText(Time time);

/// Reads "2023-11-14T22:13:20Z"; nothing when the text is anything else, or no real date.
std::optional<Date> parseIsoDate(std::string_view text);

/// The whole second in which `time` lies.
Date dateOf(Time time);

} // namespace pallax
