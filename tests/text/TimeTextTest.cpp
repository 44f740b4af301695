#include "text/TimeText.h"

#include "tests/doubles/Property.h"
#include "text/Format.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using std::chrono::hours;
using std::chrono::minutes;
using std::chrono::nanoseconds;
using std::chrono::seconds;

Time at(std::string_view iso, nanoseconds rest = {}) {
    return Time(*parseIsoDate(iso)) + rest;
}

/// Two hours before UTC, so that a local day begins at 02:00Z.
constexpr seconds kWest = -hours(2);

/// One hour ahead of UTC, in summer two: from 2023-03-26T01:00Z to 2023-10-29T01:00Z.
seconds summer(Time time) {
    return time >= at("2023-03-26T01:00:00Z") && time < at("2023-10-29T01:00:00Z") ? hours(2)
                                                                                   : hours(1);
}

class TimeTextTest : public testing::Test {
protected:
    /// The time of the text, or its error as "place: sentence".
    std::string timeOf(std::string_view text) const {
        const auto parsed = TimeText::parse(text);
        if (!parsed) {
            return formatText("%d: %@", {parsed.error().place, parsed.error().sentence});
        }
        const auto time = parsed->timeIn(span, zone);
        return time ? isoTimeText(*time) : time.error().sentence;
    }

    TimeSpan span{at("2023-11-14T22:10:00Z"), at("2023-11-15T23:00:00Z")};
    ZoneRule zone = [](Time) { return kWest; };
};

TEST_F(TimeTextTest, StartAndEndAndDistancesFromThem) {
    EXPECT_EQ(timeOf("start"), "2023-11-14T22:10:00.000Z");
    EXPECT_EQ(timeOf("end"), "2023-11-15T23:00:00.000Z");
    EXPECT_EQ(timeOf("+90s"), "2023-11-14T22:11:30.000Z");
    EXPECT_EQ(timeOf("-5m"), "2023-11-15T22:55:00.000Z");
    EXPECT_EQ(timeOf("+1h30m"), "2023-11-14T23:40:00.000Z");
    EXPECT_EQ(timeOf("+1h2m3.456s"), "2023-11-14T23:12:03.456Z");
    EXPECT_EQ(timeOf("-1h0.5s"), "2023-11-15T21:59:59.500Z");
    EXPECT_EQ(timeOf("+0s"), "2023-11-14T22:10:00.000Z");
}

TEST_F(TimeTextTest, AClockTimeIsThatOfTheFirstStretchThatHasIt) {
    span = {at("2023-11-15T02:00:00Z"),
            at("2023-11-15T09:00:00Z"),
            {{at("2023-11-15T02:00:00Z"), at("2023-11-15T03:00:00Z")},
             {at("2023-11-13T01:00:00Z"), at("2023-11-13T04:00:00Z")},
             {at("2023-11-15T08:00:00Z"), at("2023-11-15T09:00:00Z")}}};
    EXPECT_EQ(timeOf("00:30"), "2023-11-15T02:30:00.000Z"); // also in the second
    EXPECT_EQ(timeOf("01:30"), "2023-11-13T03:30:00.000Z");
    EXPECT_EQ(timeOf("06:30"), "2023-11-15T08:30:00.000Z");
    EXPECT_EQ(timeOf("12:00"), "2023-11-13T14:00:00.000Z"); // in none
}

TEST_F(TimeTextTest, DistancesStayInTheRangeOfRecordings) {
    EXPECT_EQ(timeOf("+999999999h"), isoTimeText(kLatestTime));
    EXPECT_EQ(timeOf("-999999999h999999999m999999999.999999999s"), isoTimeText(kEarliestTime));
}

TEST_F(TimeTextTest, AClockTimeIsTheFirstInTheRecording) {
    EXPECT_EQ(timeOf("20:10"), "2023-11-14T22:10:00.000Z");
    EXPECT_EQ(timeOf("20:09:59.999"), "2023-11-15T22:09:59.999Z");
    EXPECT_EQ(timeOf("9:05"), "2023-11-15T11:05:00.000Z");
    EXPECT_EQ(timeOf("00:00:00"), "2023-11-15T02:00:00.000Z");
    EXPECT_EQ(timeOf("23:59:59.123456789"), "2023-11-15T01:59:59.123Z");
    span.end = at("2023-11-14T22:40:00Z");
    EXPECT_EQ(timeOf("20:40"), "2023-11-14T22:40:00.000Z");
    EXPECT_EQ(timeOf("20:41"), "\"20:41\" is no time of the recording, which lasts from 2023-11-14 "
                               "20:10:00 to 2023-11-14 20:40:00.");
}

