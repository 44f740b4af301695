#include "app/WayToRow.h"

#include "tests/app/PaneFixture.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace pallax {
namespace {

class WayToRowTest : public doubles::PaneFixture {
protected:
    WayToRowTest() {
        const PropertyList display = Dictionary{
            {"Serving", Dictionary{{"Level", "-80"}}},
            {"Cells", Array{Dictionary{{"PCI", "1"}}, Dictionary{{"PCI", "2"}, {"Level", "-90"}}}}};
        putOnStack(makePane(PallaxModelNode::makeTreeFromObject(display, paths)));
    }
    void go(const std::vector<std::size_t>& place) {
        openWay(*application.stack, place, [this](std::size_t row) { selected.push_back(row); });
    }
    /// Of the panes over the root.
    std::vector<std::string> titles() const {
        std::vector<std::string> all;
        const auto& screens = application.stack->screens();
        for (std::size_t index = 1; index < screens.size(); ++index) {
            all.push_back(screens[index]->title());
        }
        return all;
    }

    PathDictionary paths;
    std::vector<std::size_t> selected;
};

TEST_F(WayToRowTest, ThePanesOnTheWayAreOpened) {
    go({1, 1, 1});
    EXPECT_EQ(titles(), (std::vector<std::string>{"Cells", "1"}));
    EXPECT_EQ(selected, (std::vector<std::size_t>{1, 1, 1}));
}

TEST_F(WayToRowTest, PanesThatAreOpenStayAndOthersAreLeft) {
    go({1, 1, 1});
    const auto* const list = application.stack->screens()[1].get();
    selected.clear();
    go({1, 0, 0});
    EXPECT_EQ(titles(), (std::vector<std::string>{"Cells", "0"}));
    EXPECT_EQ(application.stack->screens()[1].get(), list);
    EXPECT_EQ(selected, (std::vector<std::size_t>{0, 0})) << "not in the root pane";
    go({0});
    EXPECT_TRUE(titles().empty());
    EXPECT_EQ(selected.back(), 0U);
}

TEST_F(WayToRowTest, ThePlaceOfARowLeadsToItAgain) {
    EXPECT_EQ(placeOf(*application.stack, 1), (std::vector<std::size_t>{1}));
    go({1, 1, 1});
    EXPECT_EQ(placeOf(*application.stack, 0), (std::vector<std::size_t>{1, 1, 0}));
}

} // namespace
} // namespace pallax
