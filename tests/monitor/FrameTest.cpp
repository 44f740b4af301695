#include "monitor/Frame.h"

#include "LogGenerator/SectionAges.h"
#include "plist/PropertyList.h"
#include "tests/doubles/Property.h"

#include <gtest/gtest.h>
#include <rapidcheck.h>

#include <algorithm>
#include <map>
#include <stdexcept>

namespace pallax {
namespace {

using std::chrono::seconds;
using Paths = std::vector<std::string>;

constexpr Time kFirstTick{seconds(1700000000)};

class FrameTest : public testing::Test {
protected:
    static Frame::Picture pictureOf(const PropertyList& display, Time time) {
        const auto paths = std::make_shared<PathDictionary>();
        NodeRef root = PallaxModelNode::makeTreeFromObject(display, *paths);
        return {std::move(root), paths, time};
    }
    /// The next frame, `second` seconds after the first tick.
    void show(const PropertyList& display, int second) {
        frame = std::make_shared<Frame>(pictureOf(display, kFirstTick + seconds(second)),
                                        frame.get(), hasAges ? &ages : nullptr);
    }
    const Frame::Stamp& stamp(const std::string& path) const {
        return frame->stamp(*frame->nodeAtPath(path));
    }
    /// The time of the value's first frame, in seconds after the first tick.
    std::int64_t since(const std::string& path) const {
        return std::chrono::duration_cast<seconds>(stamp(path).since - kFirstTick).count();
    }
    std::int64_t age(const std::string& path) const {
        return std::chrono::duration_cast<seconds>(frame->age(*frame->nodeAtPath(path))).count();
    }

