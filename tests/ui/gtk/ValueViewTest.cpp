#include "ui/gtk/ValueView.h"

#include "tests/ui/gtk/WindowStage.h"
#include "tests/ui/gtk/XDisplay.h"

namespace pallax::gtk {
namespace {

using namespace std::chrono_literals;

class ValueViewTest : public DisplayTest {
protected:
    static ValueView::Content content() {
        Curve curve;
        curve.points = {{Time{10s}, -94, -101.5, -90, -92}, {Time{12s}, -92, -92, -82.25, -85}};
        curve.gap = 5s;
        return {.text = "-92.25 dBm <b>",
                .quality = "fair",
                .lines = {"A sentence.", "", "/Section/RSRP"},
                .curve = curve,
                .from = Time{10s},
                .to = Time{70s},
                .ahead = 1h,
                .unit = "dBm"};
    }
};

TEST_F(ValueViewTest, IsAPageOverThePanesUntilTheUserGoesBack) {
    WindowStage stage(360, 720);
    stage.tick(Dictionary{{"RSRP", "-92.25 dBm"}});
    const std::string panes = stage.dump();
    ValueView view;
    view.show(content());
    stage.frame.openPage(view.widget(), "RSRP");
    stage.settle();
    EXPECT_EQ(stage.dump(), R"(
button: Back (focus)
title: RSRP / 
text: -92.25 dBm <b>
text: fair
text: -101.5 … -82.25 dBm, 01:00:10 – 01:01:10
text: A sentence.
/Section/RSRP
)");
    EXPECT_TRUE(stage.frame.isPageOpen());
    stage.press("Back");
    EXPECT_FALSE(stage.frame.isPageOpen());
    EXPECT_EQ(stage.dump(), panes);
    stage.frame.openPage(view.widget(), "RSRP"); // again
    stage.settle();
    EXPECT_NE(stage.dump().find("A sentence."), std::string::npos);
    stage.frame.closePage();
}

TEST_F(ValueViewTest, TheCurveHasAName) {
    ValueView view;
    view.show(content());
    char* fault = gtk_test_accessible_check_property(
        GTK_ACCESSIBLE(WindowStage::below(view.widget(), GTK_TYPE_DRAWING_AREA)),
        GTK_ACCESSIBLE_PROPERTY_LABEL, "Curve: -101.5 … -82.25 dBm, 01:00:10 – 01:01:10");
    EXPECT_EQ(fault, nullptr) << fault;
    g_free(fault);
}

TEST_F(ValueViewTest, WithoutNumbersThereIsNoCurve) {
    ValueView::Content none = content();
    none.curve.reset();
    none.text.clear();
    ValueView view;
    view.show(none);
    WindowStage stage(360, 720);
    stage.frame.openPage(view.widget(), "State");
    stage.settle();
    EXPECT_EQ(stage.dump(), R"(
button: Back (focus)
title: State / 
text: no value now
text: fair
text: A sentence.
/Section/RSRP
)");
    stage.frame.closePage();
}

TEST_F(ValueViewTest, ALeafThatIsSelectedIsToldWithItsPath) {
    WindowStage stage(360, 720);
    stage.tick(Dictionary{{"Section", Dictionary{{"RSRP", "-92.25 dBm"}}}});
    std::vector<std::string> told;
    stage.frame.onLeaf([&](const std::string& path, const std::string& text) {
        told = {path, text};
    });
    stage.select(0);
    EXPECT_TRUE(told.empty()) << "a branch opens a pane";
    stage.select(0);
    EXPECT_EQ(told, (std::vector<std::string>{"/Section/RSRP", "-92.25 dBm"}));
}

} // namespace
} // namespace pallax::gtk
