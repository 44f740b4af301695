#include "text/Utf8.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

TEST(Utf8, EveryCodePointReadsBackAsItIsWritten) {
    for (char32_t codePoint = 0; codePoint <= kLastCodePoint; ++codePoint) {
        if (isSurrogate(codePoint)) {
            continue;
        }
        std::string text;
        appendUtf8(text, codePoint);
        const Utf8CodePoint read = utf8At(text, 0);
        ASSERT_EQ(read.value, codePoint);
        ASSERT_EQ(read.size, text.size());
    }
}

TEST(Utf8, TellsWhereATextCeasesToBeUtf8) {
    EXPECT_EQ(invalidUtf8At(""), std::nullopt);
    EXPECT_EQ(invalidUtf8At("a\u00E9\u20AC\U0001F4E1"), std::nullopt);
    EXPECT_EQ(invalidUtf8At("a\xE9z"), 1U);
    EXPECT_EQ(invalidUtf8At("\u00E9\x80"), 2U); // a continuation alone
    EXPECT_EQ(invalidUtf8At("ab\xE2\x82"), 2U); // cut
    EXPECT_EQ(invalidUtf8At("\xC1\xBF"), 0U);   // overlong, in each length
    EXPECT_EQ(invalidUtf8At("\xE0\x9F\xBF"), 0U);
    EXPECT_EQ(invalidUtf8At("\xF0\x8F\xBF\xBF"), 0U);
    EXPECT_EQ(invalidUtf8At("\xED\xA0\x80"), 0U);     // a surrogate
    EXPECT_EQ(invalidUtf8At("\xF4\x90\x80\x80"), 0U); // beyond U+10FFFF
    EXPECT_EQ(invalidUtf8At("\xF8\x88\x80\x80\x80"), 0U);
    EXPECT_EQ(invalidUtf8At("\xFF"), 0U);
}

} // namespace
} // namespace pallax
