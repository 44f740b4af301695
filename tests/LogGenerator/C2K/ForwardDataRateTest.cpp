#include "LogGenerator/C2K/ForwardDataRate.h"

#include "tests/LogGenerator/C2K/C2KFixture.h"

#include <gtest/gtest.h>

#include <array>

namespace pallax {
namespace {

using namespace doubles; // NOLINT: the vocabulary of these tests
using Lines = std::vector<RecordingLog::Line>;

constexpr std::size_t kCounters = 17;

/// A packet whose 56 counters are all `value`.
Record counters(std::uint32_t sequence, std::uint32_t value) {
    Record record(0x1192);
    record.u32(sequence);
    for (int counter = 0; counter < 56; ++counter) {
        record.u32(value);
    }
    return record;
}

/// The total after a packet in which only the lowest byte of one counter is not zero.
std::int64_t totalOf(std::size_t counter, unsigned value) {
    C2KFixture fixture;
    fixture.feed(counters(0, 0).at(kCounters + 4 * counter, value));
    return fixture.kept("FLDataSent");
}

TEST(ForwardDataRate, EveryCounterHasItsWeight) {
    constexpr auto kWeights = std::to_array<std::int64_t>(
        {128,  256,  512, 1024, 0,    128,  256,  512,  1024, 0,    128,  256,  512,  1024,
         0,    128,  256, 512,  1024, 0,    128,  256,  512,  1024, 0,    512,  1024, 2048,
         0,    128,  256, 512,  1024, 0,    512,  1024, 2048, 0,    1024, 3072, 0,    512,
         1024, 2048, 0,   4096, 0,    1024, 3072, 0,    4096, 0,    5120, 0,    5120, 0});
    ASSERT_EQ(kWeights.size(), 56U);
    for (std::size_t counter = 0; counter < kWeights.size(); ++counter) {
        EXPECT_EQ(totalOf(counter, 1), kWeights[counter]) << "counter " << counter;
        EXPECT_EQ(totalOf(counter, 255), 255 * kWeights[counter]) << "counter " << counter;
    }
}

TEST(ForwardDataRate, CountersAre32BitsWideAndTheTotal64) {
    C2KFixture fixture;
    fixture.feed(counters(0, 0x01000000).at(kCounters, 0x10).at(kCounters + 1, 0x20));
    EXPECT_EQ(fixture.kept("FLDataSent"), 48896LL * 0x01000000 + 128LL * 0x2010);
    fixture.feed(counters(0, 0xFFFFFFFF));
    EXPECT_EQ(fixture.kept("FLDataSent"), 210006720856320);
}

TEST(ForwardDataRate, TheFirstPacketSetsTheEmptyStringAndTheNextTheRate) {
    C2KFixture fixture;
    EXPECT_EQ(PropertyList(fixture.writtenBy(counters(0x04030201, 0))),
              PropertyList(Dictionary{{"kFLDataRate", ""}}));
    EXPECT_EQ(fixture.kept("FLDataSeqNum"), 0x04030201);
    EXPECT_EQ(PropertyList(fixture.writtenBy(counters(0x04030211, 5))),
              PropertyList(Dictionary{{"kFLDataRate", "14.92 kbps"}})); // 48896 x 5 / 16 / 1024
    EXPECT_EQ(fixture.lines, Lines());
    EXPECT_EQ(PropertyList(fixture.extraInfo()),
              PropertyList(Dictionary{{"FLDataSeqNum1", PropertyList::integer(0x04030211)},
                                      {"FLDataSent1", PropertyList::integer(244480)},
                                      {"FLDataSeqNum2", PropertyList::integer(0x04030201)},
                                      {"FLDataSent2", PropertyList::integer(0)}}));
}

TEST(ForwardDataRate, ASecondPacketWithTheSameSequenceNumberLeavesTheRateAndUpdatesTheTotals) {
    C2KFixture fixture;
    fixture.feed(counters(7, 0));
    fixture.feed(counters(7, 1));
    EXPECT_EQ(fixture.text("kFLDataRate"), "");
    EXPECT_EQ(fixture.kept("FLDataSent"), 48896);
    fixture.feed(counters(8, 2));
    EXPECT_EQ(fixture.text("kFLDataRate"), "47.75 kbps");
}

TEST(ForwardDataRate, ATotalThatFellGivesANegativeRate) {
    C2KFixture fixture;
    fixture.feed(counters(7, 2));
    fixture.feed(counters(8, 1));
    EXPECT_EQ(fixture.text("kFLDataRate"), "-47.75 kbps");
}

TEST(ForwardDataRate, APacketBelow241BytesIsAnError) {
    C2KFixture fixture;
    EXPECT_TRUE(fixture.writtenBy(Record(0x1192).padTo(240)).empty());
    EXPECT_EQ(fixture.lines,
              (Lines{{3, "Log code 0x1192 is 240 bytes long but must be at least 241 bytes."}}));
    EXPECT_FALSE(fixture.state.contains("FLDataSeqNum"));
    cutPacketAtEveryLength(counters(7, 1).padTo(245), 241);
}

TEST(ForwardDataRate, AnyBytesWriteOnlyItsRow) {
    anyPacketWritesOnly(0x1192, {"kFLDataRate"}, {241, 260});
}

} // namespace
} // namespace pallax
