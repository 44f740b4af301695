#include "ui/gtk/RecordingBar.h"

#include "text/Format.h"
#include "ui/gtk/ShownText.h"
#include "ui/gtk/Translation.h"

#include <utility>

namespace pallax::gtk {

namespace {

constexpr int kBarGap = 8;

/// "1:02:03"
std::string clockOf(std::chrono::seconds time) {
    constexpr auto kPart = 60;
    const auto seconds = time.count();
    return formatText("%lld:%02lld:%02lld",
                      {seconds / kPart / kPart, seconds / kPart % kPart, seconds % kPart});
}

std::string sizeOf(std::uint64_t bytes) {
    gchar* text = g_format_size(bytes);
    std::string size = text;
    g_free(text);
    return size;
}

} // namespace

RecordingBar::RecordingBar(const Guard& guard, std::function<void()> stop)
    : _box(owned(GTK_BOX(gtk_box_new(GTK_ORIENTATION_HORIZONTAL, kBarGap)))),
      _file(GTK_LABEL(gtk_label_new(nullptr))), _amounts(GTK_LABEL(gtk_label_new(nullptr))) {
    gtk_widget_add_css_class(widget(), "pallax-toolbar");
    gtk_widget_set_visible(widget(), FALSE);
    GtkWidget* icon = gtk_image_new_from_icon_name("media-record-symbolic");
    gtk_widget_add_css_class(icon, "error");
    GtkWidget* texts = gtk_box_new(GTK_ORIENTATION_VERTICAL, 0);
    gtk_widget_set_hexpand(texts, TRUE);
    gtk_widget_set_valign(texts, GTK_ALIGN_CENTER);
    for (GtkLabel* label : {_file, _amounts}) {
        gtk_label_set_xalign(label, 0);
        gtk_box_append(GTK_BOX(texts), GTK_WIDGET(label));
    }
    gtk_label_set_ellipsize(_file, PANGO_ELLIPSIZE_MIDDLE);
    gtk_label_set_ellipsize(_amounts, PANGO_ELLIPSIZE_END);
    gtk_widget_add_css_class(GTK_WIDGET(_amounts), "caption");
    gtk_widget_add_css_class(GTK_WIDGET(_amounts), "numeric");
    GtkWidget* button = gtk_button_new_with_label(translated("Stop"));
    gtk_widget_set_valign(button, GTK_ALIGN_CENTER);
    onSignal(button, "clicked", guard, std::move(stop));
    for (GtkWidget* child : {icon, texts, button}) {
        gtk_box_append(_box.get(), child);
    }
}

void RecordingBar::show(const State& state) {
    showText(_file, state.file);
    showText(_amounts, formatText(translated("%llu packets, %@, %@"),
                                  {state.packets, sizeOf(state.bytes), clockOf(state.time)}));
    gtk_widget_set_visible(widget(), TRUE);
}

void RecordingBar::hide() {
    gtk_widget_set_visible(widget(), FALSE);
}

} // namespace pallax::gtk
