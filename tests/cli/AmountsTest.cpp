#include "cli/Amounts.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

TEST(Amounts, ASizeIsANumberWithAUnit) {
    EXPECT_EQ(*parseSize("1"), 1U);
    EXPECT_EQ(*parseSize("64k"), 65536U);
    EXPECT_EQ(*parseSize("100M"), 104857600U);
    EXPECT_EQ(*parseSize("2G"), 2147483648U);
    EXPECT_EQ(*parseSize("17179869183G"), 18446744072635809792U);
    for (const std::string wrong : {"", "k", "1K", "1kk", "-1", "1.5M", " 1", "1 "}) {
        EXPECT_EQ(parseSize(wrong).error(),
                  "\"" + wrong + "\" is not a size such as 4096, 64k, 100M or 2G");
    }
    for (const std::string far : {"0", "0k", "99999999999999999999", "17179869184G"}) {
        EXPECT_EQ(parseSize(far).error(),
                  "\"" + far + "\" is out of range, which is from 1 to 17179869183G");
    }
}

TEST(Amounts, SecondsAreANumberAbove0) {
    using std::chrono::nanoseconds;
    EXPECT_EQ(*parseSeconds("1.5"), std::chrono::milliseconds(1500));
    EXPECT_EQ(*parseSeconds("1e9"), std::chrono::seconds(1'000'000'000));
    EXPECT_EQ(*parseSeconds("1e-30"), nanoseconds(1)) << "never 0";
    for (const std::string wrong : {"", "x", "nan", "1s", " 1"}) {
        EXPECT_EQ(parseSeconds(wrong).error(), "\"" + wrong + "\" is not a number of seconds");
    }
    for (const std::string far : {"0", "-1", "1000000001", "inf", "1e999"}) {
        EXPECT_EQ(parseSeconds(far).error(),
                  "\"" + far + "\" is out of range, which is above 0 and up to 1000000000");
    }
}

} // namespace
} // namespace pallax
