#include "LogGenerator/ZOR_GSM/NeighboringCells.h"

#include "tests/doubles/CellBuilder.h"
#include "tests/doubles/RecordFixture.h"
#include "tests/doubles/RecordProperties.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using namespace doubles; // NOLINT: the vocabulary of these tests
using Lines = std::vector<RecordingLog::Line>;

struct Neighbour {
    unsigned arfcn;
    unsigned rssi;
    std::int32_t c1;
};

Record measured(const std::vector<Neighbour>& neighbours) {
    Record record = Record(0x5137).padTo(28).u8(static_cast<unsigned>(neighbours.size()));
    for (const auto& [arfcn, rssi, c1] : neighbours) {
        record.u16(arfcn).u8(rssi).s32(c1).append({1, 2, 3, 4, 5, 6, 7}); // 7 bytes are not read
    }
    return record;
}

Record bsics(const std::vector<std::pair<unsigned, unsigned>>& list) {
    Record record = Record(0x51FF).u8(0xFF).u8(static_cast<unsigned>(list.size()));
    for (const auto& [arfcn, bsic] : list) {
        record.u16(arfcn).u8(bsic).u8(0xEE);
    }
    return record;
}

/// The text of `key` in an entry of the list; "(absent)" if there is none.
std::string entryText(RecordFixture<NeighboringCells>& fixture, std::size_t index,
                      std::string_view key) {
    const PropertyList* value = fixture.list().at(index).dictionary()->find(key);
    return value != nullptr ? value->string().value_or("(no text)") : "(absent)";
}

TEST(NeighboringCells, SubscribesToItsThreeRecordsAndFillsAList) {
    const RecordFixture<NeighboringCells> fixture;
    EXPECT_EQ(fixture.subscriptions(), (std::vector<LogCode>{0x5137, 0x51FF, 0xFF0001}));
    EXPECT_EQ(NeighboringCells().getSectionName(), "Neighboring Cells");
    EXPECT_EQ(NeighboringCells().sectionKind(), SectionKind::List);
}

// 0x5137

TEST(NeighboringCells, ShowsEachMeasuredCellInPacketOrder) {
    RecordFixture<NeighboringCells> fixture;
    fixture.feed(measured({{62, 95, -2}, {65535, 255, 2147483647}}));
    ASSERT_EQ(fixture.list().size(), 2U);
    expectInOrder(fixture.list()[0],
                  Dictionary{{"ARFCN", "62"}, {"RSSI", "95"}, {"C1 Value", "-2"}});
    expectInOrder(fixture.list()[1],
                  Dictionary{{"ARFCN", "65535"}, {"RSSI", "255"}, {"C1 Value", "2147483647"}});
    EXPECT_EQ(fixture.lines, (Lines{{4, "NeighboringCells"}}));
    EXPECT_EQ(fixture.list()[0].dictionary()->find("C1 Value")->displayNumber()->integer(), -2);
}

TEST(NeighboringCells, NoNeighboursEmptyTheList) {
    RecordFixture<NeighboringCells> fixture;
    fixture.feed(measured({{62, 95, -2}}));
    fixture.feed(measured({}));
    EXPECT_TRUE(fixture.list().empty());
}

TEST(NeighboringCells, A28ByteMeasurementKeepsTheList) {
    RecordFixture<NeighboringCells> fixture;
    fixture.feed(measured({{62, 95, -2}}));
    fixture.feed(Record(0x5137).padTo(28));
    EXPECT_EQ(fixture.list().size(), 1U);
    EXPECT_EQ(fixture.lines, (Lines{{4, "NeighboringCells"}}));
    cutAtEveryLength<NeighboringCells>(measured({{62, 95, -2}, {63, 1, 1}}), 29);
}

TEST(NeighboringCells, TheListStopsAtTheLastWholeEntryWhichHasSevenBytes) {
    const auto entriesIn = [](std::size_t length) {
        ByteBuffer bytes = measured({{62, 95, -2}, {63, 1, 1}}).at(28, 255).bytes();
        bytes.resize(length);
        RecordFixture<NeighboringCells> fixture;
        fixture.feed(bytes);
        return fixture.list().size();
    };
    EXPECT_EQ(entriesIn(29), 0U);
    EXPECT_EQ(entriesIn(35), 0U);
    EXPECT_EQ(entriesIn(36), 1U);
    EXPECT_EQ(entriesIn(49), 1U);
    EXPECT_EQ(entriesIn(50), 2U);
}

TEST(NeighboringCells, ShowsUpTo255MeasuredCells) {
    RecordFixture<NeighboringCells> fixture;
    fixture.feed(measured(std::vector<Neighbour>(255, {1, 2, 3})));
    EXPECT_EQ(fixture.list().size(), 255U);
}

// 0x51FF

