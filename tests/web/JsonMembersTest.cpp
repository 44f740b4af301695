#include "web/JsonMembers.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

TEST(JsonMembers, TellWhatHasChanged) {
    const JsonMembers before(Dictionary{{"a", "1"}, {"b", Array{"2"}}, {"c", "3"}});
    const JsonMembers after(Dictionary{{"a", "1"}, {"b", Array{"2", "3"}}, {"d", "3"}});
    EXPECT_EQ(after.all(), R"({"a":"1","b":["2","3"],"d":"3"})");
    EXPECT_EQ(after.changedSince(before), R"({"b":["2","3"],"d":"3"})");
    EXPECT_EQ(after.changedSince(after), "{}");
    EXPECT_NE(before, after);
    EXPECT_EQ(JsonMembers().all(), "{}");
}

TEST(JsonMembers, HoldAnyText) {
    const JsonMembers members(Dictionary{{"a\"\n", "</script>\n\xFF"}});
    EXPECT_EQ(members.all(), "{\"a\\\"\\n\":\"</script>\\n\xEF\xBF\xBD\"}");
}

} // namespace
} // namespace pallax
