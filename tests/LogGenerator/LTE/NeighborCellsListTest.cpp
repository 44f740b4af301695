#include "LogGenerator/LTE/NeighborCellsList.h"

#include "LogGenerator/LTE/ServingCellMeasurement.h"
#include "tests/LogGenerator/LTE/PackedFields.h"
#include "tests/doubles/RecordFixture.h"
#include "tests/doubles/RecordProperties.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using namespace doubles; // NOLINT: the vocabulary of these tests
using Lines = std::vector<RecordingLog::Line>;

constexpr std::size_t kEntriesStart = 21;
constexpr std::size_t kEntryLength = 20;

constexpr auto kPackedFields = std::to_array<PackedField>({
    {"Physical Cell ID", 0, 0, 9, plain},
    {"Measured RSSI", 1, 1, 8, halfDbm},
    {"Measured RSRP", 2, 1, 9, halfDbm},
    {"Average RSRP", 4, 0, 9, halfDbm},
    {"Measured RSRQ", 5, 1, 7, quarterDb},
    {"Average RSRQ", 6, 0, 7, quarterDb},
    {"Srxlev", 6, 7, 7, less30Dbm},
    {"Frequency Offset", 8, 0, 16, plain},
    {"Ant 0 Frame Offset", 12, 0, 11, plain},
    {"Ant 0 Sample Offset", 13, 3, 19, plain},
    {"Ant 1 Frame Offset", 12, 0, 11, plain},
    {"Ant 1 Sample Offset", 13, 3, 19, plain},
});

/// A record that claims `count` cells (1 to 32) and ends after its fixed part.
Record head(unsigned count) {
    const unsigned word = (count - 1) << 6U;
    return Record(0xB180).padTo(19).u16(word);
}

/// An entry with every byte set to one value.
ByteBuffer cellOf(std::uint8_t byte) {
    return ByteBuffer(kEntryLength, byte); // NOLINT: not a list of two
}

Dictionary lowestCell() {
    return {{"Physical Cell ID", "0"},
            {"Measured RSSI", "-140.00 dBm"},
            {"Measured RSRP", "-140.00 dBm"},
            {"Average RSRP", "-140.00 dBm"},
            {"Measured RSRQ", "-30.00 dB"},
            {"Average RSRQ", "-30.00 dB"},
            {"Srxlev", "-30 dBm"},
            {"Frequency Offset", "0"},
            {"Ant 0 Frame Offset", "0"},
            {"Ant 0 Sample Offset", "0"},
            {"Ant 1 Frame Offset", "0"},
            {"Ant 1 Sample Offset", "0"}};
}

Dictionary highestCell() {
    return {{"Physical Cell ID", "511"},       {"Measured RSSI", "-12.50 dBm"}, // 255 x 0.5 - 140
            {"Measured RSRP", "115.50 dBm"},                                    // 511 x 0.5 - 140
            {"Average RSRP", "115.50 dBm"},    {"Measured RSRQ", "1.75 dB"},    // 127 x 0.25 - 30
            {"Average RSRQ", "1.75 dB"},       {"Srxlev", "97 dBm"},            // 127 - 30
            {"Frequency Offset", "65535"},     {"Ant 0 Frame Offset", "2047"},
            {"Ant 0 Sample Offset", "524287"}, {"Ant 1 Frame Offset", "2047"},
            {"Ant 1 Sample Offset", "524287"}};
}

TEST(NeighborCellsList, SubscribesToTheIdleModeMeasurement) {
    const RecordFixture<NeighborCellsList> fixture;
    EXPECT_EQ(fixture.subscriptions(), (std::vector<LogCode>{0xB180}));
    EXPECT_EQ(NeighborCellsList().getSectionName(), "Neighbor Cells List");
    EXPECT_EQ(NeighborCellsList().sectionKind(), SectionKind::List);
}

TEST(NeighborCellsList, AnAllZeroAndAnAllOneEntryShowBothEndsInPacketOrder) {
    RecordFixture<NeighborCellsList> fixture;
    fixture.feed(head(2).append(cellOf(0)).append(cellOf(0xFF)));
    ASSERT_EQ(fixture.list().size(), 2U);
    expectInOrder(fixture.list()[0], lowestCell());
    expectInOrder(fixture.list()[1], highestCell());
    const DictionaryRef cell = fixture.list()[1].dictionary();
    EXPECT_EQ(cell->find("Measured RSSI")->displayNumber()->real(), -12.5);
    EXPECT_EQ(cell->find("Measured RSSI")->displayNumber()->unit(), "dBm");
    EXPECT_EQ(cell->find("Measured RSRQ")->displayNumber()->unit(), "dB");
}

TEST(NeighborCellsList, OneBitAtATimeChangesItsKeyAlone) {
    for (std::size_t byte = 0; byte < kEntryLength; ++byte) {
        for (unsigned bit = 0; bit < 8; ++bit) {
            RecordFixture<NeighborCellsList> fixture;
            fixture.feed(head(1).append(cellOf(0)).at(kEntriesStart + byte, 1U << bit));
            ASSERT_EQ(fixture.list().size(), 1U);
            expectInOrder(fixture.list()[0], withOneBit(kPackedFields, byte, bit));
        }
    }
}