TEST(NeighboringCells, ANeighbourOfTheLastBsicListGetsItsBsicAndAnotherGetsNone) {
    RecordFixture<NeighboringCells> fixture;
    fixture.feed(bsics({{62, 17}, {900, 255}}));
    fixture.feed(measured({{62, 95, -2}, {63, 1, 1}, {900, 2, 2}}));
    expectInOrder(fixture.list()[0],
                  Dictionary{{"ARFCN", "62"}, {"RSSI", "95"}, {"C1 Value", "-2"}, {"BSIC", "17"}});
    EXPECT_EQ(entryText(fixture, 1, "BSIC"), "(absent)");
    EXPECT_EQ(entryText(fixture, 2, "BSIC"), "255");
}

TEST(NeighboringCells, ABsicListDoesNotTouchTheSection) {
    RecordFixture<NeighboringCells> fixture;
    fixture.feed(measured({{62, 95, -2}}));
    fixture.feed(bsics({{62, 17}}));
    EXPECT_EQ(fixture.lines, (Lines{{4, "NeighboringCells"}}));
    EXPECT_EQ(entryText(fixture, 0, "BSIC"), "(absent)");
}

TEST(NeighboringCells, ABsicListReplacesTheLastOneAlsoWhenItIsEmpty) {
    RecordFixture<NeighboringCells> fixture;
    fixture.feed(bsics({{62, 17}}));
    fixture.feed(bsics({{63, 18}}));
    fixture.feed(measured({{62, 95, -2}, {63, 1, 1}}));
    EXPECT_EQ(entryText(fixture, 0, "BSIC"), "(absent)");
    EXPECT_EQ(entryText(fixture, 1, "BSIC"), "18");
    fixture.feed(bsics({}));
    fixture.feed(measured({{62, 95, -2}, {63, 1, 1}}));
    EXPECT_EQ(entryText(fixture, 0, "BSIC"), "(absent)");
    EXPECT_EQ(entryText(fixture, 1, "BSIC"), "(absent)");
}

TEST(NeighboringCells, ALaterBsicOfTheSameARFCNWins) {
    RecordFixture<NeighboringCells> fixture;
    fixture.feed(bsics({{62, 17}, {62, 18}}));
    fixture.feed(measured({{62, 95, -2}}));
    EXPECT_EQ(entryText(fixture, 0, "BSIC"), "18");
}

TEST(NeighboringCells, A14ByteBsicListKeepsTheLastOne) {
    RecordFixture<NeighboringCells> fixture;
    fixture.feed(bsics({{62, 17}}));
    fixture.feed(Record(0x51FF).u8(0));
    fixture.feed(measured({{62, 95, -2}}));
    EXPECT_EQ(entryText(fixture, 0, "BSIC"), "17");
}

TEST(NeighboringCells, ABsicListCutAtAnyLengthTellsItsWholeEntriesWhichHaveThreeBytes) {
    const ByteBuffer whole = bsics({{62, 17}, {63, 18}}).bytes();
    for (std::size_t length = 0; length <= whole.size(); ++length) {
        RecordFixture<NeighboringCells> fixture;
        fixture.feed(ByteBuffer(whole.begin(), whole.begin() + static_cast<std::ptrdiff_t>(length)),
                     0x51FF);
        fixture.feed(measured({{62, 95, -2}, {63, 1, 1}}));
        EXPECT_EQ(entryText(fixture, 0, "BSIC"), length < 18 ? "(absent)" : "17") << length;
        EXPECT_EQ(entryText(fixture, 1, "BSIC"), length < 22 ? "(absent)" : "18") << length;
    }
}

// 0xFF0001

TEST(NeighboringCells, ShowsEveryNeighbourOfGSMInTheOrderOfTheArray) {
    RecordFixture<NeighboringCells> fixture;
    fixture.feed(bsics({{62, 17}}));
    fixture.feed(cellsRecord({cell("GSM", "Serving", {{"ARFCN", 1}, {"RSSI", -1}}), "no cell",
                              cell("GSM", "Neighbor", {{"RSSI", -40}, {"ARFCN", 62}}),
                              cell("UMTS", "Neighbor", {{"ARFCN", 2}, {"RSSI", -2}}),
                              cell("GSM", "Neighbor", {{"ARFCN", -7}, {"RSSI", 10}})}));
    ASSERT_EQ(fixture.list().size(), 2U);
    expectInOrder(fixture.list()[0], Dictionary{{"ARFCN", "62"}, {"RSSI", "-80 dBm"}});
    expectInOrder(fixture.list()[1], Dictionary{{"ARFCN", "-7"}, {"RSSI", "20 dBm"}});
    EXPECT_EQ(fixture.lines, (Lines{{4, "NeighboringCells"}}));
}

