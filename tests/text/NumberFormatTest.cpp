#include "text/NumberFormat.h"

#include "tests/doubles/Property.h"
#include "text/Format.h"
#include "text/Text.h"

#include <gtest/gtest.h>

#include <clocale>
#include <cmath>
#include <cstdio>
#include <limits>

namespace pallax {
namespace {

constexpr NumberFormat kPlain{"%d"};
constexpr NumberFormat kUnsigned{"%u"};
constexpr NumberFormat kDbm{"%d dBm"};
constexpr NumberFormat kLevel{"%4.2f dBm"};
constexpr NumberFormat kMean{"%4.2lf dBm"};
constexpr NumberFormat kSix{"%f dB"};
constexpr NumberFormat kSigned{"%+.2f dB"};
constexpr NumberFormat kPercent{"%.02f%%"};
constexpr NumberFormat kOld{"%.02f%% (old)", "%"};
constexpr NumberFormat kHex{"0x%06x"};
constexpr NumberFormat kReserved{"[Reserved %d]"};

std::string printed(const char* format, double value) {
    char buffer[1024]; // NOLINT: printf writes it
    (void)std::snprintf(buffer, sizeof buffer, format, value);
    return buffer;
}

TEST(NumberFormat, TextsAreThoseOfPrintf) {
    EXPECT_EQ(DisplayNumber(std::int64_t{-98}, kDbm).text(), "-98 dBm");
    EXPECT_EQ(DisplayNumber(-140.0, kLevel).text(), "-140.00 dBm");
    EXPECT_EQ(DisplayNumber(1.0, kLevel).text(), "1.00 dBm");
    EXPECT_EQ(DisplayNumber(std::int64_t{1}, kLevel).text(), "1.00 dBm");
    EXPECT_EQ(DisplayNumber(-7.5, kSix).text(), "-7.500000 dB");
    EXPECT_EQ(DisplayNumber(0.0, kSigned).text(), "+0.00 dB");
    EXPECT_EQ(DisplayNumber(63.4951, kPercent).text(), "63.50%");
    EXPECT_EQ(DisplayNumber(63.4951, kOld).text(), "63.50% (old)");
    EXPECT_EQ(DisplayNumber(std::int64_t{0xABC}, kHex).text(), "0x000abc");
    EXPECT_EQ(DisplayNumber(std::int64_t{7}, kReserved).text(), "[Reserved 7]");
}

TEST(NumberFormat, A32BitValueUnderDPrintsSignedAndUnderUUnsigned) {
    constexpr std::int64_t kHigh = 0xFFFFFFFE;
    EXPECT_EQ(DisplayNumber(kHigh, kPlain).text(), "-2");
    EXPECT_EQ(DisplayNumber(kHigh, kUnsigned).text(), "4294967294");
}

TEST(NumberFormat, NotANumberNeverShowsASign) {
    EXPECT_EQ(DisplayNumber(std::numeric_limits<double>::quiet_NaN(), kMean).text(), " nan dBm");
    EXPECT_EQ(DisplayNumber(-std::numeric_limits<double>::quiet_NaN(), kMean).text(), " nan dBm");
    EXPECT_EQ(DisplayNumber(-std::numeric_limits<double>::quiet_NaN(), kSix).text(), "nan dB");
    EXPECT_EQ(DisplayNumber(-std::numeric_limits<double>::infinity(), kSigned).text(), "-inf dB");
}

TEST(NumberFormat, UnitIsTheTextBehindTheNumber) {
    EXPECT_EQ(kLevel.unit(), "dBm");
    EXPECT_EQ(kSix.unit(), "dB");
    EXPECT_EQ(kPercent.unit(), "%");
    EXPECT_EQ(kOld.unit(), "%");
    EXPECT_EQ(kPlain.unit(), "");
    EXPECT_EQ(kReserved.unit(), "");
}

TEST(NumberFormat, ACommaLocaleChangesNothing) {
    const std::string before = std::setlocale(LC_ALL, nullptr);
    // The build makes the locale.
    ASSERT_EQ(setenv("LOCPATH", PALLAX_LOCALES, 1), 0);
    ASSERT_NE(std::setlocale(LC_ALL, "de_DE.UTF-8"), nullptr);
    EXPECT_EQ(printed("%.1f", 0.5), "0,5") << "the locale has a comma";
    EXPECT_EQ(DisplayNumber(-94.75, kLevel).text(), "-94.75 dBm");
    EXPECT_EQ(formatText("Measured RSSI: %lf\n", {-75.5}), "Measured RSSI: -75.500000\n");
    (void)std::setlocale(LC_ALL, before.c_str());
}

TEST(NumberFormatProperty, RealsAgreeWithPrintf) {
    EXPECT_TRUE(doubles::holds([] {
        const double value = doubles::any::real();
        RC_ASSERT(DisplayNumber(value, kLevel).text() == printed("%4.2f dBm", value));
        RC_ASSERT(DisplayNumber(value, kSix).text() == printed("%f dB", value));
        RC_ASSERT(DisplayNumber(value, kSigned).text() == printed("%+.2f dB", value));
    }));
}

TEST(NumberFormat, LargestRealFits) {
    EXPECT_EQ(DisplayNumber(-std::numeric_limits<double>::max(), kSix).text(),
              printed("%f dB", -std::numeric_limits<double>::max()));
}

TEST(FormatText, TakesTheConversionsOfLogTexts) {
    EXPECT_EQ(formatText("Log Header 0x%x", {0x81}), "Log Header 0x81");
    EXPECT_EQ(formatText("Invalid data packet len=%lu expected=%lu", {std::size_t{12}, 13}),
              "Invalid data packet len=12 expected=13");
    EXPECT_EQ(formatText("100%% of %@ and %s", {"this", std::string("that")}),
              "100% of this and that");
    EXPECT_EQ(formatText("%c%c%c", {'3', '1', '0'}), "310");
    EXPECT_EQ(formatText("%05d|%-5d|% d", {42, 42, 42}), "00042|42   | 42");
    EXPECT_EQ(formatText("%X %#x", {255, 255}), "FF 0xff");
    EXPECT_EQ(formatText("%.4d|%6.4d|%.3s", {-42, 42, "serving"}), "-0042|  0042|ser");
    EXPECT_EQ(formatText("%.1f", {3}), "3.0");
    EXPECT_EQ(formatText("%@", {Text("serving")}), "serving");
}

TEST(FormatText, RefusesOtherConversions) {
    EXPECT_THROW((void)formatText("%q", {1}), std::invalid_argument);
    EXPECT_THROW((void)formatText("%401d", {1}), std::invalid_argument);
    EXPECT_EQ(formatText("%400d", {1}).size(), 400U);
}

TEST(FormatText, AnArgumentPrintsAsWhatItIs) {
    EXPECT_EQ(formatText("%s", {12}), "12");
    EXPECT_EQ(formatText("%d", {"text"}), "text");
    EXPECT_EQ(formatText("%d and %d", {1}), "1 and ");
}

TEST(FormatText, AddressesPrintAsPrintfsP) {
    const int object = 0;
    char buffer[64]; // NOLINT: printf writes it
    (void)std::snprintf(buffer, sizeof buffer, "%p", static_cast<const void*>(&object));
    EXPECT_EQ(formatText("%p", {static_cast<const void*>(&object)}), buffer);
    EXPECT_EQ(formatText("%p", {static_cast<const void*>(nullptr)}), "(nil)");
}

TEST(FormatText, DumpsBytesInGroupsOfFour) {
    const std::uint8_t bytes[] = {0x01, 0x00, 0xAB, 0xFF, 0x7F};
    EXPECT_EQ(dumpOf(bytes, sizeof bytes), "<0100abff 7f>");
    EXPECT_EQ(dumpOf(bytes, 0), "<>");
}

} // namespace
} // namespace pallax
