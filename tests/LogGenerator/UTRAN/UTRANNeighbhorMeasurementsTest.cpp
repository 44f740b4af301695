#include "LogGenerator/UTRAN/UTRANNeighbhorMeasurements.h"

#include "tests/doubles/RecordFixture.h"
#include "tests/doubles/RecordProperties.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using namespace doubles; // NOLINT: the vocabulary of these tests
using UtranNeighborFixture = RecordFixture<UTRANNeighbhorMeasurements>;
using Lines = std::vector<RecordingLog::Line>;

constexpr std::size_t kEntries = 168;
constexpr std::size_t kStride = 16;

/// The first four bytes of an entry as one number.
constexpr std::uint32_t packed(unsigned uarfcn, unsigned cellId, unsigned rscp, unsigned status,
                               unsigned detected) {
    return uarfcn | cellId << 14U | rscp << 21U | status << 29U | detected << 31U;
}

/// All bytes that are not read are set.
Record utranNeighbours(const std::vector<std::uint32_t>& cells) {
    Record record(0xD00A);
    while (record.bytes().size() < kEntries) {
        record.u8(0xFF);
    }
    record.at(16, static_cast<unsigned>(cells.size()) << 1U | 1U);
    for (const std::uint32_t cell : cells) {
        record.u32(cell).u32(0xFFFFFFFF).u32(0xFFFFFFFF).u32(0xFFFFFFFF);
    }
    return record;
}

std::string shown(std::uint32_t cell, std::string_view key) {
    UtranNeighborFixture fixture;
    fixture.feed(utranNeighbours({cell}));
    if (fixture.list().size() != 1) {
        return "(no single cell)";
    }
    const PropertyList* value = fixture.list()[0].dictionary()->find(key);
    return value != nullptr ? value->string().value_or("(no text)") : "(absent)";
}

TEST(UTRANNeighbhorMeasurements, OwnsTheNeighborCellListAndSubscribesTo0xD00A) {
    const UtranNeighborFixture fixture;
    EXPECT_EQ(fixture.subscriptions(), (std::vector<LogCode>{0xD00A}));
    EXPECT_EQ(UTRANNeighbhorMeasurements().getSectionName(), "Neighbor Cell List");
    EXPECT_EQ(UTRANNeighbhorMeasurements().sectionKind(), SectionKind::List);
}

TEST(UTRANNeighbhorMeasurements, ShowsEveryCellWithItsKeysInOrder) {
    UtranNeighborFixture fixture;
    fixture.feed(utranNeighbours({packed(10713, 97, 128, 1, 1), packed(10688, 5, 255, 0, 0)}));
    EXPECT_EQ(fixture.lines, (Lines{{4, "NeighbhorMeasurements List"}}));
    ASSERT_EQ(fixture.list().size(), 2U);
    expectInOrder(fixture.list()[0], Dictionary{{"UARFCN", "10713"},
                                                {"Cell ID", "97"},
                                                {"Filter RSCP", "0.500000"},
                                                {"Status", "MSET"},
                                                {"inJDCS", "TRUE"}});
    expectInOrder(fixture.list()[1], Dictionary{{"UARFCN", "10688"},
                                                {"Cell ID", "5"},
                                                {"Filter RSCP", "0.996094"},
                                                {"Status", "ASET"},
                                                {"inJDCS", "FALSE"}});
}

TEST(UTRANNeighbhorMeasurements, Byte16Of0x06GivesThreeEntriesAtBytes168And184And200) {
    Record record(0xD00A);
    record.padTo(204).at(16, 0x06).at(168, 1).at(184, 2).at(200, 3);
    UtranNeighborFixture fixture;
    fixture.feed(record);
    ASSERT_EQ(fixture.list().size(), 3U);
    for (std::size_t index = 0; index < 3; ++index) {
        EXPECT_EQ(*fixture.list()[index].dictionary()->find("UARFCN"),
                  PropertyList(std::to_string(index + 1)));
    }
}

TEST(UTRANNeighbhorMeasurements, TheCountIsTheUpperSevenBitsOfByte16) {
    Record record(0xD00A);
    record.padTo(kEntries + 127 * kStride);
    UtranNeighborFixture fixture;
    for (unsigned value = 0; value < 256; ++value) {
        fixture.feed(record.at(16, value));
        EXPECT_EQ(fixture.list().size(), value / 2);
    }
}

