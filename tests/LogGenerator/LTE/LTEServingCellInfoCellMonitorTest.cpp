#include "LogGenerator/LTE/LTEServingCellInfo.h"
#include "plist/PropertyListCodec.h"
#include "tests/doubles/CellBuilder.h"
#include "tests/doubles/RecordFixture.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using namespace doubles; // NOLINT: the vocabulary of these tests
using Lines = std::vector<RecordingLog::Line>;

PropertyList serving(std::int64_t tac, std::int64_t cellId, std::int64_t pid, std::int64_t band,
                     std::int64_t uarfcn) {
    return cell(
        "LTE", "Serving",
        {{"UARFCN", uarfcn}, {"BandInfo", band}, {"PID", pid}, {"CellId", cellId}, {"TAC", tac}});
}

/// The numbers of a cell: key in the array, shown key, and the line logged without it.
constexpr auto kNumbers = std::to_array<std::array<const char*, 3>>({
    {"kHXCellMonitorTAC", "Tracking Area Code", "Serving Cell Info: Failed to retrieve TAC\n"},
    {"kHXCellMonitorCellId", "Cell Identity", "Serving Cell Info: Failed to retrieve Cell ID\n"},
    {"kHXCellMonitorPID", "Physical Cell ID",
     "Serving Cell Info: Failed to retrieve Physical Cell ID\n"},
    {"kHXCellMonitorBandInfo", "Freq Band Indicator",
     "Serving Cell Info: Failed to retrieve Freq Band Indicator\n"},
    {"kHXCellMonitorUARFCN", "UARFCN", "Serving Cell Info: Failed to retrieve UARFCN\n"},
});

TEST(LTEServingCellInfoCellMonitor, ShowsTheFirstLTEServingCellWithItsKeysInOrder) {
    RecordFixture<LTEServingCellInfo> fixture;
    fixture.feed(cellsRecord({cell("LTE", "Neighbor", {{"TAC", 1}}), "no cell",
                              cell("UMTS", "Serving", {{"UARFCN", 10713}}),
                              Dictionary{{"kHXCellMonitorTAC", PropertyList::integer(2)}},
                              serving(6699, 26738688, 274, 3, 1850), serving(1, 2, 3, 4, 5)}));
    EXPECT_EQ(fixture.lines, (Lines{{4, "LTE Serving Cell Info"}}));
    expectInOrder(fixture.section(), Dictionary{{"Tracking Area Code", "6699"},
                                                {"Cell Identity", "26738688"},
                                                {"Physical Cell ID", "274"},
                                                {"Freq Band Indicator", "3"},
                                                {"UARFCN", "1850"}});
    EXPECT_EQ(fixture.keys().find("UARFCN")->displayNumber()->integer(), 1850);
}

TEST(LTEServingCellInfoCellMonitor, TheXmlFormShowsTheSame) {
    const auto text = serializeXml(Array{serving(-2147483648, 2147483647, 0, 4, 5)});
    ASSERT_TRUE(text);
    RecordFixture<LTEServingCellInfo> fixture;
    fixture.feed(textRecord(kCellMonitorLogCode, *text));
    expectInOrder(fixture.section(), Dictionary{{"Tracking Area Code", "-2147483648"},
                                                {"Cell Identity", "2147483647"},
                                                {"Physical Cell ID", "0"},
                                                {"Freq Band Indicator", "4"},
                                                {"UARFCN", "5"}});
}

TEST(LTEServingCellInfoCellMonitor, AMissingNumberIsLoggedAndLeavesItsKeyAsItWas) {
    for (const auto& [cellKey, key, line] : kNumbers) {
        RecordFixture<LTEServingCellInfo> fixture;
        fixture.feed(cellsRecord({serving(1, 1, 1, 1, 1)}));
        const PropertyList incomplete = serving(2, 2, 2, 2, 2);
        incomplete.dictionary()->remove(cellKey);
        fixture.feed(cellsRecord({incomplete}));
        EXPECT_EQ(fixture.lines, (Lines{{4, "LTE Serving Cell Info"}, {3, line}}));
        for (const auto& each : kNumbers) {
            EXPECT_EQ(fixture.text(each[1]), std::string_view(each[1]) == key ? "1" : "2");
        }
    }
}

