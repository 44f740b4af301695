#include "LogGenerator/Records/LayoutReader.h"

#include "LogGenerator/Records/SectionDisplay.h"
#include "platform/TelephonyConstants.h"
#include "tests/LogGenerator/Records/SampleLines.h"
#include "tests/doubles/RecordFixture.h"

#include <gtest/gtest.h>

#include <array>

namespace pallax {
namespace {

using Texts = std::vector<std::string>;

constexpr Condition kIsBig{u8At(0), 10, 99};
constexpr Condition kIsBigOrWords{u8At(0), 10, 99, "small"};
constexpr Condition kIsBigOrNumber{u8At(0), 10, 99, "only %d"};
constexpr auto kByteFields = std::to_array<Field>({{"Byte", u8At(0), Conversion::number()}});

TEST(LayoutReader, AFieldWhoseConditionDoesNotHoldIsLeftOutOrShowsAText) {
    constexpr Field kNext{"Next", u8At(1), Conversion::number()};
    const auto fields = std::to_array<Field>({kNext.when(kIsBig), kNext.when(kIsBigOrWords),
                                              kNext.when(kIsBigOrNumber), kByteFields[0]});
    const CodeLayout code{.logCode = 1, .fields = fields};
    EXPECT_EQ(samplesOf(code, {9, 77}),
              (Texts{"11 Next small", "12 Next only 9", "13 Byte 9 raw 9"}));
    EXPECT_EQ(samplesOf(code, {10, 77}), (Texts{"10 Next 77 raw 77", "11 Next 77 raw 77",
                                                "12 Next 77 raw 77", "13 Byte 10 raw 10"}));
    EXPECT_EQ(samplesOf(code, {100, 77}),
              (Texts{"11 Next small", "12 Next only 100", "13 Byte 100 raw 100"}));
}

PropertyList sumOfRecord(const Place& place) {
    const int sum = place.here.u8(0) + place.record.u8(0);
    return sum == 0 ? PropertyList() : DisplayNumber(std::int64_t{sum}, kDecimal);
}
PropertyList wordOfMemory(const Place& place) {
    return place.memory->remembered.contains(place.here.u8(0)) ? "known" : "unknown";
}
constexpr Computation kSumOfRecord{.name = "", .formula = "", .read = {}, .compute = sumOfRecord};
constexpr Computation kWordOfMemory{.name = "", .formula = "", .read = {}, .compute = wordOfMemory};

TEST(LayoutReader, AComputedValueHasNoRawNumberAndMayBeMissing) {
    const auto fields = std::to_array<Field>({
        computed("Sum", kDecimal, kSumOfRecord),
        computed("Word", kWordOfMemory),
        computed("Big", kDecimal, kSumOfRecord).when(kIsBig),
    });
    const CodeLayout code{.logCode = 1, .fields = fields};
    RecordMemory memory;
    memory.remembered[10] = 1;
    EXPECT_EQ(samplesOf(code, {0}, memory), (Texts{"11 Word unknown"}));
    EXPECT_EQ(samplesOf(code, {4}, memory), (Texts{"10 Sum 8", "11 Word unknown"}));
    EXPECT_EQ(samplesOf(code, {10}, memory), (Texts{"10 Sum 20", "11 Word known", "12 Big 20"}));
}

/// Entries of three bytes from byte 2 on; their number is byte 1.
constexpr ListLayout kTriples{
    .key = "Triples",
    .entries = {{.start = 2, .stride = 3, .bytesRead = 2}},
    .count = u8At(1),
    .fields = kByteFields,
};

/// The samples of a record of one list.
Texts listSamples(const ListLayout& list, const ByteBuffer& bytes) {
    return samplesOf({.logCode = 1, .lists = std::span(&list, 1)}, bytes);
}

TEST(LayoutReader, ARecordCutAtAnyLengthGivesItsWholeEntries) {
    const ByteBuffer whole = {0, 3, 11, 0, 0, 12, 0, 0, 13, 0, 0};
    const auto cutTo = [&](std::size_t length) {
        return listSamples(kTriples,
                           {whole.begin(), whole.begin() + static_cast<std::ptrdiff_t>(length)});
    };
    const Texts first = {"{0 0", "10 Byte 11 raw 11", "}"};
    const Texts second = {"{1 0", "10 Byte 12 raw 12", "}"};
    const Texts third = {"{2 0", "10 Byte 13 raw 13", "}"};
    const auto joined = [](const std::vector<Texts>& parts) {
        Texts all = {"[Triples " + std::to_string(parts.size())};
        for (const Texts& part : parts) {
            all.insert(all.end(), part.begin(), part.end());
        }
        all.emplace_back("]");
        return all;
    };
    for (const std::size_t length : {0U, 1U, 2U, 3U}) {
        EXPECT_EQ(cutTo(length), joined({})) << length;
    }
    for (const std::size_t length : {4U, 5U, 6U}) {
        EXPECT_EQ(cutTo(length), joined({first})) << length;
    }
    for (const std::size_t length : {7U, 8U, 9U}) {
        EXPECT_EQ(cutTo(length), joined({first, second})) << length;
    }
    for (const std::size_t length : {10U, 11U}) {
        EXPECT_EQ(cutTo(length), joined({first, second, third})) << length;
    }
}

TEST(LayoutReader, AnEntryIsCutWhereAFieldThatHoldsItsConditionIs) {
    const auto fields = std::to_array<Field>(
        {kByteFields[0], Field{"Far", u16At(2), Conversion::number()}.when(kIsBig)});
    ListLayout list = kTriples;
    list.fields = fields;
    EXPECT_EQ(listSamples(list, {0, 2, 11, 0, 1, 9, 0}),
              (Texts{"[Triples 2", "{0 0", "10 Byte 11 raw 11", "11 Far 2305 raw 2305", "}", "{1 0",
                     "10 Byte 9 raw 9", "}", "]"}));
    EXPECT_EQ(listSamples(list, {0, 2, 11, 0, 1, 11, 0, 0}),
              (Texts{"[Triples 2", "{0 0", "10 Byte 11 raw 11", "11 Far 2817 raw 2817", "}", "]"}))
        << "one byte is missing";
}

TEST(LayoutReader, OnlyTheEntriesOfItsConditionAreShown) {
    ListLayout list = kTriples;
    list.only = &kIsBig;
    EXPECT_EQ(listSamples(list, {0, 3, 9, 0, 0, 10, 0, 0, 100, 0}),
              (Texts{"[Triples 3", "{1 0", "10 Byte 10 raw 10", "}", "]"}));
}

TEST(LayoutReader, AnEntryNeedsItsCompanion) {
    constexpr Computation kOfCompanion{
        .name = "", .formula = "", .read = {}, .compute = [](const Place& place) -> PropertyList {
            return DisplayNumber(std::int64_t{place.companion.u8(0)}, kDecimal);
        }};
    const auto fields =
        std::to_array<Field>({kByteFields[0], computed("Companion", kDecimal, kOfCompanion)});
    ListLayout list = kTriples;
    list.entries = {{.start = 2, .stride = 1, .bytesRead = 1}};
    list.fields = fields;
    // Behind the entries, of which each moves it by a byte.
    list.companion =
        EntryRun{{.start = 2, .stride = 2, .bytesRead = 2}, EntryRun::Move{1, u8At(1)}};
    EXPECT_EQ(listSamples(list, {0, 2, 5, 6, 50, 0, 60, 0}),
              (Texts{"[Triples 2", "{0 0", "10 Byte 5 raw 5", "11 Companion 50", "}", "{1 0",
                     "10 Byte 6 raw 6", "11 Companion 60", "}", "]"}));
    EXPECT_EQ(listSamples(list, {0, 2, 5, 6, 50, 0, 60}),
              (Texts{"[Triples 2", "{0 0", "10 Byte 5 raw 5", "11 Companion 50", "}", "]"}));
}

TEST(LayoutReader, AListMayHaveMoreEntriesThanItCountsAndNames) {
    ListLayout list = kTriples;
    list.plus = 1;
    list.entryName = u16At(0);
    EXPECT_EQ(listSamples(list, {0, 1, 1, 2, 0, 3, 4}),
              (Texts{"[Triples 2", "{0 513", "10 Byte 1 raw 1", "}", "{1 1027", "10 Byte 3 raw 3",
                     "}", "]"}));
    list.count = std::nullopt;
    EXPECT_EQ(listSamples(list, {0, 9, 1, 2, 0, 3, 4}),
              (Texts{"[Triples 1", "{0 513", "10 Byte 1 raw 1", "}", "]"}));
}

TEST(LayoutReader, AFunctionMaySayWhereTheEntriesLie) {
    ListLayout list = kTriples;
    list.entries = {};
    list.varying = [](const LogRecord& place) {
        return EntryList::Layout{.start = place.u8(0), .stride = 1, .bytesRead = 1};
    };
    EXPECT_EQ(
        listSamples(list, {3, 2, 0, 7, 8}),
        (Texts{"[Triples 2", "{0 0", "10 Byte 7 raw 7", "}", "{1 0", "10 Byte 8 raw 8", "}", "]"}));
}

TEST(LayoutReader, ARecordThatFailsTheSizeCheckEmptiesItsList) {
    ListLayout list = kTriples;
    list.sizeCheck = SizeCheck{u8At(0), 1};
    EXPECT_EQ(listSamples(list, {0, 1, 7, 0}),
              (Texts{"[Triples 1", "{0 0", "10 Byte 7 raw 7", "}", "]"}));
    EXPECT_EQ(listSamples(list, {2, 1, 7, 0}), (Texts{"[Triples 0", "]"}));
}

TEST(LayoutReader, AListMayStayWithoutEntries) {
    ListLayout list = kTriples;
    list.staysWithoutEntries = true;
    EXPECT_EQ(listSamples(list, {0, 0}), Texts());
    EXPECT_EQ(listSamples(list, {0, 1}), (Texts{"[Triples 0", "]"})) << "one that is cut";
}

TEST(LayoutReader, ADisplayGetsNoHiddenList) {
    ListLayout list = kTriples;
    list.isShown = false;
    const ByteBuffer bytes = {0, 1, 7, 0};
    EXPECT_EQ(listSamples(list, bytes), (Texts{"[Triples 1", "{0 0", "10 Byte 7 raw 7", "}", "]"}));
    RecordMemory memory;
    SectionDisplay display(memory);
    const PropertyList section{Dictionary()};
    display.setSection(section);
    const CodeLayout code{.logCode = 1, .lists = std::span(&list, 1)};
    LayoutReader(display, memory, 0).read(code, LogRecord(bytes));
    EXPECT_EQ(section, PropertyList(Dictionary()));
}

TEST(LayoutReader, RowsKeepTheirNumbersWhateverIsLeftOut) {
    const auto two = std::to_array<Field>({Field{"A", u8At(0), Conversion::number()}.when(kIsBig),
                                           {"B", u8At(0), Conversion::number()}});
    const auto inner = std::to_array<ListLayout>({{
        .key = "Inner",
        .entries = {{.start = 0, .stride = 1, .bytesRead = 1}},
        .fields = kByteFields,
        .plus = 1,
    }});
    ListLayout outer = kTriples;
    outer.fields = two;
    outer.lists = inner;
    ListLayout stays = outer;
    stays.count = u8At(0);
    stays.staysWithoutEntries = true;
    const auto lists = std::to_array<ListLayout>({outer, stays, kTriples});
    const CodeLayout code{.logCode = 1, .fields = two, .lists = lists};
    // 10 and 11 stand in the record, 12 to 14 in the first list, 15 to 17 in the second.
    EXPECT_EQ(samplesOf(code, {0, 2, 30, 0, 0, 4, 0}), (Texts{"11 B 0 raw 0",
                                                              "[Triples 2", //
                                                              "{0 0",
                                                              "12 A 30 raw 30",
                                                              "13 B 30 raw 30",
                                                              "[Inner 1",
                                                              "{0 0",
                                                              "14 Byte 30 raw 30",
                                                              "}",
                                                              "]",
                                                              "}", //
                                                              "{1 0",
                                                              "13 B 4 raw 4",
                                                              "[Inner 1",
                                                              "{0 0",
                                                              "14 Byte 4 raw 4",
                                                              "}",
                                                              "]",
                                                              "}",
                                                              "]", //
                                                              "[Triples 2",
                                                              "{0 0",
                                                              "18 Byte 30 raw 30",
                                                              "}",
                                                              "{1 0",
                                                              "18 Byte 4 raw 4",
                                                              "}",
                                                              "]"}));
    EXPECT_EQ(samplesOf(code, {1, 0, 30, 0}),
              (Texts{"11 B 1 raw 1", "[Triples 0", "]", //
                     "[Triples 1", "{0 0", "15 A 30 raw 30", "16 B 30 raw 30", "[Inner 1", "{0 0",
                     "17 Byte 30 raw 30", "}", "]", "}", "]", //
                     "[Triples 0", "]"}));
}

TEST(LayoutReader, KeysAreRemovedAndTheListEmptiedFirst) {
    constexpr auto kRemoved = std::to_array<std::string_view>({"One", "Two"});
    EXPECT_EQ(
        samplesOf({.logCode = 1, .fields = kByteFields, .removes = kRemoved, .emptiesList = true},
                  {7}),
        (Texts{"- One", "- Two", "[ 0", "]", "10 Byte 7 raw 7"}));
}

// Property lists: the payload stands for what a parser makes of it.

PropertyList payload;
std::optional<PropertyList> parsedPayload(const LogRecord& record) {
    return record.length() != 0 ? std::optional(payload) : std::nullopt;
}

constexpr auto kTechnologies = std::to_array<std::string_view>(
    {kHXCellMonitorRadioAccessTechnologyUMTS, kHXCellMonitorRadioAccessTechnologyGSM});

Dictionary cellOf(std::string_view technology, std::string_view type, int lac, int level) {
    Dictionary cell;
    cell.setFixed(kHXCellMonitorCellRadioAccessTechnology, Text::fixed(technology));
    cell.setFixed(kHXCellMonitorCellType, Text::fixed(type));
    cell.set("lac", PropertyList::integer(lac));
    cell.set("level", PropertyList::integer(level));
    return cell;
}
const std::string_view kUmts = kHXCellMonitorRadioAccessTechnologyUMTS;
const std::string_view kGsm = kHXCellMonitorRadioAccessTechnologyGSM;
const std::string_view kLte = kHXCellMonitorRadioAccessTechnologyLTE;
const std::string_view kServing = kHXCellMonitorCellTypeServing;
const std::string_view kNeighbor = kHXCellMonitorCellTypeNeighbor;

Field ofCell(std::string_view key, std::string_view listKey, unsigned bits,
             std::string_view failure) {
    Field field{key, std::nullopt, Conversion::number()};
    field.listKey = listKey;
    field.listBits = bits;
    field.failure = failure;
    return field;
}

/// The samples of a property list of this kind, or of none that could be parsed.
Texts partSamples(ListPart::Kind kind, const std::optional<PropertyList>& list) {
    payload = list.value_or(PropertyList());
    const ListPart part{.kind = kind,
                        .parse = parsedPayload,
                        .technologies = kTechnologies,
                        .cellType = kHXCellMonitorCellTypeServing};
    const auto fields =
        std::to_array<Field>({ofCell("LAC", "lac", 0, "no LAC"), ofCell("Level", "level", 16, "")});
    const CodeLayout code{.logCode = 1, .fields = fields, .listPart = &part};
    return samplesOf(code, list ? ByteBuffer{1} : ByteBuffer{});
}

Array fourCells() {
    return {cellOf(kLte, kServing, 1, 1), cellOf(kUmts, kNeighbor, 2, 2),
            cellOf(kGsm, kServing, 70000, 65535), cellOf(kUmts, kServing, 4, 32767)};
}

TEST(LayoutReader, APropertyListIsShownByItsKeys) {
    constexpr auto kKind = ListPart::Kind::Keys;
    EXPECT_EQ(partSamples(kKind, Dictionary{{"level", "high"}, {"other", "1"}, {"lac", "low"}}),
              (Texts{"10 LAC low", "11 Level high"}));
    EXPECT_EQ(partSamples(kKind, Dictionary{{"level", "high"}}), (Texts{"11 Level high"}));
    EXPECT_EQ(partSamples(kKind, Array{"lac"}), Texts());
    EXPECT_EQ(partSamples(kKind, std::nullopt), Texts());
}

TEST(LayoutReader, APropertyListIsShownElementByElement) {
    constexpr auto kKind = ListPart::Kind::Elements;
    EXPECT_EQ(partSamples(kKind, Array{"a", Dictionary{{"lac", "b"}}}),
              (Texts{"[ 2", "{0 0", "10 LAC a", "}", "{1 0", "10 LAC { lac = b; }", "}", "]"}));
    EXPECT_EQ(partSamples(kKind, Array()), (Texts{"[ 0", "]"}));
    EXPECT_EQ(partSamples(kKind, Dictionary{{"lac", "b"}}), Texts()) << "the list stays";
    EXPECT_EQ(partSamples(kKind, std::nullopt), Texts());
}

TEST(LayoutReader, TheFirstCellThatIsLookedForIsShown) {
    constexpr auto kKind = ListPart::Kind::FirstCell;
    EXPECT_EQ(partSamples(kKind, fourCells()),
              (Texts{"10 LAC 70000 raw 70000", "11 Level -1 raw -1"}))
        << "16 bits of the level are a signed number";
    EXPECT_EQ(partSamples(kKind, Array{"a", cellOf(kLte, kServing, 1, 1)}), Texts());
    EXPECT_EQ(partSamples(kKind, Dictionary{{"lac", "b"}}), Texts());
    EXPECT_EQ(partSamples(kKind, std::nullopt), Texts());
}

TEST(LayoutReader, EachCellThatIsLookedForIsShown) {
    constexpr auto kKind = ListPart::Kind::EachCell;
    EXPECT_EQ(partSamples(kKind, fourCells()),
              (Texts{"10 LAC 70000 raw 70000", "11 Level -1 raw -1", "10 LAC 4 raw 4",
                     "11 Level 32767 raw 32767"}));
    EXPECT_EQ(partSamples(kKind, std::nullopt), Texts());
}

TEST(LayoutReader, EachCellThatIsLookedForIsAnEntry) {
    constexpr auto kKind = ListPart::Kind::CellEntries;
    EXPECT_EQ(partSamples(kKind, fourCells()),
              (Texts{"[ 4", "{0 0", "10 LAC 70000 raw 70000", "11 Level -1 raw -1", "}", "{1 0",
                     "10 LAC 4 raw 4", "11 Level 32767 raw 32767", "}", "]"}));
    EXPECT_EQ(partSamples(kKind, Dictionary{{"lac", "b"}}), (Texts{"[ 0", "]"}));
    EXPECT_EQ(partSamples(kKind, std::nullopt), (Texts{"[ 0", "]"})) << "the list is emptied";
}

TEST(LayoutReader, ANumberThatACellDoesNotHaveIsLoggedWhereTheFieldSaysHow) {
    const doubles::RecordingLog log;
    Dictionary cell = cellOf(kGsm, kServing, 1, 2);
    cell.set("lac", "text");
    (void)cell.remove("level");
    EXPECT_EQ(partSamples(ListPart::Kind::FirstCell, Array{cell}), Texts());
    EXPECT_EQ(log.lines(), (std::vector<doubles::RecordingLog::Line>{{3, "no LAC"}}));
}

} // namespace
} // namespace pallax
