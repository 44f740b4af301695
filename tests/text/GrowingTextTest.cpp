#include "text/GrowingText.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

TEST(GrowingText, HoldsItsTextWithAnyInitialRoom) {
    for (const std::size_t room : {0U, 1U, 5U, 100U}) {
        GrowingText text(room);
        EXPECT_EQ(text.view(), "");
        text.put('a');
        text.put("bcd");
        text.put("");
        text.put(3, '-');
        std::copy_n("xy", 2, text.grow(2));
        EXPECT_EQ(text.view(), "abcd---xy") << room;
        EXPECT_EQ(text.view(4), "---xy");
        EXPECT_EQ(text.size(), 9U);
        text.truncate(2);
        text.put("z");
        EXPECT_EQ(text.view(), "abz");
    }
}

} // namespace
} // namespace pallax
