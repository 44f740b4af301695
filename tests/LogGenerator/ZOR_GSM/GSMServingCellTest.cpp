#include "LogGenerator/ZOR_GSM/GSMServingCell.h"

#include "LogGenerator/ZOR_GSM/GSMRRInfo.h"
#include "tests/doubles/CellBuilder.h"
#include "tests/doubles/RecordFixture.h"
#include "tests/doubles/RecordProperties.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using namespace doubles; // NOLINT: the vocabulary of these tests
using Lines = std::vector<RecordingLog::Line>;

Record identity() {
    return Record(0x5134).u16(1023).u16(63).u16(54321).padTo(26);
}

Record servingMeasurement() {
    return Record(0x5137).padTo(15).u8(95).s32(-2).s32(70000).padTo(29);
}

TEST(GSMServingCell, SubscribesToItsFourRecords) {
    const RecordFixture<GSMServingCell> fixture;
    EXPECT_EQ(fixture.subscriptions(), (std::vector<LogCode>{0x5134, 0x5137, 0x5076, 0xFF0001}));
    EXPECT_EQ(GSMServingCell().getSectionName(), "GSM Serving Cell");
}

TEST(GSMServingCell, ShowsTheIdentity) {
    expectInOrder(sectionAfter<GSMServingCell>(identity()),
                  Dictionary{{"Cell ID", "54321"}, {"ARFCN", "1023"}, {"BSIC", "63"}});
    expectInOrder(
        sectionAfter<GSMServingCell>(Record(0x5134).u16(0xFFFF).u16(0xFFFE).u16(0xFFFD).padTo(26)),
        Dictionary{{"Cell ID", "65533"}, {"ARFCN", "65535"}, {"BSIC", "65534"}});
}

TEST(GSMServingCell, Byte15As95ShowsThePositiveLevel95dBm) {
    RecordFixture<GSMServingCell> fixture;
    fixture.feed(servingMeasurement());
    EXPECT_EQ(fixture.text("RSSI"), "95 dBm");
    EXPECT_EQ(fixture.keys().find("RSSI")->displayNumber()->integer(), 95);
    EXPECT_EQ(fixture.keys().find("RSSI")->displayNumber()->unit(), "dBm");
    fixture.feed(servingMeasurement().at(15, 255));
    EXPECT_EQ(fixture.text("RSSI"), "255 dBm");
}

TEST(GSMServingCell, BytesFEFFFFFFShowC1As65534TheUnsignedLowHalf) {
    expectInOrder(sectionAfter<GSMServingCell>(servingMeasurement()),
                  Dictionary{{"RSSI", "95 dBm"}, {"C1 Value", "65534"}, {"C2 Value", "4464"}});
}

TEST(GSMServingCell, TheDedicatedChannelIsTheLowByteOfItsField) {
    expectInOrder(sectionAfter<GSMServingCell>(Record(0x5076).u16(0x01FE).padTo(17)),
                  Dictionary{{"MA Dedicated ARFCN", "254"}});
}

TEST(GSMServingCell, LogsItsLineOnEveryAcceptedPacket) {
    RecordFixture<GSMServingCell> fixture;
    for (const Record& record :
         {identity(), servingMeasurement(), Record(0x5076).u16(1).padTo(17)}) {
        fixture.feed(record);
        EXPECT_EQ(fixture.lines, (Lines{{4, "GSMServingCell"}}));
    }
    EXPECT_EQ(fixture.keys().size(), 7U) << "all three were accepted";
}

/// GSMRRInfo shows the same words as quality.
TEST(GSMServingCell, C1AndC2AreTheRxQualityOfGSMRRInfoReadWithAnotherWidthAndSign) {
    RecordFixture<GSMServingCell> cell;
    RecordFixture<GSMRRInfo> state;
    const Record packet = Record(0x5137)
                              .padTo(15)
                              .u8(95)
                              .append({0xFE, 0xFF, 0xFF, 0xFF, 0x70, 0x11, 1, 0})
                              .padTo(29);
    cell.feed(packet);
    state.feed(packet);
    expectInOrder(cell.section(),
                  Dictionary{{"RSSI", "95 dBm"}, {"C1 Value", "65534"}, {"C2 Value", "4464"}});
    expectInOrder(state.section(), Dictionary{{"Serving Rx Level", "95"},
                                              {"Rx Quality Full", "-2"},
                                              {"Rx Quality Sub", "70000"}});
}

TEST(GSMServingCell, APacketOneByteTooShortChangesNothing) {
    cutAtEveryLength<GSMServingCell>(identity(), 26);
    cutAtEveryLength<GSMServingCell>(servingMeasurement(), 29);
    cutAtEveryLength<GSMServingCell>(Record(0x5076).u16(1).padTo(17), 17);
    RecordFixture<GSMServingCell> fixture;
    fixture.feed(Record(0x5134).padTo(25));
    EXPECT_EQ(fixture.lines, (Lines{{4, "GSMServingCell"}}));
}

