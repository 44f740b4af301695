#include "LogGenerator/C2K/ReverseDataRate.h"

#include "tests/LogGenerator/C2K/C2KFixture.h"

#include <gtest/gtest.h>

#include <array>
#include <set>

namespace pallax {
namespace {

using namespace doubles; // NOLINT: the vocabulary of these tests
using Lines = std::vector<RecordingLog::Line>;

constexpr std::size_t kLength = 1750;
constexpr auto kWeights = std::to_array<std::int64_t>(
    {128, 256, 512, 768, 1024, 1536, 2048, 3072, 4096, 6144, 8192, 12288});

/// The places of a rate's counters.
std::vector<std::size_t> countersOf(std::size_t rate) {
    std::vector<std::size_t> offsets;
    for (std::size_t block = 0; block < 3; ++block) {
        for (const std::size_t first : {18U, 22U, 26U, 30U, 306U, 310U, 314U, 318U}) {
            offsets.push_back(24 * rate + 576 * block + first);
        }
    }
    return offsets;
}

Record packet(std::uint32_t sequence) {
    return Record(0x127E).u8(0xEE).u32(sequence).padTo(kLength);
}

std::int64_t totalOf(const Record& record) {
    C2KFixture fixture;
    fixture.feed(record);
    return fixture.kept("RLDataSent");
}

TEST(ReverseDataRate, EveryCounterHasTheWeightOfItsRate) {
    for (std::size_t rate = 0; rate < kWeights.size(); ++rate) {
        for (const std::size_t offset : countersOf(rate)) {
            EXPECT_EQ(totalOf(packet(0).at(offset, 1)), kWeights[rate])
                << "rate " << rate << " at " << offset;
        }
    }
}

TEST(ReverseDataRate, TheCountersOfARateAreAddedUp) {
    Record record = packet(0);
    for (const std::size_t offset : countersOf(11)) {
        record.at(offset, 3);
    }
    record.at(countersOf(0).front() + 3, 0x80); // the highest bit of a counter
    EXPECT_EQ(totalOf(record), 24 * 3 * 12288LL + 128 * 0x80000000LL);
}

TEST(ReverseDataRate, NothingElseInThePacketCounts) {
    Record record = packet(0);
    std::set<std::size_t> counted;
    for (std::size_t rate = 0; rate < kWeights.size(); ++rate) {
        for (const std::size_t offset : countersOf(rate)) {
            counted.insert({offset, offset + 1, offset + 2, offset + 3});
        }
    }
    EXPECT_EQ(counted.size(), 12U * 24 * 4) << "no counter counts twice";
    for (std::size_t at = 18; at < kLength; ++at) {
        record.at(at, counted.contains(at) ? 0 : 0xFF);
    }
    EXPECT_EQ(totalOf(record), 0);
}

TEST(ReverseDataRate, SumsAre64BitsWide) {
    Record record = packet(0);
    for (std::size_t at = 18; at < kLength; ++at) {
        record.at(at, 0xFF);
    }
    EXPECT_EQ(totalOf(record), 4129765672965120);
}

TEST(ReverseDataRate, TheSequenceNumberStandsAt14OneByteLaterThanInTheForwardPacket) {
    C2KFixture fixture;
    EXPECT_EQ(PropertyList(fixture.writtenBy(packet(0xA4030201))),
              PropertyList(Dictionary{{"kRLDataRate", ""}}));
    EXPECT_EQ(fixture.kept("RLDataSeqNum"), 0xA4030201);
    EXPECT_EQ(PropertyList(fixture.writtenBy(packet(0xA4030203).at(18, 80))),
              PropertyList(Dictionary{{"kRLDataRate", "5.00 kbps"}}));
    EXPECT_EQ(fixture.lines, Lines());
    EXPECT_EQ(PropertyList(fixture.extraInfo()),
              PropertyList(Dictionary{{"RLDataSeqNum1", PropertyList::integer(0xA4030203)},
                                      {"RLDataSent1", PropertyList::integer(10240)},
                                      {"RLDataSeqNum2", PropertyList::integer(0xA4030201)},
                                      {"RLDataSent2", PropertyList::integer(0)}}));
}

TEST(ReverseDataRate, TheTwoLinksKeepTheirValuesApart) {
    C2KFixture fixture;
    fixture.feed(packet(1));
    fixture.feed(Record(0x1192).u32(50).padTo(241));
    EXPECT_EQ(fixture.text("kFLDataRate"), "");
    fixture.feed(packet(2).at(18, 8));
    EXPECT_EQ(fixture.text("kRLDataRate"), "1.00 kbps");
    EXPECT_EQ(fixture.text("kFLDataRate"), "");
    EXPECT_EQ(fixture.kept("FLDataSeqNum"), 50);
    EXPECT_EQ(fixture.kept("RLDataSeqNum"), 2);
}

TEST(ReverseDataRate, ASecondPacketWithTheSameSequenceNumberLeavesTheRateAndUpdatesTheTotals) {
    C2KFixture fixture;
    fixture.feed(packet(7));
    fixture.feed(packet(7).at(18, 8));
    EXPECT_EQ(fixture.text("kRLDataRate"), "");
    EXPECT_EQ(fixture.kept("RLDataSent"), 1024);
}

TEST(ReverseDataRate, APacketBelow1750BytesIsAnError) {
    C2KFixture fixture;
    EXPECT_TRUE(fixture.writtenBy(Record(0x127E).padTo(1749)).empty());
    EXPECT_EQ(fixture.lines,
              (Lines{{3, "Log code 0x127e is 1749 bytes long but must be at least 1750 bytes."}}));
    EXPECT_FALSE(fixture.state.contains("RLDataSeqNum"));
    cutPacketAtEveryLength(packet(7).padTo(1755), 1750);
}

TEST(ReverseDataRate, AnyBytesWriteOnlyItsRow) {
    anyPacketWritesOnly(0x127E, {"kRLDataRate"}, {1750, 1760});
}

} // namespace
} // namespace pallax
