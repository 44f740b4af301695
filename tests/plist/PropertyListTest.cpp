#include "plist/PropertyList.h"

#include "tests/doubles/InOrder.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using doubles::sameInOrder;

constexpr NumberFormat kShownDbm{"%d dBm"};

TEST(PropertyList, ADisplayNumberIsAStringToWhoeverReadsIt) {
    const PropertyList shown = DisplayNumber(std::int64_t{-80}, kShownDbm);
    EXPECT_TRUE(shown.isString());
    EXPECT_EQ(shown.string(), "-80 dBm");
    EXPECT_EQ(shown, PropertyList("-80 dBm"));
    EXPECT_EQ(shown.integer(), std::nullopt);
    EXPECT_EQ(shown.int32(), std::nullopt);
    EXPECT_EQ(shown.displayNumber()->unit(), "dBm");
}

TEST(PropertyList, A32BitNumberIsAnIntegerOrWholeRealInRange) {
    EXPECT_EQ(PropertyList::integer(2147483647).int32(), 2147483647);
    EXPECT_EQ(PropertyList::integer(2147483648).int32(), std::nullopt);
    EXPECT_EQ(PropertyList::integer(-2147483648).int32(), -2147483648);
    EXPECT_EQ(PropertyList::real(-40.0).int32(), -40);
    EXPECT_EQ(PropertyList::real(0.5).int32(), std::nullopt);
    EXPECT_EQ(PropertyList::real(1e300).int32(), std::nullopt);
    EXPECT_EQ(PropertyList("7").int32(), std::nullopt);
    EXPECT_EQ(PropertyList::boolean(true).int32(), std::nullopt);
    EXPECT_EQ(PropertyList().int32(), std::nullopt);
}

TEST(PropertyList, CopiesShareContainersAndShallowCopiesShareTheirElements) {
    const PropertyList section = Dictionary{{"ARFCN", "12"}};
    const PropertyList display = Dictionary{{"Serving", section}};
    const PropertyList copy = display.shallowCopy();
    display.dictionary()->set("New", "x");
    section.dictionary()->set("ARFCN", "13");
    EXPECT_FALSE(copy.dictionary()->contains("New"));
    EXPECT_EQ(copy, PropertyList(Dictionary{{"Serving", Dictionary{{"ARFCN", "13"}}}}));
}

TEST(PropertyList, TypesDiffer) {
    EXPECT_FALSE(PropertyList::integer(1) == PropertyList::real(1));
    EXPECT_FALSE(PropertyList("1") == PropertyList::integer(1));
    EXPECT_EQ(PropertyList::data({1, 2}), PropertyList::data({1, 2}));
    EXPECT_EQ(PropertyList::data({1}).typeName(), "data");
    EXPECT_EQ(PropertyList(Array{}).typeName(), "array");
}

TEST(PropertyList, DescriptionIsOneReadableLine) {
    const PropertyList object = Dictionary{
        {"State", "Idle"},
        {"List", Array{"a", PropertyList::integer(2), PropertyList::boolean(true)}},
        {"Empty", Array{}},
        {"Bytes", PropertyList::data({0x0F, 0xBD, 0x77})},
        {"Date", Date(std::chrono::seconds(1700000000))},
    };
    EXPECT_EQ(object.description(), "{ State = Idle; List = ( a, 2, true ); Empty = (); "
                                    "Bytes = <0fbd77>; Date = 2023-11-14 22:13:20 +0000; }");
}

TEST(Dictionary, KeepsTheOrderInWhichKeysWereFirstSet) {
    Dictionary entries{{"b", "1"}, {"a", "2"}};
    entries.set("b", "3");
    entries.set("c", "4");
    EXPECT_TRUE(sameInOrder(entries, Dictionary{{"b", "3"}, {"a", "2"}, {"c", "4"}}));
    EXPECT_FALSE(sameInOrder(entries, Dictionary{{"a", "2"}, {"b", "3"}, {"c", "4"}}));
    EXPECT_EQ(PropertyList(entries), PropertyList(Dictionary{{"a", "2"}, {"b", "3"}, {"c", "4"}}));
    EXPECT_TRUE(entries.remove("a"));
    EXPECT_FALSE(entries.remove("a"));
    EXPECT_TRUE(sameInOrder(entries, Dictionary{{"b", "3"}, {"c", "4"}}));
}

TEST(Dictionary, FindsKeysOnBothSidesOfTheIndexSize) {
    Dictionary entries;
    for (int count = 0; count < 100; ++count) {
        entries.set(std::to_string(count), std::to_string(count * 2));
        EXPECT_EQ(*entries.find("0"), PropertyList("0"));
        EXPECT_EQ(*entries.find(std::to_string(count)), PropertyList(std::to_string(count * 2)));
        EXPECT_EQ(entries.find("x"), nullptr);
    }
    while (!entries.empty()) {
        const std::string first = entries.begin()->key.string();
        EXPECT_TRUE(entries.remove(first));
        EXPECT_FALSE(entries.contains(first));
    }
}

TEST(Dictionary, AForeignKeyIsMetByAWalkOnly) {
    Dictionary entries;
    entries.appendForeignKey(PropertyList::integer(5), "five");
    entries.set("5", "text");
    ASSERT_EQ(entries.size(), 2U);
    EXPECT_FALSE(entries.begin()->hasStringKey);
    EXPECT_EQ(*entries.find("5"), PropertyList("text"));
}

} // namespace
} // namespace pallax
