#include "ui/drawing/HitMap.h"

#include <gtest/gtest.h>

#include <string>

namespace pallax::terminal {
namespace {

class HitMapTest : public testing::Test {
protected:
    void add(int x, int y, int columns, int rows, const char* name) {
        map.add(x, y, columns, rows, [this, name] { clicked = name; });
    }
    std::string at(int x, int y) {
        clicked = "nothing";
        if (const HitMap::Action action = map.at(x, y)) {
            action();
        }
        return clicked;
    }

    HitMap map;
    std::string clicked;
};

TEST_F(HitMapTest, AnEmptyMapHasNoAction) {
    EXPECT_EQ(at(0, 0), "nothing");
}

TEST_F(HitMapTest, AnAreaEndsBeforeItsExtent) {
    add(2, 3, 4, 2, "area");
    EXPECT_EQ(at(2, 3), "area");
    EXPECT_EQ(at(5, 4), "area");
    EXPECT_EQ(at(1, 3), "nothing");
    EXPECT_EQ(at(6, 3), "nothing");
    EXPECT_EQ(at(2, 2), "nothing");
    EXPECT_EQ(at(2, 5), "nothing");
    EXPECT_EQ(at(-1, -1), "nothing");
}

TEST_F(HitMapTest, ALaterAreaLiesOverAnEarlierOne) {
    add(0, 0, 10, 10, "below");
    add(4, 4, 2, 1, "above");
    EXPECT_EQ(at(4, 4), "above");
    EXPECT_EQ(at(6, 4), "below");
}

TEST_F(HitMapTest, ClearingForgetsAll) {
    add(0, 0, 10, 10, "area");
    map.clear();
    EXPECT_EQ(at(1, 1), "nothing");
}

TEST_F(HitMapTest, AnActionMayChangeTheMapThatItCameFrom) {
    map.add(0, 0, 1, 1, [this] {
        map.clear();
        clicked = "cleared";
    });
    EXPECT_EQ(at(0, 0), "cleared");
    EXPECT_EQ(at(0, 0), "nothing");
}

TEST_F(HitMapTest, ASliderGoesToThePlaceOfAColumnAndStopsAtItsEnds) {
    double place = -1.0;
    map.add(3, Slider{10, 5, [&place](double to) { place = to; }});
    EXPECT_FALSE(map.sliderAt(9, 3));
    EXPECT_FALSE(map.sliderAt(10, 4));
    map.at(11, 3)();
    EXPECT_EQ(place, 0.25);
    const auto slider = map.sliderAt(14, 3);
    ASSERT_TRUE(slider);
    slider->moveTo(14);
    EXPECT_EQ(place, 1.0);
    slider->moveTo(0);
    EXPECT_EQ(place, 0.0);
    slider->moveTo(100);
    EXPECT_EQ(place, 1.0);
}

TEST_F(HitMapTest, AnAreaOverASliderHidesIt) {
    map.add(3, Slider{0, 10, [](double) {}});
    add(0, 0, 10, 10, "above");
    EXPECT_FALSE(map.sliderAt(5, 3));
    EXPECT_EQ(at(5, 3), "above");
}

} // namespace
} // namespace pallax::terminal
