#include "LogGenerator/LTE/ReselectionCandidatesList.h"

#include "tests/doubles/Property.h"
#include "tests/doubles/RecordFixture.h"
#include "tests/doubles/RecordProperties.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using namespace doubles; // NOLINT: the vocabulary of these tests
using Lines = std::vector<RecordingLog::Line>;

constexpr std::size_t kCandidatesStart = 21;

Record candidatesHead(unsigned count) {
    return Record(0xB186).u8(1).u8(0).u16(1850).u16(274).u16(count);
}

/// One candidate of that technology, followed by eight different bytes.
Record oneCandidate(unsigned technology) {
    return candidatesHead(1)
        .u16(0x0102)
        .u16(technology)
        .append({0x11, 0x12, 0x13, 0x94, 0x15, 0x16, 0x17, 0x18});
}

TEST(ReselectionCandidatesList, SubscribesToTheReselectionRecord) {
    const RecordFixture<ReselectionCandidatesList> fixture;
    EXPECT_EQ(fixture.subscriptions(), (std::vector<LogCode>{0xB186}));
    EXPECT_EQ(ReselectionCandidatesList().getSectionName(), "Reselection Candidates List");
    EXPECT_EQ(ReselectionCandidatesList().sectionKind(), SectionKind::List);
}

TEST(ReselectionCandidatesList, EveryTechnologyHasItsLabelAndItsKeysInOrder) {
    const std::map<unsigned, Dictionary> expected = {
        {0,
         {{"Candidate Priority", "258"},
          {"Candidate RAT Type", "LTE"},
          {"E ARFCN", "4625"},  // 11 12
          {"Cell ID", "296"}}}, // 13 94: 0x9413 >> 7
        {1,
         {{"Candidate Priority", "258"},
          {"Candidate RAT Type", "UTRAN"},
          {"U ARFCN", "4625"},
          {"PSC", "37907"}}}, // 0x9413
        {2,
         {{"Candidate Priority", "258"},
          {"Candidate RAT Type", "GERAN"},
          {"ARFCN", "4625"},
          {"Band", "19"},
          {"BSIC ID", "148"}}},
        {3,
         {{"Candidate Priority", "258"},
          {"Candidate RAT Type", "CDMA1XRTT"},
          {"Band", "17"},
          {"Channel", "5653"}, // 15 16
          {"Pilot", "6167"}}}, // 17 18
        {4,
         {{"Candidate Priority", "258"},
          {"Candidate RAT Type", "CDMAHRPD"},
          {"Band", "17"},
          {"Channel", "5653"},
          {"Pilot", "6167"}}},
    };
    for (const auto& [technology, shown] : expected) {
        RecordFixture<ReselectionCandidatesList> fixture;
        fixture.feed(oneCandidate(technology));
        EXPECT_EQ(fixture.lines, (Lines{{4, "Reselection Candidates List"}}));
        ASSERT_EQ(fixture.list().size(), 1U) << technology;
        expectInOrder(fixture.list()[0], shown);
    }
}

TEST(ReselectionCandidatesList, AnyOtherTechnologyShowsTwoQuestionMarksAndNothingElse) {
    for (const unsigned technology : {5U, 7U, 255U, 256U, 65535U}) {
        RecordFixture<ReselectionCandidatesList> fixture;
        fixture.feed(oneCandidate(technology));
        ASSERT_EQ(fixture.list().size(), 1U) << technology;
        expectInOrder(fixture.list()[0],
                      Dictionary{{"Candidate Priority", "258"}, {"Candidate RAT Type", "??"}});
    }
}

TEST(ReselectionCandidatesList, TheCellIDIsBits7To15OfItsWord) {
    const auto cellId = [](unsigned low, unsigned high) {
        RecordFixture<ReselectionCandidatesList> fixture;
        fixture.feed(candidatesHead(1).u32(0).u16(1850).u8(low).u8(high));
        return fixture.list().at(0).dictionary()->find("Cell ID")->displayNumber()->integer();
    };
    EXPECT_EQ(cellId(0x00, 0x80), 256);
    EXPECT_EQ(cellId(0x7F, 0x00), 0) << "the low 7 bits are ignored";
    EXPECT_EQ(cellId(0x80, 0x00), 1);
    EXPECT_EQ(cellId(0xFF, 0xFF), 511);
}

TEST(ReselectionCandidatesList, EntriesStand4BytesApartSoThatTheirTechnologyDataOverlaps) {
    // Entry 0 (LTE) begins at 21, entry 1 (GERAN) at 25.
    const Record record = candidatesHead(2)
                              .u16(7)
                              .u16(0)
                              .u16(1850) // entry 0: E ARFCN; entry 1: priority
                              .u16(2)    // entry 0: Cell ID 0; entry 1: GERAN
                              .u16(42)   // entry 1: ARFCN
                              .u8(8)     // band
                              .u8(33);   // BSIC
    RecordFixture<ReselectionCandidatesList> fixture;
    fixture.feed(record);
    EXPECT_EQ(fixture.list(), (Array{Dictionary{{"Candidate Priority", "7"},
                                                {"Candidate RAT Type", "LTE"},
                                                {"E ARFCN", "1850"},
                                                {"Cell ID", "0"}},
                                     Dictionary{{"Candidate Priority", "1850"},
                                                {"Candidate RAT Type", "GERAN"},
                                                {"ARFCN", "42"},
                                                {"Band", "8"},
                                                {"BSIC ID", "33"}}}));
}

