#include "LogGenerator/C2K/LookupDisplay.h"

#include "LogGenerator/C2K/C2KLookup.h"
#include "tests/doubles/RecordBuilder.h"

#include <gtest/gtest.h>

#include <array>

namespace pallax {
namespace {

using doubles::Record;

constexpr auto kNumbers = std::to_array<Field>({{"kNumber", u8At(13), Conversion::number()}});
constexpr auto kLevel = std::to_array<Field>({{"", u8At(1), Conversion::number()}});

constexpr ListLayout pilotsUnder(std::string_view key, std::string_view ifEmpty) {
    return {.key = key,
            .entries = {{.start = 15, .stride = 2, .bytesRead = 2}},
            .count = u8At(14),
            .fields = kLevel,
            .entryName = u8At(0),
            .ifEmpty = ifEmpty};
}
constexpr auto kLists =
    std::to_array<ListLayout>({pilotsUnder("kPilots", {}), pilotsUnder("kPilotsOrNone", "(none)")});

/// Counts its packets in the state.
PropertyList packets(const Place& place) {
    Dictionary& state = *place.memory->state;
    const PropertyList* before = state.find("Packets");
    const std::int64_t count = (before != nullptr ? *before->integer() : 0) + 1;
    state.setFixed("Packets", PropertyList::integer(count));
    return DisplayNumber(count, kDecimal);
}
constexpr Computation kCount{
    .name = "count", .formula = "", .read = {}, .compute = packets, .isRunning = true};
constexpr auto kCounts = std::to_array<Field>({computed("kCount", kDecimal, kCount)});

constexpr CodeLayout kLate{.logCode = 1, .fields = kNumbers, .lists = kLists};
constexpr CodeLayout kRunning{.logCode = 2, .fields = kCounts};
constexpr auto kCodes = std::to_array<const CodeLayout*>({&kLate, &kRunning});

class LookupDisplayTest : public testing::Test {
protected:
    LookupDisplayTest() {
        for (const char* name : {"kNumber", "kPilots", "kPilotsOrNone", "kCount"}) {
            addLookupPlace(name, name, shown, *lookup);
        }
    }

    void take(std::size_t code, const Record& record) {
        const ByteBuffer bytes = record.bytes();
        display.take(code, LogRecord(bytes), lookup, state);
    }
    PropertyList value(std::string_view name) const {
        const PropertyList* found = shown->find(name);
        return found != nullptr ? *found : PropertyList();
    }

    DictionaryRef shown = std::make_shared<Dictionary>();
    DictionaryRef lookup = std::make_shared<Dictionary>();
    Dictionary state;
    LookupDisplay display{kCodes};
};

TEST_F(LookupDisplayTest, OfPacketsThatMayWaitTheLatestIsReadWhenTheDisplayIsNeeded) {
    take(0, Record(1).u8(5).u8(0));
    take(0, Record(1).u8(6).u8(0));
    EXPECT_TRUE(shown->empty());
    display.bringUpToDate();
    EXPECT_EQ(value("kNumber"), PropertyList("6"));
    shown->set("kNumber", "not again");
    display.bringUpToDate();
    EXPECT_EQ(value("kNumber"), PropertyList("not again"));
}

TEST_F(LookupDisplayTest, APacketThatKeepsRunningValuesIsReadAtOnce) {
    take(1, Record(2));
    take(1, Record(2));
    EXPECT_EQ(value("kCount"), PropertyList("2"));
    EXPECT_EQ(*state.find("Packets"), PropertyList::integer(2));
}

TEST_F(LookupDisplayTest, RunningValuesAreKeptWithoutALookupTable) {
    lookup = nullptr;
    take(0, Record(1).u8(5).u8(1).u8(4).u8(9));
    take(1, Record(2));
    display.bringUpToDate();
    EXPECT_EQ(*state.find("Packets"), PropertyList::integer(1));
}

TEST_F(LookupDisplayTest, AnotherLookupTableHasOtherPlaces) {
    take(1, Record(2));
    const auto another = std::make_shared<Dictionary>();
    lookup = std::make_shared<Dictionary>();
    addLookupPlace("kCount", "Count", another, *lookup);
    take(1, Record(2));
    EXPECT_EQ(value("kCount"), PropertyList("1"));
    EXPECT_EQ(PropertyList(another), PropertyList(Dictionary{{"Count", "2"}}));
}

TEST_F(LookupDisplayTest, AListByPilotIsSharedBetweenItsPlaces) {
    const auto section = std::make_shared<Dictionary>();
    addLookupPlace("kPilots", "Once more", section, *lookup);
    take(0, Record(1).u8(5).u8(2).u8(168).u8(1).u8(4).u8(2));
    display.bringUpToDate();
    const PropertyList list = Dictionary{{"_sorted", "_sorted"}, {"0;168", "1"}, {"1;4", "2"}};
    EXPECT_EQ(value("kPilots"), list);
    EXPECT_EQ(value("kPilotsOrNone"), list);
    EXPECT_EQ(section->find("Once more")->dictionary(), value("kPilots").dictionary());
}

TEST_F(LookupDisplayTest, AListWithoutEntryShowsItsTextOrNothingButItsMark) {
    take(0, Record(1).u8(5).u8(0));
    display.bringUpToDate();
    EXPECT_EQ(value("kPilots"), PropertyList(Dictionary{{"_sorted", "_sorted"}}));
    EXPECT_EQ(value("kPilotsOrNone"), PropertyList("(none)"));
}

} // namespace
} // namespace pallax
