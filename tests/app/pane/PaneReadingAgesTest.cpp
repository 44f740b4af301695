#include "app/pane/PaneModel.h"
#include "tests/app/pane/PaneNodes.h"

#include <gtest/gtest.h>

#include <map>

namespace pallax {
namespace {

using namespace std::chrono_literals;
using namespace doubles; // NOLINT: the vocabulary of these tests
using Names = std::vector<std::string>;

class PaneReadingAgesTest : public testing::Test {
protected:
    ReadingAges known() {
        return [this](const std::string& path) -> std::optional<ReadingAge> {
            const auto found = ages.find(path);
            return found != ages.end() ? std::optional(found->second) : std::nullopt;
        };
    }

    std::map<std::string, ReadingAge> ages;
    PaneModel pane{sectionOf({"A", "B", "C"}), "/Section"};
};

TEST_F(PaneReadingAgesTest, ARowTellsItsAgeIfItIsOverdue) {
    ages = {{"/Section/A", {14s, true}}, {"/Section/B", {14s, false}}};
    EXPECT_EQ(pane.row(0).overdue, std::nullopt) << "the ages are unknown";
    pane.setAges(known());
    EXPECT_EQ(pane.row(0).overdue, 14s);
    EXPECT_EQ(pane.row(1).overdue, std::nullopt);
    EXPECT_EQ(pane.row(2).overdue, std::nullopt);
    ages["/Section/A"] = {0s, false};
    EXPECT_EQ(pane.row(0).overdue, std::nullopt) << "it is asked for each time";
}

TEST_F(PaneReadingAgesTest, APaneWithoutRowsSaysWhy) {
    pane.setAges(known());
    EXPECT_EQ(pane.emptyWords(), "") << "it has rows";
    pane.show(treeNode("Section", {}));
    EXPECT_EQ(pane.emptyWords(), "Never reported.");
    ages = {{"/Section", {180s, false}}};
    EXPECT_EQ(pane.emptyWords(), "Reported empty 3 min ago.");
    pane.setAges({});
    EXPECT_EQ(pane.emptyWords(), "") << "the ages are unknown";
    pane.setAges(known());
    pane.show(nullptr);
    EXPECT_EQ(pane.emptyWords(), "") << "there is no data";
}

TEST_F(PaneReadingAgesTest, AFilterThatHidesAllRowsIsNoReason) {
    pane.setAges(known());
    pane.setFilter("nothing like it");
    EXPECT_EQ(pane.emptyWords(), "");
}

TEST_F(PaneReadingAgesTest, ValuesThatAreGoneAreNamedForOneTick) {
    EXPECT_EQ(pane.gone(), Names{});
    pane.show(sectionOf({"C", "D"}));
    EXPECT_EQ(pane.gone(), (Names{"A", "B"}));
    pane.show(sectionOf({"C", "D"}));
    EXPECT_EQ(pane.gone(), Names{});
    pane.show(treeNode("Section", {}));
    EXPECT_EQ(pane.gone(), (Names{"C", "D"}));
    pane.show(nullptr);
    EXPECT_EQ(pane.gone(), Names{});
}

TEST_F(PaneReadingAgesTest, ElementsOfAListHaveNoNamesThatCouldBeGone) {
    pane.show(sectionOf({"0", "1", "2"}));
    EXPECT_EQ(pane.gone(), (Names{"A", "B", "C"}));
    pane.show(sectionOf({"0"}));
    EXPECT_EQ(pane.gone(), Names{});
}

} // namespace
} // namespace pallax