TEST_F(TimeTextTest, DatesAreLocalOrHaveAZone) {
    EXPECT_EQ(timeOf("2023-11-14T14:03"), "2023-11-14T16:03:00.000Z");
    EXPECT_EQ(timeOf("2023-11-14 14:03:20.5"), "2023-11-14T16:03:20.500Z");
    EXPECT_EQ(timeOf("2023-11-14"), "2023-11-14T02:00:00.000Z");
    EXPECT_EQ(timeOf("2023-11-14T14:03Z"), "2023-11-14T14:03:00.000Z");
    EXPECT_EQ(timeOf("2023-11-14 14:03:20+02:00"), "2023-11-14T12:03:20.000Z");
    EXPECT_EQ(timeOf("2023-11-14T14:03:20.25-0330"), "2023-11-14T17:33:20.250Z");
    EXPECT_EQ(timeOf("2023-11-14T14:03+01"), "2023-11-14T13:03:00.000Z");
    EXPECT_EQ(timeOf("2024-02-29T00:00Z"), "2024-02-29T00:00:00.000Z");
    EXPECT_EQ(timeOf("2255-12-31T00:00Z"), isoTimeText(kLatestTime));
    EXPECT_EQ(timeOf("1970-01-01T00:00+01"), isoTimeText(kEarliestTime));
}

TEST_F(TimeTextTest, AnErrorNamesThePlace) {
    EXPECT_EQ(timeOf(""), "0: \"\" is not a time: expected 14:03, 2023-11-14T14:03, +90s, -5m, "
                          "start or end (character 1).");
    EXPECT_EQ(timeOf("noon"), "0: \"noon\" is not a time: expected 14:03, 2023-11-14T14:03, +90s, "
                              "-5m, start or end (character 1).");
    EXPECT_EQ(timeOf("14"), "2: \"14\" is not a time: expected a colon (character 3).");
    EXPECT_EQ(timeOf("14:3"), "4: \"14:3\" is not a time: expected minutes (character 5).");
    EXPECT_EQ(timeOf("14:60"),
              "3: \"14:60\" is not a time: minutes are from 00 to 59 (character 4).");
    EXPECT_EQ(timeOf("24:00"),
              "0: \"24:00\" is not a time: hours are from 00 to 23 (character 1).");
    EXPECT_EQ(timeOf("14:03:20x"),
              "8: \"14:03:20x\" is not a time: nothing may follow (character 9).");
    EXPECT_EQ(timeOf("14:03:20.1234567890"), "18: \"14:03:20.1234567890\" is not a time: nothing "
                                             "may follow (character 19).");
    EXPECT_EQ(timeOf("14:03:20."),
              "9: \"14:03:20.\" is not a time: expected digits (character 10).");
    EXPECT_EQ(timeOf("2023-02-29"),
              "8: \"2023-02-29\" is not a time: the month has no such day (character 9).");
    EXPECT_EQ(timeOf("2023-13-01"),
              "5: \"2023-13-01\" is not a time: months are from 01 to 12 (character 6).");
    EXPECT_EQ(timeOf("1969-12-31"),
              "0: \"1969-12-31\" is not a time: years are from 1970 to 2255 (character 1).");
    EXPECT_EQ(
        timeOf("+90"),
        "3: \"+90\" is not a time: expected the unit h, m or s, in this order (character 4).");
    EXPECT_EQ(timeOf("+1m1h"), "4: \"+1m1h\" is not a time: expected the unit h, m or s, in this "
                               "order (character 5).");
    EXPECT_EQ(timeOf("-1.5m"),
              "2: \"-1.5m\" is not a time: only seconds have a fraction (character 3).");
    EXPECT_EQ(timeOf("+1h9999999999s"), "3: \"+1h9999999999s\" is not a time: numbers have at most "
                                        "9 digits (character 4).");
    EXPECT_EQ(timeOf("+"), "1: \"+\" is not a time: expected a number (character 2).");
    EXPECT_EQ(timeOf("start "), "0: \"start \" is not a time: expected 14:03, 2023-11-14T14:03, "
                                "+90s, -5m, start or end (character 1).");
}

TEST_F(TimeTextTest, WithoutAnEndOnlyTheEndIsNotKnown) {
    span.end = std::nullopt;
    EXPECT_EQ(timeOf("+90s"), "2023-11-14T22:11:30.000Z");
    EXPECT_EQ(timeOf("20:09"), "2023-11-15T22:09:00.000Z");
    for (const char* text : {"end", "-5m"}) {
        EXPECT_EQ(timeOf(text),
                  formatText("\"%@\" cannot be used: the end of a stream is not known "
                             "before it has been read.",
                             {text}));
        EXPECT_TRUE(TimeText::parse(text)->needsEnd());
    }
    EXPECT_TRUE(TimeText::parse("20:09")->needsEnd());
    EXPECT_FALSE(TimeText::parse("start")->needsEnd());
    EXPECT_FALSE(TimeText::parse("2023-11-14T14:03")->needsEnd());
}