TEST(ReselectionCandidatesList, AnEntryIsWholeWhenTheBytesReadForItsTechnologyLieInside) {
    const std::map<unsigned, std::size_t> bytesRead = {{0, 8},  {1, 8},  {2, 8},
                                                       {3, 12}, {4, 12}, {5, 4}};
    for (const auto& [technology, needed] : bytesRead) {
        const ByteBuffer bytes = oneCandidate(technology).bytes();
        for (std::size_t length = kCandidatesStart; length <= bytes.size(); ++length) {
            RecordFixture<ReselectionCandidatesList> fixture;
            fixture.list() = Array{"what was shown before"};
            fixture.feed(
                ByteBuffer(bytes.begin(), bytes.begin() + static_cast<std::ptrdiff_t>(length)));
            EXPECT_EQ(fixture.list().size(), length >= kCandidatesStart + needed ? 1 : 0)
                << "technology " << technology << " cut at " << length;
        }
    }
}

TEST(ReselectionCandidatesList, TheListStopsAtTheFirstEntryThatIsNotWhole) {
    // The third entry is whole, but the CDMA entry before it is not, so neither is shown.
    RecordFixture<ReselectionCandidatesList> fixture;
    fixture.feed(candidatesHead(3).u16(1).u16(9).u16(2).u16(3).u16(4).u16(9));
    EXPECT_EQ(fixture.list(),
              (Array{Dictionary{{"Candidate Priority", "1"}, {"Candidate RAT Type", "??"}}}));
    fixture.feed(candidatesHead(0xFFFF).u16(1).u16(9).u16(2).u16(9).u8(3));
    EXPECT_EQ(fixture.list(),
              (Array{Dictionary{{"Candidate Priority", "1"}, {"Candidate RAT Type", "??"}},
                     Dictionary{{"Candidate Priority", "2"}, {"Candidate RAT Type", "??"}}}));
}

TEST(ReselectionCandidatesList, ACountOf0EmptiesTheListSilently) {
    RecordFixture<ReselectionCandidatesList> fixture;
    fixture.list() = Array{"what was shown before"};
    fixture.feed(oneCandidate(0).at(19, 0));
    EXPECT_EQ(fixture.lines, (Lines{{4, "Reselection Candidates List"}}));
    EXPECT_TRUE(fixture.list().empty());
}

TEST(ReselectionCandidatesList, TheCountIsAWordOf16Bits) {
    RecordFixture<ReselectionCandidatesList> fixture;
    Record record = candidatesHead(0x0102);
    for (unsigned entry = 0; entry < 0x0103; ++entry) {
        record.u16(entry).u16(9);
    }
    fixture.feed(record);
    EXPECT_EQ(fixture.list().size(), 0x0102U);
}

TEST(ReselectionCandidatesList, APacketOf20BytesLeavesTheListAsItWas) {
    cutAtEveryLength<ReselectionCandidatesList>(oneCandidate(3), kCandidatesStart);
    RecordFixture<ReselectionCandidatesList> fixture;
    fixture.feed(oneCandidate(9));
    const PropertyList before = fixture.snapshot();
    fixture.feed(Record(0xB186).padTo(20));
    EXPECT_EQ(fixture.lines, (Lines{{4, "Reselection Candidates List"}}));
    EXPECT_EQ(fixture.section(), before);
}

TEST(ReselectionCandidatesList, AnyOtherCodeIsUnknownAndChangesNothing) {
    RecordFixture<ReselectionCandidatesList> fixture;
    fixture.feed(oneCandidate(0));
    const PropertyList before = fixture.snapshot();
    fixture.feed(Record(0xB180).padTo(100));
    EXPECT_EQ(fixture.lines, (Lines{{4, "Reselection Candidates List"},
                                    {3, "Received an unknown log message: 45440"}}));
    EXPECT_EQ(fixture.section(), before);
}

TEST(ReselectionCandidatesList, AnyBytesKeepItsEntriesWithinItsKeys) {
    const std::set<std::string> keys = {"Candidate Priority",
                                        "Candidate RAT Type",
                                        "E ARFCN",
                                        "Cell ID",
                                        "U ARFCN",
                                        "PSC",
                                        "ARFCN",
                                        "Band",
                                        "BSIC ID",
                                        "Channel",
                                        "Pilot"};
    anyBytesKeepWithin<ReselectionCandidatesList>(keys);
    // Random bytes are rarely a known technology, so most of these entries have one.
    anyRecordsKeepWithin<ReselectionCandidatesList, NothingThrown>(
        keys, codesOf<ReselectionCandidatesList>(), [](LogCode) {
            Record record = candidatesHead(any::below(12));
            for (const int word : any::integers(0, 7)) {
                record.u16(static_cast<unsigned>(word));
            }
            return record.bytes();
        });
}

} // namespace
} // namespace pallax
