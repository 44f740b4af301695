#include "report/DisplayColumns.h"

#include "tests/doubles/Property.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <map>
#include <string>

namespace pallax {
namespace {

namespace any = doubles::any;

/// What is shown at a tick: "Cell/PCI = 182", a line each, in the order of the columns.
std::vector<std::string> shownAt(const DisplayColumns& columns, std::uint32_t tick) {
    std::vector<std::string> lines;
    for (const DisplayColumns::Column* column : columns.columns()) {
        std::uint32_t text = 0;
        for (const DisplayColumns::Change& change : column->changes) {
            text = change.tick <= tick ? change.text : text;
        }
        if (text != 0) {
            std::string line;
            for (const std::string& key : column->path) {
                line += (line.empty() ? "" : "/") + key;
            }
            lines.push_back(line + " = " + std::string(columns.texts()[text]));
        }
    }
    return lines;
}

TEST(DisplayColumns, ShowEachTickAsItWas) {
    DisplayColumns columns;
    columns.add(0, Dictionary{{"Cell", Dictionary{{"PCI", "182"}, {"Band", "3"}}}});
    columns.add(1, Dictionary{{"Cell", Dictionary{{"PCI", "183"}, {"TAC", "1"}, {"Band", "3"}}},
                              {"List", Array{Dictionary{{"PCI", "9"}}, Dictionary{{"PCI", "8"}}}}});
    columns.add(2, Dictionary{{"Cell", Dictionary{{"PCI", "183"}, {"Band", "3"}}},
                              {"List", Array{Dictionary{{"PCI", "8"}}}}});
    EXPECT_EQ(shownAt(columns, 0), (std::vector<std::string>{"Cell/PCI = 182", "Cell/Band = 3"}));
    EXPECT_EQ(shownAt(columns, 1),
              (std::vector<std::string>{"Cell/PCI = 183", "Cell/TAC = 1", "Cell/Band = 3",
                                        "List/0/PCI = 9", "List/1/PCI = 8"}));
    EXPECT_EQ(shownAt(columns, 2),
              (std::vector<std::string>{"Cell/PCI = 183", "Cell/Band = 3", "List/0/PCI = 8"}));
}

TEST(DisplayColumns, KeepAValueThatDoesNotChangeOnce) {
    DisplayColumns columns;
    for (std::uint32_t tick = 0; tick < 100; ++tick) {
        columns.add(tick, Dictionary{{"Cell", Dictionary{{"PCI", "182"}}}});
    }
    ASSERT_EQ(columns.columns().size(), 1U);
    EXPECT_EQ(columns.columns()[0]->changes.size(), 1U);
    EXPECT_EQ(columns.texts().size(), 2U) << "the first is none";
}

TEST(DisplayColumns, HaveTheRowsThatTheDisplayShows) {
    DisplayColumns columns;
    columns.add(
        0, Dictionary{
               {"Set",
                Dictionary{{"_sorted", "_sorted"}, {"1;48", "b"}, {"0;148", "a"}, {"2;48", "c"}}},
               {"Raw", PropertyList::data({0x01, 0xFF})},
               {"Count", PropertyList::integer(6)},
               {"Nothing", PropertyList()}});
    EXPECT_EQ(shownAt(columns, 0),
              (std::vector<std::string>{"Set/148 = a", "Set/48 = b", "Set/48 = c",
                                        "Raw = Af8=", "Count = 6"}));
}

TEST(DisplayColumns, AgreeWithAnyDisplays) {
    EXPECT_TRUE(doubles::holds([] {
        DisplayColumns columns;
        std::vector<std::map<std::string, std::string>> expected;
        const auto ticks = static_cast<std::uint32_t>(any::between(1, 12));
        for (std::uint32_t tick = 0; tick < ticks; ++tick) {
            Dictionary display;
            std::map<std::string, std::string> lines;
            for (const char* section : {"A", "B"}) {
                Dictionary inner;
                for (const char* key : {"x", "y", "z"}) {
                    const int value = any::between(0, 3);
                    if (value > 0) {
                        inner.set(std::string(key), std::to_string(value));
                        lines[std::string(section) + "/" + key] = std::to_string(value);
                    }
                }
                if (any::between(0, 3) > 0) {
                    display.set(std::string(section), std::move(inner));
                } else {
                    std::erase_if(
                        lines, [&](const auto& line) { return line.first.starts_with(section); });
                }
            }
            columns.add(tick, display);
            expected.push_back(std::move(lines));
        }
        for (std::uint32_t tick = 0; tick < ticks; ++tick) {
            std::map<std::string, std::string> shown;
            for (const std::string& line : shownAt(columns, tick)) {
                const std::size_t end = line.find(" = ");
                shown[line.substr(0, end)] = line.substr(end + 3);
            }
            RC_ASSERT(shown == expected[tick]);
        }
    }));
}

TEST(DisplayColumns, KeepsABoundedNumberOfPlaces) {
    DisplayColumns columns;
    std::size_t next = 0;
    for (std::uint32_t tick = 0; tick < 100; ++tick) {
        Dictionary display;
        for (int count = 0; count < 200; ++count) {
            display.set(std::to_string(next++), "x");
        }
        columns.add(tick, display);
        EXPECT_EQ(columns.isFull(), next >= DisplayColumns::kMostPlaces);
    }
    EXPECT_EQ(columns.columns().size(), DisplayColumns::kMostPlaces);
    columns.add(100, Dictionary{{"0", "y"}});
    const auto all = columns.columns();
    const auto known = std::find_if(all.begin(), all.end(), [](const auto* column) {
        return column->path == std::vector<std::string>{"0"};
    });
    ASSERT_NE(known, all.end());
    EXPECT_EQ(columns.texts()[(*known)->changes.back().text], "y") << "it goes on";
}

TEST(DisplayColumns, SaysWhatIsLeftOut) {
    DisplayColumns columns(
        [](const std::vector<std::string>& path) { return path.back() == "ICCID"; });
    columns.add(0, Dictionary{{"SIM", Dictionary{{"ICCID", "000"}, {"Slot", "000"}}}});
    columns.add(1, Dictionary{{"SIM", Dictionary{{"Slot", "000"}}}});
    ASSERT_EQ(columns.columns().size(), 2U);
    const auto& iccid = *columns.columns()[0];
    EXPECT_EQ(iccid.path, (std::vector<std::string>{"SIM", "ICCID"}));
    ASSERT_EQ(iccid.changes.size(), 2U);
    EXPECT_EQ(columns.texts()[iccid.changes[0].text], "left out");
    EXPECT_EQ(iccid.changes[1].text, 0U) << "nothing is shown there any more";
    EXPECT_EQ(columns.texts()[columns.columns()[1]->changes[0].text], "000");
}

TEST(DisplayColumns, ADisplayCanBeHadWithoutWhatIsLeftOut) {
    const auto isSecret = [](const std::vector<std::string>& path) {
        return path.back() == "ICCID" || path == std::vector<std::string>{"Contexts", "1", "PDP"};
    };
    const Dictionary display{
        {"SIM", Dictionary{{"_sorted", "yes"}, {"2;ICCID", "000"}, {"1;Slot", "000"}}},
        {"Contexts",
         Array{PropertyList(), Dictionary{{"PDP", "ims"}}, Dictionary{{"PDP", "web"}}}}};
    EXPECT_EQ(
        withLeftOut(display, isSecret),
        PropertyList(Dictionary{
            {"SIM", Dictionary{{"_sorted", "yes"}, {"2;ICCID", "left out"}, {"1;Slot", "000"}}},
            {"Contexts",
             Array{PropertyList(), Dictionary{{"PDP", "ims"}}, Dictionary{{"PDP", "left out"}}}}}));
}

} // namespace
} // namespace pallax
