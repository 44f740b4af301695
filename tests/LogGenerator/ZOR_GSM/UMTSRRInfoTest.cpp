#include "LogGenerator/ZOR_GSM/UMTSRRInfo.h"

#include "tests/doubles/RecordFixture.h"
#include "tests/doubles/RecordProperties.h"

#include <gtest/gtest.h>

#include <cmath>

namespace pallax {
namespace {

using namespace doubles; // NOLINT: the vocabulary of these tests
using Lines = std::vector<RecordingLog::Line>;

Record umtsState(unsigned value) {
    return Record(0x4125).u8(value);
}

Record identity(std::int32_t uplink, std::int32_t downlink, std::int32_t cell, unsigned ura) {
    return Record(0x4127).s32(uplink).s32(downlink).s32(cell).u16(ura).padTo(29);
}

Record ciphering(unsigned value) {
    return Record(0x4157).u8(value).padTo(19);
}

/// The bytes around each raw power are not zero.
Record transmitPower(const std::vector<int>& rawPowers) {
    Record record(0x4031);
    record.u8(0xA5).u8(static_cast<unsigned>(rawPowers.size())).u8(0xA5);
    for (const int raw : rawPowers) {
        record.u32(0xA5A5A5A5).s16(raw).u32(0xA5A5A5A5).u32(0xA5A5A5A5);
    }
    return record;
}

/// The shown "Transmit Power" after a record.
std::string powerAfter(const ByteBuffer& bytes) {
    RecordFixture<UMTSRRInfo> fixture;
    fixture.feed(bytes);
    EXPECT_EQ(fixture.keys().size(), 1U);
    return fixture.text("Transmit Power");
}

TEST(UMTSRRInfo, SubscribesToStatePowerIdentityCipheringAndTheCellMonitor) {
    const UMTSRRInfo record;
    const auto codes = record.getLogCodeArray();
    EXPECT_EQ(std::vector<LogCode>(codes.begin(), codes.end()),
              (std::vector<LogCode>{0x4125, 0x4031, 0x4127, 0x4157, 0xFF0001}));
    EXPECT_EQ(record.getSectionName(), "UMTS RR Info");
    EXPECT_EQ(record.sectionKind(), SectionKind::Keys);
}

TEST(UMTSRRInfo, RRCStateByte3ShowsCELL_DCHAnd6ShowsUnknown) {
    expectInOrder(sectionAfter<UMTSRRInfo>(umtsState(3)), Dictionary{{"RRC State", "CELL_DCH"}});
    expectInOrder(sectionAfter<UMTSRRInfo>(umtsState(6)), Dictionary{{"RRC State", "Unknown"}});
}

TEST(UMTSRRInfo, EveryRRCStateHasItsLabel) {
    const std::vector<std::string> labels = {"Disconnected", "Connecting", "CELL_FACH",
                                             "CELL_DCH",     "CELL_PCH",   "URA_PCH"};
    RecordFixture<UMTSRRInfo> fixture;
    for (unsigned value = 0; value < 256; ++value) {
        fixture.feed(umtsState(value));
        EXPECT_EQ(fixture.text("RRC State"), value < labels.size() ? labels[value] : "Unknown");
    }
}

TEST(UMTSRRInfo, TheIdentityShowsCellIDDownlinkUplinkAndURAIDInThisOrder) {
    expectInOrder(sectionAfter<UMTSRRInfo>(identity(9763, 10713, 123456789, 513)),
                  Dictionary{{"Cell ID", "123456789"},
                             {"Downlink Frequency", "10713"},
                             {"Uplink Frequency", "9763"},
                             {"URA ID", "513"}});
}

TEST(UMTSRRInfo, The32BitValuesOfTheIdentityAreSignedAndTheURAIDIsNot) {
    RecordFixture<UMTSRRInfo> fixture;
    fixture.feed(identity(-1, -2147483648, 2147483647, 65535));
    expectInOrder(fixture.section(), Dictionary{{"Cell ID", "2147483647"},
                                                {"Downlink Frequency", "-2147483648"},
                                                {"Uplink Frequency", "-1"},
                                                {"URA ID", "65535"}});
    EXPECT_EQ(fixture.keys().find("Uplink Frequency")->displayNumber()->integer(), -1);
}

TEST(UMTSRRInfo, ACipheringByteOf2ShowsEnabled) {
    expectInOrder(sectionAfter<UMTSRRInfo>(ciphering(2)), Dictionary{{"Ciphering", "Enabled"}});
}

TEST(UMTSRRInfo, OnlyACipheringByteOf0ShowsDisabled) {
    RecordFixture<UMTSRRInfo> fixture;
    for (unsigned value = 0; value < 256; ++value) {
        fixture.feed(ciphering(value));
        EXPECT_EQ(fixture.text("Ciphering"), value == 0 ? "Disabled" : "Enabled");
    }
}

TEST(UMTSRRInfo, TransmitPowerEntries0And88AndMinus12ShowMinus15Point00dBm) {
    RecordFixture<UMTSRRInfo> fixture;
    fixture.feed(transmitPower({0, 88, -12}));
    expectInOrder(fixture.section(), Dictionary{{"Transmit Power", "-15.00 dBm"}});
    const DisplayNumber* mean = fixture.keys().find("Transmit Power")->displayNumber();
    EXPECT_EQ(mean->real(), -15.0);
    EXPECT_EQ(mean->unit(), "dBm");
}

TEST(UMTSRRInfo, EachTransmitPowerIsTruncatedTowardZeroBeforeTheMean) {
    const auto power = [](int raw) { return powerAfter(transmitPower({raw}).bytes()); };
    EXPECT_EQ(power(188), "0.00 dBm");
    EXPECT_EQ(power(187), "-1.00 dBm");
    EXPECT_EQ(power(197), "0.00 dBm");
    EXPECT_EQ(power(-512), "-70.00 dBm");
    EXPECT_EQ(power(-521), "-70.00 dBm");
    EXPECT_EQ(power(-522), "-71.00 dBm");
    EXPECT_EQ(power(-32768), "-3295.00 dBm");
    EXPECT_EQ(power(32767), "3257.00 dBm");
}

TEST(UMTSRRInfo, TheMeanOfTheTransmitPowersIsNotCutToWholeNumbers) {
    EXPECT_EQ(powerAfter(transmitPower({88, 88, 78}).bytes()), "-10.33 dBm");
    EXPECT_EQ(powerAfter(transmitPower({88, 78, 78}).bytes()), "-10.67 dBm");
    EXPECT_EQ(powerAfter(transmitPower(std::vector<int>(255, 32767)).bytes()), "3257.00 dBm");
}

// "%4.2lf dBm" of an empty mean: "nan" has 3 characters in a width of 4.
TEST(UMTSRRInfo, Percent4Point2lf_dBm_OfAnEmptyMeanIsABlankAndNan) {
    EXPECT_EQ(powerAfter(transmitPower({}).bytes()), " nan dBm") << "no entries";
    EXPECT_EQ(powerAfter(transmitPower({0, 0}).bytes()), " nan dBm") << "no power counts";
    EXPECT_EQ(powerAfter(Record(0x4031).u8(0).u8(255).u8(0).bytes()), " nan dBm") << "none whole";
    RecordFixture<UMTSRRInfo> fixture;
    fixture.feed(transmitPower({}));
    EXPECT_TRUE(std::isnan(fixture.keys().find("Transmit Power")->displayNumber()->real()));
}

TEST(UMTSRRInfo, ATransmitPowerEntryIsWholeWhenItsRawPowerIs) {
    const ByteBuffer bytes = transmitPower({88, -12}).bytes();
    constexpr std::size_t kFirstWhole = 16 + 6;
    constexpr std::size_t kSecondWhole = 16 + 14 + 6;
    for (std::size_t length = 16; length <= bytes.size(); ++length) {
        const std::string expected = length >= kSecondWhole  ? "-15.00 dBm"
                                     : length >= kFirstWhole ? "-10.00 dBm"
                                                             : " nan dBm";
        EXPECT_EQ(powerAfter(ByteBuffer(bytes.begin(),
                                        bytes.begin() + static_cast<std::ptrdiff_t>(length))),
                  expected)
            << "cut at " << length;
    }
}

TEST(UMTSRRInfo, LogsItsLineOnEveryCall) {
    RecordFixture<UMTSRRInfo> fixture;
    for (const Record& record :
         {umtsState(0), identity(0, 0, 0, 0), ciphering(0), transmitPower({})}) {
        fixture.feed(record);
        EXPECT_EQ(fixture.lines, (Lines{{4, "UMTSRRInfo"}}));
    }
    for (const LogCode code : std::vector<LogCode>{0x4125U, 0x4127U, 0x4157U, 0x4031U}) {
        fixture.feed(Record(code));
        EXPECT_EQ(fixture.lines, (Lines{{4, "UMTSRRInfo"}}))
            << "a short packet is dropped silently";
    }
}

TEST(UMTSRRInfo, AnyOtherCodeIsUnknownAndChangesNothing) {
    RecordFixture<UMTSRRInfo> fixture;
    fixture.feed(Record(0x4116).padTo(100));
    EXPECT_EQ(fixture.lines,
              (Lines{{4, "UMTSRRInfo"}, {3, "Received an unknown log message: 16662"}}));
    EXPECT_TRUE(fixture.keys().empty());
}

TEST(UMTSRRInfo, APacketOneByteBelowItsMinimumChangesNothing) {
    cutAtEveryLength<UMTSRRInfo>(umtsState(3), 14);
    cutAtEveryLength<UMTSRRInfo>(identity(1, 2, 3, 4), 29);
    cutAtEveryLength<UMTSRRInfo>(ciphering(1), 19);
    cutAtEveryLength<UMTSRRInfo>(transmitPower({88, -12}), 16);
}

TEST(UMTSRRInfo, EachCodesKeysStayUntilTheyAreOverwritten) {
    RecordFixture<UMTSRRInfo> fixture;
    fixture.feed(umtsState(3));
    fixture.feed(ciphering(1));
    fixture.feed(transmitPower({88}));
    fixture.feed(identity(1, 2, 3, 4));
    fixture.feed(umtsState(0));
    expectInOrder(fixture.section(), Dictionary{{"RRC State", "Disconnected"},
                                                {"Ciphering", "Enabled"},
                                                {"Transmit Power", "-10.00 dBm"},
                                                {"Cell ID", "3"},
                                                {"Downlink Frequency", "2"},
                                                {"Uplink Frequency", "1"},
                                                {"URA ID", "4"}});
}

TEST(UMTSRRInfo, AnyBytesKeepItsSectionWithinItsKeys) {
    anyBytesKeepWithin<UMTSRRInfo>({"RRC State", "Cell ID", "Downlink Frequency",
                                    "Uplink Frequency", "URA ID", "Ciphering", "Transmit Power",
                                    "UARFCN", "Scrambling Code"});
}

} // namespace
} // namespace pallax
