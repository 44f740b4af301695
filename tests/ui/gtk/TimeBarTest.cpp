#include "ui/gtk/TimeBar.h"

#include "tests/ui/gtk/WindowStage.h"
#include "tests/ui/gtk/XDisplay.h"

#include <vector>

namespace pallax::gtk {
namespace {

class TimeBarTest : public DisplayTest {};

TEST_F(TimeBarTest, ShowsWhereTimeIsHeldAndTellsWhatTheUserWants) {
    WindowStage stage(360, 720);
    std::vector<TimeBar::Wish> wishes;
    std::vector<double> shares;
    TimeBar bar(stage.guard, {.wish = [&](TimeBar::Wish wish) { wishes.push_back(wish); },
                              .toShare = [&](double share) { shares.push_back(share); },
                              .goTo = [](const std::string&) {}});
    stage.frame.addBar(bar.widget());
    bar.show({.words = "held, 12 s behind", .clock = "22:14:06", .share = 0.25, .events = {0.5}});
    stage.settle();
    EXPECT_NE(stage.dump().find(R"(
text: 22:14:06, held, 12 s behind
scale: 25 %
button: Event before
button: Tick before
button: Play
button: Next tick
button: Next event
button: To the present
field: ""
button: Mark
button: Changes since the Mark (off)
)"),
              std::string::npos)
        << stage.dump();
    EXPECT_TRUE(shares.empty()) << "nobody has moved it";
    stage.press("Play");
    stage.press("Next event");
    EXPECT_EQ(wishes, (std::vector{TimeBar::Wish::HoldOrPlay, TimeBar::Wish::EventForward}));
    stage.press("Mark");
    EXPECT_EQ(wishes.back(), TimeBar::Wish::Mark);
    bar.show({.words = "", .clock = "22:14:06", .share = 0.25, .marked = 0.25});
    stage.press("Changes since the Mark");
    EXPECT_EQ(wishes.back(), TimeBar::Wish::ShowChanges);
    gtk_range_set_value(GTK_RANGE(WindowStage::below(bar.widget(), GTK_TYPE_SCALE)), 0.75);
    EXPECT_EQ(shares, std::vector{0.75});
}

TEST_F(TimeBarTest, APlaceThatIsTypedIsGoneTo) {
    WindowStage stage(360, 720);
    std::string place;
    TimeBar bar(stage.guard, {.wish = [](TimeBar::Wish) {},
                              .toShare = [](double) {},
                              .goTo = [&](const std::string& text) { place = text; }});
    GtkWidget* entry = WindowStage::below(bar.widget(), GTK_TYPE_ENTRY);
    gtk_editable_set_text(GTK_EDITABLE(entry), "+90s");
    g_signal_emit_by_name(entry, "activate");
    EXPECT_EQ(place, "+90s");
    EXPECT_STREQ(gtk_entry_get_placeholder_text(GTK_ENTRY(entry)),
                 "14:03, +90s, measured_rsrp < -110");
}

TEST_F(TimeBarTest, EscapeLeavesThePlace) {
    WindowStage stage(360, 720);
    TimeBar bar(stage.guard, {.wish = [](TimeBar::Wish) {},
                              .toShare = [](double) {},
                              .goTo = [](const std::string&) {}});
    stage.frame.addBar(bar.widget());
    const auto isInBar = [&] { return gtk_widget_get_focus_child(bar.widget()) != nullptr; };
    bar.focusPlace();
    stage.settle();
    ASSERT_TRUE(isInBar());
    const Ref<GListModel> controllers(
        gtk_widget_observe_controllers(WindowStage::below(bar.widget(), GTK_TYPE_ENTRY)));
    const Ref<GObject> keys(G_OBJECT(g_list_model_get_item(controllers.get(), 0)));
    const auto press = [&](guint key) {
        gboolean isTaken = FALSE;
        g_signal_emit_by_name(keys.get(), "key-pressed", key, 0U, GdkModifierType(), &isTaken);
        stage.settle();
        return isTaken != FALSE;
    };
    EXPECT_FALSE(press(GDK_KEY_a));
    EXPECT_TRUE(isInBar());
    EXPECT_TRUE(press(GDK_KEY_Escape));
    EXPECT_FALSE(isInBar());
}

} // namespace
} // namespace pallax::gtk
