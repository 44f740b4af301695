#include "ui/gtk/ChangesView.h"

#include "tests/ui/gtk/WindowStage.h"
#include "tests/ui/gtk/XDisplay.h"

namespace pallax::gtk {
namespace {

class ChangesViewTest : public DisplayTest {};

/// A window with what is tested.
struct ChangesViewStage {
    ~ChangesViewStage() { stage.frame.pages().close(); }
    std::string dump() {
        stage.settle();
        return stage.dump();
    }
    WindowStage stage{360, 720};
    ChangesView view;
};

TEST_F(ChangesViewTest, SectionsHaveTheirLinesBelowThem) {
    ChangesViewStage tested;
    tested.stage.frame.pages().open(tested.view.widget(), "Changes");
    tested.view.show("Changes from 22:14:20 to 22:14:50",
                     {"Measurements", "  RSRP  -77 dBm → -81 dBm", "  RSRQ  -5 dB → -6 dB", "",
                      "Neighbours", "  1 is new"});
    EXPECT_EQ(tested.dump(), R"(
button: Back (focus)
title: Changes / 
text: Changes from 22:14:20 to 22:14:50
text: Measurements
text: RSRP
text: -77 dBm → -81 dBm
text: RSRQ
text: -5 dB → -6 dB
text: Neighbours
text: 1 is new
)");
    tested.view.show("Changes from 22:14:20 to 22:14:20", {});
    EXPECT_EQ(tested.dump(), R"(
button: Back (focus)
title: Changes / 
text: Changes from 22:14:20 to 22:14:20
text: Nothing differs.
)");
}

TEST_F(ChangesViewTest, TheSameContentAgainChangesNothing) {
    ChangesViewStage tested;
    tested.stage.frame.pages().open(tested.view.widget(), "Changes");
    tested.view.show("Changes", {"Measurements", "  RSRP"});
    GtkWidget* label = WindowStage::below(tested.view.widget(), GTK_TYPE_LABEL);
    tested.view.show("Changes", {"Measurements", "  RSRP"});
    EXPECT_EQ(WindowStage::below(tested.view.widget(), GTK_TYPE_LABEL), label);
}

} // namespace
} // namespace pallax::gtk
