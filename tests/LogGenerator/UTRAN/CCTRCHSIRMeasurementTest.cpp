#include "LogGenerator/UTRAN/CCTRCHSIRMeasurement.h"

#include "tests/doubles/Property.h"
#include "tests/doubles/RecordFixture.h"
#include "tests/doubles/RecordProperties.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using namespace doubles; // NOLINT: the vocabulary of these tests
using SirFixture = RecordFixture<CCTRCHSIRMeasurement>;
using Lines = std::vector<RecordingLog::Line>;

constexpr std::size_t entriesStart(unsigned transportChannels) {
    return 289 + 34 * std::size_t{transportChannels};
}

/// A record of T transport and S composite channels that ends where the composite channels begin;
/// all bytes before are set.
Record channels(unsigned transport, unsigned composite) {
    Record record(0xD00C);
    record.u8(0xFF).u16(transport << 6U | composite << 12U | 0x3F);
    while (record.bytes().size() < entriesStart(transport)) {
        record.u8(0xFF);
    }
    return record;
}

TEST(CCTRCHSIRMeasurement, OwnsCCTRCHSIRAndSubscribesTo0xD00C) {
    const SirFixture fixture;
    EXPECT_EQ(fixture.subscriptions(), (std::vector<LogCode>{0xD00C}));
    EXPECT_EQ(CCTRCHSIRMeasurement().getSectionName(), "CCTRCH SIR");
    EXPECT_EQ(CCTRCHSIRMeasurement().sectionKind(), SectionKind::List);
}

TEST(CCTRCHSIRMeasurement, ShowsEveryChannelWithItsKeysInOrderAndSixRatios) {
    SirFixture fixture;
    fixture.feed(
        channels(0, 2).append({1, 2, 10, 11, 12, 13, 14, 255}).append({255, 6, 0, 0, 0, 0, 0, 1}));
    EXPECT_EQ(fixture.lines, (Lines{{4, "CCTRCH SIR Measurement"}}));
    ASSERT_EQ(fixture.list().size(), 2U);
    expectInOrder(fixture.list()[0],
                  Dictionary{{"CCTRCH ID", "1"},
                             {"TSNUM", "2"},
                             {"SIR", Array{"10", "11", "12", "13", "14", "255"}}});
    expectInOrder(fixture.list()[1], Dictionary{{"CCTRCH ID", "255"},
                                                {"TSNUM", "6"},
                                                {"SIR", Array{"0", "0", "0", "0", "0", "1"}}});
}

TEST(CCTRCHSIRMeasurement, WithTwoTransportChannelsTheEntryIsReadFromByte357) {
    Record record = Record(0xD00C).padTo(365).at(14, 0x80).at(15, 0x10).at(357, 42);
    SirFixture fixture;
    fixture.feed(record);
    ASSERT_EQ(fixture.list().size(), 1U);
    EXPECT_EQ(*fixture.list()[0].dictionary()->find("CCTRCH ID"), PropertyList("42"));
}

TEST(CCTRCHSIRMeasurement, TheEntriesBeginAt289Plus34TimesTheTransportChannels) {
    for (unsigned transport = 0; transport < 64; ++transport) {
        const Record record = channels(transport, 1).append({7, 8, 1, 2, 3, 4, 5, 6});
        SirFixture fixture;
        fixture.feed(record);
        EXPECT_EQ(
            fixture.section(),
            PropertyList(Array{Dictionary{
                {"CCTRCH ID", "7"}, {"TSNUM", "8"}, {"SIR", Array{"1", "2", "3", "4", "5", "6"}}}}))
            << transport;
    }
}

TEST(CCTRCHSIRMeasurement, TheCountIsTheUpperFourBitsOfByte15) {
    SirFixture fixture;
    for (unsigned composite = 0; composite < 16; ++composite) {
        fixture.feed(channels(0, composite).padTo(entriesStart(0) + 15 * 8));
        EXPECT_EQ(fixture.list().size(), composite);
    }
    fixture.feed(Record(0xD00C).padTo(entriesStart(0) + 15 * 8).at(15, 0x30));
    EXPECT_EQ(fixture.list().size(), 3U);
    fixture.feed(channels(63, 0).padTo(entriesStart(63) + 15 * 8));
    EXPECT_TRUE(fixture.list().empty()) << "the number of transport channels";
}

TEST(CCTRCHSIRMeasurement, NoChannelsEmptyTheList) {
    SirFixture fixture;
    fixture.list() = Array{"what was shown before"};
    fixture.feed(Record(0xD00C).padTo(17));
    EXPECT_TRUE(fixture.list().empty());
}

TEST(CCTRCHSIRMeasurement, AShortPacketOrAnotherCodeChangesNothingSilently) {
    SirFixture fixture;
    fixture.list() = Array{"what was shown before"};
    for (const Record& record : {Record(0xD00C).padTo(16), Record(0xD00E).padTo(400)}) {
        fixture.feed(record);
        EXPECT_EQ(fixture.lines, (Lines{{4, "CCTRCH SIR Measurement"}}));
        EXPECT_EQ(fixture.section(), PropertyList(Array{"what was shown before"}));
    }
    cutAtEveryLength<CCTRCHSIRMeasurement>(channels(2, 3).padTo(entriesStart(2) + 24), 17);
}

TEST(CCTRCHSIRMeasurement, TheListStopsAtTheFirstChannelThatIsNotWhole) {
    const ByteBuffer bytes = channels(1, 15).padTo(entriesStart(1) + 20).bytes();
    for (std::size_t length = 17; length <= bytes.size(); ++length) {
        SirFixture fixture;
        fixture.feed(
            ByteBuffer(bytes.begin(), bytes.begin() + static_cast<std::ptrdiff_t>(length)));
        const std::size_t behind = length < entriesStart(1) ? 0 : length - entriesStart(1);
        EXPECT_EQ(fixture.list().size(), behind / 8) << "cut at " << length;
    }
}

TEST(CCTRCHSIRMeasurement, AnyBytesKeepItsEntriesWithinItsKeys) {
    const std::set<std::string> keys = {"CCTRCH ID", "TSNUM", "SIR"};
    anyBytesKeepWithin<CCTRCHSIRMeasurement>(keys);
    // With bytes after the fixed distance to the first entry.
    anyRecordsKeepWithin<CCTRCHSIRMeasurement, NothingThrown>(
        keys, codesOf<CCTRCHSIRMeasurement>(), [](LogCode) {
            const auto transport = any::below(64);
            return channels(transport, any::below(16)).append(any::recordBytes()).bytes();
        });
}

} // namespace
} // namespace pallax
