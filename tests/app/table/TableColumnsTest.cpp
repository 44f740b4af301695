#include "app/table/TableColumns.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace pallax {
namespace {

TEST(TableColumns, OnlyNumbersAndWhatOpensAreFlushRight) {
    const TableContent table{{{"A"}, {"B"}, {"C"}, {"D"}},
                             {{"1", {{"7", 7.0}, {"7", 7.0}, {}, {"3", std::nullopt, true}}},
                              {"2", {{}, {"text"}, {}, {}}}}};
    EXPECT_TRUE(isFlushRight(table, 0));
    EXPECT_FALSE(isFlushRight(table, 1)) << "a text is among them";
    EXPECT_FALSE(isFlushRight(table, 2)) << "there is no value";
    EXPECT_TRUE(isFlushRight(table, 3));
}

TEST(TableColumns, AHeadingHasTheUnit) {
    EXPECT_EQ(headingOf({"RSRP", "dBm"}), "RSRP dBm");
    EXPECT_EQ(headingOf({"PCI"}), "PCI");
}

TEST(TableColumns, AHeadingIsAsNarrowAsTwoLinesCanBe) {
    const auto widthOf = [](std::string_view text) { return static_cast<int>(text.size()); };
    using Lines = std::vector<std::string>;
    EXPECT_EQ(narrowed("RSRP", widthOf), Lines{"RSRP"});
    EXPECT_EQ(narrowed("Measured RSRP dBm", widthOf), (Lines{"Measured", "RSRP dBm"}));
    EXPECT_EQ(narrowed("", widthOf), Lines{""});
}

class TableColumnKeys : public testing::Test {
protected:
    TableColumnKeys() { table.show({{{"A"}, {"B"}}, {{"1", {{"1", 1.0}, {"2", 2.0}}}}}); }
    TableModel table;
};

TEST_F(TableColumnKeys, ChooseReverseHideAndShow) {
    EXPECT_TRUE(handleColumnKey(table, U'>'));
    EXPECT_TRUE(handleColumnKey(table, U'>'));
    EXPECT_EQ(table.chosenColumn(), 1U);
    EXPECT_TRUE(handleColumnKey(table, U'<'));
    EXPECT_EQ(table.chosenColumn(), 0U);
    EXPECT_TRUE(handleColumnKey(table, U'r'));
    EXPECT_TRUE(table.isDescending());
    EXPECT_TRUE(handleColumnKey(table, U'x'));
    EXPECT_EQ(table.columns(), std::vector<std::size_t>{1});
    EXPECT_TRUE(handleColumnKey(table, U'X'));
    EXPECT_EQ(table.columns(), (std::vector<std::size_t>{0, 1}));
    EXPECT_FALSE(handleColumnKey(table, U'q'));
}

TEST_F(TableColumnKeys, APressOnAHeadingSortsAndTheNextOneReverses) {
    pressHeading(table, 1);
    EXPECT_EQ(table.chosenColumn(), 1U);
    EXPECT_FALSE(table.isDescending());
    pressHeading(table, 1);
    EXPECT_TRUE(table.isDescending());
    pressHeading(table, 0);
    EXPECT_EQ(table.chosenColumn(), 0U);
}

} // namespace
} // namespace pallax
