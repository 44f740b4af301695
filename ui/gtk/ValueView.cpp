#include "ui/gtk/ValueView.h"

#include "ui/gtk/PageParts.h"
#include "ui/gtk/ShownText.h"
#include "ui/gtk/Translation.h"

#include <utility>

namespace pallax::gtk {

namespace {

GtkLabel* addLabel(GtkBox* to, const char* look) {
    GtkWidget* label = gtk_label_new(nullptr);
    gtk_label_set_xalign(GTK_LABEL(label), 0);
    gtk_label_set_wrap(GTK_LABEL(label), TRUE);
    gtk_label_set_selectable(GTK_LABEL(label), TRUE); // to copy it
    if (look != nullptr) {
        gtk_widget_add_css_class(label, look);
    }
    gtk_box_append(to, label);
    return GTK_LABEL(label);
}

} // namespace

ValueView::ValueView(const Guard& guard, Actions actions)
    : _actions(std::move(actions)), _plot(guard, _actions.pointed),
      _spans(guard, _actions.chooseSpan), _scroller(pageScroller()) {
    GtkBox* box = pageBox();
    _text = addLabel(box, "title-1");
    _quality = addLabel(box, "heading");
    _curve = GTK_BOX(gtk_box_new(GTK_ORIENTATION_VERTICAL, kPageBorder));
    buildCurve(guard, _curve);
    gtk_box_append(box, GTK_WIDGET(_curve));
    _facts = addLabel(box, nullptr);
    gtk_scrolled_window_set_child(_scroller.get(), GTK_WIDGET(box));
}

void ValueView::buildCurve(const Guard& guard, GtkBox* to) {
    gtk_box_append(to, _spans.widget());
    gtk_box_append(to, _plot.widget());
    _cursor = addLabel(to, "numeric");
    _statistics = addLabel(to, "dim-label");
    _graph = GTK_BUTTON(gtk_button_new());
    onSignal(_graph, "clicked", guard, _actions.toggleInGraph);
    GtkWidget* open = gtk_button_new_with_label(translated("Open the Graph"));
    onSignal(open, "clicked", guard, _actions.openGraph);
    for (GtkWidget* button : {GTK_WIDGET(_graph), open}) { // side by side, they are too wide
        gtk_widget_set_halign(button, GTK_ALIGN_START);
        gtk_box_append(to, button);
    }
}

void ValueView::show(Content content) {
    changeText(_text, content.text.empty() ? translated("no value now") : content.text);
    changeText(_quality, content.quality);
    std::string facts;
    for (const std::string& line : content.lines) {
        facts += (facts.empty() || line.empty() ? "" : "\n") + line;
    }
    changeText(_facts, facts);
    gtk_widget_set_visible(GTK_WIDGET(_curve), content.plot ? TRUE : FALSE);
    if (!content.plot) {
        return;
    }
    _spans.show(content.span);
    const std::string last = content.last.empty() ? "" : translated(", last ") + content.last;
    _plot.show(std::move(*content.plot), translated("Curve: ") + content.statistics + last);
    changeText(_statistics, content.statistics);
    // Its place stays, so that nothing moves below the pointer.
    changeText(_cursor, content.cursor.empty() ? " " : content.cursor);
    gtk_widget_set_opacity(GTK_WIDGET(_cursor), content.cursor.empty() ? 0 : 1);
    gtk_button_set_label(_graph, content.isInGraph ? translated("Remove from the Graph")
                                                   : translated("Add to the Graph"));
}

} // namespace pallax::gtk
