#include "LogGenerator/C2K/EVDOStatus.h"

#include "tests/LogGenerator/C2K/C2KFixture.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using namespace doubles; // NOLINT: the vocabulary of these tests
using Lines = std::vector<RecordingLog::Line>;

/// Connected on channel 283 of the PCS band.
Record status() {
    return Record(0x1183)
        .u8(0x1B)    // channel, low 8 bits
        .u8(0x09)    // its high 3 bits: 283; band class 1
        .s8(-71)     // receive gain 0
        .s8(-74)     // receive gain 1
        .s8(12)      // transmit gain
        .u16(168)    // serving PN offset
        .padTo(36)   //
        .u8(5)       // device state
        .u8(4)       // session state
        .u16(0xC0DE) // UATI24, low 16 bits
        .u8(0x0A)    // its high 8 bits
        .u8(63)      // color code
        .padTo(50);
}

TEST(EVDOStatus, APacketSetsEveryRowOfItsTable) {
    C2KFixture fixture;
    EXPECT_EQ(PropertyList(fixture.writtenBy(status())),
              PropertyList(Dictionary{{"kChannel", "283"},
                                      {"k1xEVDODeviceState", "Connected [5]"},
                                      {"kBandClass", "1.8 to 2.0GHz PCS band [1]"},
                                      {"kRxAGC0", "-71 dBm"},
                                      {"kRxAGC1", "-74 dBm"},
                                      {"kTxAGC", "+12 dBm"},
                                      {"kServingPNOffset", "168 × 64chips"},
                                      {"kSessionState", "Open [4]"},
                                      {"kUATI24", "0x0ac0de"},
                                      {"kColorCode", "63"}}));
    EXPECT_EQ(fixture.lines, Lines());
}

TEST(EVDOStatus, APacketOf49Or51BytesSetsNothing) {
    C2KFixture fixture;
    EXPECT_TRUE(fixture.writtenBy(status().padTo(51)).empty());
    EXPECT_EQ(fixture.lines,
              (Lines{{3, "Log code 0x1183 is 51 bytes long but should be 50 bytes."}}));
    ByteBuffer shorter = status().bytes();
    shorter.pop_back();
    fixture.feed(shorter);
    EXPECT_TRUE(fixture.written().empty());
    EXPECT_EQ(fixture.lines,
              (Lines{{3, "Log code 0x1183 is 49 bytes long but should be 50 bytes."}}));
    cutPacketAtEveryLength(status().padTo(60), 50);
}

TEST(EVDOStatus, TheChannelIsByte13WithTheLow3BitsOfByte14Above) {
    C2KFixture fixture;
    const auto channel = [&fixture](unsigned byte13, unsigned byte14) {
        fixture.feed(status().at(13, byte13).at(14, byte14));
        return fixture.text("kChannel");
    };
    EXPECT_EQ(channel(0x00, 0xF8), "0") << "the band class";
    EXPECT_EQ(channel(0xFF, 0x00), "255");
    EXPECT_EQ(channel(0x00, 0x01), "256");
    EXPECT_EQ(channel(0x00, 0x04), "1024");
    EXPECT_EQ(channel(0xFF, 0x07), "2047");
}

TEST(EVDOStatus, EveryDeviceStateHasItsLabel) {
    C2KFixture fixture;
    const auto label = [&fixture](unsigned state) {
        fixture.feed(status().at(36, state));
        return fixture.text("k1xEVDODeviceState");
    };
    EXPECT_EQ(label(0), "Inactive [0]");
    EXPECT_EQ(label(1), "Acquisition [1]");
    EXPECT_EQ(label(2), "Sync [2]");
    EXPECT_EQ(label(3), "Idle [3]");
    EXPECT_EQ(label(4), "Access [4]");
    EXPECT_EQ(label(5), "Connected [5]");
    EXPECT_EQ(label(6), "[Reserved 6]");
    EXPECT_EQ(label(255), "[Reserved 255]");
}

TEST(EVDOStatus, EverySessionStateHasItsLabel) {
    C2KFixture fixture;
    const auto label = [&fixture](unsigned state) {
        fixture.feed(status().at(37, state));
        return fixture.text("kSessionState");
    };
    EXPECT_EQ(label(0), "Closed [0]");
    EXPECT_EQ(label(1), "AMP setup [1]");
    EXPECT_EQ(label(2), "AT-initiated neg [2]");
    EXPECT_EQ(label(3), "Initiated neg [3]");
    EXPECT_EQ(label(4), "Open [4]");
    EXPECT_EQ(label(5), "[Reserved 5]");
    EXPECT_EQ(label(255), "[Reserved 255]");
}

