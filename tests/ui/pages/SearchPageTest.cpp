#include "tests/timeline/TimelineFixture.h"
#include "tests/ui/pages/SampleTimeline.h"
#include "tests/ui/terminal/StageFixture.h"
#include "travel/Travel.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <string>
#include <vector>

namespace pallax::terminal {
namespace {

class SearchPageTest : public StageFixture {
protected:
    SearchPageTest() {
        stage.tick(display());
        stage.entryPart = [](const std::string& path) {
            return path.ends_with("/*/Physical Cell ID") ? EntryPart::Cell : EntryPart::None;
        };
        stage.frontEnd.resize(80, 12);
    }
    void recordDrive() {
        drive.emplace("utran");
        stage.moment = {drive->timeline.get(), drive->timeline->packets()};
    }
    bool isOpen() { return stage.line(0).find("› Find in ") != std::string::npos; }
    bool shows(const std::string& text) { return stage.screen().find(text) != std::string::npos; }

    std::optional<SampleTimeline> drive;
};

TEST_F(SearchPageTest, HitsThatAreLeftOutAreTold) {
    const auto valuesOf = [](std::size_t count) {
        Dictionary values;
        for (std::size_t index = 0; index < count; ++index) {
            values.set("Value " + std::to_string(index), "same");
        }
        return Dictionary{{"Section", values}};
    };
    stage.tick(valuesOf(TextFinder::kMostHits));
    stage.type("fsame");
    EXPECT_TRUE(shows("1000 hits"));
    EXPECT_FALSE(shows("first 1,000 hits"));
    stage.tick(valuesOf(TextFinder::kMostHits + 1));
    EXPECT_TRUE(shows("Find in this frame (first 1,000 hits)")) << stage.screen();
    EXPECT_TRUE(shows("1000 hits"));
    stage.press(Key::Enter);
    stage.type("n");
    EXPECT_TRUE(shows("same: 2 of 1000 (there are more)")) << stage.screen();
    stage.type("NN");
    EXPECT_TRUE(shows("same: 1000 of 1000 (there are more)")) << "the last that is known";
    stage.tick(valuesOf(TextFinder::kMostHits));
    stage.type("n");
    EXPECT_TRUE(shows("same: 1 of 1000")) << stage.screen();
    EXPECT_FALSE(shows("there are more"));
}

TEST_F(SearchPageTest, RowsAreListedAsTheTextIsTyped) {
    stage.type("f");
    EXPECT_EQ(stage.screen(60, 7), R"(
 Pallax › Find in this frame
 ──────────────────────────────────────────────────────────
 Type a part of a name or a value.


 ──────────────────────────────────────────────────────────
 find:                                  Tab whole recording
)");
    EXPECT_TRUE(draw().cursor().has_value());
    stage.type("cell id");
    EXPECT_EQ(stage.screen(80, 24), R"(
 Pallax › Find in this frame                                             4 hits
 ──────────────────────────────────────────────────────────────────────────────
 Name              Value  Where
▌Physical Cell ID  274    Serving Cell Measurements
 Physical Cell ID  275    Measured Neighbor Cells, Physical Cell ID 275
 Physical Cell ID  276    Measured Neighbor Cells, Physical Cell ID 276
 Physical Cell ID  277    Measured Neighbor Cells, Physical Cell ID 277















 ──────────────────────────────────────────────────────────────────────────────
 find: cell id                                              Tab whole recording
)");
    EXPECT_EQ(stage.screen(40, 20), R"(
 Pallax › Find in this frame     4 hits
 ──────────────────────────────────────
 Name              Value  Where        …
▌Physical Cell ID  274    Serving Cell…
 Physical Cell ID  275    Measured Nei…
 Physical Cell ID  276    Measured Nei…
 Physical Cell ID  277    Measured Nei…











 ──────────────────────────────────────
 find: cell id      Tab whole recording
)");
    EXPECT_EQ(stage.screen(200, 60), R"(
 Pallax › Find in this frame                                                                                                                                                                     4 hits
 ──────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────
 Name              Value  Where
▌Physical Cell ID  274    Serving Cell Measurements
 Physical Cell ID  275    Measured Neighbor Cells, Physical Cell ID 275
 Physical Cell ID  276    Measured Neighbor Cells, Physical Cell ID 276
 Physical Cell ID  277    Measured Neighbor Cells, Physical Cell ID 277



















































 ──────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────
 find: cell id                                                                                                                                                                      Tab whole recording
)");
    EXPECT_EQ(faultOf(draw()), "");
    stage.type("jq?");
    stage.frontEnd.resize(80, 12);
    EXPECT_TRUE(shows("Nothing in this frame contains this text. Tab searches the whole"));
    stage.press(Key::Backspace, 10);
    EXPECT_TRUE(shows("Type a part of a name or a value."));
    stage.press(Key::Backspace);
    EXPECT_FALSE(isOpen());
    stage.type("fx");
    stage.press(Key::Escape);
    EXPECT_FALSE(isOpen());
}

TEST_F(SearchPageTest, AnAsciiTerminalGetsAscii) {
    TerminalStage ascii(kAsciiMarks);
    ascii.tick(display());
    ascii.type("frsrp");
    EXPECT_EQ(ascii.screen(80, 8), R"(
 Pallax > Find in this frame                                             2 hits
 ------------------------------------------------------------------------------
 Name           Value       Where
>Measured RSRP  -94.75 dBm  Serving Cell Measurements
 Average RSRP   -95.00 dBm  Serving Cell Measurements

 ------------------------------------------------------------------------------
 find: rsrp                                                 Tab whole recording
)");
    recordDrive();
    ascii.moment = stage.moment;
    ascii.press(Key::Tab);
    ascii.press(Key::Backspace, 4);
    ascii.type("cell dch");
    const std::string screen = ascii.screen();
    EXPECT_NE(screen.find("RRC Connecting -> Cell DCH"), std::string::npos) << screen;
    EXPECT_TRUE(
        std::all_of(screen.begin(), screen.end(), [](char each) { return (each & 0x80) == 0; }));
}

TEST_F(SearchPageTest, EnterOpensThePaneOfTheRow) {
    stage.type("fcell id");
    stage.press(Key::Down, 2);
    stage.press(Key::Enter);
    EXPECT_FALSE(isOpen());
    EXPECT_EQ(stage.depth(), 3U);
    EXPECT_EQ(stage.cursorName(), "Physical Cell ID");
    EXPECT_TRUE(shows("276"));
    stage.type("fmeasured rsrp");
    stage.press(Key::Enter);
    EXPECT_EQ(stage.depth(), 2U);
    EXPECT_EQ(stage.cursorName(), "Measured RSRP");
    stage.type("foperator");
    (void)draw();
    stage.click(5, 3);
    EXPECT_EQ(stage.depth(), 1U);
    EXPECT_EQ(stage.cursorName(), "Operator");
    stage.type("fqq");
    stage.press(Key::Enter);
    EXPECT_TRUE(isOpen()) << "there is no row to go to";
}

TEST_F(SearchPageTest, AFilterThatHidesTheRowIsCleared) {
    stage.type("/sim");
    stage.press(Key::Enter);
    stage.type("foperator");
    stage.press(Key::Enter);
    EXPECT_EQ(stage.cursorName(), "Operator");
    EXPECT_EQ(stage.pane().filter(), "");
    stage.type("/oper");
    stage.press(Key::Enter);
    stage.type("foperator");
    stage.press(Key::Enter);
    EXPECT_EQ(stage.pane().filter(), "oper") << "it shows the row";
}

TEST_F(SearchPageTest, ARowOfAListThatIsATableIsSelected) {
    stage.frontEnd.showListsAsTables(true);
    stage.type("f277");
    stage.press(Key::Enter);
    EXPECT_EQ(stage.depth(), 3U);
    stage.press(Key::Backspace);
    EXPECT_TRUE(shows("▌     277")) << stage.screen();
}

TEST_F(SearchPageTest, TheRowsFollowTheDisplay) {
    stage.type("f-94.75");
    EXPECT_TRUE(shows("1 hit"));
    stage.tick(display("-80.00 dBm"));
    EXPECT_TRUE(shows("Nothing in this frame contains"));
    stage.tick(display());
    stage.press(Key::Enter);
    EXPECT_EQ(stage.cursorName(), "Measured RSRP");
}

TEST_F(SearchPageTest, TheNextAndThePreviousRowAreFoundWithoutThePage) {
    stage.type("n");
    EXPECT_EQ(stage.depth(), 1U) << "nothing was searched";
    stage.type("frsrp");
    stage.press(Key::Enter);
    EXPECT_EQ(stage.cursorName(), "Measured RSRP");
    stage.type("n");
    EXPECT_EQ(stage.cursorName(), "Average RSRP");
    EXPECT_TRUE(shows("rsrp: 2 of 2"));
    stage.type("n");
    EXPECT_EQ(stage.cursorName(), "Measured RSRP") << "after the last comes the first";
    stage.type("N");
    EXPECT_EQ(stage.cursorName(), "Average RSRP");
    stage.type("N");
    EXPECT_EQ(stage.cursorName(), "Measured RSRP");
    stage.type("on");
    EXPECT_TRUE(shows("The hits are rows of panes: close the page first."));
    stage.type("o");
    stage.tick(Dictionary{{"Operator", "Example"}});
    stage.type("n");
    EXPECT_TRUE(shows("Nothing in this frame contains rsrp."));
}

TEST_F(SearchPageTest, TheWholeRecordingIsSearched) {
    stage.type("f");
    stage.press(Key::Tab);
    stage.type("cell dch");
    EXPECT_TRUE(shows("There is nothing to search yet: no packet has come."));
    recordDrive();
    stage.press(Key::Tab);
    stage.press(Key::Tab);
    EXPECT_EQ(stage.screen(80, 12), R"(
 Pallax › Find in the whole recording                                    5 hits
 ──────────────────────────────────────────────────────────────────────────────
 Time      Name          Value                      Where
▌22:13:29  state-change  RRC Connecting → Cell DCH
 22:13:29  State         Cell DCH                   RRC Info
 22:13:44  state-change  RRC Cell DCH → Cell Fach
 22:14:00  state-change  RRC Connecting → Cell DCH
 22:14:18  state-change  RRC Cell DCH → Cell Fach


 ──────────────────────────────────────────────────────────────────────────────
 find: cell dch                                                  Tab this frame
)");
    stage.type("qq");
    EXPECT_TRUE(shows("No event, name or value of the recording contains it."));
    stage.press(Key::Backspace, 2);
    stage.press(Key::Enter);
    ASSERT_EQ(stage.went.size(), 1U);
    stage.moment.instant = stage.went.back();
    stage.type("n");
    ASSERT_EQ(stage.went.size(), 2U);
    EXPECT_GT(stage.went[1], stage.went[0]);
    stage.moment.instant = stage.went.back();
    stage.type("N");
    EXPECT_EQ(stage.went.back(), stage.went[0]);
    stage.moment.instant = stage.went[0];
    stage.type("N");
    EXPECT_TRUE(shows("There is no earlier hit."));
    stage.moment.instant = drive->timeline->packets();
    stage.type("n");
    EXPECT_TRUE(shows("There is no later hit."));
}

TEST_F(SearchPageTest, ASearchOfTheRecordingCanBeStopped) {
    recordDrive();
    std::string during;
    stage.mayGoOn = [this, &during] {
        during = stage.screen();
        return false;
    };
    stage.type("f");
    stage.press(Key::Tab);
    stage.type("z");
    EXPECT_NE(during.find("The recording is being searched."), std::string::npos);
    EXPECT_TRUE(shows("The search was stopped."));
    EXPECT_TRUE(shows("(stopped)"));
    stage.mayGoOn = [] { return true; };
    stage.type("z");
    EXPECT_FALSE(shows("stopped"));
}

TEST_F(SearchPageTest, TheNextHitIsOfTheLatestSearchOrCondition) {
    SampleTimeline recorded("lte");
    Timeline& timeline = *recorded.timeline;
    Travel travel{{[&] { return &timeline; }, [&] { return timeline.packets(); },
                   [] { return Time(); }, [] { return std::chrono::steady_clock::time_point(); },
                   [](Time) { return std::chrono::seconds(0); }}};
    TerminalStage viewer(kUtf8Marks, &travel);
    viewer.tick(timeline.displayAt(timeline.packets()));
    viewer.type("frsrp");
    viewer.press(Key::Enter);
    const std::string first = viewer.cursorName();
    viewer.type("n");
    EXPECT_NE(viewer.cursorName(), first);
    viewer.type("^:measured_rsrp < 0");
    viewer.press(Key::Enter);
    viewer.type("n");
    EXPECT_NE(viewer.screen().find("measured_rsrp < 0 does not become true after this."),
              std::string::npos)
        << viewer.screen();
    viewer.type("frsrp");
    viewer.press(Key::Enter);
    viewer.type("n");
    EXPECT_NE(viewer.screen().find("rsrp: 2 of "), std::string::npos) << viewer.screen();
}

TEST_F(SearchPageTest, EverySizeCanBeDrawn) {
    recordDrive();
    stage.type("fcell");
    for (int scope = 0; scope < 2; ++scope) {
        for (int columns = 0; columns < 100; columns += 3) {
            for (const int rows : {0, 1, 4, 5, 6, 7, 24}) {
                stage.frontEnd.resize(columns, rows);
                ASSERT_EQ(faultOf(draw()), "") << columns << "x" << rows;
            }
        }
        stage.press(Key::Tab);
    }
}

} // namespace
} // namespace pallax::terminal
