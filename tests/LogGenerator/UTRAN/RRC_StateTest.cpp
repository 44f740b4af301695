#include "LogGenerator/UTRAN/RRC_State.h"

#include "tests/doubles/RecordFixture.h"
#include "tests/doubles/RecordProperties.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using namespace doubles; // NOLINT: the vocabulary of these tests
using Lines = std::vector<RecordingLog::Line>;

Record state(unsigned version, unsigned mode) {
    return Record(0xD0E0).u8(version).u8(mode);
}

TEST(RRC_State, OwnsRRCInfoAndSubscribesTo0xD0E0) {
    const RecordFixture<RRC_State> fixture;
    EXPECT_EQ(fixture.subscriptions(), (std::vector<LogCode>{0xD0E0}));
    EXPECT_EQ(RRC_State().getSectionName(), "RRC Info");
    EXPECT_EQ(RRC_State().sectionKind(), SectionKind::Keys);
}

TEST(RRC_State, Version1AndMode3ShowCellDCH) {
    expectInOrder(sectionAfter<RRC_State>(state(1, 3)), Dictionary{{"State", "Cell DCH"}});
}

TEST(RRC_State, EveryModeHasItsLabel) {
    const std::vector<std::string> labels = {"Disconnected", "Connecting", "Cell Fach",
                                             "Cell DCH",     "Cell PCH",   "Cell URA PCH"};
    RecordFixture<RRC_State> fixture;
    for (unsigned mode = 0; mode < 256; ++mode) {
        fixture.feed(state(1, mode));
        EXPECT_EQ(fixture.text("State"), mode < labels.size() ? labels[mode] : "Unknown RRC Mode");
    }
}

TEST(RRC_State, AForeignVersionShowsUnknownAndLogsMode255ForAnyModeByte) {
    RecordFixture<RRC_State> fixture;
    for (const unsigned version : {0U, 2U, 255U}) {
        for (const unsigned mode : {0U, 3U, 6U}) {
            fixture.feed(state(version, mode));
            EXPECT_EQ(fixture.text("State"), "Unknown RRC Mode");
            EXPECT_EQ(fixture.lines, (Lines{{4, "RRC Info"},
                                            {4, "Display Dict = { State = Unknown RRC Mode; }, "
                                                "rrc mode = 255 Unknown RRC Mode"}}));
        }
    }
}

TEST(RRC_State, LogsTheWholeSectionTheModeAndItsLabelBehindTheUpdate) {
    RecordFixture<RRC_State> fixture;
    fixture.keys().set("Other", "kept");
    fixture.feed(state(1, 6));
    EXPECT_EQ(fixture.lines,
              (Lines{{4, "RRC Info"},
                     {4, "Display Dict = { Other = kept; State = Unknown RRC Mode; }, "
                         "rrc mode = 6 Unknown RRC Mode"}}));
    fixture.feed(state(1, 2));
    EXPECT_EQ(fixture.lines.back(),
              (RecordingLog::Line{4, "Display Dict = { Other = kept; State = Cell Fach; }, "
                                     "rrc mode = 2 Cell Fach"}));
}

TEST(RRC_State, WithoutASectionTheLineHasNoDictionary) {
    RecordingLog log;
    RRC_State record;
    const ByteBuffer bytes = state(1, 0).bytes();
    record.updateWithData(LogRecord(bytes), 0xD0E0);
    EXPECT_EQ(log.lines(),
              (Lines{{4, "RRC Info"}, {4, "Display Dict = (null), rrc mode = 0 Disconnected"}}));
}

TEST(RRC_State, AShortPacketIsLoggedAndReadWithItsMissingBytesZero) {
    RecordFixture<RRC_State> fixture;
    fixture.feed(Record(0xD0E0).u8(1)); // the version, but no mode
    EXPECT_EQ(fixture.lines,
              (Lines{{4, "RRC Info"},
                     {4, "LogCode_0xD0E0 is length is 14 expected size 15"},
                     {4, "Display Dict = { State = Disconnected; }, rrc mode = 0 Disconnected"}}));
    fixture.feed(Record(0xD0E0)); // version 0 is not understood
    EXPECT_EQ(fixture.lines, (Lines{{4, "RRC Info"},
                                    {4, "LogCode_0xD0E0 is length is 13 expected size 15"},
                                    {4, "Display Dict = { State = Unknown RRC Mode; }, "
                                        "rrc mode = 255 Unknown RRC Mode"}}));
    fixture.feed(ByteBuffer(), 0xD0E0);
    EXPECT_EQ(fixture.lines[1],
              (RecordingLog::Line{4, "LogCode_0xD0E0 is length is 0 expected size 15"}));
    EXPECT_EQ(fixture.text("State"), "Unknown RRC Mode");
}

TEST(RRC_State, AnyOtherCodeIsIgnoredSilently) {
    RecordFixture<RRC_State> fixture;
    fixture.feed(Record(0xD0E2).u8(1).u8(3).padTo(40));
    EXPECT_EQ(fixture.lines, (Lines{{4, "RRC Info"}}));
    EXPECT_TRUE(fixture.keys().empty());
}

TEST(RRC_State, ACutPacketIsNeverReadOutside) {
    cutAtEveryLength<RRC_State>(state(1, 3), 0);
}

TEST(RRC_State, AnyBytesKeepItsSectionWithinItsKeys) {
    anyBytesKeepWithin<RRC_State>({"State"});
}

} // namespace
} // namespace pallax
