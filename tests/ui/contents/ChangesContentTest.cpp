#include "ui/contents/ChangesContent.h"

#include "tests/timeline/TimelineFixture.h"
#include "ui/contents/TravelWords.h"

#include <gtest/gtest.h>

#include <algorithm>

namespace pallax {
namespace {

using namespace std::chrono_literals;
using Lines = std::vector<std::string>;

class ChangesContentTest : public testing::Test {
protected:
    ChangesContentTest() {
        fixture.drive(5, 120s);
        timeline = fixture.indexed();
    }
    TimelineFixture fixture{"lte"};
    std::unique_ptr<Timeline> timeline;
    Timeline* shown = nullptr;
    Travel travel{{[this] { return shown; }, [this] { return timeline->packets(); },
                   [] { return Simulation::kStart + 120s; },
                   [] { return std::chrono::steady_clock::time_point(); },
                   [](Time) { return 0s; }}};
    ChangesContent content;
};

TEST_F(ChangesContentTest, AreFromTheMarkToWhatIsShown) {
    EXPECT_EQ(markShown(travel), "No packet has come yet.");
    shown = timeline.get();
    content.update(travel);
    EXPECT_EQ(content.title(), "Changes");
    EXPECT_EQ(content.lines(), Lines{"No instant is marked."});
    EXPECT_FALSE(travel.goTo("+60s"));
    EXPECT_EQ(markShown(travel), "Marked 22:14:20. d shows what differs.");
    content.update(travel);
    EXPECT_EQ(content.title(), "Changes from 22:14:20 to 22:14:20");
    EXPECT_TRUE(content.lines().empty()) << "nothing differs";
    EXPECT_FALSE(travel.goTo("+90s"));
    content.update(travel);
    EXPECT_EQ(content.title(), "Changes from 22:14:20 to 22:14:50");
    ASSERT_GT(content.lines().size(), 2U);
    EXPECT_EQ(content.lines()[0], "Serving Cell Measurements");
    EXPECT_EQ(content.lines()[1], "  Measured RSRP  -77.75 dBm → -81.00 dBm (-3.25 dB)");
    content.forget();
    EXPECT_TRUE(content.lines().empty());
}

TEST(ChangeParts, AreTheNameAndWhatHasChanged) {
    const auto text = [](std::string_view line) {
        const ChangeParts parts = changeParts(line);
        return std::to_string(parts.depth) + "|" + parts.name + "|" + parts.change;
    };
    EXPECT_EQ(text("Serving Cell Measurements"), "0|Serving Cell Measurements|");
    EXPECT_EQ(text("  Srxlev         44 dBm → 41 dBm (-3 dB)"), "2|Srxlev|44 dBm → 41 dBm (-3 dB)");
    EXPECT_EQ(text("  Physical Cell ID 286  new"), "2|Physical Cell ID 286|new");
    EXPECT_EQ(text("    Frequency Offset  20"), "4|Frequency Offset|20");
    EXPECT_EQ(text("  name  "), "2|name|");
    EXPECT_EQ(text("   "), "3||");
    EXPECT_EQ(text(""), "0||");
}

TEST_F(ChangesContentTest, TheSpeedIsToldAsWhatItWillDo) {
    shown = timeline.get();
    travel.faster();
    EXPECT_EQ(speedWords(travel), "What is held will play at 2x");
    EXPECT_FALSE(travel.holdOrPlay());
    travel.slower();
    travel.slower();
    EXPECT_EQ(speedWords(travel), "Playing speed 1/2x");
}

} // namespace
} // namespace pallax
