#include "platform/ZoneText.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using namespace std::chrono_literals;

TEST(ZoneText, IsTheOffsetInHoursAndMinutes) {
    EXPECT_EQ(zoneText({0s, false}), "+0000");
    EXPECT_EQ(zoneText({2h, true}), "+0200");
    EXPECT_EQ(zoneText({5h + 45min, false}), "+0545");
    EXPECT_EQ(zoneText({-3h - 30min, false}), "-0330");
    EXPECT_EQ(zoneText({-30min, false}), "-0030");
    EXPECT_EQ(zoneText({14h, false}), "+1400");
}

TEST(ZoneText, ALocalTimeHasItsZone) {
    class WestClock final : public Clock {
    public:
        Time now() const override { return {}; }
        Zone zone(Time /*time*/) const override { return {-(3h + 30min), false}; }
    };
    EXPECT_EQ(localTimeText(Time(1'700'000'000s + 999ms), WestClock()),
              "2023-11-14 18:43:20 -0330");
}

} // namespace
} // namespace pallax
