#include "tests/ui/pages/SampleTimeline.h"
#include "tests/ui/terminal/StageFixture.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <string>
#include <vector>

namespace pallax::terminal {
namespace {

class EventsPageTest : public StageFixture {
protected:
    EventsPageTest() {
        stage.tick(display());
        stage.frontEnd.resize(80, 12);
    }
    void recordDrive(const char* technology = "lte") {
        drive.emplace(technology);
        stage.moment = {drive->timeline.get(), drive->timeline->packets()};
    }
    const std::vector<Event>& events() const { return drive->timeline->events(); }
    bool isOpen() { return stage.line(0).find("Pallax › Events") != std::string::npos; }
    int rowsWithCursor() {
        const auto lines = draw().lines();
        return static_cast<int>(std::count_if(
            lines.begin(), lines.end(), [](const auto& line) { return line.starts_with("▌"); }));
    }

    std::optional<SampleTimeline> drive;
};

TEST_F(EventsPageTest, WithoutATimelineThereAreNoEventsYet) {
    stage.type("e");
    EXPECT_EQ(stage.screen(60, 7), R"(
 Pallax › Events
 ──────────────────────────────────────────────────────────
 No events yet.


 ──────────────────────────────────────────────────────────
 Updated 2023-11-14 at 22:13:20                      ? help
)");
    stage.press(Key::Enter);
    stage.type("y");
    EXPECT_TRUE(isOpen());
    EXPECT_TRUE(stage.went.empty());
    EXPECT_TRUE(stage.copied.empty());
    recordDrive();
    EXPECT_EQ(rowsWithCursor(), 1) << "they are shown when there are some";
}

TEST_F(EventsPageTest, TheLatestComesFirst) {
    recordDrive();
    stage.type("e");
    EXPECT_EQ(stage.screen(80, 24), R"(
 Pallax › Events                                                       4 events
 ──────────────────────────────────────────────────────────────────────────────
 Time      Kind          What
▌22:14:11  context-up    context up: internet
 22:13:59  context-down  context down: internet
 22:13:44  context-up    context up: internet
 22:13:27  cell-change   serving cell 386 → 488 after 8 s















 ──────────────────────────────────────────────────────────────────────────────
 Updated 2023-11-14 at 22:13:20      Enter go there  < > sort  / filter  ? help
)");
    EXPECT_EQ(stage.screen(40, 20), R"(
 Pallax › Events               4 events
 ──────────────────────────────────────
 Time      Kind          What          …
▌22:14:11  context-up    context up: i…
 22:13:59  context-down  context down:…
 22:13:44  context-up    context up: i…
 22:13:27  cell-change   serving cell …











 ──────────────────────────────────────
 Updated 2023-11-14 at 22:13:20  ? help
)");
    EXPECT_EQ(faultOf(draw()), "");
    stage.ahead = std::chrono::hours(2);
    EXPECT_EQ(stage.line(3).substr(0, 20), "▌00:14:11  context");
}

TEST_F(EventsPageTest, AnAsciiTerminalGetsAsciiArrows) {
    recordDrive("gsm");
    TerminalStage ascii(kAsciiMarks);
    ascii.tick(display());
    ascii.moment = stage.moment;
    ascii.type("e");
    const std::string screen = ascii.screen(100, 40);
    EXPECT_NE(screen.find("->"), std::string::npos);
    EXPECT_TRUE(
        std::all_of(screen.begin(), screen.end(), [](char each) { return (each & 0x80) == 0; }));
}

TEST_F(EventsPageTest, EnterGoesToTheInstantAndClosesThePage) {
    recordDrive();
    stage.type("e");
    (void)draw();
    stage.press(Key::Down);
    stage.press(Key::Enter);
    EXPECT_FALSE(isOpen());
    stage.type("e");
    stage.click(5, 5); // the third row
    EXPECT_FALSE(isOpen());
    const std::size_t count = events().size();
    ASSERT_GE(count, 3U);
    EXPECT_EQ(stage.went,
              (std::vector<std::uint64_t>{events()[count - 2].packet, events()[count - 3].packet}));
}

TEST_F(EventsPageTest, EventsAfterTheShownInstantAreDimAndTheCursorIsAtIt) {
    recordDrive();
    const std::size_t count = events().size();
    stage.moment.instant = events()[count - 3].packet;
    stage.frontEnd.resize(80, 24);
    stage.type("e");
    const Grid grid = draw();
    EXPECT_TRUE(grid.at(1, 3).style.dim);
    EXPECT_TRUE(grid.at(1, 4).style.dim);
    EXPECT_TRUE(grid.at(1, 5).style.accent) << "the event at that instant";
    EXPECT_FALSE(grid.at(1, 6).style.dim);
    stage.moment.instant = drive->timeline->packets();
    EXPECT_FALSE(draw().at(1, 3).style.dim);
    EXPECT_TRUE(draw().at(1, 5).style.accent) << "the cursor stays";
}

TEST_F(EventsPageTest, TheCursorStaysOnItsEventWhenOthersCome) {
    SampleTimeline whole;
    SampleTimeline growing("lte", std::chrono::seconds(20));
    stage.moment = {growing.timeline.get(), growing.timeline->packets()};
    stage.type("e");
    stage.frontEnd.resize(80, 24);
    (void)draw();
    const auto cursorLine = [this] {
        for (const std::string& line : draw().lines()) {
            if (line.starts_with("▌")) {
                return line.substr(0, 12); // columns may become wider
            }
        }
        return std::string();
    };
    const std::string before = cursorLine();
    for (std::uint64_t number = growing.timeline->packets() + 1;
         number <= whole.recorded.journal.size(); ++number) {
        const JournalPacket packet = whole.recorded.journal.packet(number);
        growing.recorded.journal.add(packet.time,
                                     ByteBuffer(packet.data.begin(), packet.data.end()));
    }
    const std::size_t events = growing.timeline->events().size();
    ASSERT_TRUE(growing.timeline->index());
    ASSERT_GT(growing.timeline->events().size(), events);
    stage.moment.instant = growing.timeline->packets();
    EXPECT_EQ(cursorLine(), before);
    stage.press(Key::Enter);
    EXPECT_EQ(stage.went,
              (std::vector<std::uint64_t>{growing.timeline->events()[events - 1].packet}));
}

TEST_F(EventsPageTest, TheFilterIsTypedInTheLastRow) {
    recordDrive();
    stage.type("e/cell-");
    EXPECT_EQ(stage.line(11),
              " / cell-                                                       Esc clear filter");
    EXPECT_NE(stage.line(0).find(" of "), std::string::npos);
    stage.type("qqq");
    EXPECT_TRUE(isOpen()) << "letters are text";
    EXPECT_EQ(rowsWithCursor(), 0);
    stage.press(Key::Backspace, 3);
    stage.press(Key::Down);
    EXPECT_EQ(rowsWithCursor(), 1);
    stage.press(Key::Enter);
    EXPECT_TRUE(stage.went.empty()) << "it ends the typing";
    stage.press(Key::Escape);
    EXPECT_TRUE(isOpen());
    EXPECT_EQ(stage.line(0).find(" of "), std::string::npos);
    stage.type("/");
    stage.press(Key::Backspace);
    stage.type("/x");
    stage.press(Key::Escape);
    stage.press(Key::Escape);
    EXPECT_FALSE(isOpen());
}

TEST_F(EventsPageTest, KeysOfTheTableAndOfThePanesWork) {
    recordDrive();
    stage.type("e");
    (void)draw();
    stage.type(">>");
    EXPECT_NE(stage.screen(80, 12).find("Kind↑"), std::string::npos);
    stage.type("y");
    EXPECT_EQ(stage.copied.size(), 1U);
    EXPECT_NE(stage.screen().find("Copied: "), std::string::npos);
    stage.type("?");
    EXPECT_NE(stage.screen(80, 24).find("┌ Keys"), std::string::npos);
    stage.type("?");
    stage.press(Key::Tab);
    stage.type("e");
    EXPECT_FALSE(isOpen());
    for (const Key key : {Key::Escape, Key::Left, Key::Backspace}) {
        stage.type("e");
        ASSERT_TRUE(isOpen());
        stage.press(key);
        EXPECT_FALSE(isOpen());
    }
    stage.type("eq");
    EXPECT_FALSE(isOpen());
    EXPECT_EQ(stage.quits, 0);
}

TEST_F(EventsPageTest, EverySizeCanBeDrawn) {
    recordDrive();
    stage.type("e");
    for (int columns = 0; columns < 100; columns += 3) {
        for (const int rows : {0, 1, 4, 5, 6, 7, 24}) {
            stage.frontEnd.resize(columns, rows);
            ASSERT_EQ(faultOf(draw()), "") << columns << "x" << rows;
        }
    }
}

} // namespace
} // namespace pallax::terminal
