#include "LogGenerator/Common/CellMonitor.h"

#include "LogGenerator/Records/Formats.h"
#include "platform/TelephonyConstants.h"
#include "tests/doubles/CellBuilder.h"
#include "tests/doubles/PropertyListRecord.h"
#include "tests/doubles/RecordFixture.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using namespace doubles; // NOLINT: the vocabulary of these tests
using Lines = std::vector<RecordingLog::Line>;

constexpr LogCode kCellMonitor = 0xFF0001;

PropertyList servingCell(std::int64_t countryCode) {
    return Dictionary{
        {"kHXCellMonitorCellRadioAccessTechnology", "kHXCellMonitorRadioAccessTechnologyGSM"},
        {"kHXCellMonitorCellType", "kHXCellMonitorCellTypeServing"},
        {"kHXCellMonitorMCC", PropertyList::integer(countryCode)}};
}

/// The array that a record carries, or null when it cannot be read.
PropertyList cellsOf(const Record& record) {
    const auto cells = readCellMonitorArray(LogRecord(record.bytes()));
    return cells ? PropertyList(*cells) : PropertyList();
}

bool isServingGSM(const PropertyList& element) {
    return isCell(element, kHXCellMonitorRadioAccessTechnologyGSM, kHXCellMonitorCellTypeServing);
}

// The array

TEST(CellMonitor, ReadsTheArrayInTheBinaryForm) {
    const Array cells = {servingCell(310), "no cell"};
    EXPECT_EQ(cellsOf(propertyListRecord(kCellMonitor, cells)), PropertyList(cells));
}

TEST(CellMonitor, ReadsTheArrayInTheXmlForm) {
    EXPECT_EQ(cellsOf(textRecord(
                  kCellMonitor,
                  "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n<plist version=\"1.0\"><array><dict>"
                  "<key>kHXCellMonitorCellRadioAccessTechnology</key>"
                  "<string>kHXCellMonitorRadioAccessTechnologyGSM</string>"
                  "<key>kHXCellMonitorCellType</key><string>kHXCellMonitorCellTypeServing</string>"
                  "<key>kHXCellMonitorMCC</key><integer>310</integer>"
                  "</dict></array></plist>")),
              PropertyList(Array{servingCell(310)}));
}

TEST(CellMonitor, ReadsTheArrayInTheTextFormWhoseNumbersAreTexts) {
    const PropertyList cells = cellsOf(textRecord(
        kCellMonitor,
        "( { kHXCellMonitorCellRadioAccessTechnology = kHXCellMonitorRadioAccessTechnologyGSM;"
        " kHXCellMonitorCellType = kHXCellMonitorCellTypeServing; kHXCellMonitorMCC = 310; } )"));
    ASSERT_NE(cells.array(), nullptr);
    ASSERT_EQ(cells.array()->size(), 1U);
    EXPECT_TRUE(isServingGSM(cells.array()->front()));
    EXPECT_EQ(*cells.array()->front().dictionary()->find("kHXCellMonitorMCC"), PropertyList("310"));
}

TEST(CellMonitor, APayloadThatIsNoPropertyListGivesNothingAndIsLogged) {
    for (const std::string_view payload : {"", "( a", "bplist00", "<plist><array>"}) {
        RecordingLog log;
        const Record record = textRecord(kCellMonitor, payload);
        EXPECT_EQ(readCellMonitorArray(LogRecord(record.bytes())), std::nullopt) << payload;
        EXPECT_EQ(log.lines(), (Lines{{3, "Cell Info Array data could not be constructed"}}));
    }
}

TEST(CellMonitor, ARecordShorterThanItsHeaderGivesNothing) {
    RecordingLog log;
    EXPECT_EQ(readCellMonitorArray(LogRecord()), std::nullopt);
    EXPECT_EQ(log.lines(), (Lines{{3, "Cell Info Array data could not be constructed"}}));
}

TEST(CellMonitor, ARootThatIsNoArrayHasNoCells) {
    RecordingLog log;
    EXPECT_EQ(cellsOf(propertyListRecord(kCellMonitor, servingCell(310))), PropertyList(Array()));
    EXPECT_EQ(cellsOf(propertyListRecord(kCellMonitor, "a text")), PropertyList(Array()));
    EXPECT_EQ(log.lines(), Lines());
}

TEST(CellMonitor, TheSecondLineOfAFailureEndsInANewline) {
    RecordingLog log;
    logNoCellArray();
    EXPECT_EQ(log.lines(), (Lines{{3, "Failed to get Cell Array\n"}}));
}

TEST(CellMonitor, ARecordThatLogsBothLinesDoesSoOnlyWithoutAnArray) {
    RecordingLog log;
    EXPECT_EQ(cellMonitorArrayOrLog(LogRecord()), std::nullopt);
    EXPECT_EQ(log.take(), (Lines{{3, "Cell Info Array data could not be constructed"},
                                 {3, "Failed to get Cell Array\n"}}));
    const Record record = propertyListRecord(kCellMonitor, Array{"no cell"});
    EXPECT_EQ(cellMonitorArrayOrLog(LogRecord(record.bytes())), Array{"no cell"});
    EXPECT_EQ(log.lines(), Lines());
}

