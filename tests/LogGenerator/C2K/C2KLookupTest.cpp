#include "LogGenerator/C2K/C2KLookup.h"

#include "tests/doubles/RecordFixture.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

/// A place in the table.
PropertyList place(const PropertyList& key, const PropertyList& dict) {
    return Dictionary{{"key", key}, {"dict", dict}};
}

TEST(C2KLookup, PlacesOfANameAreKeptInOrder) {
    const auto first = std::make_shared<Dictionary>(Dictionary{{"first", ""}});
    const auto second = std::make_shared<Dictionary>(Dictionary{{"second", ""}});
    Dictionary lookup;
    addLookupPlace("kChannel", "Channel", first, lookup);
    addLookupPlace("kTxAGC", "Tx", first, lookup);
    addLookupPlace("kChannel", "Number", second, lookup);
    EXPECT_EQ(PropertyList(lookup),
              PropertyList(Dictionary{
                  {"kChannel", Array{place("Channel", *first), place("Number", *second)}},
                  {"kTxAGC", Array{place("Tx", *first)}}}));
    EXPECT_EQ(lookup.find("kChannel")->array()->at(1).dictionary()->find("dict")->dictionary(),
              second)
        << "the display dictionary itself";
}

TEST(C2KLookup, AValueIsStoredInEveryPlaceInPlaceOfTheFormerOne) {
    const auto display = std::make_shared<Dictionary>();
    const auto section = std::make_shared<Dictionary>();
    Dictionary lookup;
    addLookupPlace("kChannel", "Channel", display, lookup);
    addLookupPlace("kChannel", "Number", section, lookup);
    setLookupValue("kChannel", "283", lookup);
    EXPECT_EQ(PropertyList(display), PropertyList(Dictionary{{"Channel", "283"}}));
    EXPECT_EQ(PropertyList(section), PropertyList(Dictionary{{"Number", "283"}}));
    setLookupValue("kChannel", "25", lookup);
    EXPECT_EQ(PropertyList(display), PropertyList(Dictionary{{"Channel", "25"}}));
    EXPECT_EQ(PropertyList(section), PropertyList(Dictionary{{"Number", "25"}}));
}

TEST(C2KLookup, ANameWithoutPlacesDoesNothing) {
    const auto display = std::make_shared<Dictionary>();
    Dictionary lookup;
    addLookupPlace("kChannel", "Channel", display, lookup);
    lookup.set("kTxAGC", "no array");
    setLookupValue("kRxAGC0", "1", lookup);
    setLookupValue("kTxAGC", "1", lookup);
    EXPECT_TRUE(display->empty());
}

TEST(C2KLookup, APlaceThatIsNoneStopsAtOnceAndThoseBehindItKeepTheirValue) {
    const std::vector<PropertyList> broken = {
        "no dictionary",
        Dictionary(),
        Dictionary{{"key", "Channel"}},
        Dictionary{{"dict", Dictionary()}},
        place("Channel", "no dictionary"),
        place("Channel", Array()),
        place(PropertyList::integer(1), Dictionary()),
    };
    for (const PropertyList& each : broken) {
        const auto before = std::make_shared<Dictionary>();
        const auto behind = std::make_shared<Dictionary>();
        Dictionary lookup;
        addLookupPlace("kChannel", "Channel", before, lookup);
        lookup.find("kChannel")->array()->push_back(each);
        addLookupPlace("kChannel", "Channel", behind, lookup);
        setLookupValue("kChannel", "283", lookup);
        EXPECT_EQ(PropertyList(before), PropertyList(Dictionary{{"Channel", "283"}}));
        EXPECT_TRUE(behind->empty()) << each.description();
    }
}

} // namespace
} // namespace pallax
