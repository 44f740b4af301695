#include "text/Date.h"

#include "text/Format.h"

namespace pallax {

namespace {

struct Civil {
    std::chrono::year_month_day day;
    std::chrono::hh_mm_ss<std::chrono::seconds> clock;
};

Civil civilOf(Date date) {
    const auto days = std::chrono::floor<std::chrono::days>(date);
    return {days, std::chrono::hh_mm_ss<std::chrono::seconds>(date - days)};
}

std::string civilText(std::string_view format, const Civil& civil) {
    return formatText(format,
                      {static_cast<int>(civil.day.year()), static_cast<unsigned>(civil.day.month()),
                       static_cast<unsigned>(civil.day.day()), civil.clock.hours().count(),
                       civil.clock.minutes().count(), civil.clock.seconds().count()});
}

/// The number at text[at, at + digits), or nothing.
std::optional<int> digitsAt(std::string_view text, std::size_t at, std::size_t digits) {
    int value = 0;
    for (const char digit : text.substr(at, digits)) {
        if (digit < '0' || digit > '9') {
            return std::nullopt;
        }
        value = value * 10 + (digit - '0');
    }
    return value;
}

} // namespace

std::string dateText(Date date) {
    return civilText("%04d-%02d-%02d %02d:%02d:%02d +0000", civilOf(date));
}

std::string localDateText(Time time, std::chrono::seconds aheadOfUtc) {
    return civilText("%04d-%02d-%02d %02d:%02d:%02d", civilOf(dateOf(time) + aheadOfUtc));
}

std::optional<std::string> isoDateText(Date date) {
    const Civil civil = civilOf(date);
    if (civil.day.year() < std::chrono::year(0) || civil.day.year() > std::chrono::year(9999)) {
        return std::nullopt;
    }
    return civilText("%04d-%02d-%02dT%02d:%02d:%02dZ", civil);
}

std::string isoTimeText(Time time) {
    const Date second = dateOf(time);
    const auto rest = std::chrono::floor<std::chrono::milliseconds>(time - second);
    return civilText("%04d-%02d-%02dT%02d:%02d:%02d", civilOf(second)) +
           formatText(".%03dZ", {rest.count()});
}

std::optional<Date> parseIsoDate(std::string_view text) {
    constexpr std::string_view kShape = "0000-00-00T00:00:00Z";
    if (text.size() != kShape.size()) {
        return std::nullopt;
    }
    for (std::size_t at = 0; at < text.size(); ++at) {
        if (kShape[at] != '0' && text[at] != kShape[at]) {
            return std::nullopt;
        }
    }
    const auto year = digitsAt(text, 0, 4);
    const auto month = digitsAt(text, 5, 2);
    const auto day = digitsAt(text, 8, 2);
    const auto hour = digitsAt(text, 11, 2);
    const auto minute = digitsAt(text, 14, 2);
    const auto second = digitsAt(text, 17, 2);
    if (!year || !month || !day || !hour || !minute || !second) {
        return std::nullopt;
    }
    const std::chrono::year_month_day civil(std::chrono::year(*year),
                                            std::chrono::month(static_cast<unsigned>(*month)),
                                            std::chrono::day(static_cast<unsigned>(*day)));
    if (!civil.ok() || *hour > 23 || *minute > 59 || *second > 59) {
        return std::nullopt;
    }
    return Date(std::chrono::sys_days(civil)) + std::chrono::hours(*hour) +
           std::chrono::minutes(*minute) + std::chrono::seconds(*second);
}

Date dateOf(Time time) {
    return std::chrono::floor<std::chrono::seconds>(time);
}

} // namespace pallax
