#pragma once

#include <chrono>
#include <optional>
#include <string>
#include <string_view>

namespace pallax {

/// A time in whole seconds of UTC, as in a property list's date.
using Date = std::chrono::sys_seconds;

/// A time as recordings stamp it.
using Time = std::chrono::sys_time<std::chrono::nanoseconds>;

/// The range of times of recordings and their sources: from the epoch to the year 2255. Within it
/// no difference, and no sum with a display interval, overflows.
inline constexpr Time kEarliestTime{};
inline constexpr Time kLatestTime{std::chrono::seconds(9'000'000'000)};

/// "2023-11-14 22:13:20 +0000": the standard textual description, in UTC.
std::string dateText(Date date);

/// "2023-11-14 23:13:20": the local time where it is so much ahead of UTC, to the second.
std::string localDateText(Time time, std::chrono::seconds aheadOfUtc);

/// "2023-11-14T22:13:20Z", the form of XML property lists; nothing for dates outside the years 0000
/// to 9999.
std::optional<std::string> isoDateText(Date date);

/// "2023-11-14T22:13:20.000Z", truncated to milliseconds.
std::string isoTimeText(Time time);

/// Reads "2023-11-14T22:13:20Z"; nothing for any other text or an invalid date.
std::optional<Date> parseIsoDate(std::string_view text);

/// The whole second that contains `time`.
Date dateOf(Time time);

} // namespace pallax
