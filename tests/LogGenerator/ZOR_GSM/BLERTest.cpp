#include "LogGenerator/ZOR_GSM/BLER.h"

#include "tests/doubles/ArrayLockHolder.h"
#include "tests/doubles/RecordFixture.h"
#include "tests/doubles/RecordProperties.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using namespace doubles; // NOLINT: the vocabulary of these tests
using Lines = std::vector<RecordingLog::Line>;

/// The second channel has the greatest values.
Record twoChannels() {
    return Record(0x4116)
        .u8(2)      // channels
        .u16(65535) // window size
        .u8(5)
        .s32(1000)
        .s32(13)
        .u8(255)
        .u32(0xFFFFFFFF)
        .u32(0x80000000);
}

Array twoChannelsShown() {
    return {Dictionary{{"Transport Channel ID", "5"},
                       {"CRC Received", "1000"},
                       {"CRC Received in Error", "13"}},
            Dictionary{{"Transport Channel ID", "255"},
                       {"CRC Received", "-1"},
                       {"CRC Received in Error", "-2147483648"}}};
}

std::size_t channelCount(RecordFixture<BLER>& fixture) {
    return fixture.keys().find("Transport Channels")->array()->size();
}

TEST(BLER, SubscribesToTheBlockErrorRecord) {
    const BLER record;
    const auto codes = record.getLogCodeArray();
    EXPECT_EQ(std::vector<LogCode>(codes.begin(), codes.end()), (std::vector<LogCode>{0x4116}));
    EXPECT_EQ(record.getSectionName(), "BLER");
    EXPECT_EQ(record.sectionKind(), SectionKind::Keys);
}

TEST(BLER, ShowsTheWindowSizeAndEveryTransportChannelInPacketOrder) {
    RecordFixture<BLER> fixture;
    fixture.feed(twoChannels());
    expectInOrder(fixture.section(),
                  Dictionary{{"Window Size", "65535"}, {"Transport Channels", twoChannelsShown()}});
    const ArrayRef channels = fixture.keys().find("Transport Channels")->array();
    ASSERT_EQ(channels->size(), 2U);
    expectInOrder((*channels)[0], *twoChannelsShown()[0].dictionary());
    expectInOrder((*channels)[1], *twoChannelsShown()[1].dictionary());
    EXPECT_EQ((*channels)[0].dictionary()->find("CRC Received")->displayNumber()->integer(), 1000);
}

TEST(BLER, ACountOf0ShowsAnEmptyArray) {
    RecordFixture<BLER> fixture;
    fixture.feed(twoChannels());
    fixture.feed(twoChannels().at(13, 0));
    expectInOrder(fixture.section(),
                  Dictionary{{"Window Size", "65535"}, {"Transport Channels", Array()}});
}

TEST(BLER, TheArrayIsReplacedByANewOne) {
    RecordFixture<BLER> fixture;
    fixture.feed(twoChannels());
    const ArrayRef earlier = fixture.keys().find("Transport Channels")->array();
    fixture.feed(twoChannels().at(13, 1));
    EXPECT_EQ(channelCount(fixture), 1U);
    EXPECT_EQ(*earlier, twoChannelsShown()) << "the earlier list is unchanged";
}

TEST(BLER, TheListStopsAtTheFirstChannelThatIsNotWhole) {
    const ByteBuffer bytes = twoChannels().at(13, 255).bytes();
    for (std::size_t length = 16; length <= bytes.size(); ++length) {
        RecordFixture<BLER> fixture;
        fixture.feed(
            ByteBuffer(bytes.begin(), bytes.begin() + static_cast<std::ptrdiff_t>(length)));
        EXPECT_EQ(channelCount(fixture), (length - 16) / 9) << "cut at " << length;
    }
}

TEST(BLER, TheArrayIsReplacedWithoutTheArrayLock) {
    RecordFixture<BLER> fixture;
    EXPECT_TRUE(finishesUnderHeldArrayLock(
        kExpectedToFinish, [&fixture] { fixture.feed(twoChannels()); }, [] {}));
    EXPECT_NE(fixture.keys().find("Transport Channels"), nullptr);
}

TEST(BLER, A15BytePacketChangesNothing) {
    cutAtEveryLength<BLER>(twoChannels(), 16);
    RecordFixture<BLER> fixture;
    fixture.feed(Record(0x4116).u8(1).u8(1));
    EXPECT_EQ(fixture.lines, (Lines{{4, "BLER"}})) << "a short packet is dropped silently";
    EXPECT_TRUE(fixture.keys().empty());
}

TEST(BLER, AnyOtherCodeIsUnknownAndChangesNothing) {
    RecordFixture<BLER> fixture;
    fixture.feed(twoChannels());
    EXPECT_EQ(fixture.lines, (Lines{{4, "BLER"}}));
    const PropertyList before = fixture.snapshot();
    fixture.feed(Record(0x4221).padTo(100));
    EXPECT_EQ(fixture.lines, (Lines{{4, "BLER"}, {3, "Received an unknown log message: 16929"}}));
    EXPECT_EQ(fixture.section(), before);
}

TEST(BLER, AnyBytesKeepItsSectionWithinItsKeys) {
    anyBytesKeepWithin<BLER>({"Window Size", "Transport Channels"});
}

} // namespace
} // namespace pallax