TEST(LTEServingCellInfoCellMonitor, WhatIsNo32BitNumberIsLoggedInTheOrderOfTheKeys) {
    RecordFixture<LTEServingCellInfo> fixture;
    const PropertyList odd = serving(std::int64_t{1} << 31U, 0, 0, 0, 0);
    odd.dictionary()->set("kHXCellMonitorCellId", "26738688");
    odd.dictionary()->set("kHXCellMonitorPID", PropertyList::real(0.5));
    odd.dictionary()->set("kHXCellMonitorBandInfo", Array());
    odd.dictionary()->remove("kHXCellMonitorUARFCN");
    fixture.feed(cellsRecord({odd, serving(1, 2, 3, 4, 5)}));
    Lines expected = {{4, "LTE Serving Cell Info"}};
    for (const auto& number : kNumbers) {
        expected.push_back({3, number[2]});
    }
    EXPECT_EQ(fixture.lines, expected);
    EXPECT_TRUE(fixture.keys().empty()) << "the second serving cell is ignored";
}

TEST(LTEServingCellInfoCellMonitor, UARFCNIsRemovedBy0xB0C2) {
    const Record identity = Record(0xB0C2).padTo(38).at(14, 7);
    RecordFixture<LTEServingCellInfo> fixture;
    fixture.feed(cellsRecord({serving(1, 2, 3, 4, 1850)}));
    fixture.feed(Record(0xB0C2).padTo(37));
    EXPECT_EQ(fixture.text("UARFCN"), "1850") << "a short 0xB0C2 removes nothing";
    fixture.feed(identity);
    EXPECT_EQ(fixture.text("UARFCN"), "(absent)");
    EXPECT_EQ(fixture.text("Physical Cell ID"), "7");
    EXPECT_EQ(fixture.keys().size(), 8U);
    fixture.feed(cellsRecord({serving(1, 2, 3, 4, 1851)}));
    EXPECT_EQ(fixture.text("UARFCN"), "1851");
    EXPECT_EQ(fixture.text("Physical Cell ID"), "3");
    EXPECT_EQ(fixture.text("Download Frequency"), "0") << "stays until the next 0xB0C2";
}

TEST(LTEServingCellInfoCellMonitor, ABrokenPropertyListLogsTwoLinesAndChangesNothing) {
    // A list in text form: none of its prefixes is a property list.
    constexpr std::string_view kCells = "( { kHXCellMonitorTAC = 1; } )";
    RecordFixture<LTEServingCellInfo> fixture;
    fixture.feed(cellsRecord({serving(1, 2, 3, 4, 5)}));
    const PropertyList before = fixture.snapshot();
    for (std::size_t length = 0; length < kCells.size(); ++length) {
        fixture.feed(textRecord(kCellMonitorLogCode, kCells.substr(0, length)));
        EXPECT_EQ(fixture.lines, (Lines{{4, "LTE Serving Cell Info"},
                                        {3, "Cell Info Array data could not be constructed"},
                                        {3, "Failed to get Cell Array\n"}}))
            << "cut at " << length;
        EXPECT_EQ(fixture.section(), before);
    }
}

TEST(LTEServingCellInfoCellMonitor, NoElementsAndNoLTEServingCellChangeNothingSilently) {
    RecordFixture<LTEServingCellInfo> fixture;
    const Array others = {cell("LTE", "Neighbor", {{"TAC", 1}}),
                          cell("GSM", "Serving", {{"CellId", 1}})};
    for (const PropertyList& root :
         {PropertyList(Array()), PropertyList(others), serving(1, 2, 3, 4, 5)}) {
        fixture.feed(propertyListRecord(kCellMonitorLogCode, root));
        EXPECT_EQ(fixture.lines, (Lines{{4, "LTE Serving Cell Info"}}));
        EXPECT_TRUE(fixture.keys().empty());
    }
}

} // namespace
} // namespace pallax
