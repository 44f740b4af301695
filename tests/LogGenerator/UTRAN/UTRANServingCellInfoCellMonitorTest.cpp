#include "LogGenerator/UTRAN/UTRANServingCellInfo.h"
#include "tests/doubles/CellBuilder.h"
#include "tests/doubles/RecordFixture.h"
#include "tests/doubles/RecordProperties.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using namespace doubles; // NOLINT: the vocabulary of these tests
using CellMonitorFixture = RecordFixture<UTRANServingCellInfo>;
using Lines = std::vector<RecordingLog::Line>;

PropertyList serving(std::int64_t first) {
    return cell("UTRAN2", "Serving",
                {{"LAC", first},
                 {"CellId", first + 1},
                 {"BandInfo", first + 2},
                 {"SCN", first + 3},
                 {"UARFCN", first + 4}});
}

Dictionary shownOf(int first) {
    const auto text = [first](int step) { return PropertyList(std::to_string(first + step)); };
    return Dictionary{{"Local Area Code", text(0)},     {"Cell ID", text(1)},
                      {"Freq Band Indicator", text(2)}, {"Cell Scrambling Code", text(3)},
                      {"Uplink UARFCN", text(4)},       {"Downlink UARFCN", text(4)}};
}

TEST(UTRANServingCellInfoCellMonitor, ShowsTheServingCellWithOneUARFCNUnderTwoKeys) {
    CellMonitorFixture fixture;
    fixture.feed(cellsRecord({serving(100)}));
    EXPECT_EQ(fixture.lines, (Lines{{4, "Serving Cell Info"}}));
    expectInOrder(fixture.section(), shownOf(100));
    EXPECT_EQ(fixture.text("Uplink UARFCN"), "104");
    EXPECT_EQ(fixture.text("Downlink UARFCN"), "104");
}

TEST(UTRANServingCellInfoCellMonitor, TheScanDoesNotStopAtTheFirstMatchSoTheLastCellStays) {
    CellMonitorFixture fixture;
    const PropertyList half = cell("UTRAN2", "Serving", {{"LAC", 7}, {"SCN", 8}});
    fixture.feed(cellsRecord({serving(100), serving(200), half}));
    EXPECT_EQ(fixture.text("Local Area Code"), "7");
    EXPECT_EQ(fixture.text("Cell Scrambling Code"), "8");
    EXPECT_EQ(fixture.text("Cell ID"), "201")
        << "a value missing in the last cell is kept from the one before";
    EXPECT_EQ(fixture.text("Downlink UARFCN"), "204");
}

TEST(UTRANServingCellInfoCellMonitor, OnlyServingCellsOfUTRAN2Count) {
    CellMonitorFixture fixture;
    fixture.feed(cellsRecord({
        cell("UMTS", "Serving", {{"LAC", 1}}),
        cell("GSM", "Serving", {{"LAC", 2}}),
        cell("LTE", "Serving", {{"LAC", 3}}),
        cell("UTRAN2", "Neighbor", {{"LAC", 4}}),
        Dictionary{{"kHXCellMonitorCellType", "kHXCellMonitorCellTypeServing"}},
        Dictionary{{"kHXCellMonitorCellRadioAccessTechnology",
                    "kHXCellMonitorRadioAccessTechnologyUTRAN2"}},
        "no cell",
    }));
    EXPECT_EQ(fixture.lines, (Lines{{4, "Serving Cell Info"}}));
    EXPECT_TRUE(fixture.keys().empty());
}

TEST(UTRANServingCellInfoCellMonitor, AMissingNumberIsLoggedLeavesItsKeysAndStopsNoOther) {
    struct Row {
        const char* constant;
        std::vector<std::string> keys;
        const char* line;
    };
    const std::vector<Row> rows = {
        {"kHXCellMonitorLAC", {"Local Area Code"}, "Serving Cell Info: Failed to retrieve LAC\n"},
        {"kHXCellMonitorCellId", {"Cell ID"}, "Serving Cell Info: Failed to retrieve Cell ID\n"},
        {"kHXCellMonitorBandInfo",
         {"Freq Band Indicator"},
         "Serving Cell Info: Failed to retrieve Freq Band Indicator\n"},
        {"kHXCellMonitorSCN",
         {"Cell Scrambling Code"},
         "Serving Cell Info: Failed to retrieve Cell Scrambling Code\n"},
        {"kHXCellMonitorUARFCN",
         {"Uplink UARFCN", "Downlink UARFCN"},
         "Serving Cell Info: Failed to retrieve UARFCN\n"},
    };
    for (const Row& row : rows) {
        CellMonitorFixture fixture;
        fixture.feed(cellsRecord({serving(100)}));
        const PropertyList cell = serving(200);
        cell.dictionary()->remove(row.constant);
        fixture.feed(cellsRecord({cell}));
        EXPECT_EQ(fixture.lines, (Lines{{4, "Serving Cell Info"}, {3, row.line}}));
        Dictionary expected = shownOf(200);
        for (const std::string& key : row.keys) {
            expected.set(key, *shownOf(100).find(key));
        }
        expectInOrder(fixture.section(), expected);
    }
}