// Cells

TEST(CellMonitor, ACellIsOfItsTechnologyAndType) {
    EXPECT_TRUE(isServingGSM(servingCell(1)));
    EXPECT_FALSE(isCell(servingCell(1), kHXCellMonitorRadioAccessTechnologyUMTS,
                        kHXCellMonitorCellTypeServing));
    EXPECT_FALSE(isCell(servingCell(1), kHXCellMonitorRadioAccessTechnologyGSM,
                        kHXCellMonitorCellTypeNeighbor));
}

TEST(CellMonitor, AnElementThatIsNoDictionaryIsNoCell) {
    for (const PropertyList& element :
         {PropertyList(), PropertyList("text"), PropertyList::integer(1), PropertyList(Array())}) {
        EXPECT_FALSE(isServingGSM(element)) << element.description();
    }
}

TEST(CellMonitor, AnElementThatLacksEitherKeyIsNoCell) {
    for (const std::string_view key :
         {kHXCellMonitorCellRadioAccessTechnology, kHXCellMonitorCellType}) {
        const PropertyList cell = servingCell(1);
        EXPECT_TRUE(cell.dictionary()->remove(key));
        EXPECT_FALSE(isServingGSM(cell)) << key;
        cell.dictionary()->setFixed(key, PropertyList::integer(1));
        EXPECT_FALSE(isServingGSM(cell)) << key << " with a value that is no text";
    }
}

TEST(CellMonitor, TheFirstOfSeveralCellsIsFound) {
    const Array cells = {"no cell", servingCell(1), servingCell(2)};
    EXPECT_EQ(
        findCell(cells, kHXCellMonitorRadioAccessTechnologyGSM, kHXCellMonitorCellTypeServing),
        &cells[1]);
    EXPECT_EQ(
        findCell(cells, kHXCellMonitorRadioAccessTechnologyLTE, kHXCellMonitorCellTypeServing),
        nullptr);
    EXPECT_EQ(findCell({}, kHXCellMonitorRadioAccessTechnologyGSM, kHXCellMonitorCellTypeServing),
              nullptr);
}

// Numbers

constexpr std::string_view kFailure = "Failed to retrieve it\n";
constexpr std::string_view kKey = "number";

void expectNumber(const PropertyList& value, std::int32_t expected) {
    RecordingLog log;
    EXPECT_EQ(cellNumber(Dictionary{{"number", value}}, kKey, kFailure), expected);
    EXPECT_EQ(log.lines(), Lines()) << value.description();
}

void expectNoNumber(const PropertyList& cell) {
    RecordingLog log;
    EXPECT_EQ(cellNumber(cell, kKey, kFailure), std::nullopt) << cell.description();
    EXPECT_EQ(log.lines(), (Lines{{3, "Failed to retrieve it\n"}})) << cell.description();
}

TEST(CellNumber, ReadsTheWhole32BitRange) {
    expectNumber(PropertyList::integer(310), 310);
    expectNumber(PropertyList::integer(2147483647), 2147483647);
    expectNumber(PropertyList::integer(-2147483648LL), -2147483647 - 1);
}

TEST(CellNumber, BeyondThe32BitRangeThereIsNone) {
    expectNoNumber(Dictionary{{"number", PropertyList::integer(2147483648LL)}});
    expectNoNumber(Dictionary{{"number", PropertyList::integer(-2147483649LL)}});
    expectNoNumber(Dictionary{{"number", PropertyList::real(2147483648.0)}});
    expectNoNumber(Dictionary{{"number", PropertyList::real(-2147483649.0)}});
}

TEST(CellNumber, OneBeyond64BitsWithASignLeavesTheRestOfTheListReadable) {
    const PropertyList large = PropertyList::unsignedInteger(9223372036854775808U);
    const Array cells = {servingCell(310), Dictionary{{"number", large}}};
    EXPECT_EQ(cellsOf(propertyListRecord(kCellMonitor, cells)), PropertyList(cells));
    const auto xml = serializeXml(PropertyList(cells));
    EXPECT_EQ(cellsOf(textRecord(kCellMonitor, *xml)), PropertyList(cells));
    expectNoNumber(Dictionary{{"number", large}});
}

TEST(CellNumber, ARealCountsWhenItIsWhole) {
    expectNumber(PropertyList::real(-40.0), -40);
    expectNumber(PropertyList::real(2147483647.0), 2147483647);
    expectNoNumber(Dictionary{{"number", PropertyList::real(0.5)}});
}

TEST(CellNumber, AMissingKeyAndATextAreNoNumber) {
    expectNoNumber(Dictionary{{"another", PropertyList::integer(1)}});
    expectNoNumber(Dictionary{{"number", "310"}});
    expectNoNumber(Dictionary{{"number", PropertyList::boolean(true)}});
    expectNoNumber("no dictionary");
}

