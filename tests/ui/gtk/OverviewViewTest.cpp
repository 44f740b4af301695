#include "ui/gtk/OverviewView.h"

#include "tests/ui/gtk/WindowStage.h"
#include "tests/ui/gtk/XDisplay.h"

namespace pallax::gtk {
namespace {

using namespace std::chrono_literals;

class OverviewViewTest : public DisplayTest {
protected:
    static StatusValue level(const std::string& name, const std::string& text, double number) {
        return {.name = name,
                .field = "lte.serving_cell_measurements.measured_rsrp",
                .text = text,
                .number = number,
                .grade = Grade::Good,
                .read = Time{}};
    }
    static Overview overview() {
        Overview made;
        StatusCell cell{.system = "LTE",
                        .site = "eNodeB 104470 sector 1",
                        .identity = {},
                        .channel = {},
                        .band = "",
                        .megahertz = {},
                        .levels = {level("RSRP", "-92.25 dBm", -92.25)}};
        made.status.cells.push_back(cell);
        made.status.neighbours.push_back({"LTE", "PCI 252 <b>", level("RSRP", "-97.00 dBm", -97)});
        made.status.contexts.push_back({"ims", "Active"});
        made.events.push_back(
            {EventKind::CellChange, Time{10s}, 7, "serving cell 150 → 182 after 58 s", {}});
        made.events.push_back(
            {EventKind::CellChange, Time{20s}, 9, "serving cell 182 → 183 after 31 s", {}});
        made.ahead = 1h;
        return made;
    }
};

TEST_F(OverviewViewTest, BesideTheRootPaneAndOverItOnAPhone) {
    OverviewView view;
    view.show(overview());
    WindowStage stage(360, 900);
    stage.frame.setDetail(view.widget(), "Overview");
    stage.frame.toggleDetail();
    stage.settle();
    EXPECT_EQ(stage.dump(), R"(
button: Back
title: Overview / 
text: LTE cell
text: eNodeB 104470 sector 1
text: RSRP
text: good
text: -92.25 dBm
level: 50 %
text: Neighbours
text: PCI 252 <b>
text: LTE
text: -97.00 dBm
level: 45 %
text: Contexts
text: ims
text: Active
text: Events
text: serving cell 182 → 183 after 31 s
text: 01:00:20
text: serving cell 150 → 182 after 58 s
text: 01:00:10
spinner: turns
text: Connecting
button: Save
)");
    stage.press("Back");
    EXPECT_EQ(stage.dump().find("LTE cell"), std::string::npos);
    stage.resize(1024, 768);
    EXPECT_NE(stage.dump().find("LTE cell"), std::string::npos);
}

TEST_F(OverviewViewTest, WithoutAnythingKnownThereAreWords) {
    OverviewView view;
    view.show(Overview());
    WindowStage stage(1024, 768);
    stage.frame.setDetail(view.widget(), "Overview");
    stage.settle();
    EXPECT_NE(stage.dump().find("text: Nothing is known about the radio.\n"), std::string::npos)
        << stage.dump();
}

TEST_F(OverviewViewTest, WhatIsSeenIsTheLatestFromTheFirstFrame) {
    WindowStage stage(360, 720);
    OverviewView view;
    Overview latest = overview();
    int asked = 0;
    view.showWhenSeen(stage.guard, [&] {
        ++asked;
        return latest;
    });
    stage.frame.setDetail(view.widget(), "Overview");
    stage.settle();
    EXPECT_EQ(asked, 0) << "on a phone it is hidden";
    stage.frame.toggleDetail();
    stage.settle();
    EXPECT_NE(stage.dump().find("text: -92.25 dBm\n"), std::string::npos) << stage.dump();
    stage.frame.toggleDetail();
    stage.settle();
    latest.status.cells[0].levels[0].text = "-80.00 dBm";
    stage.frame.toggleDetail();
    stage.settle();
    EXPECT_NE(stage.dump().find("text: -80.00 dBm\n"), std::string::npos) << stage.dump();
    EXPECT_EQ(asked, 2);
}

TEST_F(OverviewViewTest, RowsStayWhenOnlyTheirTextsChange) {
    OverviewView view;
    Overview shown = overview();
    view.show(shown);
    GtkWidget* before = WindowStage::below(view.widget(), ADW_TYPE_ACTION_ROW);
    shown.status.cells[0].levels[0].text = "-80.00 dBm";
    view.show(shown);
    EXPECT_EQ(WindowStage::below(view.widget(), ADW_TYPE_ACTION_ROW), before);
    EXPECT_NE(WindowStage::found(view.widget(),
                                 [](GtkWidget* widget) {
                                     return GTK_IS_LABEL(widget) &&
                                            gtk_label_get_text(GTK_LABEL(widget)) ==
                                                std::string("-80.00 dBm");
                                 }),
              nullptr);
}

TEST_F(OverviewViewTest, RowsAndGroupsThatAreNotNeededNowAreHiddenUntilTheyAre) {
    OverviewView view;
    const Overview before = overview();
    view.show(before);
    WindowStage stage(1024, 768);
    stage.frame.setDetail(view.widget(), "Overview");
    stage.settle();
    const std::string dump = stage.dump();
    GtkWidget* row = WindowStage::below(view.widget(), ADW_TYPE_ACTION_ROW);

    Overview fewer = before;
    fewer.status.neighbours.clear(); // the contexts come in their place
    fewer.events.pop_back();
    view.show(fewer);
    stage.settle();
    const std::string fewerDump = stage.dump();
    EXPECT_EQ(fewerDump.find("text: Neighbours"), std::string::npos) << fewerDump;
    EXPECT_EQ(fewerDump.find("182 → 183"), std::string::npos) << fewerDump;
    EXPECT_NE(fewerDump.find("text: Contexts\ntext: ims\ntext: Active\ntext: Events\n"
                             "text: serving cell 150 → 182 after 58 s\ntext: 01:00:10\n"),
              std::string::npos)
        << fewerDump;

    view.show(before);
    stage.settle();
    EXPECT_EQ(stage.dump(), dump);
    EXPECT_EQ(WindowStage::below(view.widget(), ADW_TYPE_ACTION_ROW), row);
}

} // namespace
} // namespace pallax::gtk
