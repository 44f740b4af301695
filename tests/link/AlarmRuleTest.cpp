#include "link/AlarmRule.h"

#include <gtest/gtest.h>

#include <string>

namespace pallax {
namespace {

using namespace std::chrono_literals;

std::string reasonFor(std::string_view text) {
    const auto rule = parseAlarmRule(text);
    return rule ? "none" : rule.error();
}

TEST(AlarmRule, HasANameAndACondition) {
    const auto rule = parseAlarmRule("weak signal: measured_rsrp < -110");
    ASSERT_TRUE(rule);
    EXPECT_EQ(rule->name, "weak signal");
    EXPECT_EQ(rule->condition, "measured_rsrp < -110");
    EXPECT_EQ(rule->needed, 0s);
    EXPECT_FALSE(rule->ringsBell);
}

TEST(AlarmRule, MayHaveATimeAndABell) {
    const auto both = parseAlarmRule(" a :\tx = ':'  for  1.5s  bell ");
    ASSERT_TRUE(both);
    EXPECT_EQ(both->name, "a");
    EXPECT_EQ(both->condition, "x = ':'");
    EXPECT_EQ(both->needed, 1500ms);
    EXPECT_TRUE(both->ringsBell);
    const auto time = parseAlarmRule("a: x for 10");
    EXPECT_EQ(time->condition, "x");
    EXPECT_EQ(time->needed, 10s);
    EXPECT_FALSE(time->ringsBell);
    const auto bell = parseAlarmRule("a: x bell");
    EXPECT_EQ(bell->condition, "x");
    EXPECT_TRUE(bell->ringsBell);
}

TEST(AlarmRule, AMistakeIsNamed) {
    for (const char* text : {"", "weak", ": a < 1", " : "}) {
        EXPECT_EQ(reasonFor(text), "an alarm is written \"NAME: CONDITION [for SECONDS] [bell]\"");
    }
    EXPECT_EQ(reasonFor("a:"), "alarm \"a\": there is no condition");
    EXPECT_EQ(reasonFor("a: bell"), "alarm \"a\": there is no condition");
    EXPECT_EQ(reasonFor("a: for 10s bell"), "alarm \"a\": there is no condition");
    EXPECT_EQ(reasonFor("a: x < for 10m"), "alarm \"a\": \"10m\" is not a number of seconds");
    EXPECT_EQ(reasonFor("a: x <"), "alarm \"a\": This is not a whole condition");
    EXPECT_EQ(reasonFor("a: band(1)"), "alarm \"a\": wrong number of arguments to function band() "
                                       "(line 1, column 1 of the condition)");
}

TEST(AlarmRule, IsFoundByItsName) {
    const std::vector<AlarmRule> rules{{"a", "x"}, {"b", "y"}};
    EXPECT_EQ(alarmNamed(rules, "b"), &rules[1]);
    EXPECT_EQ(alarmNamed(rules, "c"), nullptr);
}

} // namespace
} // namespace pallax
