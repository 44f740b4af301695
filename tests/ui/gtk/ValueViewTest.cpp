#include "ui/gtk/ValueView.h"

#include "tests/ui/gtk/CurveSamples.h"
#include "tests/ui/gtk/WindowStage.h"
#include "tests/ui/gtk/XDisplay.h"

namespace pallax::gtk {
namespace {

class ValueViewTest : public DisplayTest {};

/// A window with what is tested.
struct ValueViewStage {
    static ValueView::Content content() {
        return {.text = "-92.25 dBm <b>",
                .quality = "fair · 2 s old",
                .lines = {"A sentence.", "", "/Section/RSRP"},
                .span = 2,
                .plot = samplePlot(),
                .statistics = "-101.5 … -82.25 dBm, 01:00:10 – 01:01:10",
                .last = "-85 dBm"};
    }
    void open(const ValueView::Content& shown) {
        view.show(shown);
        stage.frame.pages().open(view.widget(), "RSRP");
        stage.settle();
    }
    ~ValueViewStage() { stage.frame.pages().close(); }

    WindowStage stage{360, 720};
    std::vector<std::string> done;
    ValueView view{
        stage.guard,
        {.chooseSpan = [this](std::size_t span) { done.push_back("span " + std::to_string(span)); },
         .pointed = [this](auto time) { done.emplace_back(time ? "pointed" : "left"); },
         .toggleInGraph = [this] { done.emplace_back("toggle"); },
         .openGraph = [this] { done.emplace_back("open"); }}};
};

constexpr const char* kValuePage = R"(
button: Back (focus)
title: RSRP / 
text: -92.25 dBm <b>
text: fair · 2 s old
button: 30 s
button: 60 s
button: 5 min (on)
button: 15 min
button: 60 min
button: All
text: -101.5 … -82.25 dBm, 01:00:10 – 01:01:10
button: Add to the Graph
button: Open the Graph
text: A sentence.
/Section/RSRP
)";

TEST_F(ValueViewTest, IsAPageOverThePanesUntilTheUserGoesBack) {
    ValueViewStage tested;
    tested.stage.tick(Dictionary{{"RSRP", "-92.25 dBm"}});
    const std::string panes = tested.stage.dump();
    tested.open(tested.content());
    EXPECT_EQ(tested.stage.dump(), kValuePage);
    EXPECT_TRUE(tested.stage.frame.pages().isOpen());
    tested.stage.press("Back");
    EXPECT_FALSE(tested.stage.frame.pages().isOpen());
    EXPECT_EQ(tested.stage.dump(), panes);
    tested.stage.frame.pages().open(tested.view.widget(), "RSRP"); // again
    tested.stage.settle();
    EXPECT_NE(tested.stage.dump().find("A sentence."), std::string::npos);
}

TEST_F(ValueViewTest, IsTheSameOnADesktop) {
    ValueViewStage tested;
    tested.stage.resize(1024, 768);
    tested.open(tested.content());
    EXPECT_EQ(tested.stage.dump(), kValuePage);
}

TEST_F(ValueViewTest, TellsWhatTheUserWants) {
    ValueViewStage tested;
    tested.open(tested.content());
    tested.stage.press("all time");
    tested.stage.press("Add to the Graph");
    tested.stage.press("Open the Graph");
    EXPECT_EQ(tested.done, (std::vector<std::string>{"span 5", "toggle", "open"}));
    ValueView::Content next = tested.content();
    next.isInGraph = true;
    tested.view.show(next);
    tested.stage.press("Remove from the Graph");
    EXPECT_EQ(tested.done.back(), "toggle");
}

TEST_F(ValueViewTest, ShowsWhatTheCursorIsOnInPlaceOfAnEmptyLine) {
    ValueViewStage tested;
    tested.open(tested.content());
    const auto heightOfPage = [&tested] {
        tested.stage.settle();
        return gtk_adjustment_get_upper(
            gtk_scrolled_window_get_vadjustment(GTK_SCROLLED_WINDOW(tested.view.widget())));
    };
    const double height = heightOfPage();
    ValueView::Content read = tested.content();
    read.cursor = "01:00:40  -85 dBm";
    tested.view.show(read);
    EXPECT_EQ(heightOfPage(), height) << "nothing moves";
    EXPECT_NE(tested.stage.dump().find("text: 01:00:40  -85 dBm\n"), std::string::npos);
}

TEST_F(ValueViewTest, TheCurveHasANameWithItsRangeAndLastValue) {
    ValueViewStage tested;
    tested.open(tested.content());
    const auto plots = plotsBelow(tested.view.widget());
    ASSERT_EQ(plots.size(), 1U);
    EXPECT_EQ(
        faultOfName(plots[0], "Curve: -101.5 … -82.25 dBm, 01:00:10 – 01:01:10, last -85 dBm"), "");
}

TEST_F(ValueViewTest, HoldsItsPlaceWhileTimeGoesOn) {
    ValueViewStage tested;
    tested.stage.resize(360, 300);
    tested.open(tested.content());
    GtkAdjustment* down =
        gtk_scrolled_window_get_vadjustment(GTK_SCROLLED_WINDOW(tested.view.widget()));
    gtk_adjustment_set_value(down, 150);
    GtkWidget* text = WindowStage::below(tested.view.widget(), GTK_TYPE_LABEL);
    gtk_label_select_region(GTK_LABEL(text), 0, 6);
    ValueView::Content next = tested.content();
    next.quality = "good · 4 s old";
    next.plot->to += std::chrono::seconds(2);
    tested.view.show(next);
    tested.stage.settle();
    EXPECT_EQ(gtk_adjustment_get_value(down), 150);
    int begin = 0;
    int end = 0;
    EXPECT_NE(gtk_label_get_selection_bounds(GTK_LABEL(text), &begin, &end), FALSE)
        << "what is selected stays so while the text is the same";
    EXPECT_EQ(end, 6);
    EXPECT_NE(tested.stage.dump().find("text: good · 4 s old"), std::string::npos);
}

TEST_F(ValueViewTest, WithoutNumbersThereIsNoCurve) {
    ValueViewStage tested;
    ValueView::Content none = tested.content();
    none.plot.reset();
    none.text.clear();
    tested.open(none);
    EXPECT_EQ(tested.stage.dump(), R"(
button: Back (focus)
title: RSRP / 
text: no value now
text: fair · 2 s old
text: A sentence.
/Section/RSRP
)");
}

TEST_F(ValueViewTest, ALeafThatIsSelectedIsToldWithItsPath) {
    ValueViewStage tested;
    tested.stage.tick(Dictionary{{"Section", Dictionary{{"RSRP", "-92.25 dBm"}}}});
    std::vector<std::string> told;
    tested.stage.frame.onLeaf([&](const std::string& path, const std::string& text) {
        told = {path, text};
    });
    tested.stage.select(0);
    EXPECT_TRUE(told.empty()) << "a branch opens a pane";
    tested.stage.select(0);
    EXPECT_EQ(told, (std::vector<std::string>{"/Section/RSRP", "-92.25 dBm"}));
}

} // namespace
} // namespace pallax::gtk