TEST(NeighboringCells, ALevelOf32767IsTheEmptyStringAndMinus40IsMinus80dBm) {
    RecordFixture<NeighboringCells> fixture;
    fixture.feed(cellsRecord({cell("GSM", "Neighbor", {{"ARFCN", 1}, {"RSSI", 32767}}),
                              cell("GSM", "Neighbor", {{"ARFCN", 2}, {"RSSI", -40}}),
                              cell("GSM", "Neighbor", {{"ARFCN", 3}, {"RSSI", 0x1FFD8}}),
                              cell("GSM", "Neighbor", {{"ARFCN", 4}, {"RSSI", -32768}})}));
    EXPECT_EQ(entryText(fixture, 0, "RSSI"), "");
    EXPECT_EQ(entryText(fixture, 1, "RSSI"), "-80 dBm");
    EXPECT_EQ(entryText(fixture, 2, "RSSI"), "-80 dBm") << "the low 16 bits count";
    EXPECT_EQ(entryText(fixture, 3, "RSSI"), "-65536 dBm");
    EXPECT_EQ(fixture.list()[1].dictionary()->find("RSSI")->displayNumber()->integer(), -80);
}

TEST(NeighboringCells, ACellWithoutItsNumbersIsLoggedAndStillAppended) {
    RecordFixture<NeighboringCells> fixture;
    fixture.feed(cellsRecord({cell("GSM", "Neighbor"), cell("GSM", "Neighbor", {{"RSSI", -1}}),
                              cell("GSM", "Neighbor", {{"ARFCN", 5}})}));
    EXPECT_EQ(fixture.section(), PropertyList(Array{Dictionary(), Dictionary{{"RSSI", "-2 dBm"}},
                                                    Dictionary{{"ARFCN", "5"}}}));
    EXPECT_EQ(fixture.lines, (Lines{{4, "NeighboringCells"},
                                    {3, "NeighboringCells: Failed to retrieve ARFCN\n"},
                                    {3, "NeighboringCells: Failed to retrieve RSSI\n"},
                                    {3, "NeighboringCells: Failed to retrieve ARFCN\n"},
                                    {3, "NeighboringCells: Failed to retrieve RSSI\n"}}));
}

TEST(NeighboringCells, AnArrayWithoutNeighboursEmptiesTheList) {
    RecordFixture<NeighboringCells> fixture;
    for (const Array& cells : {Array(), Array{cell("GSM", "Serving", {{"ARFCN", 1}})}}) {
        fixture.feed(measured({{62, 95, -2}}));
        fixture.feed(cellsRecord(cells));
        EXPECT_TRUE(fixture.list().empty());
        EXPECT_EQ(fixture.lines, (Lines{{4, "NeighboringCells"}}));
    }
}

TEST(NeighboringCells, AnArrayThatCannotBeReadIsLoggedTwiceAndLeavesTheListEmpty) {
    const ByteBuffer whole = cellsRecord({cell("GSM", "Neighbor", {{"ARFCN", 1}})}).bytes();
    RecordFixture<NeighboringCells> fixture;
    fixture.feed(measured({{62, 95, -2}}));
    fixture.feed(Record(0xFF0001));
    EXPECT_EQ(fixture.lines, (Lines{{4, "NeighboringCells"},
                                    {3, "Cell Info Array data could not be constructed"},
                                    {3, "Failed to get Cell Array\n"}}));
    EXPECT_TRUE(fixture.list().empty());
    for (std::size_t length = 0; length < whole.size(); ++length) {
        fixture.feed(measured({{62, 95, -2}}));
        fixture.feed(ByteBuffer(whole.begin(), whole.begin() + static_cast<std::ptrdiff_t>(length)),
                     0xFF0001);
        EXPECT_TRUE(fixture.list().empty()) << "cut at " << length;
    }
}

TEST(NeighboringCells, WhicheverListCameLastIsShown) {
    RecordFixture<NeighboringCells> fixture;
    fixture.feed(cellsRecord({cell("GSM", "Neighbor", {{"ARFCN", 1}, {"RSSI", 2}})}));
    fixture.feed(measured({{62, 95, -2}}));
    ASSERT_EQ(fixture.list().size(), 1U);
    EXPECT_EQ(entryText(fixture, 0, "ARFCN"), "62");
}

TEST(NeighboringCells, AnyOtherCodeIsUnknownAndChangesNothing) {
    RecordFixture<NeighboringCells> fixture;
    fixture.feed(measured({{62, 95, -2}}));
    fixture.feed(Record(0x5134).padTo(40));
    EXPECT_EQ(fixture.lines,
              (Lines{{4, "NeighboringCells"}, {3, "Received an unknown log message: 20788"}}));
    EXPECT_EQ(fixture.list().size(), 1U);
}

TEST(NeighboringCells, AnyBytesAndAnyCellsKeepWithinTheKeysOfItsEntries) {
    const std::set<std::string> keys = {"ARFCN", "RSSI", "C1 Value", "BSIC"};
    anyBytesKeepWithin<NeighboringCells>(keys);
    anyCellsKeepWithin<NeighboringCells>(keys);
}

} // namespace
} // namespace pallax
