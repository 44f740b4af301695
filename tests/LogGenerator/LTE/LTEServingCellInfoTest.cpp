#include "LogGenerator/LTE/LTEServingCellInfo.h"

#include "tests/doubles/RecordFixture.h"
#include "tests/doubles/RecordProperties.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using namespace doubles; // NOLINT: the vocabulary of these tests
using Lines = std::vector<RecordingLog::Line>;

Record identity() {
    return Record(0xB0C2)
        .u8(3)      // version
        .u16(274)   // physical cell ID
        .u16(1850)  // downlink EARFCN
        .u16(19850) // uplink EARFCN
        .u8(100)    // downlink resource blocks
        .u8(50)     // uplink resource blocks
        .u32(26738688)
        .u16(6699) // tracking area
        .u32(3)    // band
        .padTo(38);
}

Dictionary identityShown() {
    return {{"Physical Cell ID", "274"},    {"Download Frequency", "1850"},
            {"Upload Frequency", "19850"},  {"Download Bandwidth", "20 MHz"},
            {"Upload Bandwidth", "10 MHz"}, {"Cell Identity", "26738688"},
            {"Tracking Area Code", "6699"}, {"Freq Band Indicator", "3"}};
}

Record antennas(unsigned count) {
    return Record(0xB0C1).padTo(22).at(20, count);
}

TEST(LTEServingCellInfo, SubscribesToItsThreeRecords) {
    const RecordFixture<LTEServingCellInfo> fixture;
    EXPECT_EQ(fixture.subscriptions(), (std::vector<LogCode>{0xB0C2, 0xB0C1, 0xFF0001}));
    EXPECT_EQ(LTEServingCellInfo().getSectionName(), "Serving Cell Info");
}

TEST(LTEServingCellInfo, ShowsTheIdentityInTheOrderOfTheKeys) {
    RecordFixture<LTEServingCellInfo> fixture;
    fixture.feed(identity());
    EXPECT_EQ(fixture.lines, (Lines{{4, "LTE Serving Cell Info"}}));
    expectInOrder(fixture.section(), identityShown());
    EXPECT_EQ(fixture.keys().find("Cell Identity")->displayNumber()->integer(), 26738688);
}

TEST(LTEServingCellInfo, ValuesOf32BitsAreSignedThoseOf16BitsAreNot) {
    const ByteBuffer ones(25, 0xFF);
    expectInOrder(sectionAfter<LTEServingCellInfo>(Record(0xB0C2).append(ones)),
                  Dictionary{{"Physical Cell ID", "65535"},
                             {"Download Frequency", "65535"},
                             {"Upload Frequency", "65535"},
                             {"Download Bandwidth", "Unknown"},
                             {"Upload Bandwidth", "Unknown"},
                             {"Cell Identity", "-1"},
                             {"Tracking Area Code", "65535"},
                             {"Freq Band Indicator", "-1"}});
    RecordFixture<LTEServingCellInfo> fixture;
    fixture.feed(identity().at(25, 0x80).at(31, 0x80).at(24, 0).at(23, 0).at(22, 0));
    EXPECT_EQ(fixture.text("Cell Identity"), "-2147483648");
    EXPECT_EQ(fixture.text("Freq Band Indicator"), "-2147483645");
}

TEST(LTEServingCellInfo, TheBandwidthIsALabelOfItsResourceBlocks) {
    const std::map<unsigned, std::string> labels = {{6, "1.4 MHz"}, {15, "3 MHz"},
                                                    {25, "5 MHz"},  {50, "10 MHz"},
                                                    {75, "15 MHz"}, {100, "20 MHz"}};
    RecordFixture<LTEServingCellInfo> fixture;
    for (unsigned blocks = 0; blocks < 256; ++blocks) {
        const auto found = labels.find(blocks);
        const std::string label = found != labels.end() ? found->second : "Unknown";
        fixture.feed(identity().at(20, blocks).at(21, 6));
        EXPECT_EQ(fixture.text("Download Bandwidth"), label) << blocks;
        EXPECT_EQ(fixture.text("Upload Bandwidth"), "1.4 MHz");
        fixture.feed(identity().at(20, 100).at(21, blocks));
        EXPECT_EQ(fixture.text("Download Bandwidth"), "20 MHz");
        EXPECT_EQ(fixture.text("Upload Bandwidth"), label) << blocks;
    }
}

TEST(LTEServingCellInfo, AGood0xB0C1IsShownAndStillLogsReceivedAnUnknownLogMessage) {
    RecordFixture<LTEServingCellInfo> fixture;
    fixture.feed(antennas(2));
    expectInOrder(fixture.section(), Dictionary{{"Num Tx Antennas", "2"}});
    EXPECT_EQ(fixture.lines,
              (Lines{{4, "LTE Serving Cell Info"}, {3, "Received an unknown log message: 45249"}}));
    fixture.feed(antennas(255));
    EXPECT_EQ(fixture.text("Num Tx Antennas"), "255");
}

TEST(LTEServingCellInfo, A0xB0C1Of21BytesChangesNothingAndLogsNoUnknownMessage) {
    cutAtEveryLength<LTEServingCellInfo>(antennas(2), 22);
    RecordFixture<LTEServingCellInfo> fixture;
    fixture.feed(Record(0xB0C1).padTo(21));
    EXPECT_EQ(fixture.lines, (Lines{{4, "LTE Serving Cell Info"}}));
}

TEST(LTEServingCellInfo, A0xB0C2Of37BytesChangesNothing) {
    cutAtEveryLength<LTEServingCellInfo>(identity(), 38);
    RecordFixture<LTEServingCellInfo> fixture;
    fixture.feed(Record(0xB0C2).padTo(37));
    EXPECT_EQ(fixture.lines, (Lines{{4, "LTE Serving Cell Info"}}))
        << "a short packet is dropped silently";
}

TEST(LTEServingCellInfo, EachRecordLeavesTheKeysOfTheOtherAsTheyWere) {
    RecordFixture<LTEServingCellInfo> fixture;
    fixture.feed(antennas(4));
    fixture.feed(identity());
    EXPECT_EQ(fixture.text("Num Tx Antennas"), "4");
    fixture.feed(antennas(2));
    EXPECT_EQ(fixture.text("Num Tx Antennas"), "2");
    EXPECT_EQ(fixture.text("Download Frequency"), "1850");
}

TEST(LTEServingCellInfo, AnyOtherCodeIsUnknownAndChangesNothing) {
    RecordFixture<LTEServingCellInfo> fixture;
    fixture.feed(Record(0xB0C3).padTo(100));
    EXPECT_EQ(fixture.lines,
              (Lines{{4, "LTE Serving Cell Info"}, {3, "Received an unknown log message: 45251"}}));
    EXPECT_TRUE(fixture.keys().empty());
}

TEST(LTEServingCellInfo, AnyBytesAndAnyCellsKeepWithinItsKeys) {
    const std::set<std::string> keys = {"Physical Cell ID",   "Download Frequency",
                                        "Upload Frequency",   "Download Bandwidth",
                                        "Upload Bandwidth",   "Cell Identity",
                                        "Tracking Area Code", "Freq Band Indicator",
                                        "Num Tx Antennas",    "UARFCN"};
    anyBytesKeepWithin<LTEServingCellInfo>(keys);
    anyCellsKeepWithin<LTEServingCellInfo>(keys);
}

} // namespace
} // namespace pallax
