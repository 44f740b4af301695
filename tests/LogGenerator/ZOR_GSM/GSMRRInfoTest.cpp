#include "LogGenerator/ZOR_GSM/GSMRRInfo.h"

#include "tests/doubles/RecordFixture.h"
#include "tests/doubles/RecordProperties.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using namespace doubles; // NOLINT: the vocabulary of these tests
using Lines = std::vector<RecordingLog::Line>;

Record gsmState(unsigned rrState, unsigned mode = 1) {
    return Record(0x512C).u8(rrState).u8(200).u8(3).u8(mode);
}

Record measurement() {
    return Record(0x5137).padTo(15).u8(95).s32(-2).s32(70000).padTo(29);
}

TEST(GSMRRInfo, SubscribesToItsFourRecords) {
    const RecordFixture<GSMRRInfo> fixture;
    EXPECT_EQ(fixture.subscriptions(), (std::vector<LogCode>{0x512C, 0x5137, 0x5072, 0x51F6}));
    EXPECT_EQ(GSMRRInfo().getSectionName(), "GSM RR Info");
}

TEST(GSMRRInfo, ShowsTheState) {
    expectInOrder(sectionAfter<GSMRRInfo>(gsmState(5)), Dictionary{{"RR State", "RR_IDLE"},
                                                                   {"RR Sub State", "200"},
                                                                   {"RR Status", "3"},
                                                                   {"RR Mode", "Data"}});
}

TEST(GSMRRInfo, EveryStateHasItsLabelAndByte22ShowsUnknown) {
    const std::vector<std::string> labels = {
        "RR_INACTIVE",
        "RR_GOING_ACTIVE",
        "RR_GOING_INACTIVE",
        "RR_CELL_SELECTION",
        "RR_PLMN_LIST_CONSTRUCTION",
        "RR_IDLE",
        "RR_CELL_RESELECTION",
        "RR_CONNECTION_PENDING",
        "RR_CHOOSE_CELL",
        "RR_DATA_TRANSFER",
        "RR_NO_CHANNELS",
        "RR_CONNECTION_RELEASE",
        "RR_EARLY_CAMPED_WAIT_FOR_SI",
        "RR_W2G_INTERRAT_HANDOVER_ PROGRESS",
        "RR_W2G_INTERRAT_RESELECTION_PROGRESS",
        "RR_WAIT_FOR_EARLY_PSCAN",
        "GRR51",
        "GRR52",
        "RR_G2W_INTERRAT_RESELECTION_PROGRESS",
        "RR_G2W_INTERRAT_HANDOVER_ PROGRESS",
        "RR_CELL_REEST",
        "RR_W2G_INTERRAT_CC_ORDER_ PROGRESS",
    };
    ASSERT_EQ(labels.size(), 22U);
    RecordFixture<GSMRRInfo> fixture;
    for (unsigned value = 0; value < 256; ++value) {
        fixture.feed(gsmState(value));
        EXPECT_EQ(fixture.text("RR State"), value < 22 ? labels[value] : "Unknown") << value;
    }
}

TEST(GSMRRInfo, Byte16As0ShowsVoiceAndAnythingElseData) {
    RecordFixture<GSMRRInfo> fixture;
    for (const unsigned mode : {0U, 1U, 255U}) {
        fixture.feed(gsmState(0, mode));
        EXPECT_EQ(fixture.text("RR Mode"), mode == 0 ? "Voice" : "Data");
    }
}

TEST(GSMRRInfo, Byte15As95ShowsTheServingLevelAs95) {
    RecordFixture<GSMRRInfo> fixture;
    fixture.feed(measurement());
    EXPECT_EQ(fixture.text("Serving Rx Level"), "95");
}

TEST(GSMRRInfo, BytesFEFFFFFFShowTheFullQualityAsMinus2TheWholeSignedWord) {
    RecordFixture<GSMRRInfo> fixture;
    fixture.feed(measurement());
    expectInOrder(fixture.section(), Dictionary{{"Serving Rx Level", "95"},
                                                {"Rx Quality Full", "-2"},
                                                {"Rx Quality Sub", "70000"}});
    EXPECT_EQ(fixture.keys().find("Rx Quality Full")->displayNumber()->integer(), -2);
    fixture.feed(Record(0x5137).padTo(16).u32(0x7FFFFFFF).u32(0x80000000).padTo(29));
    EXPECT_EQ(fixture.text("Rx Quality Full"), "2147483647");
    EXPECT_EQ(fixture.text("Rx Quality Sub"), "-2147483648");
}

TEST(GSMRRInfo, ShowsWhetherDTXIsUsed) {
    for (const unsigned used : {0U, 1U, 255U}) {
        expectInOrder(sectionAfter<GSMRRInfo>(Record(0x5072).padTo(19).u8(used)),
                      Dictionary{{"DTX Used", used == 0 ? "OFF" : "ON"}});
    }
}

TEST(GSMRRInfo, ShowsTheSecondsOfDRX) {
    RecordFixture<GSMRRInfo> fixture;
    fixture.feed(Record(0x51F6).padTo(16).u8(64).padTo(24));
    expectInOrder(fixture.section(), Dictionary{{"DRX Used", "64 sec"}});
    EXPECT_EQ(fixture.keys().find("DRX Used")->displayNumber()->unit(), "sec");
}

TEST(GSMRRInfo, APacketOneByteTooShortChangesNothing) {
    cutAtEveryLength<GSMRRInfo>(gsmState(5), 17);
    cutAtEveryLength<GSMRRInfo>(measurement(), 29);
    cutAtEveryLength<GSMRRInfo>(Record(0x5072).padTo(19).u8(1), 20);
    cutAtEveryLength<GSMRRInfo>(Record(0x51F6).padTo(16).u8(64).padTo(24), 24);
}

TEST(GSMRRInfo, LogsItsLineOnEveryCall) {
    RecordFixture<GSMRRInfo> fixture;
    for (const Record& record : {gsmState(5), Record(0x512C), measurement(),
                                 Record(0x5072).padTo(20), Record(0x51F6).padTo(24)}) {
        fixture.feed(record);
        EXPECT_EQ(fixture.lines, (Lines{{4, "GSMRRInfo"}}));
    }
}

TEST(GSMRRInfo, AKeyKeepsItsLastValueUntilItIsOverwritten) {
    RecordFixture<GSMRRInfo> fixture;
    fixture.feed(Record(0x5072).padTo(19).u8(1));
    fixture.feed(measurement());
    EXPECT_EQ(fixture.text("DTX Used"), "ON");
    EXPECT_EQ(fixture.keys().size(), 4U);
}

TEST(GSMRRInfo, AnyOtherCodeIsUnknownAndChangesNothing) {
    RecordFixture<GSMRRInfo> fixture;
    fixture.feed(Record(0x512D).padTo(40));
    EXPECT_EQ(fixture.lines,
              (Lines{{4, "GSMRRInfo"}, {3, "Received an unknown log message: 20781"}}));
    EXPECT_TRUE(fixture.keys().empty());
}

TEST(GSMRRInfo, AnyBytesKeepWithinItsKeys) {
    anyBytesKeepWithin<GSMRRInfo>({"RR State", "RR Sub State", "RR Status", "RR Mode",
                                   "Serving Rx Level", "Rx Quality Full", "Rx Quality Sub",
                                   "DTX Used", "DRX Used"});
}

} // namespace
} // namespace pallax