TEST(GSMServingCell, TheFirstServingCellOfGSMShowsItsIdentityAndUMTSIsNotConsidered) {
    RecordFixture<GSMServingCell> fixture;
    fixture.feed(cellsRecord({cell("UMTS", "Serving", {{"CellId", 1}, {"ARFCN", 2}}),
                              cell("GSM", "Neighbor", {{"CellId", 3}, {"ARFCN", 4}}),
                              cell("GSM", "Serving", {{"ARFCN", 62}, {"CellId", 70000}}),
                              cell("GSM", "Serving", {{"CellId", 5}, {"ARFCN", 6}})}));
    expectInOrder(fixture.section(), Dictionary{{"Cell ID", "70000"}, {"ARFCN", "62"}});
    EXPECT_EQ(fixture.lines, (Lines{{4, "GSMServingCell"}}));
}

TEST(GSMServingCell, AMissingCellIdentityAndAMissingARFCNAreLoggedIndependently) {
    RecordFixture<GSMServingCell> fixture;
    fixture.feed(cellsRecord({cell("GSM", "Serving", {{"ARFCN", -1}})}));
    expectInOrder(fixture.section(), Dictionary{{"ARFCN", "-1"}});
    EXPECT_EQ(fixture.lines,
              (Lines{{4, "GSMServingCell"}, {3, "GSMServingCell: Failed to retrieve Cell ID\n"}}));
    fixture.feed(cellsRecord({cell("GSM", "Serving", {{"CellId", 9}})}));
    EXPECT_EQ(fixture.text("Cell ID"), "9");
    EXPECT_EQ(fixture.lines,
              (Lines{{4, "GSMServingCell"}, {3, "GSMServingCell: Failed to retrieve ARFCN\n"}}));
    fixture.feed(cellsRecord({cell("GSM", "Serving")}));
    EXPECT_EQ(fixture.lines, (Lines{{4, "GSMServingCell"},
                                    {3, "GSMServingCell: Failed to retrieve Cell ID\n"},
                                    {3, "GSMServingCell: Failed to retrieve ARFCN\n"}}));
}

TEST(GSMServingCell, WithoutAServingCellNothingChanges) {
    RecordFixture<GSMServingCell> fixture;
    for (const Array& cells : {Array(), Array{cell("UMTS", "Serving", {{"CellId", 1}})}}) {
        fixture.feed(cellsRecord(cells));
        EXPECT_EQ(fixture.lines, (Lines{{4, "GSMServingCell"}}));
        EXPECT_TRUE(fixture.keys().empty());
    }
}

TEST(GSMServingCell, AnArrayThatCannotBeReadIsLoggedTwiceAndChangesNothing) {
    RecordFixture<GSMServingCell> fixture;
    fixture.feed(Record(0xFF0001));
    EXPECT_EQ(fixture.lines, (Lines{{4, "GSMServingCell"},
                                    {3, "Cell Info Array data could not be constructed"},
                                    {3, "Failed to get Cell Array\n"}}));
    const Record cells = cellsRecord({cell("GSM", "Serving", {{"CellId", 1}, {"ARFCN", 2}})});
    cutAtEveryLength<GSMServingCell>(cells, cells.bytes().size());
}

TEST(GSMServingCell, AKeyKeepsItsLastValueUntilItIsOverwritten) {
    RecordFixture<GSMServingCell> fixture;
    fixture.feed(identity());
    fixture.feed(servingMeasurement());
    fixture.feed(cellsRecord({cell("GSM", "Serving", {{"CellId", 7}, {"ARFCN", 8}})}));
    expectInOrder(fixture.section(), Dictionary{{"Cell ID", "7"},
                                                {"ARFCN", "8"},
                                                {"BSIC", "63"},
                                                {"RSSI", "95 dBm"},
                                                {"C1 Value", "65534"},
                                                {"C2 Value", "4464"}});
}

TEST(GSMServingCell, AnyOtherCodeIsUnknownAndChangesNothing) {
    RecordFixture<GSMServingCell> fixture;
    fixture.feed(Record(0x5135).padTo(40));
    EXPECT_EQ(fixture.lines,
              (Lines{{4, "GSMServingCell"}, {3, "Received an unknown log message: 20789"}}));
    EXPECT_TRUE(fixture.keys().empty());
}

TEST(GSMServingCell, AnyBytesAndAnyCellsKeepWithinItsKeys) {
    const std::set<std::string> keys = {
        "Cell ID", "ARFCN", "BSIC", "RSSI", "C1 Value", "C2 Value", "MA Dedicated ARFCN"};
    anyBytesKeepWithin<GSMServingCell>(keys);
    anyCellsKeepWithin<GSMServingCell>(keys);
}

} // namespace
} // namespace pallax
