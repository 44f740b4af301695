#include "web/AccessToken.h"

#include <gtest/gtest.h>

#include <set>

namespace pallax {
namespace {

TEST(AccessToken, HasThirtyTwoHexadecimalDigits) {
    const std::string text = AccessToken::random().text();
    EXPECT_EQ(text.size(), 32U);
    EXPECT_EQ(text.find_first_not_of("0123456789abcdef"), std::string::npos) << text;
}

TEST(AccessToken, IsAnotherOneEachTime) {
    std::set<std::string> texts;
    std::set<char> digits;
    for (int count = 0; count < 1000; ++count) {
        const std::string text = AccessToken::random().text();
        texts.insert(text);
        digits.insert(text.begin(), text.end());
    }
    EXPECT_EQ(texts.size(), 1000U);
    EXPECT_EQ(digits.size(), 16U);
}

TEST(AccessToken, IsOnlyItsWholeText) {
    const AccessToken token("0123456789abcdef0123456789abcdef");
    EXPECT_TRUE(token.is("0123456789abcdef0123456789abcdef"));
    EXPECT_FALSE(token.is(""));
    EXPECT_FALSE(token.is("0123456789abcdef0123456789abcde"));
    EXPECT_FALSE(token.is("0123456789abcdef0123456789abcdef0"));
    EXPECT_FALSE(token.is("1123456789abcdef0123456789abcdef"));
    EXPECT_FALSE(token.is("0123456789abcdef0123456789abcdee"));
    EXPECT_FALSE(token.is("0123456789ABCDEF0123456789ABCDEF"));
}

} // namespace
} // namespace pallax
