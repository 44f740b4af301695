#include "LogGenerator/ZOR_GSM/UMTSSet.h"

#include "LogGenerator/ZOR_GSM/GSMSet.h"
#include "tests/doubles/RecordFixture.h"
#include "tests/doubles/RecordProperties.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using namespace doubles; // NOLINT: the vocabulary of these tests
using Lines = std::vector<RecordingLog::Line>;

/// The second entry has the greatest values.
Record twoUmtsCells() {
    return Record(0x4005)
        .u8(2) // UMTS entries
        .u8(0) // GSM entries
        .s16(10713)
        .u16(388)
        .u8(0xE0) // RSCP: -32 - 21
        .s16(-97)
        .u8(0xF1) // energy: -15 x 0.5
        .s16(-12)
        .s16(-32768)
        .u16(65535)
        .s8(-128)
        .s16(32767)
        .s8(127)
        .s16(-32768);
}

Array twoUmtsCellsShown() {
    return {Dictionary{{"Scrambling Code", "388"},
                       {"RSCP", "-53 dB"},
                       {"Energy Per Chip", "-7.500000 dB"},
                       {"Downlink Frequency", "10713"},
                       {"Ranking Value", "-12"},
                       {"Rank Cell RSCP", "-97 dB"}},
            Dictionary{{"Scrambling Code", "65535"},
                       {"RSCP", "-149 dB"},
                       {"Energy Per Chip", "63.500000 dB"},
                       {"Downlink Frequency", "-32768"},
                       {"Ranking Value", "-32768"},
                       {"Rank Cell RSCP", "32767 dB"}}};
}

TEST(UMTSSet, SubscribesToTheRankingRecordAndTheCellMonitor) {
    const UMTSSet record;
    const auto codes = record.getLogCodeArray();
    EXPECT_EQ(std::vector<LogCode>(codes.begin(), codes.end()),
              (std::vector<LogCode>{0x4005, 0xFF0001}));
    EXPECT_EQ(record.getSectionName(), "UMTS Set");
    EXPECT_EQ(record.sectionKind(), SectionKind::List);
}

TEST(UMTSSet, EntryByte0xE0ShowsRSCPAsMinus53dBAndByte0xF1TheEnergyAsMinus7Point5dB) {
    RecordFixture<UMTSSet> fixture;
    fixture.feed(twoUmtsCells().at(13, 1));
    ASSERT_EQ(fixture.list().size(), 1U);
    expectInOrder(fixture.list()[0], *twoUmtsCellsShown()[0].dictionary());
}

TEST(UMTSSet, ShowsEveryEntryInPacketOrderWithItsKeysInOrder) {
    RecordFixture<UMTSSet> fixture;
    fixture.feed(twoUmtsCells());
    ASSERT_EQ(fixture.list().size(), 2U);
    const Array expected = twoUmtsCellsShown();
    expectInOrder(fixture.list()[0], *expected[0].dictionary());
    expectInOrder(fixture.list()[1], *expected[1].dictionary());
}

TEST(UMTSSet, ItsValuesKeepTheirNumbers) {
    RecordFixture<UMTSSet> fixture;
    fixture.feed(twoUmtsCells());
    ASSERT_EQ(fixture.list().size(), 2U);
    const DictionaryRef cell = fixture.list()[0].dictionary();
    EXPECT_EQ(cell->find("RSCP")->displayNumber()->integer(), -53);
    EXPECT_EQ(cell->find("RSCP")->displayNumber()->unit(), "dB");
    EXPECT_EQ(cell->find("Energy Per Chip")->displayNumber()->real(), -7.5);
    EXPECT_EQ(cell->find("Energy Per Chip")->displayNumber()->unit(), "dB");
}

