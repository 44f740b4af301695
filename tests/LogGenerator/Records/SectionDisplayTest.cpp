#include "LogGenerator/Records/SectionDisplay.h"

#include "tests/doubles/ArrayLockHolder.h"
#include "tests/doubles/InOrder.h"
#include "tests/doubles/RecordFixture.h"

#include <gtest/gtest.h>

#include <array>
#include <memory>

namespace pallax {
namespace {

int readings = 0;

/// Counts how often a record is read.
PropertyList firstByte(const Place& place) {
    ++readings;
    return DisplayNumber(std::int64_t{place.here.u8(0)}, kDecimal);
}
constexpr Computation kCounted{.name = "", .formula = "", .read = {}, .compute = firstByte};
constexpr Condition kSecondByteIsSet{u8At(1), 1, 255};
constexpr auto kTurnFields = std::to_array<Field>({
    computed("Turn", kCounted),
    Field{"Extra", u8At(1), Conversion::number()}.when(kSecondByteIsSet),
});
constexpr auto kOtherTurnFields = std::to_array<Field>({computed("Other turn", kCounted)});
constexpr CodeLayout kTurn{.logCode = 1, .fields = kTurnFields};
constexpr CodeLayout kOtherTurn{.logCode = 2, .fields = kOtherTurnFields};

constexpr Condition kFirstByteIsSet{u8At(0), 1, 255};
constexpr auto kAgentFields = std::to_array<Field>({
    Field{"Left", u8At(0), Conversion::number()}.when(kFirstByteIsSet),
    Field{"Right", u8At(1), Conversion::number()}.when(kSecondByteIsSet),
});
/// Entries of two bytes, each with a key for each byte that is not 0.
constexpr auto kAgentLists = std::to_array<ListLayout>({{
    .entries = {{.start = 1, .stride = 2, .bytesRead = 2}},
    .count = u8At(0),
    .fields = kAgentFields,
}});
constexpr CodeLayout kAgents{.logCode = 3, .lists = kAgentLists};

constexpr auto kPlainFields = std::to_array<Field>({{{}, u8At(0), Conversion::number()}});
constexpr auto kPlainLists = std::to_array<ListLayout>({{
    .key = "Numbers",
    .entries = {{.start = 1, .stride = 1, .bytesRead = 1}},
    .count = u8At(0),
    .fields = kPlainFields,
}});
constexpr CodeLayout kPlain{.logCode = 4, .lists = kPlainLists};

/// Entries with their number of numbers and those numbers.
constexpr auto kNestedLists = std::to_array<ListLayout>({{
    .key = "Groups",
    .entries = {{.start = 1, .stride = 4, .bytesRead = 4}},
    .count = u8At(0),
    .lists = kPlainLists,
}});
constexpr CodeLayout kNested{.logCode = 5, .lists = kNestedLists};

constexpr auto kRemovedKeys = std::to_array<std::string_view>({"Turn", "Not there"});
constexpr CodeLayout kRemoves{.logCode = 6, .removes = kRemovedKeys, .emptiesList = true};

class SectionDisplayTest : public testing::Test {
protected:
    void show(const CodeLayout& code, const ByteBuffer& bytes, unsigned shape = 0) {
        display.keep(code, 0, shape, {}, LogRecord(bytes));
    }
    void give(PropertyList object) {
        section = std::move(object);
        display.setSection(section);
        readings = 0;
    }
    Dictionary* entry(std::size_t index) const {
        return section.array()->at(index).dictionary().get();
    }

