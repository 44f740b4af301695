#include "tests/doubles/Property.h"
#include "tests/ui/pages/ValueStage.h"

#include <gtest/gtest.h>

#include <array>
#include <string>

namespace pallax::terminal {
namespace {

constexpr const char* kMeasurements = "Serving Cell Measurements";
constexpr const char* kRsrp = "Measured RSRP";

class ValuePageTest : public ValueStage {
protected:
    void openRsrp() {
        show(last());
        select(kMeasurements, kRsrp);
        stage.type("i");
        (void)stage.screen(); // the keys refer to the shown curve
    }
};

TEST_F(ValuePageTest, EnterOnALeafOpensItAndSomeKeysCloseIt) {
    show(last());
    select(kMeasurements, kRsrp);
    const std::string pane = stage.screen();
    stage.press(Key::Enter);
    EXPECT_TRUE(shows("Pallax › Serving Cell Measurements › Measured RSRP"));
    stage.type("i");
    EXPECT_EQ(stage.screen(), pane);
    for (const Key key : {Key::Escape, Key::Backspace}) {
        stage.press(Key::Enter);
        EXPECT_TRUE(shows("min -"));
        stage.press(key);
        EXPECT_EQ(stage.screen(), pane);
    }
    EXPECT_EQ(stage.depth(), 2U);
}

TEST_F(ValuePageTest, ABranchHasNoPage) {
    show(last());
    for (const char* key : {"i", "v"}) {
        stage.type(key);
        EXPECT_EQ(stage.depth(), 1U);
        EXPECT_FALSE(shows("copy"));
        EXPECT_TRUE(shows("Nothing to show here: choose a value."));
        stage.press(Key::Down);
    }
    stage.type("t");
    EXPECT_TRUE(shows("Nothing to show as a table: choose a list."));
}

TEST_F(ValuePageTest, ZoomsTheCurve) {
    openRsrp();
    EXPECT_TRUE(shows("of the last 5 minutes"));
    for (const char* words :
         {"of the last minute", "of the last 30 seconds", "of the last 30 seconds"}) {
        stage.type("+");
        EXPECT_TRUE(shows(words)) << words;
    }
    for (const char* words :
         {"of the last minute", "of the last 5 minutes", "of the last 15 minutes",
          "of the last hour", "of all time", "of all time"}) {
        stage.type("-");
        EXPECT_TRUE(shows(words)) << words;
    }
}

TEST_F(ValuePageTest, TheArrowsReadTheCurve) {
    openRsrp();
    stage.press(Key::Home);
    EXPECT_TRUE(shows("\n 22:15:22  ")) << stage.screen();
    stage.press(Key::Right);
    EXPECT_TRUE(shows("\n 22:15:26  ")) << stage.screen();
    stage.press(Key::End);
    EXPECT_TRUE(shows("\n 22:20:17  ")) << stage.screen();
    stage.type("h");
    stage.type("l");
    EXPECT_TRUE(shows("\n 22:20:17  "));
    bool hasEvent = false;
    for (int column = 0; column < 80; ++column) {
        stage.press(Key::Left);
        hasEvent = hasEvent || shows("serving cell ");
    }
    EXPECT_TRUE(hasEvent);
    EXPECT_TRUE(shows("dBm └")) << "still open";
}

TEST_F(ValuePageTest, WithoutACurveLeftGoesBack) {
    stage.tick(display());
    stage.press(Key::Enter);
    stage.type("i");
    EXPECT_EQ(stage.screen(80, 8), R"(
 Pallax › Serving Cell Measurements › Version
 ──────────────────────────────────────────────────────────────────────────────
 1



 ──────────────────────────────────────────────────────────────────────────────
 Updated 2023-11-14 at 22:13:20                                  y copy  ? help
)");
    stage.press(Key::Left);
    EXPECT_FALSE(shows("y copy"));
}

TEST_F(ValuePageTest, TheQualityHasATint) {
    show(last());
    select(kMeasurements, kRsrp);
    stage.type("i");
    EXPECT_EQ(styleOf(draw(), "excellent"), Style{.tint = Tint::Green});
}

TEST_F(ValuePageTest, AValueThatDoesNotFitEndsInAMark) {
    stage.tick(Dictionary{{"SIM Info", Dictionary{{"IMSI", std::string(200, '1')}}}});
    select("SIM Info", "IMSI");
    stage.type("i");
    stage.frontEnd.resize(40, 10);
    EXPECT_EQ(stage.line(2), " " + std::string(37, '1') + "…");
}

TEST_F(ValuePageTest, WithoutATimelineTheCurrentValuesTellTheRest) {
    const CurrentValues& values = drive.timeline->latestValues();
    show(last());
    stage.moment = {};
    stage.values = &values;
    select(kMeasurements, kRsrp);
    stage.type("i");
    EXPECT_TRUE(shows("log code 0xB17F"));
    EXPECT_TRUE(shows("raw "));
    EXPECT_FALSE(shows("packet "));
    EXPECT_FALSE(shows("min "));
    stage.press(Key::Left);
    EXPECT_FALSE(shows("y copy"));
}

TEST_F(ValuePageTest, FollowsTheShownInstant) {
    const std::uint64_t half = last() / 2;
    show(half);
    select(kMeasurements, kRsrp);
    stage.type("i");
    const std::string earlier = stage.screen();
    const auto then = valueOf(drive.timeline->valuesAt(half),
                              {"lte.serving_cell_measurements.measured_rsrp", "", ""});
    EXPECT_TRUE(shows("\n " + then->value.text() + "  ")) << earlier;
    show(last());
    EXPECT_NE(stage.screen(), earlier);
    show(half);
    EXPECT_EQ(stage.screen(), earlier);
}

TEST_F(ValuePageTest, AnEntryStaysTheSameCellWhereverItStands) {
    std::uint64_t instant = last();
    const std::string path = "/Neighbor Cells List/1/Measured RSRP";
    while (!leafAt(drive.timeline->valuesAt(instant), path)) {
        instant -= 10;
    }
    const CurrentValues values = drive.timeline->valuesAt(instant);
    const LeafName leaf = *leafAt(values, path);
    show(instant);
    select("Neighbor Cells List", "1");
    stage.press(Key::Enter);
    select(stage, "Measured RSRP", "Measured RSRP");
    EXPECT_TRUE(shows("Neighbor Cells List › " + leaf.entry + " › Measured RSRP"))
        << stage.screen();
    EXPECT_TRUE(shows(valueOf(values, leaf)->value.text()));
    while (valueOf(drive.timeline->valuesAt(instant), leaf)) {
        ASSERT_GT(instant, 10U);
        instant -= 10;
    }
    show(instant);
    EXPECT_TRUE(shows("no value now")) << stage.screen();
}

TEST_F(ValuePageTest, KnowsWhatTheChannelMeans) {
    show(last());
    select(kMeasurements, "E-ARFCN");
    stage.type("i");
    EXPECT_TRUE(shows("band 3 · downlink 1870.0 MHz · uplink 1775.0 MHz")) << stage.screen();
}

TEST_F(ValuePageTest, CopiesNameAndValue) {
    openRsrp();
    stage.type("y");
    ASSERT_EQ(stage.copied.size(), 1U);
    EXPECT_TRUE(stage.copied.front().starts_with("Measured RSRP -"));
    EXPECT_TRUE(stage.copied.front().ends_with(" dBm"));
    EXPECT_TRUE(shows("Copied: Measured RSRP -"));
}

TEST_F(ValuePageTest, SaysWhenNothingWasReadInTheTime) {
    Timeline& timeline = *drive.timeline;
    const auto field = *timeline.fields().named("lte.neighbor_cells_list.measured_rsrp");
    const auto points = [&](EntryId entry, std::chrono::seconds span) {
        const auto window = windowUntil(timeline, last(), span);
        return readCurve(timeline, field, entry, window, 70).points.size();
    };
    std::uint64_t instant = last();
    std::optional<LeafValue> gone; // a cell that was last measured more than a minute ago
    while (!gone) {
        ASSERT_GT(instant -= 100, 4000U);
        const CurrentValues values = timeline.valuesAt(instant);
        const auto leaf = leafAt(values, "/Neighbor Cells List/0/Measured RSRP");
        gone = leaf ? valueOf(values, *leaf) : std::nullopt;
        if (gone && (points(gone->entry, std::chrono::seconds(60)) > 0 ||
                     points(gone->entry, std::chrono::seconds(300)) == 0)) {
            gone.reset();
        }
    }
    show(instant);
    select("Neighbor Cells List", "0");
    stage.press(Key::Enter);
    select("Measured RSRP", "Measured RSRP");
    show(last());
    EXPECT_TRUE(shows("no value now")) << stage.screen();
    EXPECT_TRUE(shows("of the last 5 minutes"));
    EXPECT_FALSE(shows("no value in"));
    stage.type("+");
    EXPECT_TRUE(shows("no value in the last minute")) << stage.screen();
    stage.type("-");
    EXPECT_FALSE(shows("no value in"));
}

TEST_F(ValuePageTest, OnlyMeasuresHaveAMean) {
    show(last());
    select("Serving Cell Measurements", "Physical Cell ID");
    stage.type("i");
    EXPECT_TRUE(shows("min ")) << stage.screen();
    EXPECT_TRUE(shows("max "));
    EXPECT_FALSE(shows("mean"));
    stage.type("i");
    stage.press(Key::Backspace);
    openRsrp();
    EXPECT_TRUE(shows("mean"));
}

TEST_F(ValuePageTest, HelpAndQuittingWorkAsInAPane) {
    openRsrp();
    stage.type("?");
    EXPECT_TRUE(shows("┌ Keys"));
    stage.press(Key::Escape);
    EXPECT_TRUE(shows("min -"));
    stage.type("q");
    EXPECT_FALSE(shows("min -"));
    EXPECT_EQ(stage.quits, 0);
}

TEST(ValuePageProperty, AnyKeysAndSizesDrawAWholeScreen) {
    namespace any = doubles::any;
    EXPECT_TRUE(doubles::holds([] {
        constexpr std::string_view kKeys = "iivV+-yhlo?qjkG";
        constexpr std::array kMoreKeys{Key::Enter, Key::Left, Key::Right,
                                       Key::Home,  Key::End,  Key::Down};
        TerminalStage stage(any::between(0, 1) == 0 ? kUtf8Marks : kAsciiMarks);
        Timeline& timeline = *RecordedDrive::lte().timeline;
        for (int step = 0; step < 30; ++step) {
            const auto instant = static_cast<std::uint64_t>(any::between(0, 300) * 4 + 1);
            stage.moment = {&timeline, instant};
            if (step % 10 == 0) {
                stage.tick(timeline.displayAt(instant));
            }
            stage.frontEnd.resize(static_cast<int>(any::between(18, 100)),
                                  static_cast<int>(any::between(4, 30)));
            const auto key = static_cast<std::size_t>(any::between(0, 20));
            if (key < kKeys.size()) {
                stage.type(kKeys.substr(key, 1));
            } else {
                stage.press(kMoreKeys.at(key - kKeys.size()));
            }
            RC_ASSERT(faultOf(stage.frontEnd.draw()) == "");
        }
    }));
}

} // namespace
} // namespace pallax::terminal
