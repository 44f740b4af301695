#include "app/table/ListTable.h"

#include "tests/app/pane/PaneNodes.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using namespace doubles; // NOLINT: the vocabulary of these tests

NodeRef nodeOf(const PropertyList& object) {
    PathDictionary paths;
    return PallaxModelNode::makeTreeFromObject(object, paths);
}

EntryPart noPart(const std::string& /*path*/) {
    return EntryPart::None;
}

/// Columns, then rows, with "|" between cells.
std::string textOf(const TableContent& table) {
    std::string text;
    for (const TableColumn& column : table.columns) {
        text += column.name + (column.unit.empty() ? "" : " in " + column.unit) +
                (column.isIdentity ? "!" : "") + "|";
    }
    for (const TableRow& row : table.rows) {
        text += "\n";
        for (const TableCell& cell : row.cells) {
            text += cell.text + (cell.number ? "#" : "") + (cell.opens ? ">" : "") + "|";
        }
    }
    return text;
}

std::string tableText(const PropertyList& list, const EntryPartAt& partAt = noPart) {
    return textOf(tableOf(*nodeOf(list), "/List", partAt));
}

TEST(ListTableTest, AListOfBranchesIsATable) {
    EXPECT_TRUE(isTable(*nodeOf(Array{Dictionary{{"A", "1"}}})));
    EXPECT_FALSE(isTable(*nodeOf(Array{})));
    EXPECT_FALSE(isTable(*nodeOf(Array{"1", "2"})));
    EXPECT_FALSE(isTable(*nodeOf(Array{Dictionary{{"A", "1"}}, "2"})));
    EXPECT_FALSE(isTable(*nodeOf(Array{Dictionary{}})));
    EXPECT_FALSE(isTable(*nodeOf(Dictionary{{"A", Dictionary{{"B", "1"}}}})));
    EXPECT_FALSE(isTable(*leafNode("A", "1")));
}

TEST(ListTableTest, AnEntryIsAsOldAsItsLatestValue) {
    using namespace std::chrono_literals;
    const NodeRef list = nodeOf(
        Array{Dictionary{{"A", "1"}, {"B", "2"}}, Dictionary{{"A", "3"}}, Dictionary{{"A", "4"}}});
    const LeafAgeAt ageAt = [](const std::string& path) -> std::optional<std::chrono::nanoseconds> {
        return path == "/List/0/A"   ? std::optional(200s)
               : path == "/List/0/B" ? std::optional(14s)
               : path == "/List/2/A" ? std::optional(180s)
                                     : std::nullopt;
    };
    TableContent table = tableOf(*list, "/List", noPart);
    addAges(table, agesOf(*list, "/List", ageAt));
    EXPECT_EQ(textOf(table), "A|B|age|\n1#|2#|14 s#|\n3#|||\n4#||3 min#|");
    EXPECT_TRUE(table.columns.back().isExtra);
    EXPECT_FALSE(table.columns.front().isExtra);
    TableContent unknown = tableOf(*list, "/List", noPart);
    addAges(unknown, agesOf(*list, "/List", [](const std::string&) { return std::nullopt; }));
    EXPECT_EQ(textOf(unknown), "A|B|\n1#|2#|\n3#||\n4#||");
}

TEST(ListTableTest, AColumnForEachFieldInTheOrderOfTheDisplay) {
    EXPECT_EQ(tableText(Array{Dictionary{{"A", "x"}, {"C", "y"}},
                              Dictionary{{"A", "1"}, {"B", "2"}, {"C", "z"}, {"D", "4"}},
                              Dictionary{{"0", "first"}}}),
              "0|A|B|C|D|\n"
              "|x||y||\n"
              "|1#|2#|z|4#|\n"
              "first|||||");
}

TEST(ListTableTest, TheUnitOfAllNumbersGoesToTheColumn) {
    static constexpr NumberFormat kShare{"%.1f%%"};
    EXPECT_EQ(
        tableText(Array{Dictionary{{"Level", dbm(-94)}, {"Share", DisplayNumber(12.34, kShare)}},
                        Dictionary{{"Level", "unknown"}, {"Share", "7%"}},
                        Dictionary{{"Level", "-101.5 dBm"}, {"Share", ""}}}),
        "Level in dBm|Share in %|\n"
        "-94#|12.3#|\n"
        "unknown|7#|\n"
        "-101.5#||");
    EXPECT_EQ(tableText(Array{Dictionary{{"Level", "-94 dBm"}}, Dictionary{{"Level", "3 dB"}},
                              Dictionary{{"Level", "5"}}}),
              "Level|\n-94 dBm#|\n3 dB#|\n5#|")
        << "several units stay in the cells";
}

TEST(ListTableTest, ABranchIsItsNumberOfElements) {
    EXPECT_EQ(tableText(Array{Dictionary{{"A", "1"}, {"SIR", Array{"31", "33"}}}}),
              "A|SIR|\n1#|2>|");
}

TEST(ListTableTest, IdentityComesFirstAndIsTheKey) {
    std::vector<std::string> asked;
    const EntryPartAt partAt = [&asked](const std::string& path) {
        asked.push_back(path);
        return path == "/Outer/*/List/*/PCI"      ? EntryPart::Cell
               : path == "/Outer/*/List/*/EARFCN" ? EntryPart::Identity
                                                  : EntryPart::None;
    };
    const PropertyList list =
        Array{Dictionary{{"RSRP", "-90"}, {"PCI", "12"}, {"EARFCN", "1850"}, {"More", Array{"1"}}}};
    const TableContent table = tableOf(*nodeOf(list), "/Outer/3/List", partAt);
    EXPECT_EQ(textOf(table), "PCI!|EARFCN!|RSRP|More|\n12#|1850#|-90#|1>|");
    EXPECT_EQ(table.rows.front().key, "12\n1850\n");
    EXPECT_EQ(table.many, "cells");
    EXPECT_EQ(asked, (std::vector<std::string>{"/Outer/*/List/*/RSRP", "/Outer/*/List/*/PCI",
                                               "/Outer/*/List/*/EARFCN"}));
}

TEST(ListTableTest, WithoutIdentityTheKeyIsThePlace) {
    const TableContent table =
        tableOf(*nodeOf(Array{Dictionary{{"A", "1"}}, Dictionary{{"A", "1"}}}), "/", noPart);
    EXPECT_EQ(table.rows[0].key, "0");
    EXPECT_EQ(table.rows[1].key, "1");
    EXPECT_EQ(table.one, "entry");
    EXPECT_EQ(table.many, "entries");
}

} // namespace
} // namespace pallax
