#include "LogGenerator/ZOR_GSM/GSMSet.h"

#include "tests/doubles/RecordFixture.h"
#include "tests/doubles/RecordProperties.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using namespace doubles; // NOLINT: the vocabulary of these tests
using Lines = std::vector<RecordingLog::Line>;

/// Two entries with the least and greatest values.
Record twoGsmCells() {
    return Record(0x4005)
        .u8(0) // UMTS entries
        .u8(2) // GSM entries
        .u16(975)
        .u16(63)
        .s8(-95)
        .s16(-32768)
        .u16(65535)
        .u16(65535)
        .s8(127)
        .s16(32767);
}

Array twoGsmCellsShown() {
    return {Dictionary{
                {"ARFCN", "975"}, {"BSIC", "63"}, {"RSSI", "-95 dBm"}, {"Ranking Value", "-32768"}},
            Dictionary{{"ARFCN", "65535"},
                       {"BSIC", "65535"},
                       {"RSSI", "127 dBm"},
                       {"Ranking Value", "32767"}}};
}

TEST(GSMSet, SubscribesToTheRankingRecord) {
    const GSMSet record;
    const auto codes = record.getLogCodeArray();
    EXPECT_EQ(std::vector<LogCode>(codes.begin(), codes.end()), (std::vector<LogCode>{0x4005}));
    EXPECT_EQ(record.getSectionName(), "GSM Set");
    EXPECT_EQ(record.sectionKind(), SectionKind::List);
}

TEST(GSMSet, ShowsEveryEntryInPacketOrderWithItsKeysInOrder) {
    RecordFixture<GSMSet> fixture;
    fixture.feed(twoGsmCells());
    ASSERT_EQ(fixture.list().size(), 2U);
    const Array expected = twoGsmCellsShown();
    expectInOrder(fixture.list()[0], *expected[0].dictionary());
    expectInOrder(fixture.list()[1], *expected[1].dictionary());
}

TEST(GSMSet, ItsValuesKeepTheirNumbers) {
    RecordFixture<GSMSet> fixture;
    fixture.feed(twoGsmCells());
    ASSERT_EQ(fixture.list().size(), 2U);
    const DictionaryRef cell = fixture.list()[0].dictionary();
    EXPECT_EQ(cell->find("ARFCN")->displayNumber()->integer(), 975);
    EXPECT_EQ(cell->find("RSSI")->displayNumber()->integer(), -95);
    EXPECT_EQ(cell->find("RSSI")->displayNumber()->unit(), "dBm");
}

TEST(GSMSet, EveryPacketRebuildsTheListAndACountOf0EmptiesIt) {
    RecordFixture<GSMSet> fixture;
    fixture.list() = Array{"what was shown before"};
    fixture.feed(twoGsmCells());
    EXPECT_EQ(fixture.list(), twoGsmCellsShown());
    fixture.feed(twoGsmCells().at(14, 1));
    EXPECT_EQ(fixture.list(), Array{twoGsmCellsShown()[0]});
    fixture.feed(twoGsmCells().at(14, 0));
    EXPECT_TRUE(fixture.list().empty());
}

TEST(GSMSet, TheUMTSCountSaysNothingToIt) {
    RecordFixture<GSMSet> fixture;
    fixture.feed(twoGsmCells().at(13, 255));
    EXPECT_EQ(fixture.list(), twoGsmCellsShown());
}

TEST(GSMSet, A14BytePacketLeavesTheListAsItWas) {
    RecordFixture<GSMSet> fixture;
    fixture.feed(twoGsmCells());
    fixture.feed(Record(0x4005).u8(1));
    EXPECT_EQ(fixture.lines, (Lines{{4, "GSMSet"}})) << "a short packet is dropped silently";
    EXPECT_EQ(fixture.list(), twoGsmCellsShown());
    cutAtEveryLength<GSMSet>(twoGsmCells(), 15);
}

TEST(GSMSet, TheListStopsAtTheFirstEntryThatIsNotWhole) {
    const ByteBuffer bytes = twoGsmCells().at(14, 255).bytes();
    for (std::size_t length = 15; length <= bytes.size(); ++length) {
        RecordFixture<GSMSet> fixture;
        fixture.list() = Array{"what was shown before"};
        fixture.feed(
            ByteBuffer(bytes.begin(), bytes.begin() + static_cast<std::ptrdiff_t>(length)));
        EXPECT_EQ(fixture.list().size(), (length - 15) / 7) << "cut at " << length;
    }
}

TEST(GSMSet, AnyOtherCodeIsUnknownAndChangesNothing) {
    RecordFixture<GSMSet> fixture;
    fixture.feed(twoGsmCells());
    EXPECT_EQ(fixture.lines, (Lines{{4, "GSMSet"}}));
    fixture.feed(Record(0x417A).padTo(100));
    EXPECT_EQ(fixture.lines, (Lines{{4, "GSMSet"}, {3, "Received an unknown log message: 16762"}}));
    EXPECT_EQ(fixture.list(), twoGsmCellsShown());
}

TEST(GSMSet, AnyBytesKeepItsEntriesWithinItsKeys) {
    anyBytesKeepWithin<GSMSet>({"ARFCN", "BSIC", "RSSI", "Ranking Value"});
}

} // namespace
} // namespace pallax
