#include "ui/gtk/SearchView.h"

#include "ui/gtk/ShownText.h"
#include "ui/gtk/Translation.h"

#include <utility>

namespace pallax::gtk {

SearchView::SearchView(const PangoMetrics& metrics, const Guard& guard, Surroundings surroundings)
    : _guard(guard), _work(std::move(surroundings.work)), _close(std::move(surroundings.close)),
      _content(std::move(surroundings.search)), _page(metrics, guard, [this] { open(); }),
      _field(GTK_SEARCH_ENTRY(gtk_search_entry_new())),
      _frame(GTK_TOGGLE_BUTTON(gtk_toggle_button_new_with_label(translated("This Instant")))),
      _recording(
          GTK_TOGGLE_BUTTON(gtk_toggle_button_new_with_label(translated("Whole Recording")))) {
    _page.table().setName(translated("Hits"));
    buildFields();
    refresh();
}

void SearchView::buildFields() {
    nameWidget(GTK_WIDGET(_field), translated("Find a text in names and values"));
    onSignal(_field, "search-changed", _guard, [this] { search(); });
    onSignal(_field, "stop-search", _guard, [this] { _close(); });
    onSignal(_field, "activate", _guard, [this] { open(); });
    GtkEventController* keys = gtk_event_controller_key_new();
    gtk_event_controller_set_propagation_phase(keys, GTK_PHASE_CAPTURE);
    const auto pressed = [this](guint key) -> gboolean {
        if (key == GDK_KEY_Down) {
            _page.table().focusCursor();
        }
        return key == GDK_KEY_Down ? TRUE : FALSE;
    };
    connect(keys, "key-pressed", _guard, std::function<gboolean(guint)>(pressed));
    gtk_widget_add_controller(GTK_WIDGET(_field), keys);
    _page.addField(GTK_WIDGET(_field));

    GtkWidget* scopes = gtk_box_new(GTK_ORIENTATION_HORIZONTAL, 0);
    gtk_widget_add_css_class(scopes, "linked");
    gtk_box_set_homogeneous(GTK_BOX(scopes), TRUE);
    for (GtkToggleButton* each : {_frame, _recording}) {
        gtk_widget_set_hexpand(GTK_WIDGET(each), TRUE);
        gtk_label_set_ellipsize(GTK_LABEL(gtk_button_get_child(GTK_BUTTON(each))),
                                PANGO_ELLIPSIZE_END); // a long word does not widen the window
        gtk_box_append(GTK_BOX(scopes), GTK_WIDGET(each));
    }
    gtk_toggle_button_set_group(_recording, _frame);
    gtk_toggle_button_set_active(_frame, TRUE);
    onSignal(_recording, "toggled", _guard, [this] { search(); });
    _page.addField(scopes);
}

SearchScope SearchView::wantedScope() const {
    return gtk_toggle_button_get_active(_recording) != FALSE ? SearchScope::Recording
                                                             : SearchScope::Frame;
}

void SearchView::search() {
    _work([this] {
        _content.search(_page.model(), gtk_editable_get_text(GTK_EDITABLE(_field)), wantedScope());
        _page.show(sentence());
    });
}

void SearchView::refresh() {
    _content.refresh(_page.model());
    _page.show(sentence());
}

/// What is typed replaces the text before.
void SearchView::focus() {
    gtk_widget_grab_focus(GTK_WIDGET(_field));
    gtk_editable_select_region(GTK_EDITABLE(_field), 0, -1);
}

void SearchView::open() {
    if (_content.goThere(_page.model())) {
        _close();
    }
}

std::string SearchView::sentence() const {
    switch (_content.state()) {
    case SearchState::NothingTyped:
        return translated("Type a part of a name or a value.");
    case SearchState::NotInFrame:
        return translated("Nothing in this instant contains this text.");
    case SearchState::NotInRecording:
        return translated("No event, name or value of the recording contains it.");
    case SearchState::NothingToSearch:
        return translated("There is nothing to search yet: no packet has come.");
    case SearchState::Searching:
        return translated("The recording is being searched.");
    case SearchState::Stopped:
        return translated("The search was stopped.");
    case SearchState::Found:
        break;
    }
    const auto add = [](std::string& words, const char* sentence) {
        words += (words.empty() ? "" : " ") + std::string(sentence);
    };
    std::string words;
    if (_content.isStopped()) {
        add(words, translated("The search was stopped: there may be more hits."));
    } else if (_content.isFull()) {
        add(words, translated("Not all values of the recording were searched."));
    }
    if (_content.isCut()) {
        add(words, translated("These are the first 1,000 hits."));
    }
    return words;
}

} // namespace pallax::gtk
