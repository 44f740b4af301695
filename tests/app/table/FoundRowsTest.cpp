#include "app/table/FoundRows.h"

#include "plist/PropertyList.h"

#include <gtest/gtest.h>

#include <string>

namespace pallax {
namespace {

NodeRef displayTree() {
    PathDictionary paths;
    return PallaxModelNode::makeTreeFromObject(
        Dictionary{{"Serving Cell", Dictionary{{"RSRP", "-94.75 dBm"}, {"State", "Camped"}}},
                   {"Cells", Array{Dictionary{{"PCI", "275"}, {"RSRP", "-101.00 dBm"}},
                                   Dictionary{{"PCI", "276"}, {"RSRP", "-99.00 dBm"}}}},
                   {"Areas", Array{"12", "275"}}},
        paths);
}

EntryPart partAt(const std::string& path) {
    return path == "/Cells/*/PCI" ? EntryPart::Cell : EntryPart::None;
}

/// "0.1 name = value in where" for each.
std::string found(std::string_view text, std::size_t most = 100) {
    std::string lines;
    for (const FoundRow& row : findRows(*displayTree(), text, partAt, most)) {
        for (const std::size_t place : row.place) {
            lines += std::to_string(place) + ".";
        }
        lines += " " + row.name + " = " + row.value + " in " + row.where + "\n";
    }
    return lines;
}

TEST(FoundRowsTest, NamesAreFoundInAnyCaseWithTheirEntries) {
    // The dictionary's order is that of the display.
    const std::string rsrp = found("rsrp");
    EXPECT_NE(rsrp.find(" RSRP = -94.75 dBm in Serving Cell\n"), std::string::npos) << rsrp;
    EXPECT_NE(rsrp.find(".0.1. RSRP = -101.00 dBm in Cells, PCI 275\n"), std::string::npos) << rsrp;
    EXPECT_NE(rsrp.find(".1.1. RSRP = -99.00 dBm in Cells, PCI 276\n"), std::string::npos) << rsrp;
    EXPECT_EQ(rsrp, found("RsRP"));
}

TEST(FoundRowsTest, ValuesAndSectionsAreFound) {
    const std::string values = found("275");
    EXPECT_NE(values.find(" PCI = 275 in Cells, PCI 275\n"), std::string::npos) << values;
    EXPECT_NE(values.find(" 1 = 275 in Areas\n"), std::string::npos) << values;
    const std::string sections = found("serving");
    EXPECT_NE(sections.find(" Serving Cell =  in \n"), std::string::npos) << sections;
    EXPECT_EQ(sections.find("RSRP"), std::string::npos) << "the rows of a section have own names";
}

TEST(FoundRowsTest, TheNumbersOfElementsAreNoNames) {
    EXPECT_EQ(found("0.1"), "");
    const std::string ones = found("1");
    EXPECT_EQ(ones.find(" 1 = 275"), std::string::npos) << ones;
    EXPECT_NE(ones.find(" 0 = 12 in Areas"), std::string::npos) << ones;
}

TEST(FoundRowsTest, NothingIsFoundForNoTextAndNoMoreThanWanted) {
    EXPECT_EQ(found(""), "");
    EXPECT_EQ(found("no such text"), "");
    EXPECT_EQ(findRows(*displayTree(), "s", partAt, 2).size(), 2U);
    EXPECT_TRUE(
        findRows(PallaxModelLeafNode("Only", PropertyList("a value")), "a", partAt, 9).empty());
}

} // namespace
} // namespace pallax
