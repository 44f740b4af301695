#include "travel/Travel.h"

#include "tests/timeline/TimelineFixture.h"
#include "timeline/Instants.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace pallax {
namespace {

using namespace std::chrono_literals;
using Direction = Travel::Direction;

/// A drive of which a part has been played.
class TravelTest : public testing::Test {
protected:
    TravelTest() { _fixture.drive(5, 120s); }

    std::string told(const Travel::Refusal& refusal) { return refusal.value_or("done"); }
    std::uint64_t shown() { return travel.moment().instant; }
    Time time() { return *travel.time(); }
    /// How long after the start of the drive.
    double seconds() { return std::chrono::duration<double>(time() - Simulation::kStart).count(); }
    void useDrive() {
        timeline = _fixture.indexed();
        present = timeline->packets();
    }
    /// The values at the shown instant.
    std::string value(const char* field) {
        const CurrentValues values = timeline->valuesAt(shown());
        const FieldValue* found = values.value(field);
        return found != nullptr ? found->text() : "";
    }

    TimelineFixture _fixture{"lte"};
    std::unique_ptr<Timeline> timeline;
    std::uint64_t present = 0;
    Time now = Simulation::kStart + 120s;
    std::chrono::steady_clock::time_point steady{};
    bool mayGoOn = true;
    Travel travel{{[this] { return timeline.get(); },
                   [this] { return present; },
                   [this] { return now; },
                   [this] { return steady; },
                   [](Time) { return std::chrono::seconds(0); },
                   {},
                   [this](double) { return mayGoOn; }}};
};

TEST_F(TravelTest, WithoutAPacketEverythingIsRefused) {
    const std::string none = "No packet has come yet.";
    EXPECT_EQ(told(travel.holdOrPlay()), none);
    EXPECT_EQ(told(travel.stepTick(Direction::Back)), none);
    EXPECT_EQ(told(travel.stepEvent(Direction::Forward)), none);
    EXPECT_EQ(told(travel.stepTime(1min)), none);
    EXPECT_EQ(told(travel.toStart()), none);
    EXPECT_EQ(told(travel.toEnd()), none);
    EXPECT_EQ(told(travel.goTo("start")), none);
    EXPECT_EQ(told(travel.mark()), none);
    EXPECT_EQ(told(travel.findAgain(Direction::Back)), none);
    EXPECT_FALSE(travel.isAway());
    EXPECT_EQ(travel.moment().timeline, nullptr);
    EXPECT_EQ(travel.words(), "");
}

TEST_F(TravelTest, HoldsThePresentWhichGoesOn) {
    useDrive();
    present = 1000;
    EXPECT_EQ(shown(), 1000U);
    EXPECT_EQ(told(travel.holdOrPlay()), "done");
    const Time held = time();
    present = 1500;
    EXPECT_EQ(shown(), 1000U);
    now = held + 12s;
    EXPECT_EQ(travel.words(), "held, 12 s behind");
    now = held + 200s;
    EXPECT_EQ(travel.words(), "held, 3 min behind");
    now = held - 3h;
    EXPECT_EQ(travel.words(), "held, 3 h ahead");
    now = held;
    EXPECT_EQ(travel.words(), "held");
    EXPECT_EQ(told(travel.toEnd()), "done");
    EXPECT_FALSE(travel.isAway());
    EXPECT_EQ(shown(), 1500U);
}

TEST_F(TravelTest, TheEndFollowsThePresent) {
    useDrive();
    present = 1000; // of a recording that is being played
    EXPECT_EQ(told(travel.toEnd()), "done");
    EXPECT_EQ(shown(), timeline->packets());
    EXPECT_TRUE(travel.isAway());
    EXPECT_EQ(told(travel.toEnd()), "done");
    EXPECT_FALSE(travel.isAway());
    EXPECT_EQ(shown(), 1000U);
}

TEST_F(TravelTest, StepsByTicksAndBackAgain) {
    useDrive();
    EXPECT_EQ(told(travel.toStart()), "done");
    EXPECT_EQ(shown(), 1U);
    EXPECT_EQ(told(travel.stepTick(Direction::Back)), "This is the first tick.");
    std::vector<std::uint64_t> ticks;
    while (!travel.stepTick(Direction::Forward)) {
        ticks.push_back(shown());
    }
    EXPECT_EQ(ticks.size(), 60U);
    EXPECT_EQ(told(travel.stepTick(Direction::Forward)), "This is the last tick.");
    ticks.pop_back();
    while (!travel.stepTick(Direction::Back)) {
        ASSERT_FALSE(ticks.empty());
        EXPECT_EQ(shown(), ticks.back());
        ticks.pop_back();
    }
    EXPECT_TRUE(ticks.empty());
}

TEST_F(TravelTest, StepsByEventsAndMinutes) {
    useDrive();
    const auto& events = timeline->events();
    ASSERT_GT(events.size(), 2U);
    (void)travel.toStart();
    EXPECT_EQ(told(travel.stepEvent(Direction::Back)), events.front().packet == 1
                                                           ? "There is no earlier event."
                                                           : "There is no earlier event.");
    (void)travel.toInstant(events[1].packet);
    EXPECT_EQ(told(travel.stepEvent(Direction::Back)), "done");
    EXPECT_EQ(shown(), events[0].packet);
    (void)travel.toInstant(timeline->packets());
    EXPECT_EQ(told(travel.stepEvent(Direction::Forward)), "There is no later event.");
    EXPECT_EQ(told(travel.stepTime(-1min)), "done");
    EXPECT_NEAR(seconds(), 60.0, 0.2);
    EXPECT_EQ(told(travel.stepTime(-1h)), "done");
    EXPECT_EQ(shown(), 0U);
    EXPECT_EQ(told(travel.stepTime(1h)), "done");
    EXPECT_EQ(shown(), timeline->packets());
}

TEST_F(TravelTest, GoesToATime) {
    useDrive();
    EXPECT_EQ(told(travel.goTo("22:14:20")), "done"); // the drive begins at 22:13:20
    EXPECT_NEAR(seconds(), 60.0, 0.2);
    EXPECT_EQ(told(travel.goTo("+90s")), "done");
    EXPECT_NEAR(seconds(), 90.0, 0.2);
    EXPECT_EQ(told(travel.goTo("-10s")), "done");
    EXPECT_NEAR(seconds(), 110.0, 0.2);
    const std::uint64_t before = shown();
    EXPECT_NE(told(travel.goTo("03:00")), "done");
    EXPECT_EQ(told(travel.goTo("25:99")), TimeText::parse("25:99").error().sentence);
    EXPECT_EQ(told(travel.goTo("-5")), TimeText::parse("-5").error().sentence);
    EXPECT_EQ(shown(), before);
}

TEST_F(TravelTest, GoesToWhereAConditionBecomesTrue) {
    useDrive();
    (void)travel.toStart();
    EXPECT_EQ(told(travel.findAgain(Direction::Forward)),
              "Go to a condition first, with the key \":\".");
    EXPECT_TRUE(told(travel.goTo("nonsense = 1")).starts_with("no such column: nonsense"));
    ASSERT_EQ(told(travel.goTo("packet > 1000")), "done");
    EXPECT_EQ(shown(), 1001U);
    EXPECT_EQ(told(travel.findAgain(Direction::Forward)),
              "packet > 1000 does not become true after this.");
    EXPECT_EQ(shown(), 1001U);
    (void)travel.toEnd();
    EXPECT_EQ(told(travel.findAgain(Direction::Back)), "done");
    EXPECT_EQ(shown(), 1001U);
    EXPECT_EQ(told(travel.findAgain(Direction::Back)),
              "packet > 1000 did not become true before this.");
    mayGoOn = false;
    (void)travel.toStart();
    EXPECT_EQ(told(travel.goTo("packet > 3000")), "The search was stopped.");
    EXPECT_EQ(shown(), 1U);
}

TEST_F(TravelTest, TheConditionLooksAtTheValues) {
    useDrive();
    (void)travel.toStart();
    const std::string first = value("lte.serving_cell_info.physical_cell_id");
    const std::string condition =
        "lte.serving_cell_info.physical_cell_id <> " + (first.empty() ? "0" : first);
    ASSERT_EQ(told(travel.goTo(condition)), "done");
    const std::uint64_t changed = shown();
    EXPECT_NE(value("lte.serving_cell_info.physical_cell_id"), first);
    (void)travel.toInstant(changed - 1);
    EXPECT_EQ(value("lte.serving_cell_info.physical_cell_id"), first);
}

TEST_F(TravelTest, PlaysOnFromThereAtItsSpeed) {
    useDrive();
    (void)travel.goTo("+10s");
    EXPECT_EQ(told(travel.holdOrPlay()), "done");
    EXPECT_TRUE(travel.isPlaying());
    EXPECT_FALSE(travel.playOn());
    steady += 5s;
    EXPECT_TRUE(travel.playOn());
    EXPECT_NEAR(seconds(), 14.0, 0.2); // the tick before 15 s
    EXPECT_FALSE(travel.playOn());
    travel.faster();
    travel.faster();
    EXPECT_EQ(travel.speedText(), "4x");
    steady += 5s;
    EXPECT_TRUE(travel.playOn());
    EXPECT_NEAR(seconds(), 34.0, 0.2);
    EXPECT_EQ(travel.words(), "playing 4x, 86 s behind");
    for (int time = 0; time < 9; ++time) {
        travel.slower();
    }
    EXPECT_EQ(travel.speedText(), "1/8x");
    steady += 24s;
    EXPECT_TRUE(travel.playOn());
    EXPECT_NEAR(seconds(), 38.0, 0.2);
    EXPECT_EQ(told(travel.holdOrPlay()), "done");
    EXPECT_FALSE(travel.isPlaying());
    EXPECT_TRUE(travel.isAway());
    steady += 24s;
    EXPECT_FALSE(travel.playOn());
}

TEST_F(TravelTest, PlayingCatchesUpWithThePresent) {
    useDrive();
    (void)travel.goTo("-10s");
    (void)travel.holdOrPlay();
    steady += 11s;
    EXPECT_TRUE(travel.playOn());
    EXPECT_FALSE(travel.isAway());
    present = 100; // of a recording that is played elsewhere
    (void)travel.goTo("-10s");
    (void)travel.holdOrPlay();
    steady += 11s;
    EXPECT_TRUE(travel.playOn());
    EXPECT_TRUE(travel.isAway());
    EXPECT_FALSE(travel.isPlaying());
    EXPECT_EQ(shown(), timeline->packets());
}

TEST_F(TravelTest, PlayingSkipsLongPausesAndFollowsClocksThatAreSetBack) {
    const MemoryJournal first = _fixture.journal;
    for (std::uint64_t number = 1; number <= 400; ++number) { // again, an hour later
        const JournalPacket packet = first.packet(number);
        _fixture.journal.add(packet.time + 1h, ByteBuffer(packet.data.begin(), packet.data.end()));
    }
    for (std::uint64_t number = 1; number <= 400; ++number) { // and with the clock of the first
        const JournalPacket packet = first.packet(number);
        _fixture.journal.add(packet.time, ByteBuffer(packet.data.begin(), packet.data.end()));
    }
    useDrive();
    const std::uint64_t size = first.size();
    (void)travel.toInstant(size - 1);
    (void)travel.holdOrPlay();
    steady += 1s;
    (void)travel.playOn();
    steady += 3s;
    EXPECT_TRUE(travel.playOn());
    EXPECT_EQ(shown(), size + 1);
    EXPECT_TRUE(travel.isPlaying());
    steady += 9s;
    EXPECT_TRUE(travel.playOn());
    steady += 5s;
    EXPECT_TRUE(travel.playOn());
    EXPECT_EQ(shown(), size + 401);
    steady += 4s;
    EXPECT_TRUE(travel.playOn());
    EXPECT_GT(shown(), size + 401);
    EXPECT_LT(shown(), size + 700);
}

TEST_F(TravelTest, AMarkStaysUntilTheTimelineIsAnother) {
    useDrive();
    (void)travel.toInstant(70);
    EXPECT_FALSE(travel.marked());
    (void)travel.mark();
    travel.release();
    EXPECT_EQ(travel.marked(), std::optional<std::uint64_t>(70));
    (void)travel.holdOrPlay();
    travel.reset();
    EXPECT_FALSE(travel.marked());
    EXPECT_FALSE(travel.isAway());
}

TEST_F(TravelTest, AnInstantThatIsDroppedBecomesTheEarliest) {
    useDrive();
    (void)travel.toStart();
    _fixture.journal.dropBefore(2000);
    (void)timeline->index();
    EXPECT_GE(shown(), 1950U);
    EXPECT_EQ(shown(), timeline->firstInstant());
    EXPECT_DOUBLE_EQ(travel.shareOf(shown()), 0.0);
    EXPECT_DOUBLE_EQ(travel.shareOf(timeline->packets()), 1.0);
    (void)travel.toShare(0.5);
    EXPECT_NEAR(travel.shareOf(shown()), 0.5, 0.001);
}

} // namespace
} // namespace pallax
