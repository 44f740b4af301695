#include "LogGenerator/Common/CellMonitor.h"

#include "LogGenerator/Records/LayoutRecord.h"
#include "platform/TelephonyConstants.h"
#include "tests/doubles/CellBuilder.h"
#include "tests/doubles/PropertyListRecord.h"
#include "tests/doubles/RecordFixture.h"

#include <gtest/gtest.h>

#include <algorithm>

namespace pallax {
namespace {

using namespace doubles; // NOLINT: the vocabulary of these tests
using Lines = std::vector<RecordingLog::Line>;

constexpr LogCode kCellMonitor = 0xFF0001;

constexpr auto kGsm = std::to_array<std::string_view>({kHXCellMonitorRadioAccessTechnologyGSM});
constexpr auto kGsmAndUmts = std::to_array<std::string_view>(
    {kHXCellMonitorRadioAccessTechnologyGSM, kHXCellMonitorRadioAccessTechnologyUMTS});
constexpr ListPart kServingCell{.kind = ListPart::Kind::FirstCell,
                                .parse = parseCellMonitorArray,
                                .technologies = kGsm,
                                .cellType = kHXCellMonitorCellTypeServing};
constexpr ListPart kNeighbours{.kind = ListPart::Kind::CellEntries,
                               .parse = parseCellMonitorArray,
                               .technologies = kGsmAndUmts,
                               .cellType = kHXCellMonitorCellTypeNeighbor};

constexpr auto kNumberFields = std::to_array<Field>({
    cellNumber("Second", "b", "no b\n", "The second."),
    cellNumber("First", "a", "no a\n", "The first."),
    cellNumber("Third", "c", "no c\n", "The third."),
});
constexpr auto kNumberCodes = std::to_array<CodeLayout>(
    {{.logCode = kCellMonitor, .fields = kNumberFields, .listPart = &kServingCell}});
constexpr RecordLayout kNumbersLayout{
    .section = "Numbers", .logLine = "Numbers", .codes = kNumberCodes};

/// Shows three numbers of the first serving cell.
class Numbers final : public LayoutRecord {
public:
    Numbers() : LayoutRecord(kNumbersLayout) {}
};

constexpr auto kEntryFields = std::to_array<Field>({
    cellNumber("Channel", kHXCellMonitorARFCN, "no channel\n", "The channel."),
    cellLevel("Level", kHXCellMonitorRSSI, "no level\n", kDecimalDbm),
    cellLevel("Doubled", kHXCellMonitorRSCP, "", kDecimalDb, 2.0),
});
constexpr auto kEntryCodes = std::to_array<CodeLayout>(
    {{.logCode = kCellMonitor, .fields = kEntryFields, .listPart = &kNeighbours}});
constexpr RecordLayout kEntriesLayout{
    .section = "Entries", .logLine = "Entries", .kind = SectionKind::List, .codes = kEntryCodes};

/// Lists a number and two levels of every neighbour.
class Entries final : public LayoutRecord {
public:
    Entries() : LayoutRecord(kEntriesLayout) {}
};

PropertyList servingCell(const Dictionary& numbers) {
    PropertyList serving = cell("GSM", "Serving");
    for (const Dictionary::Entry& number : numbers) {
        serving.dictionary()->set(number.key.string(), number.value);
    }
    return serving;
}

/// The array that a record carries, or null when it cannot be read.
PropertyList cellsOf(const Record& record) {
    const auto cells = parseCellMonitorArray(LogRecord(record.bytes()));
    return cells ? *cells : PropertyList();
}

// The array

TEST(CellMonitor, ReadsTheArrayInTheBinaryForm) {
    const Array cells = {servingCell({{"a", PropertyList::integer(310)}}), "no cell"};
    EXPECT_EQ(cellsOf(propertyListRecord(kCellMonitor, cells)), PropertyList(cells));
}

TEST(CellMonitor, ReadsTheArrayInTheXmlForm) {
    EXPECT_EQ(cellsOf(textRecord(
                  kCellMonitor,
                  "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n<plist version=\"1.0\"><array><dict>"
                  "<key>kHXCellMonitorCellRadioAccessTechnology</key>"
                  "<string>kHXCellMonitorRadioAccessTechnologyGSM</string>"
                  "<key>kHXCellMonitorCellType</key><string>kHXCellMonitorCellTypeServing</string>"
                  "<key>a</key><integer>310</integer>"
                  "</dict></array></plist>")),
              PropertyList(Array{servingCell({{"a", PropertyList::integer(310)}})}));
}

TEST(CellMonitor, ReadsTheArrayInTheTextFormWhoseNumbersAreTexts) {
    const PropertyList cells = cellsOf(textRecord(
        kCellMonitor,
        "( { kHXCellMonitorCellRadioAccessTechnology = kHXCellMonitorRadioAccessTechnologyGSM;"
        " kHXCellMonitorCellType = kHXCellMonitorCellTypeServing; a = 310; } )"));
    ASSERT_NE(cells.array(), nullptr);
    ASSERT_EQ(cells.array()->size(), 1U);
    EXPECT_TRUE(kServingCell.looksFor(cells.array()->front()));
    EXPECT_EQ(*cells.array()->front().dictionary()->find("a"), PropertyList("310"));
}

TEST(CellMonitor, APayloadThatIsNoPropertyListGivesNothingAndIsLogged) {
    for (const std::string_view payload : {"", "( a", "bplist00", "<plist><array>"}) {
        RecordingLog log;
        const Record record = textRecord(kCellMonitor, payload);
        EXPECT_EQ(parseCellMonitorArray(LogRecord(record.bytes())), std::nullopt) << payload;
        EXPECT_EQ(log.take(), (Lines{{3, "Cell Info Array data could not be constructed"},
                                     {3, "Failed to get Cell Array\n"}}));
        EXPECT_EQ(parseCellMonitorArrayQuietly(LogRecord(record.bytes())), std::nullopt) << payload;
        EXPECT_EQ(log.lines(), (Lines{{3, "Cell Info Array data could not be constructed"}}));
    }
}

TEST(CellMonitor, ARecordShorterThanItsHeaderGivesNothing) {
    RecordingLog log;
    EXPECT_EQ(parseCellMonitorArrayQuietly(LogRecord()), std::nullopt);
    EXPECT_EQ(log.lines(), (Lines{{3, "Cell Info Array data could not be constructed"}}));
}

TEST(CellMonitor, WhatCannotBeReadEmptiesAListOfCellsAndLeavesKeys) {
    RecordFixture<Numbers> numbers;
    numbers.keys().set("First", "what was shown before");
    numbers.feed(textRecord(kCellMonitor, "( a"));
    expectInOrder(numbers.section(), Dictionary{{"First", "what was shown before"}});
    RecordFixture<Entries> entries;
    entries.list() = Array{"what was shown before"};
    entries.feed(textRecord(kCellMonitor, "( a"));
    EXPECT_TRUE(entries.list().empty());
}

TEST(CellMonitor, ARootThatIsNoArrayHasNoCells) {
    for (const PropertyList& root : {servingCell({}), PropertyList("a text")}) {
        RecordFixture<Numbers> numbers;
        numbers.feed(propertyListRecord(kCellMonitor, root));
        EXPECT_EQ(numbers.lines, (Lines{{4, "Numbers"}}));
        EXPECT_TRUE(numbers.keys().empty());
        RecordFixture<Entries> entries;
        entries.list() = Array{"what was shown before"};
        entries.feed(propertyListRecord(kCellMonitor, root));
        EXPECT_EQ(entries.lines, (Lines{{4, "Entries"}}));
        EXPECT_TRUE(entries.list().empty());
    }
}

// Cells

TEST(CellMonitor, ACellIsOfItsTechnologiesAndType) {
    EXPECT_TRUE(kServingCell.looksFor(cell("GSM", "Serving")));
    EXPECT_FALSE(kServingCell.looksFor(cell("UMTS", "Serving")));
    EXPECT_FALSE(kServingCell.looksFor(cell("GSM", "Neighbor")));
    EXPECT_TRUE(kNeighbours.looksFor(cell("GSM", "Neighbor")));
    EXPECT_TRUE(kNeighbours.looksFor(cell("UMTS", "Neighbor")));
    EXPECT_FALSE(kNeighbours.looksFor(cell("LTE", "Neighbor")));
}

TEST(CellMonitor, AnElementThatIsNoDictionaryIsNoCell) {
    for (const PropertyList& element :
         {PropertyList(), PropertyList("text"), PropertyList::integer(1), PropertyList(Array())}) {
        EXPECT_FALSE(kServingCell.looksFor(element)) << element.description();
    }
}

TEST(CellMonitor, AnElementThatLacksEitherKeyIsNoCell) {
    for (const std::string_view key :
         {kHXCellMonitorCellRadioAccessTechnology, kHXCellMonitorCellType}) {
        const PropertyList element = servingCell({});
        EXPECT_TRUE(element.dictionary()->remove(key));
        EXPECT_FALSE(kServingCell.looksFor(element)) << key;
        element.dictionary()->setFixed(key, PropertyList::integer(1));
        EXPECT_FALSE(kServingCell.looksFor(element)) << key << " with a value that is not a text";
    }
}

/// The values and log lines of the numbers record for one cell.
struct Shown {
    PropertyList section;
    Lines lines; ///< without the first
};

Shown numbersOf(const Array& cells) {
    RecordFixture<Numbers> fixture;
    fixture.feed(cellsRecord(cells));
    return {fixture.snapshot(), {fixture.lines.begin() + 1, fixture.lines.end()}};
}

TEST(CellMonitor, TheFirstOfSeveralCellsIsShown) {
    const auto numbered = [](std::int64_t number) {
        return servingCell({{"a", PropertyList::integer(number)},
                            {"b", PropertyList::integer(number)},
                            {"c", PropertyList::integer(number)}});
    };
    const auto [shown, lines] =
        numbersOf({"no cell", cell("GSM", "Neighbor", {{"a", 3}}), numbered(1), numbered(2)});
    expectInOrder(shown, Dictionary{{"Second", "1"}, {"First", "1"}, {"Third", "1"}});
    EXPECT_EQ(lines, Lines());
    const auto [none, nothing] = numbersOf({"no cell", cell("GSM", "Neighbor")});
    expectInOrder(none, Dictionary());
    EXPECT_EQ(nothing, Lines());
}

// Numbers

/// The shown value of "a" or, if there is none, "(none)" with its line.
std::string numberOf(const PropertyList& value) {
    const auto [shown, lines] = numbersOf({servingCell({{"a", value}})});
    const bool isMissed =
        std::find(lines.begin(), lines.end(), RecordingLog::Line{3, "no a\n"}) != lines.end();
    const PropertyList* first = shown.dictionary()->find("First");
    EXPECT_EQ(first == nullptr, isMissed) << value.description();
    return first != nullptr ? first->string().value_or("(no text)") : "(none)";
}

TEST(CellNumber, ReadsTheWhole32BitRange) {
    EXPECT_EQ(numberOf(PropertyList::integer(310)), "310");
    EXPECT_EQ(numberOf(PropertyList::integer(2147483647)), "2147483647");
    EXPECT_EQ(numberOf(PropertyList::integer(-2147483648LL)), "-2147483648");
}

TEST(CellNumber, BeyondThe32BitRangeThereIsNone) {
    EXPECT_EQ(numberOf(PropertyList::integer(2147483648LL)), "(none)");
    EXPECT_EQ(numberOf(PropertyList::integer(-2147483649LL)), "(none)");
    EXPECT_EQ(numberOf(PropertyList::real(2147483648.0)), "(none)");
    EXPECT_EQ(numberOf(PropertyList::real(-2147483649.0)), "(none)");
}

TEST(CellNumber, OneBeyond64BitsWithASignLeavesTheRestOfTheListReadable) {
    const PropertyList large = PropertyList::unsignedInteger(9223372036854775808U);
    const Array cells = {servingCell({{"a", large}}), "no cell"};
    EXPECT_EQ(cellsOf(propertyListRecord(kCellMonitor, cells)), PropertyList(cells));
    const auto xml = serializeXml(PropertyList(cells));
    EXPECT_EQ(cellsOf(textRecord(kCellMonitor, *xml)), PropertyList(cells));
    EXPECT_EQ(numberOf(large), "(none)");
}

TEST(CellNumber, ARealCountsWhenItIsWhole) {
    EXPECT_EQ(numberOf(PropertyList::real(-40.0)), "-40");
    EXPECT_EQ(numberOf(PropertyList::real(2147483647.0)), "2147483647");
    EXPECT_EQ(numberOf(PropertyList::real(0.5)), "(none)");
}

TEST(CellNumber, ATextIsNoNumber) {
    EXPECT_EQ(numberOf("310"), "(none)");
    EXPECT_EQ(numberOf(PropertyList::boolean(true)), "(none)");
}

TEST(CellNumber, SeveralAreShownInOrderAndAMissingOneStopsNoOther) {
    const auto [shown, lines] = numbersOf(
        {servingCell({{"c", PropertyList::integer(-3)}, {"b", PropertyList::real(2.0)}})});
    expectInOrder(shown, Dictionary{{"Second", "2"}, {"Third", "-3"}});
    EXPECT_EQ(lines, (Lines{{3, "no a\n"}}));
    ASSERT_NE(shown.dictionary()->find("Third")->displayNumber(), nullptr);
    EXPECT_EQ(shown.dictionary()->find("Third")->displayNumber()->integer(), -3);
}

TEST(CellNumber, WithoutASectionOnlyTheMissingOnesAreLogged) {
    const Record record = cellsRecord({servingCell({{"a", PropertyList::integer(1)}})});
    RecordingLog log;
    Numbers().updateWithData(LogRecord(record.bytes()), kCellMonitor);
    EXPECT_EQ(log.lines(), (Lines{{4, "Numbers"}, {3, "no b\n"}, {3, "no c\n"}}));
}

// Levels

/// The entry of a neighbour with a level under both keys.
PropertyList levelsOf(std::int32_t number) {
    RecordFixture<Entries> fixture;
    fixture.feed(
        cellsRecord({cell("GSM", "Neighbor", {{"ARFCN", 1}, {"RSSI", number}, {"RSCP", number}})}));
    EXPECT_EQ(fixture.lines, (Lines{{4, "Entries"}}));
    return fixture.list().front();
}

void expectLevels(std::int32_t number, const char* level, const char* doubled) {
    expectInOrder(levelsOf(number),
                  Dictionary{{"Channel", "1"}, {"Level", level}, {"Doubled", doubled}});
}

TEST(CellLevel, IsTheLow16BitsSignedTimesItsFactor) {
    expectLevels(-40, "-40 dBm", "-80 dB");
    expectLevels(0xFFD8, "-40 dBm", "-80 dB");
    expectLevels(0x1FFD8, "-40 dBm", "-80 dB");
    expectLevels(32766, "32766 dBm", "65532 dB");
    expectLevels(32768, "-32768 dBm", "-65536 dB");
    EXPECT_EQ(levelsOf(-40).dictionary()->find("Doubled")->displayNumber()->integer(), -80);
}

TEST(CellLevel, Is32767AsTheEmptyString) {
    expectLevels(32767, "", "");
    expectLevels(0x17FFF, "", ""); // the low 16 bits count
}

// Entries

TEST(CellEntries, EveryCellOfTheKindHasTheFieldsThatItHolds) {
    RecordFixture<Entries> fixture;
    fixture.feed(cellsRecord({cell("LTE", "Neighbor", {{"RSSI", -1}}),
                              cell("UMTS", "Neighbor", {{"RSSI", -40}, {"ARFCN", 62}}),
                              cell("UMTS", "Serving", {{"RSSI", -2}, {"ARFCN", 63}}), "no cell",
                              cell("GSM", "Neighbor")}));
    ASSERT_EQ(fixture.list().size(), 2U);
    expectInOrder(fixture.list()[0], Dictionary{{"Channel", "62"}, {"Level", "-40 dBm"}});
    expectInOrder(fixture.list()[1], Dictionary());
    EXPECT_EQ(fixture.lines, (Lines{{4, "Entries"}, {3, "no channel\n"}, {3, "no level\n"}}));
}

} // namespace
} // namespace pallax
