#include "ui/gtk/CurveInk.h"

#include <adwaita.h>
#include <array>
#include <vector>

namespace pallax::gtk {

namespace {

constexpr double kCurveWidth = 2;

/// Colours of the theme's palette that stand out from its background.
struct CurveColor {
    const char* onLight;
    const char* onDark;
};

constexpr std::array kCurveColors{
    CurveColor{"blue_4", "blue_2"},   CurveColor{"orange_5", "orange_2"},
    CurveColor{"green_5", "green_2"}, CurveColor{"purple_4", "purple_1"},
    CurveColor{"red_4", "red_1"},     CurveColor{"brown_4", "brown_1"},
};

std::vector<double> dashesOf(std::size_t number) {
    switch (number % kCurveColors.size()) {
    case 1:
        return {8, 4};
    case 2:
        return {2, 3};
    case 3:
        return {10, 3, 2, 3};
    case 4:
        return {4, 4};
    case 5:
        return {14, 4};
    default:
        return {};
    }
}

} // namespace

void setCurveColor(cairo_t* to, GtkWidget* widget, std::size_t number) {
    const CurveColor& names = kCurveColors.at(number % kCurveColors.size());
    const bool isDark = adw_style_manager_get_dark(adw_style_manager_get_default()) != FALSE;
    GdkRGBA color;
    if (gtk_style_context_lookup_color(gtk_widget_get_style_context(widget),
                                       isDark ? names.onDark : names.onLight, &color) == FALSE) {
        return setTextColor(to, widget, 1);
    }
    gdk_cairo_set_source_rgba(to, &color);
}

void setCurveInk(cairo_t* to, GtkWidget* widget, std::size_t number) {
    setCurveColor(to, widget, number);
    cairo_set_line_width(to, kCurveWidth);
    const std::vector<double> dashes = dashesOf(number);
    cairo_set_dash(to, dashes.data(), static_cast<int>(dashes.size()), 0);
}

void setTextColor(cairo_t* to, GtkWidget* widget, double opacity) {
    GdkRGBA color;
    gtk_style_context_get_color(gtk_widget_get_style_context(widget), &color);
    color.alpha *= static_cast<float>(opacity);
    gdk_cairo_set_source_rgba(to, &color);
}

} // namespace pallax::gtk
