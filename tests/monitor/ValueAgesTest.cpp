#include "monitor/ValueAges.h"

#include "LogGenerator/SectionAges.h"

#include <gtest/gtest.h>

#include <map>

namespace pallax {
namespace {

using namespace std::chrono_literals;

constexpr Time kAgesStart{std::chrono::hours(480000)};

class ValueAgesTest : public testing::Test {
protected:
    void take(const std::map<std::string, std::chrono::seconds>& read) {
        SectionAges section;
        for (const auto& [path, time] : read) {
            section.note(path, kAgesStart + time);
        }
        ages.take(section);
    }
    std::optional<Time> lastOf(std::string_view path) const {
        const Arrivals* arrivals = ages.arrivals(path);
        return arrivals != nullptr ? arrivals->last() : std::nullopt;
    }

    ValueAges ages;
};

TEST_F(ValueAgesTest, AValueIsReadWithTheBranchAboveUnlessItHasATimeOfItsOwn) {
    take({{"/Section", 5s}, {"/Section/Own", 3s}});
    EXPECT_EQ(lastOf("/Section"), kAgesStart + 5s);
    EXPECT_EQ(lastOf("/Section/Own"), kAgesStart + 3s);
    EXPECT_EQ(lastOf("/Section/Other"), kAgesStart + 5s);
    EXPECT_EQ(lastOf("/Section/List/0/Value"), kAgesStart + 5s);
    EXPECT_EQ(lastOf("/Section B"), std::nullopt);
    EXPECT_EQ(lastOf("/"), std::nullopt);
}

TEST_F(ValueAgesTest, ABranchWithoutATimeOfItsOwnIsReadWithWhatIsBelow) {
    take({{"/1x/Ec", 3s}, {"/1x/Io", 4s}});
    take({{"/1x/Ec", 13s}, {"/1x/Io", 14s}});
    EXPECT_EQ(lastOf("/1x"), kAgesStart + 14s);
    EXPECT_EQ(ages.arrivals("/1x")->median(), 10s) << "one arrival a tick";
}

TEST_F(ValueAgesTest, TheRootsTimeIsThatOfEverything) {
    take({{"/", 7s}});
    EXPECT_EQ(lastOf("/"), kAgesStart + 7s);
    EXPECT_EQ(lastOf("/A/B"), kAgesStart + 7s);
}

TEST_F(ValueAgesTest, OnlyANewTimeIsAnArrival) {
    for (const auto time : {1s, 1s, 3s, 3s, 5s}) {
        take({{"/A", time}, {"/B", 1s}});
    }
    EXPECT_EQ(ages.arrivals("/A")->patience(), std::nullopt) << "three arrivals";
    take({{"/A", 7s}});
    EXPECT_EQ(ages.arrivals("/A")->patience(), 6s);
    EXPECT_EQ(ages.arrivals("/B")->median(), std::nullopt);
    EXPECT_EQ(lastOf("/B"), kAgesStart + 1s) << "what a tick does not mention stays";
    ages.clear();
    EXPECT_EQ(ages.arrivals("/A"), nullptr);
}

} // namespace
} // namespace pallax
