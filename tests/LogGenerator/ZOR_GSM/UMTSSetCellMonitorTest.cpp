#include "LogGenerator/ZOR_GSM/UMTSSet.h"
#include "tests/doubles/CellBuilder.h"
#include "tests/doubles/RecordFixture.h"
#include "tests/doubles/RecordProperties.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using namespace doubles; // NOLINT: the vocabulary of these tests
using Lines = std::vector<RecordingLog::Line>;

PropertyList neighbour(std::int64_t uarfcn, std::int64_t code, std::int64_t rscp,
                       std::int64_t energy) {
    return cell("UMTS", "Neighbor",
                {{"ECN0", energy}, {"RSCP", rscp}, {"SCN", code}, {"UARFCN", uarfcn}});
}

TEST(UMTSSetCellMonitor, ShowsEveryUMTSNeighbourInOrderAndNothingElse) {
    const PropertyList serving = cell("UMTS", "Serving", {{"UARFCN", 1}, {"SCN", 2}});
    const PropertyList gsm = cell("GSM", "Neighbor", {{"UARFCN", 1}, {"SCN", 2}});
    const PropertyList untyped = neighbour(1, 2, 3, 4);
    untyped.dictionary()->remove("kHXCellMonitorCellType");
    RecordFixture<UMTSSet> fixture;
    fixture.list() = Array{"what was shown before"};
    fixture.feed(cellsRecord(Array{serving, neighbour(10713, 388, -95, -7), gsm, "no cell", untyped,
                                   neighbour(10688, 1, 0, 0)}));
    EXPECT_EQ(fixture.lines, (Lines{{4, "UMTSSet"}}));
    ASSERT_EQ(fixture.list().size(), 2U);
    expectInOrder(fixture.list()[0], Dictionary{{"UARFCN", "10713"},
                                                {"Scrambling Code", "388"},
                                                {"RSCP", "-95 dBm"},
                                                {"Energy Per Chip", "-7 dB"}});
    expectInOrder(fixture.list()[1], Dictionary{{"UARFCN", "10688"},
                                                {"Scrambling Code", "1"},
                                                {"RSCP", "0 dBm"},
                                                {"Energy Per Chip", "0 dB"}});
}

TEST(UMTSSetCellMonitor, RSCPNumber32767ShowsTheEmptyStringAndSoDoesTheEnergy) {
    RecordFixture<UMTSSet> fixture;
    fixture.feed(cellsRecord(Array{neighbour(1, 2, 32767, -7), neighbour(1, 2, -95, 32767),
                                   neighbour(32767, 32767, 98303, 98303)}));
    EXPECT_EQ(fixture.list(), (Array{Dictionary{{"UARFCN", "1"},
                                                {"Scrambling Code", "2"},
                                                {"RSCP", ""},
                                                {"Energy Per Chip", "-7 dB"}},
                                     Dictionary{{"UARFCN", "1"},
                                                {"Scrambling Code", "2"},
                                                {"RSCP", "-95 dBm"},
                                                {"Energy Per Chip", ""}},
                                     Dictionary{{"UARFCN", "32767"},
                                                {"Scrambling Code", "32767"},
                                                {"RSCP", ""}, // the low 16 bits are 32767
                                                {"Energy Per Chip", ""}}}));
}

TEST(UMTSSetCellMonitor, ALevelIsTheLow16BitsSigned) {
    RecordFixture<UMTSSet> fixture;
    fixture.feed(cellsRecord(Array{neighbour(-2147483648, 2147483647, 65536 - 95, -32768)}));
    EXPECT_EQ(fixture.list(), (Array{Dictionary{{"UARFCN", "-2147483648"},
                                                {"Scrambling Code", "2147483647"},
                                                {"RSCP", "-95 dBm"},
                                                {"Energy Per Chip", "-32768 dB"}}}));
}

TEST(UMTSSetCellMonitor, RSCPIsIn_dB_From0x4005AndIn_dBm_FromTheCellMonitor) {
    const auto rscp = [](const Record& record) {
        RecordFixture<UMTSSet> fixture;
        fixture.feed(record);
        return *fixture.list().at(0).dictionary()->find("RSCP");
    };
    const PropertyList ranked = rscp(Record(0x4005).u8(1).u8(0).u32(0).s8(-74).padTo(25));
    const PropertyList monitored = rscp(cellsRecord(Array{neighbour(1, 2, -95, -7)}));
    EXPECT_EQ(ranked.string(), "-95 dB");
    EXPECT_EQ(monitored.string(), "-95 dBm");
    EXPECT_EQ(ranked.displayNumber()->unit(), "dB");
    EXPECT_EQ(monitored.displayNumber()->unit(), "dBm");
}

