#include "LogGenerator/UTRAN/TRCHBLERMeasurement.h"

#include "LogGenerator/UTRAN/ChannelQuality.h"
#include "tests/doubles/RecordFixture.h"
#include "tests/doubles/RecordProperties.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using namespace doubles; // NOLINT: the vocabulary of these tests
using BlerFixture = RecordFixture<TRCHBLERMeasurement>;
using Lines = std::vector<RecordingLog::Line>;

Record counts(unsigned byte14, unsigned byte15) {
    return Record(0xD00C).u8(0xFF).u8(byte14).u8(byte15).u8(0xFF);
}

TEST(TRCHBLERMeasurement, OwnsTRCHBLERAndSubscribesTo0xD00C) {
    const BlerFixture fixture;
    EXPECT_EQ(fixture.subscriptions(), (std::vector<LogCode>{0xD00C}));
    EXPECT_EQ(TRCHBLERMeasurement().getSectionName(), "TRCH BLER");
    EXPECT_EQ(TRCHBLERMeasurement().sectionKind(), SectionKind::List);
}

TEST(TRCHBLERMeasurement, Bytes0x80And0x00GiveTwoChannelsWithTheirKeysInOrder) {
    BlerFixture fixture;
    fixture.feed(counts(0x80, 0x00).append({1, 12, 255, 254, 3, 3}));
    ASSERT_EQ(fixture.list().size(), 2U);
    expectInOrder(fixture.list()[0], Dictionary{{"TRCH ID", "1"}, {"TRCH BLER Measurement", "12"}});
    expectInOrder(fixture.list()[1],
                  Dictionary{{"TRCH ID", "255"}, {"TRCH BLER Measurement", "254"}});
}

TEST(TRCHBLERMeasurement, ItsTraceLineIsANoticeOfPriority5) {
    BlerFixture fixture;
    for (const Record& record : {counts(0x40, 0).padTo(19), counts(0, 0), Record(0xD00C)}) {
        fixture.feed(record);
        EXPECT_EQ(fixture.lines, (Lines{{5, "TRCH BLER Measurement"}}));
    }
}

TEST(TRCHBLERMeasurement, TheCountIsBits6To11OfTheWordAtByte14) {
    BlerFixture fixture;
    const auto shown = [&fixture](unsigned byte14, unsigned byte15) {
        fixture.feed(counts(byte14, byte15).padTo(17 + 2 * 63));
        return fixture.list().size();
    };
    EXPECT_EQ(shown(0x3F, 0xF0), 0U) << "the neighbouring bits";
    EXPECT_EQ(shown(0x40, 0x00), 1U);
    EXPECT_EQ(shown(0x80, 0x00), 2U);
    EXPECT_EQ(shown(0x00, 0x01), 4U);
    EXPECT_EQ(shown(0x00, 0x08), 32U);
    EXPECT_EQ(shown(0xC0, 0x0F), 63U);
    EXPECT_EQ(shown(0x00, 0x30), 0U) << "the number of composite channels";
}

TEST(TRCHBLERMeasurement, NoChannelsEmptyTheList) {
    BlerFixture fixture;
    fixture.list() = Array{"what was shown before"};
    fixture.feed(counts(0, 0));
    EXPECT_TRUE(fixture.list().empty());
}

TEST(TRCHBLERMeasurement, AShortPacketOrAnotherCodeChangesNothingSilently) {
    BlerFixture fixture;
    fixture.list() = Array{"what was shown before"};
    for (const Record& record : {Record(0xD00C).padTo(16), Record(0xD00E).padTo(400)}) {
        fixture.feed(record);
        EXPECT_EQ(fixture.lines, (Lines{{5, "TRCH BLER Measurement"}}));
        EXPECT_EQ(fixture.section(), PropertyList(Array{"what was shown before"}));
    }
    cutAtEveryLength<TRCHBLERMeasurement>(counts(0xC0, 0x0F).padTo(17 + 2 * 63), 17);
}

TEST(TRCHBLERMeasurement, TheListStopsAtTheFirstChannelThatIsNotWhole) {
    const ByteBuffer bytes = counts(0xC0, 0x0F).padTo(17 + 9).bytes();
    for (std::size_t length = 17; length <= bytes.size(); ++length) {
        BlerFixture fixture;
        fixture.feed(
            ByteBuffer(bytes.begin(), bytes.begin() + static_cast<std::ptrdiff_t>(length)));
        EXPECT_EQ(fixture.list().size(), (length - 17) / 2) << "cut at " << length;
    }
}

TEST(TRCHBLERMeasurement, AChannelIndexAtTheCountThrows) {
    const ByteBuffer bytes = counts(0x80, 0x30).bytes();
    const LogRecord record{Bytes(bytes)};
    const ListLayout transport{.entries = kTransportChannels, .count = kTransportChannelCount};
    EXPECT_NO_THROW((void)transport.entriesIn(record).at(1));
    EXPECT_THROW((void)transport.entriesIn(record).at(2), ArrayOutOfBoundsException);
    const ListLayout composite{.entries = kCompositeChannels, .count = kCompositeChannelCount};
    EXPECT_NO_THROW((void)composite.entriesIn(record).at(2));
    EXPECT_THROW((void)composite.entriesIn(record).at(3), ArrayOutOfBoundsException);
}

TEST(TRCHBLERMeasurement, AnyBytesKeepItsEntriesWithinItsKeys) {
    anyBytesKeepWithin<TRCHBLERMeasurement>({"TRCH ID", "TRCH BLER Measurement"});
}

} // namespace
} // namespace pallax
