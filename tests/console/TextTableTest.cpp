#include "console/TextTable.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

std::string textOf(const TextTable& table) {
    std::string text = "before";
    table.appendTo(text);
    return text;
}

TEST(TextTable, NumbersAreAlignedRightAndTextsLeft) {
    TextTable table;
    table.setHead({"Cell", "RSRP (dBm)", "Näme"});
    table.add({"7", "-98.25", "a"});
    table.add({"275", "", "öö"});
    table.add({"1e3"});
    EXPECT_EQ(textOf(table), "beforeCell  RSRP (dBm)  Näme\n"
                             "   7      -98.25  a\n"
                             " 275              öö\n"
                             " 1e3\n");
}

TEST(TextTable, ACellIsOneLineAndNoCommandToATerminal) {
    TextTable table;
    table.setHead({"A\x1B"});
    table.add({"one\ntwo\xFF"});
    EXPECT_EQ(textOf(table), "beforeA\\x1B\none\\x0Atwo\xEF\xBF\xBD\n");
}

TEST(TextTable, WithoutColumnsHasAnEmptyHead) {
    EXPECT_EQ(textOf(TextTable()), "before\n");
}

} // namespace
} // namespace pallax
