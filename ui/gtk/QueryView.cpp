#include "ui/gtk/QueryView.h"

#include "ui/gtk/ShownText.h"
#include "ui/gtk/Translation.h"

#include <utility>

namespace pallax::gtk {

QueryView::QueryView(const PangoMetrics& metrics, const Guard& guard, Surroundings surroundings)
    : _guard(guard), _work(std::move(surroundings.work)), _close(std::move(surroundings.close)),
      _say(std::move(surroundings.say)), _content(std::move(surroundings.queries)),
      _page(metrics, guard, [this] { open(); }), _field(GTK_ENTRY(gtk_entry_new())) {
    table().setName(translated("Answer"));
    buildField();
    _page.show(sentence());
}

void QueryView::buildField() {
    gtk_entry_set_placeholder_text(_field, "select kind, count(*) from event group by kind");
    nameWidget(GTK_WIDGET(_field), translated("Question in SQL"));
    gtk_entry_set_icon_from_icon_name(_field, GTK_ENTRY_ICON_SECONDARY, "go-next-symbolic");
    gtk_entry_set_icon_tooltip_text(_field, GTK_ENTRY_ICON_SECONDARY, translated("Ask"));
    onSignal(_field, "activate", _guard, [this] { ask(); });
    onSignal(_field, "icon-press", _guard, [this] { ask(); });
    GtkEventController* keys = gtk_event_controller_key_new();
    gtk_event_controller_set_propagation_phase(keys, GTK_PHASE_CAPTURE);
    connect(keys, "key-pressed", _guard,
            std::function<gboolean(guint)>([this](guint key) { return handleKey(key); }));
    gtk_widget_add_controller(GTK_WIDGET(_field), keys);
    _page.addField(GTK_WIDGET(_field));
}

/// Recalls earlier queries, and goes back.
gboolean QueryView::handleKey(guint key) {
    if (key == GDK_KEY_Escape) {
        _close();
        return TRUE;
    }
    if (key != GDK_KEY_Up && key != GDK_KEY_Down) {
        return FALSE;
    }
    const std::string typed = gtk_editable_get_text(GTK_EDITABLE(_field));
    if (const auto query = _content.recall(key == GDK_KEY_Up, typed)) {
        gtk_editable_set_text(GTK_EDITABLE(_field), query->c_str());
        gtk_editable_set_position(GTK_EDITABLE(_field), -1);
    }
    return TRUE;
}

void QueryView::ask() {
    const std::string query = gtk_editable_get_text(GTK_EDITABLE(_field));
    if (query.find_first_not_of(' ') == std::string::npos) {
        return;
    }
    _work([this, query] {
        _content.run(query, _page.model());
        _page.show(sentence());
        if (_content.state() == QueryState::Answered) {
            table().focusCursor();
        }
    });
}

void QueryView::focus() {
    gtk_widget_grab_focus(GTK_WIDGET(_field));
}

void QueryView::open() {
    switch (_content.goThere(_page.model())) {
    case QueryContent::Went::There:
        return _close();
    case QueryContent::Went::NoInstant:
        return _say(translated("The row has no packet and no time to go to."));
    case QueryContent::Went::NoRow:
        break;
    }
}

std::string QueryView::sentence() const {
    switch (_content.state()) {
    case QueryState::NotAsked:
        return translated("Ask in SQL: select * from tables lists the tables.");
    case QueryState::NothingToAsk:
        return translated("There is nothing to ask yet: no packet has come.");
    case QueryState::Running:
        return translated("The query is running.");
    case QueryState::NoRows:
        return translated("The query gave no rows.");
    case QueryState::Failed:
    case QueryState::Answered:
        break;
    }
    return _content.sentence();
}

} // namespace pallax::gtk
