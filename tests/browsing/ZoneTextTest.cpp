#include "browsing/ZoneText.h"

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

} // namespace
} // namespace pallax
