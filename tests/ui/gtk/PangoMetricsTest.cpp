#include "ui/gtk/PangoMetrics.h"

#include "tests/ui/gtk/XDisplay.h"

namespace pallax::gtk {
namespace {

constexpr ui::Font kBold{ui::FontFace::BoldSystem, 15};
constexpr ui::Font kRegular{ui::FontFace::System, 15};

class Metrics : public DisplayTest {
protected:
    const Ref<GtkWidget>& widget() {
        if (!_widget) {
            _widget = owned(gtk_label_new(nullptr));
        }
        return _widget;
    }

private:
    Ref<GtkWidget> _widget;
};

TEST_F(Metrics, BoldTextsAreWiderAndLargerFontsHigher) {
    const PangoMetrics metrics(widget().get());
    EXPECT_GT(metrics.measure("Measured RSRP", kBold).width,
              metrics.measure("Measured RSRP", kRegular).width);
    EXPECT_GT(metrics.measure("A", {ui::FontFace::System, 30}).height,
              metrics.measure("A", kRegular).height);
    EXPECT_EQ(metrics.measure("", kRegular).width, 0);
}

TEST_F(Metrics, WhatIsShownAsAnEscapeIsMeasuredAsOne) {
    const PangoMetrics metrics(widget().get());
    EXPECT_EQ(metrics.measure("\x1B", kRegular), metrics.measure("\\x1B", kRegular));
    EXPECT_EQ(metrics.measure("a\nb", kRegular), metrics.measure("a\\x0Ab", kRegular));
}

TEST_F(Metrics, PointsFollowTheUsersTextSize) {
    GtkSettings* settings = gtk_settings_get_default();
    gint usual = 0;
    g_object_get(settings, "gtk-xft-dpi", &usual, nullptr);
    g_object_set(settings, "gtk-xft-dpi", 96 * 1024, nullptr);
    PangoMetrics metrics(widget().get());
    EXPECT_EQ(metrics.pixels(50), 50);
    g_object_set(settings, "gtk-xft-dpi", 2 * 96 * 1024, nullptr);
    EXPECT_TRUE(metrics.adoptSettings());
    EXPECT_FALSE(metrics.adoptSettings());
    EXPECT_EQ(metrics.pixels(50), 100);
    g_object_set(settings, "gtk-xft-dpi", usual, nullptr);
}

} // namespace
} // namespace pallax::gtk
