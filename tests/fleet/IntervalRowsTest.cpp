#include "fleet/IntervalRows.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

TEST(IntervalRowsTest, MonthsAreOfUtc) {
    EXPECT_EQ(monthOf(0), 197001U);
    EXPECT_EQ(monthOf(1'700'000'000'000), 202311U);
    EXPECT_EQ(monthOf(1'701'388'799'999), 202311U);
    EXPECT_EQ(monthOf(1'701'388'800'000), 202312U);
    EXPECT_EQ(monthOf(8'999'999'999'999), 225503U);
}

TEST(IntervalRowsTest, ATextIsMadeOfItsNumberIfThatIsExact) {
    const auto made = [](double number, std::string_view text) {
        const DecimalText parts = decimalTextOf(number, text);
        return std::to_string(parts.decimals) + "|" + std::string(parts.suffix);
    };
    EXPECT_EQ(made(-82.75, "-82.75 dBm"), "2| dBm");
    EXPECT_EQ(made(-82, "-82.00 dBm"), "2| dBm");
    EXPECT_EQ(made(5.05, "5.05"), "2|");
    EXPECT_EQ(made(0.07, "0.07"), "-1|") << "0.07 * 100 is 7.000000000000001";
    EXPECT_EQ(made(0.25, "0.25"), "2|");
    EXPECT_EQ(made(-0.5, "-0.5 dB"), "1| dB");
    EXPECT_EQ(made(1850, "1850"), "0|");
    EXPECT_EQ(made(12, "12%"), "0|%");
    // It would be another text:
    EXPECT_EQ(made(-82.75, "-82.8 dBm"), "-1|");
    EXPECT_EQ(made(-0.0, "-0.00 dBm"), "-1|");
    EXPECT_EQ(made(7, "007"), "-1|");
    EXPECT_EQ(made(7, "0x7"), "-1|");
    EXPECT_EQ(made(7, "+7"), "-1|");
    EXPECT_EQ(made(7, " 7"), "-1|");
    EXPECT_EQ(made(7, "7."), "-1|");
    EXPECT_EQ(made(0, ""), "-1|");
    EXPECT_EQ(made(1e17, "100000000000000000"), "-1|");
    EXPECT_EQ(made(0.0625, "0.06250"), "-1|") << "more decimals than the view has";
}

} // namespace
} // namespace pallax