    RecordMemory memory;
    SectionDisplay display{memory};
    PropertyList section;
};

TEST_F(SectionDisplayTest, RecordsAreReadAtOnceUnlessTheyMayWait) {
    give(Dictionary());
    show(kTurn, {1});
    EXPECT_EQ(section, PropertyList(Dictionary{{"Turn", "1"}}));
    show(kTurn, {2});
    EXPECT_EQ(section, PropertyList(Dictionary{{"Turn", "2"}}));
    EXPECT_EQ(readings, 2);
    display.bringUpToDate();
    EXPECT_EQ(readings, 2);
}

TEST_F(SectionDisplayTest, OfRecordsThatMayWaitOnlyTheLatestIsReadAndOnce) {
    give(Dictionary());
    display.setLate(true);
    for (const std::uint8_t turn : std::array<std::uint8_t, 3>{1, 2, 3}) {
        show(kTurn, {turn});
    }
    EXPECT_EQ(section, PropertyList(Dictionary()));
    EXPECT_EQ(readings, 0);
    display.bringUpToDate();
    EXPECT_EQ(section, PropertyList(Dictionary{{"Turn", "3"}}));
    display.bringUpToDate();
    EXPECT_EQ(readings, 1);
}

TEST_F(SectionDisplayTest, ARecordOfAnotherCodeHasTheOneBeforeItReadFirst) {
    give(Dictionary());
    display.setLate(true);
    show(kTurn, {1});
    show(kOtherTurn, {2});
    EXPECT_EQ(section, PropertyList(Dictionary{{"Turn", "1"}}));
    show(kTurn, {3});
    EXPECT_EQ(section, PropertyList(Dictionary{{"Turn", "1"}, {"Other turn", "2"}}));
    display.bringUpToDate();
    EXPECT_EQ(section, PropertyList(Dictionary{{"Turn", "3"}, {"Other turn", "2"}}));
    EXPECT_EQ(readings, 3);
}

TEST_F(SectionDisplayTest, ARecordOfAnotherShapeHasTheOneBeforeItReadFirst) {
    give(Dictionary());
    display.setLate(true);
    show(kTurn, {1, 7}, 1);
    show(kTurn, {2, 8}, 1);
    show(kTurn, {3}, 0);
    EXPECT_EQ(section, PropertyList(Dictionary{{"Turn", "2"}, {"Extra", "8"}}));
    display.bringUpToDate();
    EXPECT_EQ(section, PropertyList(Dictionary{{"Turn", "3"}, {"Extra", "8"}}));
    EXPECT_EQ(readings, 2);
}

TEST_F(SectionDisplayTest, NothingIsWrittenWithoutASectionOrIntoOneOfTheWrongKind) {
    show(kTurn, {1});
    show(kAgents, {1, 5, 6});
    show(kPlain, {1, 5});
    show(kRemoves, {});
    give(Dictionary{{"Kept", "1"}});
    show(kAgents, {1, 5, 6});
    EXPECT_EQ(section, PropertyList(Dictionary{{"Kept", "1"}}));
    give(Array{"kept"});
    show(kTurn, {1});
    show(kPlain, {1, 5});
    EXPECT_EQ(section, PropertyList(Array{"kept"}));
    give("neither");
    show(kTurn, {1});
    show(kAgents, {1, 5, 6});
    EXPECT_EQ(section, PropertyList("neither"));
}

TEST_F(SectionDisplayTest, ANewSectionTakesThePlaceOfOneOfTheOtherKind) {
    const PropertyList list{Array{"kept"}};
    display.setSection(list);
    give(Dictionary());
    show(kAgents, {1, 5, 6});
    show(kTurn, {1});
    EXPECT_EQ(list, PropertyList(Array{"kept"}));
    EXPECT_EQ(section, PropertyList(Dictionary{{"Turn", "1"}}));
}

TEST_F(SectionDisplayTest, ACodeMayTakeAwayKeysAndEmptyTheList) {
    give(Dictionary{{"Turn", "1"}, {"Stays", "2"}});
    show(kRemoves, {});
    EXPECT_EQ(section, PropertyList(Dictionary{{"Stays", "2"}}));
    give(Array{"a", "b"});
    show(kRemoves, {});
    EXPECT_EQ(section, PropertyList(Array()));
}

TEST_F(SectionDisplayTest, AListSectionIsFilledInPlace) {
    give(Array{"before"});
    const Array* array = section.array().get();
    show(kAgents, {2, 1, 2, 3, 4});
    EXPECT_EQ(section, PropertyList(Array{Dictionary{{"Left", "1"}, {"Right", "2"}},
                                          Dictionary{{"Left", "3"}, {"Right", "4"}}}));
    show(kAgents, {0});
    EXPECT_EQ(section, PropertyList(Array()));
    EXPECT_EQ(section.array().get(), array);
}

TEST_F(SectionDisplayTest, TheListIsEmptiedUnderTheArrayLock) {
    give(Array{"before"});
    EXPECT_FALSE(doubles::finishesUnderHeldArrayLock(
        doubles::kExpectedToWait, [&] { display.beginList({}); },
        [&] { EXPECT_EQ(section, PropertyList(Array{"before"})); }));
    EXPECT_EQ(section, PropertyList(Array()));
    display.endList();
}

TEST_F(SectionDisplayTest, TheListIsFilledUnderTheArrayLock) {
    give(Array{"before"});
    const Sample sample{0, kPlainFields[0], 5, SampleValue::label("after")};
    display.beginList({});
    display.beginEntry(0, 0);
    display.sample(sample);
    display.endEntry();
    EXPECT_FALSE(doubles::finishesUnderHeldArrayLock(
        doubles::kExpectedToWait, [&] { display.endList(); },
        [&] { EXPECT_EQ(section, PropertyList(Array())); }));
    EXPECT_EQ(section, PropertyList(Array{"after"}));
}

TEST_F(SectionDisplayTest, AnEntryIsUsedAgain) {
    give(Array());
    show(kAgents, {1, 1, 2});
    const std::weak_ptr<Dictionary> before = section.array()->at(0).dictionary();
    show(kAgents, {1, 3, 4});
    EXPECT_EQ(before.lock().get(), entry(0));
    EXPECT_EQ(section, PropertyList(Array{Dictionary{{"Left", "3"}, {"Right", "4"}}}));
}

TEST_F(SectionDisplayTest, AnEntryIsFilledFromItsStartWhoeverFilledItBefore) {
    Dictionary other{{"Left", "1"}, {"Right", "2"}};
    other.setFixed("Left", "3"); // where the next key to be set would be "Right"
    Array entries;
    entries.emplace_back(std::move(other));
    give(std::move(entries));
    entry(0)->setFixed("Left", "4");
    show(kAgents, {1, 5, 6});
    EXPECT_TRUE(doubles::sameInOrder(*entry(0), {{"Left", "5"}, {"Right", "6"}}));
}

TEST_F(SectionDisplayTest, AnEntryThatIsHeldElsewhereStaysAsItIs) {
    give(Array());
    show(kAgents, {2, 1, 2, 3, 4});
    const PropertyList held = section.array()->at(1);
    const Dictionary* first = entry(0);
    show(kAgents, {2, 5, 6, 7, 8});
    EXPECT_EQ(held, PropertyList(Dictionary{{"Left", "3"}, {"Right", "4"}}));
    EXPECT_EQ(entry(0), first) << "the one that nobody else holds is used";
    EXPECT_EQ(section, PropertyList(Array{Dictionary{{"Left", "5"}, {"Right", "6"}},
                                          Dictionary{{"Left", "7"}, {"Right", "8"}}}));
}

TEST_F(SectionDisplayTest, AnEntryKeepsNoKeyOfTheOneBefore) {
    give(Array());
    const auto after = [&](std::uint8_t left, std::uint8_t right) {
        show(kAgents, {1, left, right});
        return *entry(0);
    };
    EXPECT_TRUE(doubles::sameInOrder(after(1, 2), {{"Left", "1"}, {"Right", "2"}}));
    EXPECT_TRUE(doubles::sameInOrder(after(3, 0), {{"Left", "3"}}));
    EXPECT_TRUE(doubles::sameInOrder(after(0, 4), {{"Right", "4"}}));
    EXPECT_TRUE(doubles::sameInOrder(after(5, 6), {{"Left", "5"}, {"Right", "6"}}));
    EXPECT_TRUE(doubles::sameInOrder(after(0, 0), {}));
}

TEST_F(SectionDisplayTest, APlainValueIsAnEntryItself) {
    give(Dictionary());
    show(kPlain, {3, 7, 8, 9});
    EXPECT_EQ(section, PropertyList(Dictionary{{"Numbers", Array{"7", "8", "9"}}}));
}

TEST_F(SectionDisplayTest, AListMayStandInAnEntry) {
    give(Dictionary());
    show(kNested, {2, 2, 5, 6, 0, 0, 0, 0, 0});
    EXPECT_EQ(section,
              PropertyList(Dictionary{{"Groups", Array{Dictionary{{"Numbers", Array{"5", "6"}}},
                                                       Dictionary{{"Numbers", Array()}}}}}));
}

TEST_F(SectionDisplayTest, AListUnderAKeyIsANewArrayEachTime) {
    give(Dictionary());
    show(kPlain, {1, 7});
    const PropertyList held = *section.dictionary()->find("Numbers");
    show(kPlain, {2, 8, 9});
    EXPECT_EQ(held, PropertyList(Array{"7"}));
    EXPECT_EQ(section, PropertyList(Dictionary{{"Numbers", Array{"8", "9"}}}));
}

} // namespace
} // namespace pallax