constexpr auto kNumbers = std::to_array<CellNumber>({
    {"Second", "b", "no b\n"},
    {"First", "a", "no a\n"},
    {"Third", "c", "no c\n"},
});

TEST(CellNumber, SeveralAreShownInOrderAndAMissingOneStopsNoOther) {
    RecordingLog log;
    const auto shown = std::make_shared<Dictionary>();
    showCellNumbers(shown, kNumbers,
                    Dictionary{{"c", PropertyList::integer(-3)}, {"b", PropertyList::real(2.0)}});
    expectInOrder(shown, Dictionary{{"Second", "2"}, {"Third", "-3"}});
    EXPECT_EQ(log.lines(), (Lines{{3, "no a\n"}}));
    ASSERT_NE(shown->find("Third")->displayNumber(), nullptr);
    EXPECT_EQ(shown->find("Third")->displayNumber()->integer(), -3);
}

TEST(CellNumber, WithoutATargetOnlyTheMissingOnesAreLogged) {
    RecordingLog log;
    showCellNumbers(nullptr, kNumbers, Dictionary{{"a", PropertyList::integer(1)}});
    EXPECT_EQ(log.lines(), (Lines{{3, "no b\n"}, {3, "no c\n"}}));
}

// Levels

std::string level(std::int32_t number, int factor = 1) {
    return cellLevel(number, kDecimalDbm, factor).string().value_or("(no text)");
}

TEST(CellLevel, IsTheLow16BitsSigned) {
    EXPECT_EQ(level(-40), "-40 dBm");
    EXPECT_EQ(level(0xFFD8), "-40 dBm");
    EXPECT_EQ(level(0x1FFD8), "-40 dBm");
    EXPECT_EQ(level(32766), "32766 dBm");
    EXPECT_EQ(level(32768), "-32768 dBm");
}

TEST(CellLevel, TimesItsFactor) {
    EXPECT_EQ(level(-40, 2), "-80 dBm");
    EXPECT_EQ(level(-32768, 2), "-65536 dBm");
    EXPECT_EQ(cellLevel(-40, kDecimalDbm, 2).displayNumber()->integer(), -80);
}

TEST(CellLevel, Is32767AsTheEmptyString) {
    EXPECT_EQ(level(32767), "");
    EXPECT_EQ(level(32767, 2), "");
    EXPECT_EQ(level(0x17FFF), "") << "by its low 16 bits";
}

constexpr auto kLevels = std::to_array<CellLevel>({
    {"Level", "l", "no l\n", &kDecimalDbm, 2},
    {"Ratio", "r", "no r\n", &kDecimalDb},
});

TEST(CellLevel, SeveralAreShownInOrderAndAMissingOneStopsNoOther) {
    RecordingLog log;
    const auto shown = std::make_shared<Dictionary>();
    showCellLevels(shown, kLevels,
                   Dictionary{{"r", PropertyList::integer(-7)}, {"l", PropertyList::integer(-40)}});
    expectInOrder(shown, Dictionary{{"Level", "-80 dBm"}, {"Ratio", "-7 dB"}});
    EXPECT_EQ(log.take(), Lines());
    const auto partly = std::make_shared<Dictionary>();
    showCellLevels(partly, kLevels, Dictionary{{"r", PropertyList::integer(32767)}});
    expectInOrder(partly, Dictionary{{"Ratio", ""}});
    EXPECT_EQ(log.lines(), (Lines{{3, "no l\n"}}));
}

TEST(CellLevel, WithoutATargetOnlyTheMissingOnesAreLogged) {
    RecordingLog log;
    showCellLevels(nullptr, kLevels, Dictionary{{"l", PropertyList::integer(1)}});
    EXPECT_EQ(log.lines(), (Lines{{3, "no r\n"}}));
}

// Entries

TEST(CellEntries, EveryCellOfTheKindHasItsNumbersAndBehindThemItsLevels) {
    RecordingLog log;
    const Array cells = {cell("GSM", "Neighbor", {{"RSSI", -1}}),
                         cell("UMTS", "Neighbor", {{"RSSI", -40}, {"ARFCN", 62}}),
                         cell("UMTS", "Serving", {{"RSSI", -2}, {"ARFCN", 63}}), "no cell",
                         cell("UMTS", "Neighbor")};
    constexpr auto kNumber =
        std::to_array<CellNumber>({{"Channel", kHXCellMonitorARFCN, "no channel\n"}});
    constexpr auto kLevel =
        std::to_array<CellLevel>({{"Level", kHXCellMonitorRSSI, "no level\n", &kDecimalDbm}});
    const Array entries = cellEntries(cells, kHXCellMonitorRadioAccessTechnologyUMTS,
                                      kHXCellMonitorCellTypeNeighbor, kNumber, kLevel);
    ASSERT_EQ(entries.size(), 2U);
    expectInOrder(entries[0], Dictionary{{"Channel", "62"}, {"Level", "-40 dBm"}});
    expectInOrder(entries[1], Dictionary());
    EXPECT_EQ(log.lines(), (Lines{{3, "no channel\n"}, {3, "no level\n"}}));
}

} // namespace
} // namespace pallax
