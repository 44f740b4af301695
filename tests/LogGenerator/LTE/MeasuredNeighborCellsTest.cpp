#include "LogGenerator/LTE/MeasuredNeighborCells.h"

#include "LogGenerator/LTE/DetectedCells.h"
#include "tests/LogGenerator/LTE/ConnectedModeRecords.h"
#include "tests/doubles/RecordFixture.h"
#include "tests/doubles/RecordProperties.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using namespace doubles; // NOLINT: the vocabulary of these tests
using Lines = std::vector<RecordingLog::Line>;

Array twoCellsShown() {
    return {Dictionary{{"Physical Cell ID", "275"},
                       {"Filtered RSRP", "-98.25 dBm"},
                       {"Filtered RSRQ", "-11.25 dB"}},
            Dictionary{{"Physical Cell ID", "65535"},
                       {"Filtered RSRP", "16243.75 dBm"},
                       {"Filtered RSRQ", "8171.88 dB"}}};
}

RecordingLog::Line refusal(int expected, int actual) {
    return {3, "Unexpected log packet bytes size: expected=" + std::to_string(expected) +
                   " actual=" + std::to_string(actual)};
}

TEST(MeasuredNeighborCells, SubscribesToTheConnectedModeMeasurement) {
    const RecordFixture<MeasuredNeighborCells> fixture;
    EXPECT_EQ(fixture.subscriptions(), (std::vector<LogCode>{0xB179}));
    EXPECT_EQ(MeasuredNeighborCells().getSectionName(), "Measured Neighbor Cells");
    EXPECT_EQ(MeasuredNeighborCells().sectionKind(), SectionKind::List);
}

TEST(MeasuredNeighborCells, ShowsEveryEntryInPacketOrderWithItsKeysInOrder) {
    ASSERT_EQ(twoMeasuredOneDetected().bytes().size(), 43U);
    RecordFixture<MeasuredNeighborCells> fixture;
    fixture.feed(twoMeasuredOneDetected());
    EXPECT_EQ(fixture.lines, (Lines{{4, "Measured Neighbor Cells"}}));
    ASSERT_EQ(fixture.list().size(), 2U);
    expectInOrder(fixture.list()[0], *twoCellsShown()[0].dictionary());
    expectInOrder(fixture.list()[1], *twoCellsShown()[1].dictionary());
    const DictionaryRef cell = fixture.list()[0].dictionary();
    EXPECT_EQ(cell->find("Filtered RSRP")->displayNumber()->real(), -98.25);
    EXPECT_EQ(cell->find("Filtered RSRP")->displayNumber()->unit(), "dBm");
    EXPECT_EQ(cell->find("Filtered RSRQ")->displayNumber()->unit(), "dB");
}

TEST(MeasuredNeighborCells, ACountOf0IsRefusedWithExpected0AndEmptiesTheList) {
    RecordFixture<MeasuredNeighborCells> fixture;
    fixture.list() = Array{"what was shown before"};
    fixture.feed(connectedModeHead(0, 1).u16(301));
    EXPECT_EQ(fixture.lines, (Lines{{4, "Measured Neighbor Cells"}, refusal(0, 29)}));
    EXPECT_TRUE(fixture.list().empty());
}

TEST(MeasuredNeighborCells, TheLengthComparisonSeesOnlyTheLowBytes) {
    // 50 entries of 6 bytes are 300 bytes (low byte 44); the 129 bytes contain 16 of them.
    RecordFixture<MeasuredNeighborCells> passed;
    passed.feed(connectedModeHead(50, 0).padTo(129));
    EXPECT_EQ(passed.lines, (Lines{{4, "Measured Neighbor Cells"}}));
    EXPECT_EQ(passed.list().size(), 16U) << "the list stops at the last whole entry";
    // 40 entries are 240 bytes; the record is long enough, but the low byte of 29 + 240 is 13.
    RecordFixture<MeasuredNeighborCells> refused;
    refused.list() = Array{"what was shown before"};
    refused.feed(connectedModeHead(40, 0).padTo(269));
    EXPECT_EQ(refused.lines, (Lines{{4, "Measured Neighbor Cells"}, refusal(240, 13)}));
    EXPECT_TRUE(refused.list().empty());
}

