#include "ui/gtk/SpanChooser.h"

#include "text/AgeText.h"
#include "ui/contents/CurveReading.h"
#include "ui/gtk/ShownText.h"
#include "ui/gtk/Translation.h"

#include <string>
#include <utility>

namespace pallax::gtk {

SpanChooser::SpanChooser(const Guard& guard, std::function<void(std::size_t span)> chosen)
    : _chosen(std::move(chosen)), _box(owned(GTK_BOX(gtk_box_new(GTK_ORIENTATION_HORIZONTAL, 0)))) {
    gtk_widget_add_css_class(widget(), "linked");
    gtk_widget_set_halign(widget(), GTK_ALIGN_CENTER);
    for (const CurveSpan& span : curveSpans()) {
        const bool isAll = span.length.count() == 0;
        const std::string label = isAll ? translated("All") : ageText(span.length);
        auto* button = GTK_TOGGLE_BUTTON(gtk_toggle_button_new_with_label(label.c_str()));
        gtk_widget_add_css_class(GTK_WIDGET(button), "pallax-span");
        nameWidget(GTK_WIDGET(button), translated(std::string(span.words).c_str()));
        if (!_buttons.empty()) {
            gtk_toggle_button_set_group(button, _buttons.front());
        }
        onSignal(button, "toggled", guard, [this, button, index = _buttons.size()] {
            if (!_isShowing && gtk_toggle_button_get_active(button) != FALSE) {
                _chosen(index);
            }
        });
        gtk_box_append(_box.get(), GTK_WIDGET(button));
        _buttons.push_back(button);
    }
}

void SpanChooser::show(std::size_t span) {
    _isShowing = true;
    gtk_toggle_button_set_active(_buttons.at(span), TRUE);
    _isShowing = false;
}

} // namespace pallax::gtk