TEST(NeighborCellsList, Antenna1RepeatsAntenna0) {
    RecordFixture<NeighborCellsList> fixture;
    // Frame offset 0x123; sample offset 0x54321, which begins at bit 3 of byte 13.
    const unsigned packed = 0x123U | 0x54321U << 11U;
    Record record = head(1).append(cellOf(0xFF)); // no other byte is read for them
    for (unsigned byte = 0; byte < 4; ++byte) {
        record.at(kEntriesStart + 12 + byte, packed >> (8 * byte) & 0xFFU);
    }
    fixture.feed(record);
    ASSERT_EQ(fixture.list().size(), 1U);
    const Dictionary& cell = *fixture.list()[0].dictionary();
    EXPECT_EQ(*cell.find("Ant 0 Frame Offset"), PropertyList("291"));
    EXPECT_EQ(*cell.find("Ant 1 Frame Offset"), PropertyList("291"));
    EXPECT_EQ(*cell.find("Ant 0 Sample Offset"), PropertyList("344865"));
    EXPECT_EQ(*cell.find("Ant 1 Sample Offset"), PropertyList("344865"));
}

TEST(NeighborCellsList, AnRSRPStepIs0Point5dBHereAnd0Point25dBForTheServingCell) {
    RecordFixture<NeighborCellsList> neighbours;
    neighbours.feed(head(1).append(cellOf(0)).at(kEntriesStart + 4, 1));
    ASSERT_EQ(neighbours.list().size(), 1U);
    EXPECT_EQ(*neighbours.list()[0].dictionary()->find("Average RSRP"),
              PropertyList("-139.50 dBm"));
    RecordFixture<ServingCellMeasurement> serving;
    serving.feed(Record(0xB17F).padTo(33).at(21, 1));
    EXPECT_EQ(serving.text("Measured RSRP"), "-139.75 dBm");
}

TEST(NeighborCellsList, FiveMeasuredRSSILinesFollowEachCellsLine) {
    RecordFixture<NeighborCellsList> fixture;
    fixture.feed(head(2).append(cellOf(0)).append(cellOf(0xFF)));
    EXPECT_EQ(fixture.lines, (Lines{{4, "Neighbor Cells List"},
                                    {4, "Number of neighboring cells being reported: 2\n"},
                                    {4, "Physical Cell ID: 0\n"},
                                    {4, "Measured RSSI: -140.000000\n"},
                                    {4, "Measured RSSI: -140.000000\n"},
                                    {4, "Measured RSSI: -140.000000\n"},
                                    {4, "Measured RSSI: -30.000000\n"},
                                    {4, "Measured RSSI: -30.000000\n"},
                                    {4, "Physical Cell ID: 511\n"},
                                    {4, "Measured RSSI: -12.500000\n"},
                                    {4, "Measured RSSI: 115.500000\n"},
                                    {4, "Measured RSSI: 115.500000\n"},
                                    {4, "Measured RSSI: 1.750000\n"},
                                    {4, "Measured RSSI: 1.750000\n"}}));
}

TEST(NeighborCellsList, ACountFieldOf0GivesOneCellAnd31Gives32) {
    Record record = head(32);
    for (int cell = 0; cell < 33; ++cell) {
        record.append(cellOf(0));
    }
    RecordFixture<NeighborCellsList> fixture;
    fixture.feed(record);
    EXPECT_EQ(fixture.list().size(), 32U);
    EXPECT_EQ(fixture.lines[1].text, "Number of neighboring cells being reported: 32\n");
    fixture.feed(record.at(19, 0x3F).at(20, 0xF8)); // all other bits of the word
    EXPECT_EQ(fixture.list().size(), 1U);
    EXPECT_EQ(fixture.lines[1].text, "Number of neighboring cells being reported: 1\n");
}

TEST(NeighborCellsList, TheClaimedCountIsLoggedButOnlyWholeEntriesAre) {
    const ByteBuffer bytes = head(32).append(cellOf(0)).append(cellOf(0xFF)).bytes();
    for (std::size_t length = kEntriesStart; length <= bytes.size(); ++length) {
        RecordFixture<NeighborCellsList> fixture;
        fixture.list() = Array{"what was shown before"};
        fixture.feed(
            ByteBuffer(bytes.begin(), bytes.begin() + static_cast<std::ptrdiff_t>(length)));
        // 16 of an entry's 20 bytes are read.
        const std::size_t whole = (length - kEntriesStart + 4) / kEntryLength;
        EXPECT_EQ(fixture.list().size(), whole) << "cut at " << length;
        ASSERT_EQ(fixture.lines.size(), 2 + 6 * whole) << "cut at " << length;
        EXPECT_EQ(fixture.lines[1],
                  (RecordingLog::Line{4, "Number of neighboring cells being reported: 32\n"}));
    }
}

TEST(NeighborCellsList, APacketOf20BytesLeavesTheListAsItWas) {
    cutAtEveryLength<NeighborCellsList>(head(1).append(cellOf(0xFF)), kEntriesStart);
    RecordFixture<NeighborCellsList> fixture;
    fixture.feed(head(1).append(cellOf(0)));
    fixture.feed(Record(0xB180).padTo(kEntriesStart - 1));
    EXPECT_EQ(fixture.lines, (Lines{{4, "Neighbor Cells List"}}));
    EXPECT_EQ(fixture.list(), Array{lowestCell()});
}

TEST(NeighborCellsList, AnyOtherCodeIsUnknownAndChangesNothing) {
    RecordFixture<NeighborCellsList> fixture;
    fixture.feed(head(1).append(cellOf(0)));
    fixture.feed(Record(0xB179).padTo(100));
    EXPECT_EQ(fixture.lines,
              (Lines{{4, "Neighbor Cells List"}, {3, "Received an unknown log message: 45433"}}));
    EXPECT_EQ(fixture.list(), Array{lowestCell()});
}

TEST(NeighborCellsList, AnyBytesKeepItsEntriesWithinItsKeys) {
    std::set<std::string> keys;
    for (const PackedField& field : kPackedFields) {
        keys.insert(field.key);
    }
    anyBytesKeepWithin<NeighborCellsList>(keys);
}

} // namespace
} // namespace pallax
