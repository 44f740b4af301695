#include "LogGenerator/Records/SampleValue.h"

#include "tests/doubles/Property.h"

#include <gtest/gtest.h>

#include <cstdlib>
#include <optional>
#include <string>
#include <utility>

namespace pallax {
namespace {

using Read = std::optional<std::pair<double, std::string>>;

/// The number and the unit in a text.
Read numberOf(const std::string& text) {
    const auto found = numberTextIn(text);
    return found ? Read({found->number, std::string(found->unit)}) : std::nullopt;
}

TEST(NumberText, IsANumberAndPerhapsAUnit) {
    EXPECT_EQ(numberOf("85"), Read({85, ""}));
    EXPECT_EQ(numberOf("-96.5 dBm"), Read({-96.5, "dBm"}));
    EXPECT_EQ(numberOf("+7 dB"), Read({7, "dB"}));
    EXPECT_EQ(numberOf("61%"), Read({61, "%"}));
    EXPECT_EQ(numberOf("007"), Read({7, ""}));
    EXPECT_EQ(numberOf("5."), Read({5, ""}));
}

TEST(NumberText, IsNoOtherText) {
    for (const char* text : {"", "-", "+", "inf", "nan", "dBm", ".5", "5 6", "5 ", "5 dB m", "4,1",
                             "0x1F", "12:30", "1e3", "--5", "5-6"}) {
        EXPECT_EQ(numberOf(text), Read()) << text;
    }
}

TEST(NumberText, OfManyDigitsIsTheNearestDouble) {
    EXPECT_EQ(numberOf("999999999999999"), Read({999999999999999.0, ""}));
    EXPECT_EQ(numberOf("9007199254740993"), Read({9007199254740992.0, ""}));
    EXPECT_EQ(numberOf("18446744073709551621"), Read({18446744073709551621.0, ""}));
    EXPECT_EQ(numberOf(std::string(400, '9')), Read());
}

TEST(NumberTextProperty, HasTheValueThatTheLibraryReads) {
    EXPECT_TRUE(doubles::holds([] {
        const std::string digits = "1" + doubles::any::textOf("0123456789");
        const Read read = numberOf(digits + " dBm");
        RC_ASSERT(read.has_value());
        RC_ASSERT(read->first == std::strtod(digits.c_str(), nullptr));
        RC_ASSERT(read->second == "dBm");
    }));
}

} // namespace
} // namespace pallax
