#include "LogGenerator/Records/Conversion.h"

#include "tests/doubles/RecordFixture.h"

#include <gtest/gtest.h>

#include <array>

namespace pallax {
namespace {

constexpr NumberFormat kLevel{"%4.2f dBm"};
constexpr auto kLabels = std::to_array<std::string_view>({"Zero", "One", "Two"});

PropertyList displayOf(const Conversion& conversion, std::int64_t raw) {
    PropertyList value;
    conversion.valueOf(raw).showIn(value);
    return value;
}

std::string shown(const Conversion& conversion, std::int64_t raw) {
    return displayOf(conversion, raw).string().value_or("(no text)");
}

TEST(Conversion, NumbersKeepNumberAndFormat) {
    const PropertyList value = displayOf(Conversion::number(kDecimalDbm), -80);
    ASSERT_NE(value.displayNumber(), nullptr);
    EXPECT_EQ(value.displayNumber()->integer(), -80);
    EXPECT_EQ(value.string(), "-80 dBm");
}

TEST(Conversion, ScalesInDoublePrecision) {
    EXPECT_EQ(shown(Conversion::number(kLevel, 0.25, -140.0), 0), "-140.00 dBm");
    EXPECT_EQ(shown(Conversion::number(kLevel, 0.25, -140.0), 511), "-12.25 dBm");
    EXPECT_EQ(shown(Conversion::number(kDecimalDbm, 2.0, -140.0), 63), "-14 dBm");
}

TEST(Conversion, LabelsComeFromTheTableAndBeyondItFromTheFallback) {
    const Conversion label = Conversion::label(kLabels);
    EXPECT_EQ(shown(label, 0), "Zero");
    EXPECT_EQ(shown(label, 2), "Two");
    EXPECT_EQ(shown(label, 3), "Unknown");
    EXPECT_EQ(shown(label, 255), "Unknown");
    EXPECT_EQ(shown(Conversion::label(kLabels, "?? ms"), 3), "?? ms");
}

TEST(Conversion, AShiftedTableIsIndexedByTheBytePlusOneModulo256) {
    const Conversion label = Conversion::label(kLabels, "Unknown", 1);
    EXPECT_EQ(shown(label, 255), "Zero");
    EXPECT_EQ(shown(label, 0), "One");
    EXPECT_EQ(shown(label, 1), "Two");
    EXPECT_EQ(shown(label, 2), "Unknown");
    EXPECT_EQ(shown(label, 254), "Unknown");
}

TEST(Conversion, FlagsShowTheClearTextForZeroOnly) {
    const Conversion flag = Conversion::flag("ON", "OFF");
    EXPECT_EQ(shown(flag, 0), "OFF");
    EXPECT_EQ(shown(flag, 1), "ON");
    EXPECT_EQ(shown(flag, 255), "ON");
}

TEST(Conversion, AnExceptionalRawValueShowsItsText) {
    const Conversion power = Conversion::number(kDecimalDbm, 1.0, -30.0).except(64, "Not Present");
    EXPECT_EQ(shown(power, 64), "Not Present");
    EXPECT_EQ(shown(power, 63), "33 dBm");
}

} // namespace
} // namespace pallax