TEST(UTRANNeighbhorMeasurements, EveryFieldEndsWhereTheNextBegins) {
    const std::uint32_t none = 0;
    const std::uint32_t all = 0xFFFFFFFF;
    EXPECT_EQ(shown(packed(0x3FFF, 0, 0, 0, 0), "UARFCN"), "16383");
    EXPECT_EQ(shown(all & ~packed(0x3FFF, 0, 0, 0, 0), "UARFCN"), "0");
    EXPECT_EQ(shown(packed(0, 0x7F, 0, 0, 0), "Cell ID"), "127");
    EXPECT_EQ(shown(all & ~packed(0, 0x7F, 0, 0, 0), "Cell ID"), "0");
    EXPECT_EQ(shown(packed(0, 0, 0xFF, 0, 0), "Filter RSCP"), "0.996094");
    EXPECT_EQ(shown(all & ~packed(0, 0, 0xFF, 0, 0), "Filter RSCP"), "0.000000");
    EXPECT_EQ(shown(packed(0, 0, 1, 0, 0), "Filter RSCP"), "0.003906");
    EXPECT_EQ(shown(all & ~packed(0, 0, 0, 3, 0), "Status"), "ASET");
    EXPECT_EQ(shown(all & ~packed(0, 0, 0, 0, 1), "inJDCS"), "FALSE");
    EXPECT_EQ(shown(packed(0, 0, 0, 0, 1), "inJDCS"), "TRUE");
    EXPECT_EQ(shown(none, "UARFCN"), "0");
}

TEST(UTRANNeighbhorMeasurements, TheStatusIsAbsentFor3) {
    EXPECT_EQ(shown(packed(1, 1, 1, 0, 0), "Status"), "ASET");
    EXPECT_EQ(shown(packed(1, 1, 1, 1, 0), "Status"), "MSET");
    EXPECT_EQ(shown(packed(1, 1, 1, 2, 0), "Status"), "DSET");
    EXPECT_EQ(shown(packed(1, 1, 1, 3, 0), "Status"), "(absent)");
    EXPECT_EQ(shown(packed(1, 1, 1, 3, 0), "inJDCS"), "FALSE") << "the next key is set";
}

TEST(UTRANNeighbhorMeasurements, ACountOf0EmptiesTheListAndAPacketOf21BytesIsEnough) {
    UtranNeighborFixture fixture;
    fixture.list() = Array{"what was shown before"};
    fixture.feed(Record(0xD00A).padTo(21));
    EXPECT_TRUE(fixture.list().empty());
}

TEST(UTRANNeighbhorMeasurements, AShortPacketOrAnotherCodeChangesNothingSilently) {
    UtranNeighborFixture fixture;
    fixture.list() = Array{"what was shown before"};
    for (const Record& record : {Record(0xD00A).padTo(20), Record(0xD00E).padTo(400)}) {
        fixture.feed(record);
        EXPECT_EQ(fixture.lines, (Lines{{4, "NeighbhorMeasurements List"}}));
        EXPECT_EQ(fixture.section(), PropertyList(Array{"what was shown before"}));
    }
    cutAtEveryLength<UTRANNeighbhorMeasurements>(utranNeighbours({1, 2, 3}), 21);
}

TEST(UTRANNeighbhorMeasurements, TheListStopsAtTheFirstCellWhoseFourBytesAreNotWhole) {
    const ByteBuffer bytes = utranNeighbours({1, 2, 3}).bytes();
    for (std::size_t length = 21; length <= bytes.size(); ++length) {
        UtranNeighborFixture fixture;
        fixture.feed(
            ByteBuffer(bytes.begin(), bytes.begin() + static_cast<std::ptrdiff_t>(length)));
        const std::size_t whole = length < kEntries + 4 ? 0 : (length - kEntries - 4) / kStride + 1;
        EXPECT_EQ(fixture.list().size(), whole) << "cut at " << length;
    }
}

TEST(UTRANNeighbhorMeasurements, AnyBytesKeepItsEntriesWithinItsKeys) {
    const std::set<std::string> keys = {"UARFCN", "Cell ID", "Filter RSCP", "Status", "inJDCS"};
    anyBytesKeepWithin<UTRANNeighbhorMeasurements>(keys);
    // With bytes after the fixed distance to the first entry.
    anyRecordsKeepWithin<UTRANNeighbhorMeasurements, NothingThrown>(
        keys, codesOf<UTRANNeighbhorMeasurements>(), [](LogCode code) {
            return Record(code)
                .append(any::recordBytes())
                .padTo(kEntries)
                .append(any::recordBytes())
                .bytes();
        });
}

} // namespace
} // namespace pallax
