#include "app/DateFormatter.h"

#include "tests/doubles/ManualClock.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using namespace std::chrono_literals;
using doubles::ManualClock;

constexpr const char* kUpdatePattern = "'Updated' yyyy-MM-dd 'at' HH:mm:ss";

std::string written(const std::string& pattern, std::int64_t secondsSince1970,
                    std::chrono::seconds offset = 0s) {
    ManualClock clock;
    clock.setZone({offset, false});
    return DateFormatter(pattern, clock)
        .stringFromDate(Time(std::chrono::seconds(secondsSince1970)));
}

TEST(DateFormatter, TheUpdatePatternWritesDateAndTime) {
    EXPECT_EQ(written(kUpdatePattern, 1726186706), "Updated 2024-09-13 at 00:18:26");
    EXPECT_EQ(written(kUpdatePattern, 1700000000), "Updated 2023-11-14 at 22:13:20");
}

TEST(DateFormatter, TheTimeIsLocal) {
    EXPECT_EQ(written(kUpdatePattern, 1700000000, 2h), "Updated 2023-11-15 at 00:13:20");
    EXPECT_EQ(written(kUpdatePattern, 1700000000, -(22h + 13min + 21s)),
              "Updated 2023-11-13 at 23:59:59");
}

/// A zone that is one hour ahead at even seconds only.
class LeapingZone final : public Clock {
public:
    Time now() const override { return {}; }
    Zone zone(Time time) const override {
        return {dateOf(time).time_since_epoch().count() % 2 == 0 ? 1h : 0h, false};
    }
};

TEST(DateFormatter, TheZoneIsTheOneInForceAtTheTimeWritten) {
    const LeapingZone zone;
    const DateFormatter formatter("HH:ss", zone);
    EXPECT_EQ(formatter.stringFromDate(Time(2s)), "01:02");
    EXPECT_EQ(formatter.stringFromDate(Time(3s)), "00:03");
}

TEST(DateFormatter, FractionsOfASecondAreCut) {
    ManualClock clock;
    EXPECT_EQ(DateFormatter("ss", clock).stringFromDate(Time(1999ms)), "01");
}

TEST(DateFormatter, TimesBefore1970AreWritten) {
    EXPECT_EQ(written("yyyy-MM-dd HH:mm:ss", -1), "1969-12-31 23:59:59");
}

TEST(DateFormatter, EveryFieldHasAtLeastAsManyDigitsAsLetters) {
    EXPECT_EQ(written("y M d H m s", 1041429906), "2003 1 1 14 5 6");
    EXPECT_EQ(written("yyyyy MMM ddd HHH mmm sss", 1041429906), "02003 001 001 014 005 006");
}

TEST(DateFormatter, TextBetweenApostrophesIsCopied) {
    EXPECT_EQ(written("'My days' d 'Hms'", 0), "My days 1 Hms");
    EXPECT_EQ(written("", 0), "");
    EXPECT_EQ(written("'", 0), "");
}

} // namespace
} // namespace pallax
