#include "ui/gtk/CurvePlot.h"

#include "tests/ui/gtk/CurveSamples.h"
#include "tests/ui/gtk/WindowStage.h"
#include "tests/ui/gtk/XDisplay.h"

#include <vector>

namespace pallax::gtk {
namespace {

using namespace std::chrono_literals;

class CurvePlotTest : public DisplayTest {};

/// A window with what is tested.
struct CurvePlotStage {
    void open() {
        plot.show(samplePlot(), "Curve: something");
        stage.frame.pages().open(plot.widget(), "RSRP");
        stage.settle();
    }
    ~CurvePlotStage() { stage.frame.pages().close(); }

    WindowStage stage{360, 720};
    std::vector<std::optional<Time>> pointed;
    CurvePlot plot{stage.guard, [this](auto time) { pointed.push_back(time); }};
};

TEST_F(CurvePlotTest, ThePointerReadsItUntilItLeaves) {
    CurvePlotStage tested;
    tested.open();
    point(tested.plot.widget(), GTK_TYPE_EVENT_CONTROLLER_MOTION, "motion", 0);
    point(tested.plot.widget(), GTK_TYPE_EVENT_CONTROLLER_MOTION, "motion", 360);
    point(tested.plot.widget(), GTK_TYPE_EVENT_CONTROLLER_MOTION, "leave", 0);
    ASSERT_EQ(tested.pointed.size(), 3U);
    EXPECT_EQ(tested.pointed[0], Time{10s}) << "left of the curve";
    EXPECT_EQ(tested.pointed[1], Time{70s}) << "right of it";
    EXPECT_EQ(tested.pointed[2], std::nullopt);
}

TEST_F(CurvePlotTest, APointerThatRestsDoesNotReadIt) {
    CurvePlotStage tested;
    tested.open();
    GtkWidget* plot = tested.plot.widget();
    point(plot, GTK_TYPE_EVENT_CONTROLLER_MOTION, "enter", 200);
    point(plot, GTK_TYPE_EVENT_CONTROLLER_MOTION, "motion", 200);
    EXPECT_TRUE(tested.pointed.empty()) << "a page was opened below it";
    point(plot, GTK_TYPE_EVENT_CONTROLLER_MOTION, "motion", 201);
    point(plot, GTK_TYPE_EVENT_CONTROLLER_MOTION, "motion", 201);
    EXPECT_EQ(tested.pointed.size(), 1U);
}

TEST_F(CurvePlotTest, ATouchedPlaceStays) {
    CurvePlotStage tested;
    tested.open();
    point(tested.plot.widget(), GTK_TYPE_GESTURE_CLICK, "pressed", 200);
    ASSERT_EQ(tested.pointed.size(), 1U);
    EXPECT_GT(tested.pointed[0], Time{30s});
    EXPECT_LT(tested.pointed[0], Time{60s});
    point(tested.plot.widget(), GTK_TYPE_EVENT_CONTROLLER_MOTION, "leave", 0);
    EXPECT_EQ(tested.pointed.size(), 1U);
}

TEST_F(CurvePlotTest, HasANameForScreenReadersAndCanHaveTheFocus) {
    CurvePlotStage tested;
    tested.open();
    EXPECT_EQ(faultOfName(tested.plot.widget(), "Curve: something"), "");
    EXPECT_EQ(gtk_accessible_get_accessible_role(GTK_ACCESSIBLE(tested.plot.widget())),
              GTK_ACCESSIBLE_ROLE_IMG);
    EXPECT_NE(gtk_widget_grab_focus(tested.plot.widget()), FALSE);
}

TEST_F(CurvePlotTest, ItsLabelsAreAsWideAsTheWidestOne) {
    CurvePlotStage tested;
    tested.open();
    const int width = tested.plot.labelWidth();
    CurvePlot::Content wider = samplePlot();
    wider.lines.front().curve.points.front().least = -1e9;
    tested.plot.show(wider, "");
    EXPECT_GT(tested.plot.labelWidth(), width);
}

} // namespace
} // namespace pallax::gtk