TEST(UMTSSetCellMonitor, EveryMissingNumberIsLoggedAndLeftOutOfTheShownCell) {
    const auto without = [](const char* key) {
        const PropertyList partial = neighbour(10713, 388, -95, -7);
        partial.dictionary()->remove(key);
        RecordFixture<UMTSSet> fixture;
        fixture.feed(cellsRecord({partial}));
        EXPECT_EQ(fixture.list().size(), 1U);
        return std::pair(fixture.lines, fixture.list().at(0).dictionary());
    };
    const std::vector<std::array<const char*, 3>> numbers = {
        {"kHXCellMonitorUARFCN", "UARFCN", "UMTSSet: Failed to retrieve UARFCN\n"},
        {"kHXCellMonitorSCN", "Scrambling Code", "UMTSSet: Failed to retrieve Scrambling Code\n"},
        {"kHXCellMonitorRSCP", "RSCP", "UMTSSet: Failed to retrieve RSCP\n"},
        {"kHXCellMonitorECN0", "Energy Per Chip", "UMTSSet: Failed to retrieve Energy Per Chip\n"},
    };
    for (const auto& [constant, key, line] : numbers) {
        const auto [lines, cell] = without(constant);
        EXPECT_EQ(lines, (Lines{{4, "UMTSSet"}, {3, line}}));
        EXPECT_FALSE(cell->contains(key));
        EXPECT_EQ(cell->size(), 3U);
    }
}

TEST(UMTSSetCellMonitor, ANumberThatIsNo32BitIntegerCountsAsMissing) {
    const PropertyList odd = cell("UMTS", "Neighbor", {{"SCN", std::int64_t{1} << 31U}});
    odd.dictionary()->set("kHXCellMonitorUARFCN", "10713");
    odd.dictionary()->set("kHXCellMonitorRSCP", PropertyList::real(-95.5));
    RecordFixture<UMTSSet> fixture;
    fixture.feed(cellsRecord({odd}));
    EXPECT_EQ(fixture.lines, (Lines{{4, "UMTSSet"},
                                    {3, "UMTSSet: Failed to retrieve UARFCN\n"},
                                    {3, "UMTSSet: Failed to retrieve Scrambling Code\n"},
                                    {3, "UMTSSet: Failed to retrieve RSCP\n"},
                                    {3, "UMTSSet: Failed to retrieve Energy Per Chip\n"}}));
    EXPECT_EQ(fixture.list(), Array{Dictionary()});
}

TEST(UMTSSetCellMonitor, ABrokenPropertyListEmptiesTheListAndLogsTwoLines) {
    // A list in text form: none of its prefixes is a property list.
    constexpr std::string_view kCells = "( { kHXCellMonitorUARFCN = 1; } )";
    const ByteBuffer whole = textRecord(kCellMonitorLogCode, kCells).bytes();
    for (std::size_t length = 0; length < whole.size(); ++length) {
        RecordFixture<UMTSSet> fixture;
        fixture.list() = Array{"what was shown before"};
        fixture.feed(ByteBuffer(whole.begin(), whole.begin() + static_cast<std::ptrdiff_t>(length)),
                     kCellMonitorLogCode);
        EXPECT_EQ(fixture.lines, (Lines{{4, "UMTSSet"},
                                        {3, "Cell Info Array data could not be constructed"},
                                        {3, "Failed to get Cell Array\n"}}))
            << "cut at " << length;
        EXPECT_TRUE(fixture.list().empty());
    }
}

TEST(UMTSSetCellMonitor, AnArrayWithoutUMTSNeighboursAndARootThatIsNoArrayEmptyTheList) {
    for (const PropertyList& root :
         {PropertyList(Array()), PropertyList(Array{"no cell"}), neighbour(1, 2, 3, 4)}) {
        RecordFixture<UMTSSet> fixture;
        fixture.list() = Array{"what was shown before"};
        fixture.feed(propertyListRecord(kCellMonitorLogCode, root));
        EXPECT_EQ(fixture.lines, (Lines{{4, "UMTSSet"}}));
        EXPECT_TRUE(fixture.list().empty());
    }
}

TEST(UMTSSetCellMonitor, WhicheverOfTheTwoCodesCameLastIsShown) {
    const Record ranked = Record(0x4005).u8(1).u8(0).padTo(25);
    const Record monitored = cellsRecord(Array{neighbour(1, 2, 3, 4)});
    RecordFixture<UMTSSet> fixture;
    fixture.feed(ranked);
    fixture.feed(monitored);
    ASSERT_EQ(fixture.list().size(), 1U);
    EXPECT_TRUE(fixture.list()[0].dictionary()->contains("UARFCN"));
    EXPECT_FALSE(fixture.list()[0].dictionary()->contains("Ranking Value"));
    fixture.feed(ranked);
    ASSERT_EQ(fixture.list().size(), 1U);
    EXPECT_FALSE(fixture.list()[0].dictionary()->contains("UARFCN"));
    EXPECT_TRUE(fixture.list()[0].dictionary()->contains("Ranking Value"));
}

TEST(UMTSSetCellMonitor, AnyCellsKeepItsEntriesWithinItsKeys) {
    anyCellsKeepWithin<UMTSSet>({"Scrambling Code", "RSCP", "Energy Per Chip", "Downlink Frequency",
                                 "Ranking Value", "Rank Cell RSCP", "UARFCN"});
}

} // namespace
} // namespace pallax
