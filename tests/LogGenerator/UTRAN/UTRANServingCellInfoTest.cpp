#include "LogGenerator/UTRAN/UTRANServingCellInfo.h"

#include "tests/doubles/RecordFixture.h"
#include "tests/doubles/RecordProperties.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using namespace doubles; // NOLINT: the vocabulary of these tests
using Lines = std::vector<RecordingLog::Line>;

/// All bytes and bits that are not read are set.
Record servingCell() {
    return Record(0xD0E2)
        .u8(0xA5)
        .u8(7) // access restrictions
        .u8(9) // URA
        .u8(0xA5)
        .u16(9763)      // uplink
        .u16(10713)     // downlink
        .u32(123456789) // cell
        .u8(0xFE);
}

std::string textAfter(const Record& record, std::string_view key) {
    RecordFixture<UTRANServingCellInfo> fixture;
    fixture.feed(record);
    return fixture.text(key);
}

TEST(UTRANServingCellInfo, OwnsServingCellInfoAndSubscribesTo0xD0E2AndTheCellMonitor) {
    const RecordFixture<UTRANServingCellInfo> fixture;
    EXPECT_EQ(fixture.subscriptions(), (std::vector<LogCode>{0xD0E2, 0xFF0001}));
    EXPECT_EQ(UTRANServingCellInfo().getSectionName(), "Serving Cell Info");
    EXPECT_EQ(UTRANServingCellInfo().sectionKind(), SectionKind::Keys);
}

TEST(UTRANServingCellInfo, ShowsItsSixKeysInOrder) {
    expectInOrder(sectionAfter<UTRANServingCellInfo>(servingCell()),
                  Dictionary{{"Cell Access Restrictions", "7"},
                             {"Cell ID", "123456789"},
                             {"Downlink UARFCN", "10713"},
                             {"Uplink UARFCN", "9763"},
                             {"URA ID", "9"},
                             {"Allowed Access", "All Calls"}});
}

TEST(UTRANServingCellInfo, OnlyTheCellIDIsSigned) {
    Record record(0xD0E2);
    while (record.bytes().size() < 26) {
        record.u8(0xFF);
    }
    expectInOrder(sectionAfter<UTRANServingCellInfo>(record),
                  Dictionary{{"Cell Access Restrictions", "255"},
                             {"Cell ID", "-1"},
                             {"Downlink UARFCN", "65535"},
                             {"Uplink UARFCN", "65535"},
                             {"URA ID", "255"},
                             {"Allowed Access", "Emergency Calls Only"}});
    EXPECT_EQ(textAfter(servingCell().at(21, 0).at(22, 0).at(23, 0).at(24, 0x80), "Cell ID"),
              "-2147483648");
}

TEST(UTRANServingCellInfo, OnlyBit0OfByte25DecidesTheAllowedAccess) {
    for (unsigned value = 0; value < 256; ++value) {
        EXPECT_EQ(textAfter(servingCell().at(25, value), "Allowed Access"),
                  value % 2 == 1 ? "Emergency Calls Only" : "All Calls")
            << value;
    }
}

TEST(UTRANServingCellInfo, APacketOf25BytesChangesNothingSilently) {
    const ByteBuffer whole = servingCell().bytes();
    ASSERT_EQ(whole.size(), 26U);
    RecordFixture<UTRANServingCellInfo> fixture;
    fixture.feed(ByteBuffer(whole.begin(), whole.end() - 1));
    EXPECT_EQ(fixture.lines, (Lines{{4, "Serving Cell Info"}}));
    EXPECT_TRUE(fixture.keys().empty());
    cutAtEveryLength<UTRANServingCellInfo>(servingCell(), 26);
}

TEST(UTRANServingCellInfo, AnyOtherCodeIsIgnoredSilently) {
    RecordFixture<UTRANServingCellInfo> fixture;
    fixture.feed(Record(0xD0E0).padTo(40));
    EXPECT_EQ(fixture.lines, (Lines{{4, "Serving Cell Info"}}));
    EXPECT_TRUE(fixture.keys().empty());
}

TEST(UTRANServingCellInfo, AnyBytesKeepItsSectionWithinItsKeys) {
    anyBytesKeepWithin<UTRANServingCellInfo>(
        {"Cell Access Restrictions", "Cell ID", "Downlink UARFCN", "Uplink UARFCN", "URA ID",
         "Allowed Access", "Local Area Code", "Freq Band Indicator", "Cell Scrambling Code"});
}

} // namespace
} // namespace pallax