TEST(UTRANServingCellInfoCellMonitor, EveryNumberMissingIsFiveLinesInOrder) {
    CellMonitorFixture fixture;
    fixture.feed(cellsRecord({cell("UTRAN2", "Serving")}));
    EXPECT_EQ(fixture.lines,
              (Lines{{4, "Serving Cell Info"},
                     {3, "Serving Cell Info: Failed to retrieve LAC\n"},
                     {3, "Serving Cell Info: Failed to retrieve Cell ID\n"},
                     {3, "Serving Cell Info: Failed to retrieve Freq Band Indicator\n"},
                     {3, "Serving Cell Info: Failed to retrieve Cell Scrambling Code\n"},
                     {3, "Serving Cell Info: Failed to retrieve UARFCN\n"}}));
    EXPECT_TRUE(fixture.keys().empty());
}

TEST(UTRANServingCellInfoCellMonitor, ANumberThatIsNoSigned32BitIntegerCountsAsMissing) {
    const PropertyList cell = serving(100);
    cell.dictionary()->set("kHXCellMonitorLAC", PropertyList::integer(std::int64_t{1} << 31U));
    cell.dictionary()->set("kHXCellMonitorCellId", PropertyList::integer(-2147483648));
    cell.dictionary()->set("kHXCellMonitorSCN", "103");
    cell.dictionary()->set("kHXCellMonitorUARFCN", PropertyList::real(0.5));
    CellMonitorFixture fixture;
    fixture.feed(cellsRecord({cell}));
    EXPECT_EQ(fixture.lines,
              (Lines{{4, "Serving Cell Info"},
                     {3, "Serving Cell Info: Failed to retrieve LAC\n"},
                     {3, "Serving Cell Info: Failed to retrieve Cell Scrambling Code\n"},
                     {3, "Serving Cell Info: Failed to retrieve UARFCN\n"}}));
    expectInOrder(fixture.section(),
                  Dictionary{{"Cell ID", "-2147483648"}, {"Freq Band Indicator", "102"}});
}

TEST(UTRANServingCellInfoCellMonitor, ABrokenPropertyListLogsOneLineAndChangesNothing) {
    // A list in text form: none of its prefixes is a property list.
    const ByteBuffer whole = textRecord(0xFF0001, "( { kHXCellMonitorLAC = 1; } )").bytes();
    CellMonitorFixture fixture;
    fixture.feed(cellsRecord({serving(100)}));
    for (std::size_t length = 0; length < whole.size(); ++length) {
        fixture.feed(ByteBuffer(whole.begin(), whole.begin() + static_cast<std::ptrdiff_t>(length)),
                     0xFF0001);
        EXPECT_EQ(fixture.lines, (Lines{{4, "Serving Cell Info"},
                                        {3, "Cell Info Array data could not be constructed"}}))
            << "cut at " << length;
    }
    expectInOrder(fixture.section(), shownOf(100));
}

TEST(UTRANServingCellInfoCellMonitor, AnEmptyArrayOrAnotherRootChangesNothingSilently) {
    CellMonitorFixture fixture;
    for (const PropertyList& root : {PropertyList(Array()), serving(100)}) {
        fixture.feed(propertyListRecord(0xFF0001, root));
        EXPECT_EQ(fixture.lines, (Lines{{4, "Serving Cell Info"}}));
        EXPECT_TRUE(fixture.keys().empty());
    }
}

TEST(UTRANServingCellInfoCellMonitor, WithoutASectionTheLinesAreTheSame) {
    RecordingLog log;
    UTRANServingCellInfo record;
    const ByteBuffer bytes =
        cellsRecord({cell("UTRAN2", "Serving", {{"LAC", 1}, {"UARFCN", 5}})}).bytes();
    record.updateWithData(LogRecord(bytes), 0xFF0001);
    EXPECT_EQ(log.lines(),
              (Lines{{4, "Serving Cell Info"},
                     {3, "Serving Cell Info: Failed to retrieve Cell ID\n"},
                     {3, "Serving Cell Info: Failed to retrieve Freq Band Indicator\n"},
                     {3, "Serving Cell Info: Failed to retrieve Cell Scrambling Code\n"}}));
}

TEST(UTRANServingCellInfoCellMonitor, TheRecordAndTheCellMonitorShareTheirKeys) {
    CellMonitorFixture fixture;
    fixture.feed(cellsRecord({serving(100)}));
    fixture.feed(Record(0xD0E2).padTo(17).u16(9763).u16(10713).u32(5).u8(0));
    EXPECT_EQ(fixture.text("Uplink UARFCN"), "9763");
    EXPECT_EQ(fixture.text("Downlink UARFCN"), "10713");
    EXPECT_EQ(fixture.text("Cell ID"), "5");
    EXPECT_EQ(fixture.text("Local Area Code"), "100");
    fixture.feed(cellsRecord({serving(200)}));
    EXPECT_EQ(fixture.text("Uplink UARFCN"), "204");
    EXPECT_EQ(fixture.text("Allowed Access"), "All Calls");
}

TEST(UTRANServingCellInfoCellMonitor, AnyCellsKeepItsSectionWithinItsKeys) {
    anyCellsKeepWithin<UTRANServingCellInfo>(
        {"Cell Access Restrictions", "Cell ID", "Downlink UARFCN", "Uplink UARFCN", "URA ID",
         "Allowed Access", "Local Area Code", "Freq Band Indicator", "Cell Scrambling Code"});
}

} // namespace
} // namespace pallax