TEST_F(TimeTextTest, WhereTheClockChangesTheFirstTimeIsMeant) {
    zone = summer;
    span = {at("2023-03-01T00:00:00Z"), at("2023-12-01T00:00:00Z")};
    EXPECT_EQ(timeOf("2023-03-26T01:59"), "2023-03-26T00:59:00.000Z");
    EXPECT_EQ(timeOf("2023-03-26T02:30"), "2023-03-26T01:30:00.000Z"); // skipped
    EXPECT_EQ(timeOf("2023-03-26T03:00"), "2023-03-26T01:00:00.000Z");
    EXPECT_EQ(timeOf("2023-10-29T02:30"), "2023-10-29T00:30:00.000Z"); // twice
    EXPECT_EQ(timeOf("2023-10-29T03:00"), "2023-10-29T02:00:00.000Z");
    // A day whose clock skips the time is meant only if no other has it.
    span = {at("2023-03-25T14:00:00Z"), at("2023-03-27T18:00:00Z")};
    EXPECT_EQ(timeOf("2:00"), "2023-03-27T00:00:00.000Z");
    EXPECT_EQ(timeOf("2:30"), "2023-03-27T00:30:00.000Z");
    span.end = at("2023-03-26T20:00:00Z");
    EXPECT_EQ(timeOf("2:30"), "2023-03-26T01:30:00.000Z");
    // The second of the two, where the first lies before the recording.
    span = {at("2023-10-29T00:45:00Z"), at("2023-10-29T02:00:00Z")};
    EXPECT_EQ(timeOf("2:30"), "2023-10-29T01:30:00.000Z");
    EXPECT_EQ(timeOf("2:50"), "2023-10-29T00:50:00.000Z");
}

TEST_F(TimeTextTest, EveryTimeOfARecordingIsFoundByItsTexts) {
    EXPECT_TRUE(doubles::holds([this] {
        zone = summer;
        span.begin = at("2023-01-01T00:00:00Z") +
                     nanoseconds(doubles::any::longBetween(0, 31'000'000'000'000'000));
        span.end = span.begin + nanoseconds(doubles::any::longBetween(0, 200'000'000'000'000));
        const Time time =
            span.begin +
            nanoseconds(doubles::any::longBetween(0, (*span.end - span.begin).count() + 1));
        const auto found = [this](const std::string& text) {
            return TimeText::parse(text)->timeIn(span, zone).value();
        };
        const auto rest = (time - dateOf(time)).count();
        const std::string utc =
            dateText(dateOf(time)).substr(0, 19) + formatText(".%09lld", {rest});
        RC_ASSERT(found(utc + "Z") == time);
        const auto since = (time - span.begin).count();
        RC_ASSERT(found(formatText("+%lld.%09llds",
                                   {since / 1'000'000'000, since % 1'000'000'000})) == time);
        const auto left = (*span.end - time).count();
        RC_ASSERT(found(formatText("-%lld.%09llds",
                                   {left / 1'000'000'000, left % 1'000'000'000})) == time);
        // A clock time is the first in the recording at which the clock shows it.
        const std::string clock =
            dateText(dateOf(time + summer(time))).substr(11, 8) + formatText(".%09lld", {rest});
        const Time first = found(clock);
        RC_ASSERT(first >= span.begin && first <= time);
        RC_ASSERT(dateText(dateOf(first + summer(first))).substr(11, 8) == clock.substr(0, 8));
        for (Time earlier = time - hours(1); earlier >= span.begin; earlier -= hours(1)) {
            const bool showsIt =
                (earlier + summer(earlier) - (time + summer(time))) % hours(24) == nanoseconds(0);
            RC_ASSERT(!showsIt || first <= earlier);
        }
    }));
}

TEST_F(TimeTextTest, AnyTextIsATimeInRangeOrASentence) {
    EXPECT_TRUE(doubles::holds([this] {
        const std::string text = doubles::any::textOf("0123456789:.-+TZ hmsdenrta");
        const auto parsed = TimeText::parse(text);
        if (!parsed) {
            RC_ASSERT(parsed.error().place <= text.size());
            RC_ASSERT(parsed.error().sentence.back() == '.');
            return;
        }
        const auto time = parsed->timeIn(span, zone);
        RC_ASSERT(!time || (*time >= kEarliestTime && *time <= kLatestTime));
    }));
}

} // namespace
} // namespace pallax
