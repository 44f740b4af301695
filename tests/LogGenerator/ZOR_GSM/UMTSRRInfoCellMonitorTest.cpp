#include "LogGenerator/ZOR_GSM/UMTSRRInfo.h"
#include "tests/doubles/CellBuilder.h"
#include "tests/doubles/RecordFixture.h"
#include "tests/doubles/RecordProperties.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using namespace doubles; // NOLINT: the vocabulary of these tests
using Lines = std::vector<RecordingLog::Line>;

PropertyList serving(std::int64_t cellId, std::int64_t uarfcn, std::int64_t code) {
    return cell("UMTS", "Serving", {{"SCN", code}, {"UARFCN", uarfcn}, {"CellId", cellId}});
}

TEST(UMTSRRInfoCellMonitor, ShowsTheFirstUMTSServingCellWithItsKeysInOrder) {
    const PropertyList neighbour =
        cell("UMTS", "Neighbor", {{"CellId", 1}, {"UARFCN", 2}, {"SCN", 3}});
    const PropertyList gsm = cell("GSM", "Serving", {{"CellId", 4}, {"UARFCN", 5}, {"SCN", 6}});
    RecordFixture<UMTSRRInfo> fixture;
    fixture.feed(cellsRecord(
        Array{neighbour, "no cell", gsm, serving(123456789, 10713, 388), serving(7, 8, 9)}));
    EXPECT_EQ(fixture.lines, (Lines{{4, "UMTSRRInfo"}}));
    expectInOrder(
        fixture.section(),
        Dictionary{{"Cell ID", "123456789"}, {"UARFCN", "10713"}, {"Scrambling Code", "388"}});
    EXPECT_EQ(fixture.keys().find("UARFCN")->displayNumber()->integer(), 10713);
}

TEST(UMTSRRInfoCellMonitor, NumbersAreSigned32BitIntegers) {
    RecordFixture<UMTSRRInfo> fixture;
    fixture.feed(cellsRecord(Array{serving(-2147483648, 2147483647, 32767)}));
    expectInOrder(fixture.section(), Dictionary{{"Cell ID", "-2147483648"},
                                                {"UARFCN", "2147483647"},
                                                {"Scrambling Code", "32767"}});
}

TEST(UMTSRRInfoCellMonitor, AMissingNumberIsLoggedAndLeavesItsKeyAsItWas) {
    const std::vector<std::array<const char*, 3>> numbers = {
        {"kHXCellMonitorCellId", "Cell ID", "UMTSRRInfo: Failed to retrieve Cell ID\n"},
        {"kHXCellMonitorUARFCN", "UARFCN", "UMTSRRInfo: Failed to retrieve UARFCN\n"},
        {"kHXCellMonitorSCN", "Scrambling Code",
         "UMTSRRInfo: Failed to retrieve Scrambling Code\n"},
    };
    for (const auto& [constant, key, line] : numbers) {
        RecordFixture<UMTSRRInfo> fixture;
        fixture.feed(cellsRecord(Array{serving(1, 1, 1)}));
        const PropertyList partial = serving(2, 2, 2);
        partial.dictionary()->remove(constant);
        fixture.feed(cellsRecord(Array{partial}));
        EXPECT_EQ(fixture.lines, (Lines{{4, "UMTSRRInfo"}, {3, line}}));
        for (const char* each : {"Cell ID", "UARFCN", "Scrambling Code"}) {
            EXPECT_EQ(fixture.text(each), std::string_view(each) == key ? "1" : "2");
        }
    }
}

