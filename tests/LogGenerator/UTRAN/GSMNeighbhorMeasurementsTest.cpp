#include "LogGenerator/UTRAN/GSMNeighbhorMeasurements.h"

#include "tests/doubles/Property.h"
#include "tests/doubles/RecordFixture.h"
#include "tests/doubles/RecordProperties.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using namespace doubles; // NOLINT: the vocabulary of these tests
using GsmNeighborFixture = RecordFixture<GSMNeighbhorMeasurements>;
using Lines = std::vector<RecordingLog::Line>;

Record gsmNeighbours(unsigned count) {
    return Record(0xD00E).padTo(16).u8(count);
}

PropertyList onlyCell(std::initializer_list<unsigned> entry) {
    const Record record = gsmNeighbours(1).append(entry);
    const Array cells = GSMNeighbhorMeasurements::cellsOf(LogRecord(record.bytes()));
    return cells.size() == 1 ? cells[0] : PropertyList();
}

TEST(GSMNeighbhorMeasurements, OwnsTheGSMNeighborCellListAndSubscribesTo0xD00E) {
    const GsmNeighborFixture fixture;
    EXPECT_EQ(fixture.subscriptions(), (std::vector<LogCode>{0xD00E}));
    EXPECT_EQ(GSMNeighbhorMeasurements().getSectionName(), "GSM Neighbor Cell List");
    EXPECT_EQ(GSMNeighbhorMeasurements().sectionKind(), SectionKind::List);
}

TEST(GSMNeighbhorMeasurements, TheListIsBuiltAndDroppedSoThatTheSectionIsEmptied) {
    const Record record = gsmNeighbours(2)
                              .append({0x2A, 0xC1, 3, 5, 0x56, 0, 0xB0, 0xFF})
                              .append({0x2B, 0x81, 4, 6, 0x57, 0, 0xB1, 0xFF});
    EXPECT_EQ(GSMNeighbhorMeasurements::cellsOf(LogRecord(record.bytes())).size(), 2U);
    GsmNeighborFixture fixture;
    fixture.list() = Array{"what was shown before"};
    fixture.feed(record);
    EXPECT_EQ(fixture.lines, (Lines{{4, "GSM Neighbor Cell List"}}));
    EXPECT_TRUE(fixture.list().empty());
    fixture.feed(record);
    EXPECT_TRUE(fixture.list().empty());
}

TEST(GSMNeighbhorMeasurements, ACellWouldHaveItsKeysInOrder) {
    expectInOrder(onlyCell({0x2A, 0xC1, 3, 5, 0x56, 0, 0xB0, 0xFF}),
                  Dictionary{{"Cell ID", "298"},
                             {"Band Indicator", "1"},
                             {"BSIC Valid", "1"},
                             {"NCC", "3"},
                             {"BCC", "5"},
                             {"ARFCN", "86"},
                             {"RSSI", "-80"}});
}

TEST(GSMNeighbhorMeasurements, OnlyTheRSSIIsSigned) {
    expectInOrder(onlyCell({0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF}),
                  Dictionary{{"Cell ID", "16383"},
                             {"Band Indicator", "1"},
                             {"BSIC Valid", "1"},
                             {"NCC", "255"},
                             {"BCC", "255"},
                             {"ARFCN", "65535"},
                             {"RSSI", "-1"}});
}

TEST(GSMNeighbhorMeasurements, TheBandIndicatorIsBit6OfByte1AndTheValidityBit7) {
    const auto shown = [](unsigned byte1) {
        const PropertyList cell = onlyCell({0, byte1, 0, 0, 0, 0, 0, 0});
        return *cell.dictionary()->find("Cell ID")->string() + " " +
               *cell.dictionary()->find("Band Indicator")->string() + " " +
               *cell.dictionary()->find("BSIC Valid")->string();
    };
    EXPECT_EQ(shown(0x3F), "16128 0 0");
    EXPECT_EQ(shown(0x40), "0 1 0");
    EXPECT_EQ(shown(0x80), "0 0 1");
}

TEST(GSMNeighbhorMeasurements, CellsAreReadUpToTheFirstThatIsNotWhole) {
    const Record record = gsmNeighbours(255).padTo(17 + 5 * 8);
    for (std::size_t length = 17; length <= record.bytes().size(); ++length) {
        const ByteBuffer cut(record.bytes().begin(),
                             record.bytes().begin() + static_cast<std::ptrdiff_t>(length));
        EXPECT_EQ(GSMNeighbhorMeasurements::cellsOf(LogRecord(cut)).size(), (length - 17) / 8);
    }
}

TEST(GSMNeighbhorMeasurements, AShortPacketOrAnotherCodeChangesNothingSilently) {
    GsmNeighborFixture fixture;
    fixture.list() = Array{"what was shown before"};
    for (const Record& record : {Record(0xD00E).padTo(16), Record(0xD00A).padTo(400)}) {
        fixture.feed(record);
        EXPECT_EQ(fixture.lines, (Lines{{4, "GSM Neighbor Cell List"}}));
        EXPECT_EQ(fixture.section(), PropertyList(Array{"what was shown before"}));
    }
    fixture.feed(gsmNeighbours(0));
    EXPECT_TRUE(fixture.list().empty()) << "17 bytes are enough";
    cutAtEveryLength<GSMNeighbhorMeasurements>(gsmNeighbours(3).padTo(17 + 24), 17);
}

TEST(GSMNeighbhorMeasurements, AnyBytesKeepItsSectionEmpty) {
    anyBytesKeepWithin<GSMNeighbhorMeasurements>({});
}

TEST(GSMNeighbhorMeasurements, AnyBytesKeepItsCellsWithinTheirKeys) {
    EXPECT_TRUE(doubles::holds([] {
        const ByteBuffer bytes = any::recordBytes();
        RC_ASSERT(keepsWithin(
            GSMNeighbhorMeasurements::cellsOf(LogRecord(bytes)),
            {"Cell ID", "Band Indicator", "BSIC Valid", "NCC", "BCC", "ARFCN", "RSSI"}));
    }));
}

} // namespace
} // namespace pallax
