#include "ui/gtk/Remarks.h"

#include "ui/gtk/ShownText.h"
#include "ui/gtk/Translation.h"

#include <utility>

namespace pallax::gtk {

Remarks::Remarks() : _label(shared(GTK_LABEL(gtk_label_new(nullptr)))) {
    gtk_label_set_ellipsize(_label.get(), PANGO_ELLIPSIZE_END);
    gtk_label_set_xalign(_label.get(), 0);
    for (const char* look : {"dim-label", "caption"}) {
        gtk_widget_add_css_class(widget(), look);
    }
    showText(_label.get(), "");
}

void Remarks::setNote(std::string text) {
    _note = std::move(text);
    show();
}

void Remarks::setStream(std::string state) {
    _stream = std::move(state);
    show();
}

void Remarks::setAlarms(const std::vector<std::string>& names) {
    _alarms.clear();
    for (const std::string& alarm : names) {
        _alarms += (_alarms.empty() ? translated("alarm: ") : ", ") + alarm;
    }
    show();
}

void Remarks::show() {
    std::string text;
    for (const std::string* part : {&_alarms, &_stream, &_note}) {
        if (!part->empty()) {
            text += (text.empty() ? "" : " · ") + *part;
        }
    }
    if (text == std::exchange(_shown, text)) {
        return;
    }
    showText(_label.get(), text);
    showTooltip(widget(), text);
}

} // namespace pallax::gtk