TEST(MeasuredNeighborCells, TheLengthComparisonPrintsUnsignedLowBytesAndWrapsBelow0) {
    RecordFixture<MeasuredNeighborCells> fixture;
    // 42 entries are 252 bytes; 29 - 2 x 16 is -3 (low byte 253).
    fixture.feed(connectedModeHead(42, 16));
    EXPECT_EQ(fixture.lines, (Lines{{4, "Measured Neighbor Cells"}})) << "252 fits into 253";
    EXPECT_TRUE(fixture.list().empty()) << "it contains no entry";
    // 29 - 2 x 17 is -5: 251.
    fixture.feed(connectedModeHead(42, 17));
    EXPECT_EQ(fixture.lines, (Lines{{4, "Measured Neighbor Cells"}, refusal(252, 251)}));
    fixture.feed(connectedModeHead(0, 255)); // 29 - 510 is -481: 31
    EXPECT_EQ(fixture.lines, (Lines{{4, "Measured Neighbor Cells"}, refusal(0, 31)}));
}

TEST(MeasuredNeighborCells, EqualLowBytesPass) {
    RecordFixture<MeasuredNeighborCells> fixture;
    fixture.feed(connectedModeHead(5, 0).padTo(30)); // 30 and 30
    EXPECT_EQ(fixture.lines, (Lines{{4, "Measured Neighbor Cells"}}));
    fixture.feed(connectedModeHead(5, 0)); // 30 and 29
    EXPECT_EQ(fixture.lines, (Lines{{4, "Measured Neighbor Cells"}, refusal(30, 29)}));
}

TEST(MeasuredNeighborCells, WhatItRefusesStillFillsTheDetectedCells) {
    const Record record = connectedModeHead(0, 2).u16(301).u16(302);
    RecordFixture<MeasuredNeighborCells> measured;
    measured.feed(record);
    EXPECT_EQ(measured.lines, (Lines{{4, "Measured Neighbor Cells"}, refusal(0, 29)}));
    EXPECT_TRUE(measured.list().empty());
    RecordFixture<DetectedCells> detected;
    detected.feed(record);
    EXPECT_EQ(detected.lines, (Lines{{4, "Detected Cells"}}));
    EXPECT_EQ(detected.list(), (Array{Dictionary{{"Physical Cell ID", "301"}},
                                      Dictionary{{"Physical Cell ID", "302"}}}));
}

TEST(MeasuredNeighborCells, TheListStopsAtTheFirstEntryThatIsNotWhole) {
    const ByteBuffer bytes = twoMeasuredOneDetected().at(28, 0).bytes();
    for (std::size_t length = 29; length <= bytes.size(); ++length) {
        RecordFixture<MeasuredNeighborCells> fixture;
        fixture.list() = Array{"what was shown before"};
        fixture.feed(
            ByteBuffer(bytes.begin(), bytes.begin() + static_cast<std::ptrdiff_t>(length)));
        const std::size_t whole = std::min<std::size_t>(2, (length - 29) / 6);
        EXPECT_EQ(fixture.list().size(), whole) << "cut at " << length;
    }
}

TEST(MeasuredNeighborCells, APacketOf28BytesLeavesTheListAsItWas) {
    cutAtEveryLength<MeasuredNeighborCells>(twoMeasuredOneDetected(), 29);
    RecordFixture<MeasuredNeighborCells> fixture;
    fixture.feed(twoMeasuredOneDetected());
    fixture.feed(Record(0xB179).padTo(28));
    EXPECT_EQ(fixture.lines, (Lines{{4, "Measured Neighbor Cells"}}));
    EXPECT_EQ(fixture.list(), twoCellsShown());
}

TEST(MeasuredNeighborCells, AnyOtherCodeIsUnknownAndChangesNothing) {
    RecordFixture<MeasuredNeighborCells> fixture;
    fixture.feed(twoMeasuredOneDetected());
    fixture.feed(Record(0xB180).padTo(100));
    EXPECT_EQ(fixture.lines, (Lines{{4, "Measured Neighbor Cells"},
                                    {3, "Received an unknown log message: 45440"}}));
    EXPECT_EQ(fixture.list(), twoCellsShown());
}

TEST(MeasuredNeighborCells, AnyBytesKeepItsEntriesWithinItsKeys) {
    anyBytesKeepWithin<MeasuredNeighborCells>(
        {"Physical Cell ID", "Filtered RSRP", "Filtered RSRQ"});
}

} // namespace
} // namespace pallax
