#include "ui/gtk/GraphView.h"

#include "tests/ui/gtk/CurveSamples.h"
#include "tests/ui/gtk/WindowStage.h"
#include "tests/ui/gtk/XDisplay.h"

namespace pallax::gtk {
namespace {

class GraphViewTest : public DisplayTest {};

/// A window with what is tested.
struct GraphViewStage {
    void show(const GraphView::Content& content) {
        view.show(content);
        stage.frame.pages().open(view.widget(), "Graph");
        stage.settle();
    }
    static GraphView::Content content() {
        GraphView::Plot levels{samplePlot(), {"a  -92 dBm  RSRP", "c  -95 dBm  Average RSRP"}};
        levels.content.lines = {{"a", 0, sampleCurve()}, {"c", 2, sampleCurve()}};
        GraphView::Plot ratios{samplePlot(), {"b  -9 dB  RSRQ"}};
        ratios.content.lines = {{"b", 1, sampleCurve()}};
        return {.span = 2, .plots = {levels, ratios}, .words = "the last 5 minutes"};
    }
    ~GraphViewStage() { stage.frame.pages().close(); }

    WindowStage stage{360, 720};
    std::vector<std::size_t> spans;
    GraphView view{stage.guard,
                   {.chooseSpan = [this](std::size_t span) { spans.push_back(span); },
                    .pointed = [](auto) {}}};
};

constexpr const char* kPage = R"(
button: Back (focus)
title: Graph / 
button: 30 s
button: 60 s
button: 5 min (on)
button: 15 min
button: 60 min
button: All
text: the last 5 minutes
text: a  -92 dBm  RSRP
text: c  -95 dBm  Average RSRP
text: b  -9 dB  RSRQ
)";

TEST_F(GraphViewTest, HasALegendAboveThePlotOfEachUnit) {
    GraphViewStage tested;
    for (const auto& [width, height] : {std::pair(360, 720), std::pair(1024, 768)}) {
        tested.stage.resize(width, height);
        tested.show(tested.content());
        EXPECT_EQ(tested.stage.dump(), kPage) << width;
        const auto plots = plotsBelow(tested.view.widget());
        ASSERT_EQ(plots.size(), 2U);
        EXPECT_EQ(faultOfName(plots[0], "Curves: a  -92 dBm  RSRP; c  -95 dBm  Average RSRP"), "");
        EXPECT_EQ(faultOfName(plots[1], "Curves: b  -9 dB  RSRQ"), "");
    }
    EXPECT_TRUE(tested.spans.empty()) << "nobody has chosen one";
    tested.stage.press("the last 15 minutes");
    EXPECT_EQ(tested.spans, std::vector<std::size_t>{3});
}

TEST_F(GraphViewTest, WidgetsStayWhileTheirValuesChange) {
    GraphViewStage tested;
    tested.show(tested.content());
    const auto plots = plotsBelow(tested.view.widget());
    GraphView::Content next = tested.content();
    next.plots[0].legend[0] = "a  -80 dBm  RSRP";
    tested.view.show(next);
    EXPECT_EQ(plotsBelow(tested.view.widget()), plots);
    EXPECT_NE(tested.stage.dump().find("a  -80 dBm  RSRP"), std::string::npos);
    next.plots.pop_back();
    tested.view.show(next);
    EXPECT_EQ(plotsBelow(tested.view.widget()).size(), 1U);
}

TEST_F(GraphViewTest, AnEmptyGraphSaysHowItIsFilled) {
    GraphViewStage tested;
    tested.show({.span = 2, .plots = {}, .words = ""});
    EXPECT_EQ(tested.stage.dump(), R"(
button: Back (focus)
title: Graph / 
text: The graph is empty
text: The page of a value adds it to the graph.
)");
}

} // namespace
} // namespace pallax::gtk