TEST(UMTSSet, TheUMTSAndTheGSMListOf0x4005AreReadFromTheSameBytes) {
    // 24 bytes from offset 15: two UMTS entries of 10 bytes, or three GSM entries of 7.
    Record record(0x4005);
    record.u8(2).u8(3);
    for (unsigned byte = 0; byte < 24; ++byte) {
        record.u8(byte + 1);
    }
    RecordFixture<UMTSSet> umts;
    umts.feed(record);
    EXPECT_EQ(umts.section(), PropertyList(Array{Dictionary{{"Scrambling Code", "1027"}, // 03 04
                                                            {"RSCP", "-16 dB"},          // 05
                                                            {"Energy Per Chip", "4.000000 dB"},
                                                            {"Downlink Frequency", "513"}, // 01 02
                                                            {"Ranking Value", "2569"},     // 09 0A
                                                            {"Rank Cell RSCP", "1798 dB"}},
                                                 Dictionary{{"Scrambling Code", "3597"}, // 0D 0E
                                                            {"RSCP", "-6 dB"},
                                                            {"Energy Per Chip", "9.000000 dB"},
                                                            {"Downlink Frequency", "3083"}, // 0B 0C
                                                            {"Ranking Value", "5139"},
                                                            {"Rank Cell RSCP", "4368 dB"}}}));
    RecordFixture<GSMSet> gsm;
    gsm.feed(record);
    EXPECT_EQ(gsm.section(), PropertyList(Array{Dictionary{{"ARFCN", "513"}, // 01 02
                                                           {"BSIC", "1027"}, // 03 04
                                                           {"RSSI", "5 dBm"},
                                                           {"Ranking Value", "1798"}},
                                                Dictionary{{"ARFCN", "2312"}, // 08 09
                                                           {"BSIC", "2826"},
                                                           {"RSSI", "12 dBm"},
                                                           {"Ranking Value", "3597"}},
                                                Dictionary{{"ARFCN", "4111"}, // 0F 10
                                                           {"BSIC", "4625"},
                                                           {"RSSI", "19 dBm"},
                                                           {"Ranking Value", "5396"}}}));
}

TEST(UMTSSet, EveryPacketRebuildsTheListAndACountOf0EmptiesIt) {
    RecordFixture<UMTSSet> fixture;
    fixture.list() = Array{"what was shown before"};
    fixture.feed(twoUmtsCells());
    EXPECT_EQ(fixture.list(), twoUmtsCellsShown());
    fixture.feed(twoUmtsCells().at(13, 0));
    EXPECT_TRUE(fixture.list().empty());
}

TEST(UMTSSet, A14BytePacketLeavesTheListAsItWas) {
    RecordFixture<UMTSSet> fixture;
    fixture.feed(twoUmtsCells());
    fixture.feed(Record(0x4005).u8(1));
    EXPECT_EQ(fixture.lines, (Lines{{4, "UMTSSet"}})) << "a short packet is dropped silently";
    EXPECT_EQ(fixture.list(), twoUmtsCellsShown());
    cutAtEveryLength<UMTSSet>(twoUmtsCells(), 15);
}

TEST(UMTSSet, TheListStopsAtTheFirstEntryThatIsNotWhole) {
    const ByteBuffer bytes = twoUmtsCells().at(13, 255).bytes();
    for (std::size_t length = 15; length <= bytes.size(); ++length) {
        RecordFixture<UMTSSet> fixture;
        fixture.list() = Array{"what was shown before"};
        fixture.feed(
            ByteBuffer(bytes.begin(), bytes.begin() + static_cast<std::ptrdiff_t>(length)));
        EXPECT_EQ(fixture.list().size(), (length - 15) / 10) << "cut at " << length;
    }
}

TEST(UMTSSet, AnyOtherCodeIsUnknownAndChangesNothing) {
    RecordFixture<UMTSSet> fixture;
    fixture.feed(twoUmtsCells());
    EXPECT_EQ(fixture.lines, (Lines{{4, "UMTSSet"}}));
    fixture.feed(Record(0x417A).padTo(100));
    EXPECT_EQ(fixture.lines,
              (Lines{{4, "UMTSSet"}, {3, "Received an unknown log message: 16762"}}));
    EXPECT_EQ(fixture.list(), twoUmtsCellsShown());
}

TEST(UMTSSet, AnyBytesKeepItsEntriesWithinItsKeys) {
    anyBytesKeepWithin<UMTSSet>({"Scrambling Code", "RSCP", "Energy Per Chip", "Downlink Frequency",
                                 "Ranking Value", "Rank Cell RSCP", "UARFCN"});
}

} // namespace
} // namespace pallax
