#include "ui/gtk/Style.h"

#include "ui/gtk/Ref.h"

namespace pallax::gtk {

namespace {

/// The layouts have their own margins: the theme's would add to them. Rows change at each tick: the
/// theme's transitions would draw a dozen frames each time.
constexpr const char* kStyle = R"(
row { transition: none; }
.pallax-rows { background: none; }
.pallax-rows > row { padding: 0; margin: 0; border-radius: 0; }
.pallax-rows label { padding: 0; }
.pallax-rows undershoot.right, .pallax-table undershoot.right {
    background: linear-gradient(to left, alpha(@window_fg_color, 0.3), transparent 14px);
}
.pallax-table undershoot.left { background: none; }
.pallax-rows undershoot.left {
    background: linear-gradient(to right, alpha(@window_fg_color, 0.3), transparent 14px);
}
.pallax-changed { color: @accent_color; }
.pallax-open { background: alpha(@accent_bg_color, 0.2); }
.pallax-headings { border-bottom: 1px solid @borders; }
.pallax-heading { padding: 0; min-width: 0; min-height: 0; border-radius: 0; }
.pallax-toolbar { border-top: 1px solid @borders; min-height: 34px; padding: 4px 10px; }
.pallax-plot:focus-visible { outline: 2px solid @accent_color; }
.pallax-message {
    padding: 10px 18px; margin: 12px; border-radius: 18px;
    color: white; background: #303034; border: 1px solid alpha(white, 0.3);
}
.pallax-span { padding-left: 8px; padding-right: 8px; min-width: 0; }
.pallax-banner { padding: 4px 10px; background: alpha(@warning_bg_color, 0.3); }
)";

} // namespace

void addStyle() {
    static const bool isAdded = [] {
        const Ref<GtkCssProvider> provider(gtk_css_provider_new());
        gtk_css_provider_load_from_data(provider.get(), kStyle, -1);
        gtk_style_context_add_provider_for_display(gdk_display_get_default(),
                                                   GTK_STYLE_PROVIDER(provider.get()),
                                                   GTK_STYLE_PROVIDER_PRIORITY_APPLICATION);
        return true;
    }();
    (void)isAdded;
}

void setClass(GtkWidget* widget, const char* name, bool isSet) {
    if (isSet) {
        gtk_widget_add_css_class(widget, name);
    } else {
        gtk_widget_remove_css_class(widget, name);
    }
}

} // namespace pallax::gtk
