// The entries of a list serve the next one, unless somebody else holds them.

#include "LogGenerator/Records/Base.h"
#include "tests/doubles/InOrder.h"

#include <gtest/gtest.h>

#include <array>

namespace pallax {
namespace {

using doubles::sameInOrder;

constexpr auto kCellFields = std::to_array<Field>({
    {"First", u8At(0), Conversion::number()},
    {"Second", u8At(1), Conversion::number()},
});
constexpr auto kFirstField = std::to_array<Field>({kCellFields[0]});

class Cells : public Base {
public:
    std::string_view getSectionName() const override { return "Cells"; }

    void show(const ByteBuffer& bytes) {
        clearList();
        replaceList(EntryList(LogRecord(bytes), {0, 2, 2}, bytes.size() / 2),
                    [](Dictionary& cell, const LogRecord& entry) {
                        if (entry.u8(1) == 0) {
                            fillEntry(cell, kFirstField, entry);
                        } else {
                            fillEntry(cell, kCellFields, entry);
                        }
                    });
    }
};

class ListEntries : public testing::Test {
protected:
    ListEntries() { cells.updateSectionRef(list); }

    const Dictionary* entry(std::size_t index) const { return list->at(index).dictionary().get(); }

    ArrayRef list = std::make_shared<Array>();
    Cells cells;
};

TEST_F(ListEntries, ShowNothingOfTheListBefore) {
    cells.show({1, 2, 3, 4, 5, 6});
    cells.show({7, 0, 8, 9});
    EXPECT_EQ(*list,
              (Array{Dictionary{{"First", "7"}}, Dictionary{{"First", "8"}, {"Second", "9"}}}));
    cells.show({1, 2, 3, 0});
    EXPECT_EQ(*list,
              (Array{Dictionary{{"First", "1"}, {"Second", "2"}}, Dictionary{{"First", "3"}}}));
    EXPECT_TRUE(sameInOrder(*entry(0), Dictionary{{"First", "1"}, {"Second", "2"}}));
    cells.show({});
    EXPECT_TRUE(list->empty());
}

TEST_F(ListEntries, AreTheDictionariesOfTheListBefore) {
    cells.show({1, 2});
    const Dictionary* before = entry(0);
    cells.show({3, 4});
    EXPECT_EQ(entry(0), before);
}

TEST_F(ListEntries, ThatSomebodyHoldsStayAsTheyAre) {
    cells.show({1, 2, 3, 4});
    const Array held = *list;
    cells.show({5, 6, 7, 8});
    EXPECT_EQ(held, (Array{Dictionary{{"First", "1"}, {"Second", "2"}},
                           Dictionary{{"First", "3"}, {"Second", "4"}}}));
    EXPECT_EQ(*list, (Array{Dictionary{{"First", "5"}, {"Second", "6"}},
                            Dictionary{{"First", "7"}, {"Second", "8"}}}));
}

TEST_F(ListEntries, NeedASection) {
    Cells without;
    without.show({1, 2});
    EXPECT_TRUE(list->empty());
}

TEST(SharedPayload, IsParsedOnceForAllThatAskOfTheRecord) {
    ByteBuffer bytes(LogRecord::kHeaderLength);
    for (const char letter : std::string_view("( a, b )")) {
        bytes.push_back(static_cast<std::uint8_t>(letter));
    }
    SharedPayload shared;
    const LogRecord record(bytes, shared);
    EXPECT_FALSE(shared.list) << "nobody has asked yet";
    const auto first = record.payloadAsPropertyList();
    const auto second = record.payloadAsPropertyList();
    ASSERT_TRUE(first && second);
    EXPECT_EQ(*first, (Array{"a", "b"}));
    EXPECT_EQ(first->array(), second->array());
    EXPECT_NE(LogRecord(bytes).payloadAsPropertyList()->array(), first->array());
}

} // namespace
} // namespace pallax
