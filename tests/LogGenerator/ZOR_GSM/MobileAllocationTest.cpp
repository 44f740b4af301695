#include "LogGenerator/ZOR_GSM/MobileAllocation.h"

#include "tests/doubles/RecordFixture.h"
#include "tests/doubles/RecordProperties.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using namespace doubles; // NOLINT: the vocabulary of these tests
using Lines = std::vector<RecordingLog::Line>;

Record threeChannels() {
    return Record(0x51F8).u8(17).u8(3).u16(62).u16(1023).u16(0xFFFF);
}

TEST(MobileAllocation, SubscribesToItsRecord) {
    const RecordFixture<MobileAllocation> fixture;
    EXPECT_EQ(fixture.subscriptions(), (std::vector<LogCode>{0x51F8}));
    EXPECT_EQ(MobileAllocation().getSectionName(), "Mobile Allocation");
}

TEST(MobileAllocation, ShowsTheSequenceNumberAndTheChannelsInPacketOrder) {
    RecordFixture<MobileAllocation> fixture;
    fixture.feed(threeChannels());
    expectInOrder(fixture.section(),
                  Dictionary{{"HSN", "17"}, {"ARFCNs", Array{"62", "1023", "65535"}}});
    EXPECT_EQ(fixture.lines, (Lines{{4, "MobileAllocation"}}));
    const ArrayRef channels = fixture.keys().find("ARFCNs")->array();
    ASSERT_NE(channels->front().displayNumber(), nullptr);
    EXPECT_EQ(channels->front().displayNumber()->integer(), 62);
}

TEST(MobileAllocation, WithoutChannelsTheArrayIsEmptyAndTheSequenceNumberStillSet) {
    expectInOrder(sectionAfter<MobileAllocation>(Record(0x51F8).u8(255).u8(0)),
                  Dictionary{{"HSN", "255"}, {"ARFCNs", Array()}});
}

TEST(MobileAllocation, EachPacketBringsANewArrayAndLeavesTheOldOneAsItWas) {
    RecordFixture<MobileAllocation> fixture;
    fixture.feed(threeChannels());
    const ArrayRef before = fixture.keys().find("ARFCNs")->array();
    fixture.feed(Record(0x51F8).u8(1).u8(1).u16(5));
    expectInOrder(fixture.section(), Dictionary{{"HSN", "1"}, {"ARFCNs", Array{"5"}}});
    EXPECT_EQ(before->size(), 3U);
}

TEST(MobileAllocation, TheListStopsAtTheLastWholeChannel) {
    const auto channelsIn = [](std::size_t length) {
        ByteBuffer bytes = threeChannels().at(14, 255).bytes();
        bytes.resize(length);
        RecordFixture<MobileAllocation> fixture;
        fixture.feed(bytes);
        return fixture.keys().find("ARFCNs")->array()->size();
    };
    EXPECT_EQ(channelsIn(15), 0U);
    EXPECT_EQ(channelsIn(16), 0U);
    EXPECT_EQ(channelsIn(17), 1U);
    EXPECT_EQ(channelsIn(20), 2U);
    EXPECT_EQ(channelsIn(21), 3U);
}

TEST(MobileAllocation, ShowsUpTo255Channels) {
    RecordFixture<MobileAllocation> fixture;
    fixture.feed(Record(0x51F8).u8(0).u8(255).padTo(1000));
    EXPECT_EQ(fixture.keys().find("ARFCNs")->array()->size(), 255U);
}

TEST(MobileAllocation, A14BytePacketChangesNothing) {
    cutAtEveryLength<MobileAllocation>(threeChannels(), 15);
    RecordFixture<MobileAllocation> fixture;
    fixture.feed(Record(0x51F8).u8(1));
    EXPECT_EQ(fixture.lines, (Lines{{4, "MobileAllocation"}}));
    EXPECT_TRUE(fixture.keys().empty());
}

TEST(MobileAllocation, AnyOtherCodeIsUnknownAndChangesNothing) {
    RecordFixture<MobileAllocation> fixture;
    fixture.feed(Record(0x51F9).padTo(40));
    EXPECT_EQ(fixture.lines,
              (Lines{{4, "MobileAllocation"}, {3, "Received an unknown log message: 20985"}}));
    EXPECT_TRUE(fixture.keys().empty());
}

TEST(MobileAllocation, AnyBytesKeepWithinItsKeys) {
    anyBytesKeepWithin<MobileAllocation>({"HSN", "ARFCNs"});
}

} // namespace
} // namespace pallax