TEST(EVDOStatus, EveryBandClassOfTheHigh5BitsOfByte14HasItsLabel) {
    C2KFixture fixture;
    const auto label = [&fixture](unsigned bandClass) {
        fixture.feed(status().at(14, bandClass << 3U | 7U));
        return fixture.text("kBandClass");
    };
    EXPECT_EQ(label(0), "800 MHz cellular band [0]");
    EXPECT_EQ(label(1), "1.8 to 2.0GHz PCS band [1]");
    EXPECT_EQ(label(2), "872 to 960MHz TACS band [2]");
    EXPECT_EQ(label(3), "832 to 925MHz JTACS band [3]");
    EXPECT_EQ(label(4), "1.75 to 1.87GHz Korean PCS band [4]");
    EXPECT_EQ(label(5), "450MHz band [5]");
    EXPECT_EQ(label(6), "2GHz band [6]");
    EXPECT_EQ(label(7), "700MHz band [7]");
    EXPECT_EQ(label(8), "1800 MHz band [8]");
    EXPECT_EQ(label(9), "900 MHzband [9]");
    EXPECT_EQ(label(10), "Secondary 800 MHz band [10]");
    EXPECT_EQ(label(11), "400 MHz European PAMR band [11]");
    EXPECT_EQ(label(12), "800 MHz European PAMR band [12]");
    EXPECT_EQ(label(13), "[Bad Value 13]");
    EXPECT_EQ(label(31), "[Bad Value 31]");
}

TEST(EVDOStatus, WithDeviceState3BothRxAGC1AndTxAGCReadNA) {
    C2KFixture fixture;
    fixture.feed(status().at(36, 3));
    EXPECT_EQ(fixture.text("kRxAGC0"), "-71 dBm");
    EXPECT_EQ(fixture.text("kRxAGC1"), "N/A");
    EXPECT_EQ(fixture.text("kTxAGC"), "N/A");
    for (const unsigned transmitting : {4U, 5U, 6U, 255U}) {
        fixture.feed(status().at(36, transmitting));
        EXPECT_EQ(fixture.text("kRxAGC1"), "-74 dBm") << transmitting;
        EXPECT_EQ(fixture.text("kTxAGC"), "+12 dBm") << transmitting;
    }
}

TEST(EVDOStatus, GainsAreSignedBytesShownWithTheirSign) {
    C2KFixture fixture;
    const auto gains = [&fixture](unsigned raw) {
        fixture.feed(status().at(15, raw).at(16, raw).at(17, raw));
        EXPECT_EQ(fixture.text("kRxAGC1"), fixture.text("kRxAGC0"));
        EXPECT_EQ(fixture.text("kTxAGC"), fixture.text("kRxAGC0"));
        return fixture.text("kRxAGC0");
    };
    EXPECT_EQ(gains(0), "+0 dBm");
    EXPECT_EQ(gains(1), "+1 dBm");
    EXPECT_EQ(gains(0x7F), "+127 dBm");
    EXPECT_EQ(gains(0x80), "-128 dBm");
    EXPECT_EQ(gains(0xFF), "-1 dBm");
}

TEST(EVDOStatus, AServingPNOffsetOf0xFFFFReadsInvalidValue) {
    C2KFixture fixture;
    const auto offset = [&fixture](unsigned low, unsigned high) {
        fixture.feed(status().at(18, low).at(19, high));
        return fixture.text("kServingPNOffset");
    };
    EXPECT_EQ(offset(0xFF, 0xFF), "Invalid Value");
    EXPECT_EQ(offset(0xFE, 0xFF), "65534 × 64chips");
    EXPECT_EQ(offset(0, 0), "0 × 64chips");
    EXPECT_EQ(offset(0, 1), "256 × 64chips");
    EXPECT_EQ(fixture.value("kServingPNOffset").displayNumber()->unit(), "64chips");
}

TEST(EVDOStatus, TheUATI24IsSixHexadecimalDigits) {
    C2KFixture fixture;
    const auto uati = [&fixture](unsigned low, unsigned middle, unsigned high) {
        fixture.feed(status().at(38, low).at(39, middle).at(40, high));
        return fixture.text("kUATI24");
    };
    EXPECT_EQ(uati(0, 0, 0), "0x000000");
    EXPECT_EQ(uati(1, 0, 0), "0x000001");
    EXPECT_EQ(uati(0x12, 0x34, 0xAB), "0xab3412");
    EXPECT_EQ(uati(0xFF, 0xFF, 0xFF), "0xffffff");
}

TEST(EVDOStatus, ItsNumbersAreDisplayNumbers) {
    C2KFixture fixture;
    fixture.feed(status());
    EXPECT_EQ(fixture.value("kChannel").displayNumber()->integer(), 283);
    EXPECT_EQ(fixture.value("kRxAGC0").displayNumber()->integer(), -71);
    EXPECT_EQ(fixture.value("kRxAGC0").displayNumber()->unit(), "dBm");
    EXPECT_EQ(fixture.value("kUATI24").displayNumber()->integer(), 0x0AC0DE);
}

TEST(EVDOStatus, AnyBytesWriteOnlyItsRows) {
    anyPacketWritesOnly(0x1183,
                        {"kChannel", "k1xEVDODeviceState", "kBandClass", "kRxAGC0", "kRxAGC1",
                         "kTxAGC", "kServingPNOffset", "kSessionState", "kUATI24", "kColorCode"},
                        {50});
}

} // namespace
} // namespace pallax