    SectionAges ages;
    bool hasAges = false;
    FrameRef frame;
};

TEST_F(FrameTest, TheFirstFrameMarksNothingAsChanged) {
    show(Dictionary{{"A", "1"}, {"B", Dictionary{{"C", "2"}}}}, 0);
    EXPECT_EQ(frame->number(), 1U);
    EXPECT_EQ(frame->time(), kFirstTick);
    EXPECT_EQ(frame->changed(), Paths{});
    EXPECT_EQ(frame->gone(), Paths{});
    for (const char* path : {"/", "/A", "/B", "/B/C"}) {
        EXPECT_FALSE(stamp(path).isChanged) << path;
        EXPECT_EQ(since(path), 0) << path;
        EXPECT_EQ(stamp(path).read, std::nullopt) << path;
    }
    EXPECT_EQ(frame->nodeAtPath("/B/C")->value()->string(), "2");
    EXPECT_EQ(frame->nodeAtPath("/C"), nullptr);
}

TEST_F(FrameTest, AValueThatChangesIsMarkedWithTheBranchesAboveIt) {
    show(Dictionary{{"A", "1"}, {"B", Dictionary{{"C", "2"}, {"D", "3"}}}}, 0);
    show(Dictionary{{"A", "1"}, {"B", Dictionary{{"C", "4"}, {"D", "3"}}}}, 2);
    EXPECT_EQ(frame->number(), 2U);
    EXPECT_EQ(frame->changed(), Paths{"/B/C"});
    EXPECT_TRUE(stamp("/").isChanged && stamp("/B").isChanged && stamp("/B/C").isChanged);
    EXPECT_FALSE(stamp("/A").isChanged || stamp("/B/D").isChanged);
    show(Dictionary{{"A", "1"}, {"B", Dictionary{{"C", "4"}, {"D", "3"}}}}, 4);
    EXPECT_EQ(frame->changed(), Paths{});
    EXPECT_FALSE(stamp("/B").isChanged);
    EXPECT_EQ(since("/B/C"), 2) << "the time of the change, not of the latest frame";
    EXPECT_EQ(since("/B"), 2);
    EXPECT_EQ(since("/"), 2);
    EXPECT_EQ(since("/B/D"), 0);
    EXPECT_EQ(age("/B/C"), 2);
    EXPECT_EQ(age("/A"), 4);
}

TEST_F(FrameTest, ValuesAreComparedByTheirTexts) {
    static constexpr NumberFormat kDbm{"%d dBm"};
    show(Dictionary{{"A", DisplayNumber(std::int64_t{-90}, kDbm)}}, 0);
    show(Dictionary{{"A", "-90 dBm"}}, 2);
    EXPECT_EQ(frame->changed(), Paths{});
    show(Dictionary{{"A", DisplayNumber(std::int64_t{-91}, kDbm)}}, 4);
    EXPECT_EQ(frame->changed(), Paths{"/A"});
}

TEST_F(FrameTest, NewNodesAreChangedAndVanishedOnesAreListedWithoutThoseBelow) {
    show(Dictionary{{"A", Dictionary{{"B", "1"}, {"C", "2"}}}, {"D", "3"}}, 0);
    show(Dictionary{{"E", Dictionary{{"F", "4"}}}, {"D", "3"}}, 2);
    EXPECT_EQ(frame->changed(), Paths{"/E/F"});
    EXPECT_EQ(frame->gone(), Paths{"/A"});
    EXPECT_TRUE(stamp("/E").isChanged);
    EXPECT_FALSE(stamp("/D").isChanged) << "moved, with the same name";
    show(Dictionary{{"E", Dictionary{}}, {"D", "3"}}, 4);
    EXPECT_EQ(frame->gone(), Paths{"/E/F"});
    EXPECT_TRUE(stamp("/E").isChanged) << "it has fewer nodes below";
    EXPECT_EQ(since("/E"), 4);
}

TEST_F(FrameTest, ALeafThatBecomesABranchAndBackIsANewOne) {
    show(Dictionary{{"A", "1"}}, 0);
    show(Dictionary{{"A", Dictionary{{"B", "1"}}}}, 2);
    EXPECT_EQ(frame->changed(), Paths{"/A/B"});
    EXPECT_EQ(frame->gone(), Paths{});
    EXPECT_EQ(since("/A"), 2);
    show(Dictionary{{"A", "1"}}, 4);
    EXPECT_EQ(frame->changed(), Paths{"/A"});
    EXPECT_EQ(frame->gone(), Paths{"/A/B"});
}

TEST_F(FrameTest, RowsOfOneNameAreComparedInTheirOrder) {
    const auto named = [](const char* first, const char* second) {
        return Dictionary{{"_sorted", "1"}, {"1;Cell", first}, {"2;Cell", second}};
    };
    show(named("a", "b"), 0);
    show(named("a", "c"), 2);
    EXPECT_EQ(frame->changed(), Paths{"/Cell"});
    const auto& rows = *frame->root()->childNodes();
    EXPECT_FALSE(frame->stamp(*rows[0]).isChanged);
    EXPECT_TRUE(frame->stamp(*rows[1]).isChanged);
    show(Dictionary{{"_sorted", "1"}, {"0;New", ""}, {"1;Cell", "a"}, {"2;Cell", "c"}}, 4);
    EXPECT_EQ(frame->changed(), Paths{"/New"}) << "the others have only moved down";
    show(Dictionary{{"_sorted", "1"}, {"1;Cell", "a"}}, 6);
    EXPECT_EQ(frame->gone(), (Paths{"/New", "/Cell"}));
    show(Dictionary{{"_sorted", "1"}, {"1;Cell", "a"}, {"2;New", ""}, {"3;Cell", "c"}}, 8);
    show(Dictionary{{"_sorted", "1"}, {"1;Cell", "a"}, {"3;Cell", "c"}}, 10);
    EXPECT_EQ(frame->changed(), Paths{}) << "not compared with the first of that name";
    EXPECT_EQ(frame->gone(), Paths{"/New"});
}

TEST_F(FrameTest, ListsAreComparedByPosition) {
    show(Dictionary{{"List", Array{"a", "b"}}}, 0);
    show(Dictionary{{"List", Array{"b", "b", "c"}}}, 2);
    EXPECT_EQ(frame->changed(), (Paths{"/List/0", "/List/2"}));
    show(Dictionary{{"List", Array{}}}, 4);
    EXPECT_EQ(frame->gone(), (Paths{"/List/0", "/List/1", "/List/2"}));
}

TEST_F(FrameTest, WithoutADisplayThereIsAnEmptyFrame) {
    show(PropertyList(), 0);
    EXPECT_EQ(frame->root(), nullptr);
    EXPECT_EQ(frame->nodeAtPath("/"), nullptr);
    show(Dictionary{{"A", "1"}}, 2);
    EXPECT_EQ(frame->changed(), Paths{"/A"});
    show(PropertyList(), 4);
    EXPECT_EQ(frame->gone(), Paths{"/"});
    frame = std::make_shared<Frame>(Frame::Picture{}, frame.get(), nullptr);
    EXPECT_EQ(frame->nodeAtPath("/"), nullptr);
    EXPECT_EQ(frame->gone(), Paths{});
}

TEST_F(FrameTest, AValueIsAsOldAsItsLatestReading) {
    hasAges = true;
    ages.note("/A", kFirstTick + seconds(1));
    show(Dictionary{{"A", Dictionary{{"B", "1"}}}, {"C", Dictionary{{"D", "2"}}}}, 2);
    EXPECT_EQ(age("/A/B"), 1) << "the section's age";
    EXPECT_EQ(age("/A"), 1);
    EXPECT_EQ(age("/"), 1) << "the latest age below";
    EXPECT_EQ(stamp("/C/D").read, std::nullopt);
    EXPECT_EQ(age("/C/D"), 0) << "the age of the change";
    ages.note("/A", kFirstTick + seconds(9));
    ages.note("/A/B", kFirstTick + seconds(4));
    show(Dictionary{{"A", Dictionary{{"B", "1"}}}, {"C", Dictionary{{"D", "2"}}}}, 10);
    EXPECT_EQ(frame->changed(), Paths{});
    EXPECT_EQ(age("/A/B"), 6) << "its own time";
    EXPECT_EQ(age("/A"), 1);
    EXPECT_EQ(since("/A/B"), 2);
    EXPECT_EQ(age("/C/D"), 8);
}

TEST_F(FrameTest, AFrameKeepsTheAgesThatItWasMadeWith) {
    hasAges = true;
    ages.note("/", kFirstTick);
    show(Dictionary{{"A", "1"}}, 3);
    ages = {};
    EXPECT_EQ(age("/A"), 3);
}

TEST_F(FrameTest, AfterAStepBackOfTheClockNothingIsYoungerThanNow) {
    show(Dictionary{{"A", "1"}}, 100);
    show(Dictionary{{"A", "1"}}, 0);
    EXPECT_EQ(age("/A"), 0);
}

TEST_F(FrameTest, ANodeOfAnotherFrameHasNoStamp) {
    show(Dictionary{{"A", "1"}}, 0);
    const FrameRef first = frame;
    show(Dictionary{{"A", "1"}}, 2);
    EXPECT_THROW((void)frame->stamp(*first->root()), std::out_of_range);
}

TEST_F(FrameTest, SharesNoContainerWithTheDisplay) {
    const auto section = std::make_shared<Dictionary>(Dictionary{{"A", "1"}});
    const auto list = std::make_shared<Array>(Array{"a", Dictionary{{"B", "b"}}});
    const auto display =
        std::make_shared<Dictionary>(Dictionary{{"Section", section}, {"List", list}});
    show(display, 0);
    EXPECT_EQ(section.use_count(), 2) << "owned by the display and the test";
    EXPECT_EQ(list.use_count(), 2);
    EXPECT_EQ(display.use_count(), 1);
    section->set("A", "2");
    list->clear();
    EXPECT_EQ(frame->nodeAtPath("/Section/A")->value()->string(), "1");
    EXPECT_EQ(frame->nodeAtPath("/List/1/B")->value()->string(), "b");
}

/// A display of few names and texts, so that two displays have much in common.
PropertyList anyDisplay(int depth) {
    using doubles::any::between;
    const int kind = depth == 0 ? 0 : between(0, 5);
    if (kind == 0) {
        return std::to_string(between(0, 3));
    }
    if (kind == 1) {
        Array elements;
        for (int left = between(0, 4); left > 0; --left) {
            elements.push_back(anyDisplay(depth - 1));
        }
        return elements;
    }
    Dictionary entries;
    for (int left = between(0, 6); left > 0; --left) {
        entries.set(Text(std::string(1, static_cast<char>('A' + between(0, 6)))),
                    anyDisplay(depth - 1));
    }
    return entries;
}

/// Each leaf's path with its text, and each branch's path with nothing.
using Shown = std::map<std::string, std::optional<std::string>>;

void collect(const PallaxModelNode& node, const std::string& path, Shown& shown) {
    const auto* children = node.childNodes();
    shown[path] = children == nullptr ? node.value()->string() : std::nullopt;
    for (std::size_t at = 0; children != nullptr && at < children->size(); ++at) {
        collect(*(*children)[at], childPath(path, (*children)[at]->displayName()), shown);
    }
}

TEST_F(FrameTest, TellsWhatComparingAllPathsTells) {
    EXPECT_TRUE(doubles::holds([this] {
        frame.reset();
        Shown before;
        for (int tick = 0; tick < 5; ++tick) {
            show(anyDisplay(3), tick);
            Shown now;
            collect(*frame->root(), "/", now);
            Paths changed;
            for (const auto& [path, text] : now) {
                const auto former = before.find(path);
                const bool isSame = former != before.end() && former->second == text;
                if (tick > 0 && text && !isSame) {
                    changed.push_back(path);
                }
                RC_ASSERT(stamp(path).isChanged || !text || isSame || tick == 0);
            }
            Paths told = frame->changed();
            std::sort(told.begin(), told.end());
            RC_ASSERT(told == changed);
            for (const auto& each : before) {
                const std::string& path = each.first;
                const bool isTold = std::any_of(
                    frame->gone().begin(), frame->gone().end(), [&path](const auto& gone) {
                        return path == gone || path.starts_with(gone + "/");
                    });
                RC_ASSERT(isTold == !now.contains(path));
            }
            before = std::move(now);
        }
    }));
}

} // namespace
} // namespace pallax
