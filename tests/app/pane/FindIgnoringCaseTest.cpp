#include "app/pane/FindIgnoringCase.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

TEST(FindIgnoringCaseTest, FindsAsciiInAnyCaseAndOtherBytesAsTheyAre) {
    EXPECT_EQ(findIgnoringCase("Measured RSRP", "rsrp"), 9U);
    EXPECT_EQ(findIgnoringCase("abc", "ABC"), 0U);
    EXPECT_EQ(findIgnoringCase("größe", "ÖSS"), std::string_view::npos);
    EXPECT_EQ(findIgnoringCase("漢字", "字"), 3U);
    EXPECT_EQ(findIgnoringCase("[x", "{X"),
              std::string_view::npos); // differ by one bit, but are not letters
    EXPECT_EQ(findIgnoringCase("ab", "abc"), std::string_view::npos);
    EXPECT_EQ(findIgnoringCase("", ""), 0U);
    EXPECT_EQ(findIgnoringCase("abc", ""), 0U);
}

} // namespace
} // namespace pallax