TEST(UMTSRRInfoCellMonitor, ANumberThatIsNo32BitIntegerCountsAsMissing) {
    const PropertyList odd = serving(std::int64_t{1} << 31U, 0, 0);
    odd.dictionary()->set("kHXCellMonitorUARFCN", "10713");
    odd.dictionary()->set("kHXCellMonitorSCN", PropertyList::real(0.5));
    RecordFixture<UMTSRRInfo> fixture;
    fixture.feed(cellsRecord(Array{odd, serving(1, 2, 3)}));
    EXPECT_EQ(fixture.lines, (Lines{{4, "UMTSRRInfo"},
                                    {3, "UMTSRRInfo: Failed to retrieve Cell ID\n"},
                                    {3, "UMTSRRInfo: Failed to retrieve UARFCN\n"},
                                    {3, "UMTSRRInfo: Failed to retrieve Scrambling Code\n"}}));
    EXPECT_TRUE(fixture.keys().empty()) << "the second serving cell is ignored";
}

TEST(UMTSRRInfoCellMonitor, ABrokenPropertyListLogsTwoLinesAndChangesNothing) {
    // A list in text form: none of its prefixes is a property list.
    constexpr std::string_view kCells = "( { kHXCellMonitorCellId = 1; } )";
    const ByteBuffer whole = textRecord(kCellMonitorLogCode, kCells).bytes();
    RecordFixture<UMTSRRInfo> fixture;
    fixture.feed(cellsRecord(Array{serving(7, 8, 9)}));
    const PropertyList before = fixture.snapshot();
    for (std::size_t length = 0; length < whole.size(); ++length) {
        fixture.feed(ByteBuffer(whole.begin(), whole.begin() + static_cast<std::ptrdiff_t>(length)),
                     kCellMonitorLogCode);
        EXPECT_EQ(fixture.lines, (Lines{{4, "UMTSRRInfo"},
                                        {3, "Cell Info Array data could not be constructed"},
                                        {3, "Failed to get Cell Array\n"}}))
            << "cut at " << length;
        EXPECT_EQ(fixture.section(), before);
    }
}

TEST(UMTSRRInfoCellMonitor, NoElementsAndNoUMTSServingCellChangeNothingSilently) {
    const PropertyList neighbour =
        cell("UMTS", "Neighbor", {{"CellId", 1}, {"UARFCN", 2}, {"SCN", 3}});
    RecordFixture<UMTSRRInfo> fixture;
    for (const PropertyList& root :
         {PropertyList(Array()), PropertyList(Array{neighbour}), serving(1, 2, 3)}) {
        fixture.feed(propertyListRecord(kCellMonitorLogCode, root));
        EXPECT_EQ(fixture.lines, (Lines{{4, "UMTSRRInfo"}}));
        EXPECT_TRUE(fixture.keys().empty());
    }
}

TEST(UMTSRRInfoCellMonitor, TheUARFCNIsShownOnlyUntilTheNext0x4127) {
    const Record identity = Record(0x4127).s32(9763).s32(10713).s32(42).u16(7).padTo(29);
    RecordFixture<UMTSRRInfo> fixture;
    fixture.feed(cellsRecord(Array{serving(41, 10713, 388)}));
    fixture.feed(ByteBuffer(identity.bytes().begin(), identity.bytes().end() - 1));
    EXPECT_EQ(fixture.text("UARFCN"), "10713") << "a short 0x4127 removes nothing";
    fixture.feed(identity);
    expectInOrder(fixture.section(), Dictionary{{"Cell ID", "42"},
                                                {"Scrambling Code", "388"},
                                                {"Downlink Frequency", "10713"},
                                                {"Uplink Frequency", "9763"},
                                                {"URA ID", "7"}});
    fixture.feed(cellsRecord(Array{serving(41, 10688, 388)}));
    EXPECT_EQ(fixture.text("UARFCN"), "10688");
    EXPECT_EQ(fixture.text("Cell ID"), "41");
    EXPECT_EQ(fixture.text("URA ID"), "7");
}

TEST(UMTSRRInfoCellMonitor, AnyCellsKeepItsSectionWithinItsKeys) {
    anyCellsKeepWithin<UMTSRRInfo>({"RRC State", "Cell ID", "Downlink Frequency",
                                    "Uplink Frequency", "URA ID", "Ciphering", "Transmit Power",
                                    "UARFCN", "Scrambling Code"});
}

} // namespace
} // namespace pallax
