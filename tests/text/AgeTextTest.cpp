#include "text/AgeText.h"

#include <gtest/gtest.h>

#include <chrono>
#include <utility>

namespace pallax {
namespace {

using namespace std::chrono_literals;

TEST(AgeText, HasOneUnitThatGrows) {
    const std::pair<std::chrono::nanoseconds, const char*> expected[] = {
        {0s, "0 s"},         {14400ms, "14 s"}, {119s, "119 s"}, {120s, "2 min"}, {239s, "3 min"},
        {119min, "119 min"}, {120min, "2 h"},   {47h, "47 h"},   {48h, "2 days"},
    };
    for (const auto& [age, text] : expected) {
        EXPECT_EQ(ageText(age), text);
    }
}

} // namespace
} // namespace pallax
