#include "plist/DeepCopy.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

PropertyList picture() {
    return Dictionary{{"Cell", Dictionary{{"ARFCN", "62"}, {"Band", "900"}}},
                      {"List", Array{Dictionary{{"A", "1"}}, "plain"}},
                      {"Text", "shown"}};
}

TEST(DeepCopy, IsEqualAndSharesNoContainer) {
    const PropertyList original = picture();
    const PropertyList copy = deepCopy(original);
    EXPECT_EQ(copy, original);
    original.dictionary()->find("Cell")->dictionary()->set("ARFCN", "71");
    original.dictionary()->find("List")->array()->front().dictionary()->set("A", "2");
    EXPECT_EQ(copy, picture());
}

TEST(DeepCopy, KeepsKeysThatAreNoStrings) {
    Dictionary entries;
    entries.appendForeignKey(PropertyList::integer(7), "seven");
    const PropertyList copy = deepCopy(entries);
    ASSERT_EQ(copy.dictionary()->size(), 1U);
    EXPECT_FALSE(copy.dictionary()->begin()->hasStringKey);
    EXPECT_EQ(copy.dictionary()->begin()->key.view(), "7");
}

TEST(DeepCopy, IntoAnotherObjectKeepsItsContainersAndTakesTheOrder) {
    const PropertyList target = Dictionary{
        {"Gone", "x"}, {"List", Array()}, {"Cell", Dictionary{{"Other", "1"}}}, {"Text", Array()}};
    const DictionaryRef cell = target.dictionary()->find("Cell")->dictionary();
    const ArrayRef list = target.dictionary()->find("List")->array();
    const PropertyList source = picture();
    copyInto(target, source);
    EXPECT_EQ(target, source);
    EXPECT_EQ(target.description(), source.description()) << "the order, too";
    EXPECT_EQ(target.dictionary()->find("Cell")->dictionary(), cell);
    EXPECT_EQ(target.dictionary()->find("List")->array(), list);
    source.dictionary()->find("List")->array()->front().dictionary()->set("A", "2");
    EXPECT_EQ(target, picture());
}

TEST(DeepCopy, IntoAnObjectOfAnotherKindDoesNothing) {
    const PropertyList target = Array{"x"};
    copyInto(target, picture());
    EXPECT_EQ(target, (PropertyList(Array{"x"})));
}

TEST(DeepCopy, TheSizeGrowsWithTheContent) {
    EXPECT_GT(memoryOf(picture()), memoryOf(Dictionary{{"Text", "shown"}}));
    EXPECT_GT(memoryOf(PropertyList(std::string(1000, 'x'))), 1000U);
}

} // namespace
} // namespace pallax
