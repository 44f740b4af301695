#include "ui/gtk/MainFrame.h"

#include "ui/gtk/EndedPage.h"
#include "ui/gtk/SaveScreen.h"
#include "ui/gtk/ShownText.h"
#include "ui/gtk/Style.h"
#include "ui/gtk/Translation.h"
#include "ui/gtk/WidgetTable.h"

#include <utility>
#include <variant>

namespace pallax::gtk {

namespace {

constexpr int kUsualWidth = 1000;
constexpr int kUsualHeight = 700;
constexpr int kLeastWidth = 320;
constexpr int kLeastHeight = 240;
constexpr const char* kPanesPage = "panes";
constexpr const char* kModalPage = "modal";
constexpr const char* kEndedPage = "ended";

} // namespace

MainFrame::MainFrame(GtkApplication* application, const Guard& guard, Actions actions)
    : _guard(guard), _actions(std::move(actions)),
      _window(shared(GTK_WIDGET(
          g_object_new(ADW_TYPE_APPLICATION_WINDOW, "application", application, nullptr)))),
      _metrics(_window.get()), _messages(_guard), _layers(GTK_STACK(gtk_stack_new())),
      _pages(_layers, _guard), _header(ADW_HEADER_BAR(adw_header_bar_new())),
      _title(ADW_WINDOW_TITLE(adw_window_title_new("Pallax", ""))),
      _back(GTK_BUTTON(gtk_button_new_from_icon_name("go-previous-symbolic"))),
      _oldValues(GTK_LABEL(gtk_label_new(nullptr))), _panes(ADW_BIN(adw_bin_new())),
      _filter(_guard,
              [this](const std::string& text) {
                  if (_stack != nullptr) {
                      widgetTable(_stack->top().table()).setFilter(text);
                  }
              }),
      _lists(GTK_BUTTON(gtk_button_new())),
      _bars(GTK_BOX(gtk_box_new(GTK_ORIENTATION_VERTICAL, 0))),
      _toolbar(GTK_BOX(gtk_box_new(GTK_ORIENTATION_HORIZONTAL, 8))),
      _spinner(GTK_SPINNER(gtk_spinner_new())), _status(GTK_LABEL(gtk_label_new(nullptr))),
      _save(GTK_BUTTON(gtk_button_new_with_label(translated("Save")))) {
    addStyle();
    build();
    listen();
}

MainFrame::~MainFrame() {
    for (const auto& [instance, handler] : _handlers) {
        g_signal_handler_disconnect(instance, handler);
    }
    gtk_window_destroy(window());
}

void MainFrame::build() {
    gtk_window_set_title(window(), "Pallax");
    gtk_window_set_default_size(window(), kUsualWidth, kUsualHeight);
    gtk_widget_set_size_request(_window.get(), kLeastWidth, kLeastHeight);
    nameWidget(GTK_WIDGET(_back), translated("Back"));
    gtk_widget_set_visible(GTK_WIDGET(_back), FALSE);
    adw_header_bar_pack_start(_header, GTK_WIDGET(_back));
    adw_header_bar_pack_start(_header, GTK_WIDGET(_lists));
    gtk_widget_set_visible(GTK_WIDGET(_lists), FALSE);
    adw_header_bar_set_title_widget(_header, GTK_WIDGET(_title));
    gtk_widget_add_css_class(GTK_WIDGET(_oldValues), "pallax-banner");
    gtk_label_set_wrap(_oldValues, TRUE);
    showText(_oldValues, "");
    GtkWidget* panes = GTK_WIDGET(_messages.panes());
    gtk_overlay_set_child(_messages.panes(), GTK_WIDGET(_panes));
    gtk_widget_set_vexpand(panes, TRUE);

    GtkWidget* page = gtk_box_new(GTK_ORIENTATION_VERTICAL, 0);
    for (GtkWidget* child : {GTK_WIDGET(_header), _filter.widget(), GTK_WIDGET(_oldValues), panes,
                             GTK_WIDGET(_bars), buildToolbar()}) {
        gtk_box_append(GTK_BOX(page), child);
    }
    gtk_stack_add_named(_layers, page, kPanesPage);
    gtk_stack_set_transition_type(_layers, GTK_STACK_TRANSITION_TYPE_OVER_UP_DOWN);
    gtk_overlay_set_child(_messages.window(), GTK_WIDGET(_layers));
    adw_application_window_set_content(ADW_APPLICATION_WINDOW(_window.get()),
                                       GTK_WIDGET(_messages.window()));
}

GtkWidget* MainFrame::buildToolbar() {
    GtkWidget* toolbar = GTK_WIDGET(_toolbar);
    gtk_widget_add_css_class(toolbar, "toolbar");
    gtk_widget_add_css_class(toolbar, "pallax-toolbar");
    gtk_widget_set_visible(toolbar, FALSE);
    gtk_widget_set_visible(GTK_WIDGET(_spinner), FALSE);
    gtk_widget_set_visible(GTK_WIDGET(_save), FALSE);
    gtk_widget_set_valign(GTK_WIDGET(_save), GTK_ALIGN_CENTER);
    nameWidget(GTK_WIDGET(_spinner), translated("Connecting"));
    GtkWidget* texts = gtk_box_new(GTK_ORIENTATION_VERTICAL, 0);
    gtk_widget_set_hexpand(texts, TRUE);
    gtk_widget_set_valign(texts, GTK_ALIGN_CENTER);
    gtk_label_set_ellipsize(_status, PANGO_ELLIPSIZE_END);
    gtk_label_set_xalign(_status, 0);
    gtk_box_append(GTK_BOX(texts), GTK_WIDGET(_status));
    gtk_box_append(GTK_BOX(texts), _remarks.widget());
    for (GtkWidget* child : {GTK_WIDGET(_spinner), texts, GTK_WIDGET(_save)}) {
        gtk_box_append(_toolbar, child);
    }
    return toolbar;
}

void MainFrame::listen() {
    onSignal(_back, "clicked", _guard, [this] { back(); });
    onSignal(_save, "clicked", _guard, [this] { _saveAction(); });
    onSignal(_lists, "clicked", _guard, [this] { switchLists(); });
    connect(_window.get(), "close-request", _guard, std::function<gboolean()>([this]() -> gboolean {
                _work.stop();
                _guard.queue().async(_actions.closed);
                return TRUE; // the window goes with the program
            }));
    GtkEventController* keys = gtk_event_controller_key_new();
    gtk_event_controller_set_propagation_phase(keys, GTK_PHASE_CAPTURE);
    connect(keys, "key-pressed", _guard,
            std::function<gboolean(guint, guint, GdkModifierType)>(
                [this](guint key, guint code, GdkModifierType state) {
                    return handleKey(key, code, state);
                }));
    gtk_widget_add_controller(_window.get(), keys);
    GtkSettings* settings = gtk_settings_get_default();
    for (const char* property : {"notify::gtk-xft-dpi", "notify::gtk-font-name"}) {
        _handlers.emplace_back(settings, onSignal(settings, property, _guard, [this] {
                                   (void)_metrics.adoptSettings();
                                   reloadTables();
                               }));
    }
    onSignal(_window.get(), "realize", _guard, [this] {
        GdkSurface* surface = gtk_native_get_surface(GTK_NATIVE(_window.get()));
        const auto changed = [this] { reloadTables(); }; // which were not filled while hidden
        _handlers.emplace_back(surface, onSignal(surface, "notify::state", _guard, changed));
    });
}

void MainFrame::reloadTables() {
    if (_stack != nullptr) {
        for (const auto& screen : _stack->screens()) {
            screen->table().reloadData();
        }
    }
}

ui::Rect MainFrame::bounds() const {
    int width = gtk_widget_get_width(_window.get());
    int height = gtk_widget_get_height(_window.get());
    if (width <= 0 || height <= 0) { // not shown so far
        gtk_window_get_default_size(window(), &width, &height);
    }
    return {{}, {width / _metrics.scale(), height / _metrics.scale()}};
}

void MainFrame::setStack(WidgetNavigation* stack) {
    _live = stack;
    adopt(stack);
}

void MainFrame::setHeldStack(WidgetNavigation* stack) {
    WidgetNavigation* wanted = stack != nullptr ? stack : _live;
    if (wanted != _stack) {
        adopt(wanted);
    }
}

void MainFrame::adopt(WidgetNavigation* stack) {
    if (_stack != nullptr) {
        _stack->setDetail(nullptr); // it goes to the next one
    }
    _stack = stack;
    modalChanged();
    adw_bin_set_child(_panes, stack != nullptr ? stack->widget() : nullptr);
    if (stack != nullptr && _detail) {
        stack->setDetail(_detail.get());
    }
    refresh();
}

void MainFrame::setDetail(GtkWidget* widget, std::string title) {
    _detail = shared(widget);
    _detailTitle = std::move(title);
    if (_stack != nullptr) {
        _stack->setDetail(widget);
    }
}

void MainFrame::toggleDetail() {
    if (_stack != nullptr) {
        _stack->showDetail(!_stack->isDetailOnTop());
        refresh();
    }
}

void MainFrame::addBar(GtkWidget* bar) {
    gtk_box_append(_bars, bar);
}

void MainFrame::toggleSearch() {
    if (_pages.isOpen()) {
        _pages.toggleFilter();
    } else {
        _filter.toggle();
    }
}

void MainFrame::switchLists() {
    if (_stack == nullptr || !widgetTable(_stack->top().table()).isListWithColumns()) {
        return setMessage(translated("Nothing to show as a table: choose a list."));
    }
    widgetTable(_stack->top().table()).switchLook();
    refresh();
}

void MainFrame::setMenu(GtkWidget* button) {
    adw_header_bar_pack_end(_header, button);
}

void MainFrame::refresh() {
    if (_stack == nullptr) {
        return;
    }
    const bool isDetail = _stack->isDetailOnTop() && !_stack->isSideBySide();
    adw_window_title_set_title(_title,
                               shownText(isDetail ? _detailTitle : _stack->top().title()).c_str());
    gtk_widget_set_visible(GTK_WIDGET(_back), _stack->isAtRoot() && !isDetail ? FALSE : TRUE);
    // The panes of another instant have no connection to tell of.
    const bool hasToolbar = _stack == _live && _stack->isToolbarShown();
    gtk_widget_set_visible(GTK_WIDGET(_toolbar), hasToolbar ? TRUE : FALSE);
    showToolbarItems(_stack->top().toolbarItems());
    showListButton();
}

void MainFrame::showListButton() {
    const WidgetTable& table = widgetTable(_stack->top().table());
    const bool isTable = table.isShownAsTable();
    gtk_button_set_icon_name(_lists, isTable ? "view-list-symbolic" : "view-grid-symbolic");
    nameWidget(GTK_WIDGET(_lists),
               isTable ? translated("Show as Rows") : translated("Show as Table"));
    gtk_widget_set_visible(GTK_WIDGET(_lists), table.isListWithColumns() ? TRUE : FALSE);
}

/// The widgets stay, so that the focus stays on the button.
void MainFrame::showToolbarItems(const ui::BarItems& items) {
    bool canSave = false;
    for (const ui::BarItem& item : items) {
        if (const auto* indicator = std::get_if<ui::ActivityIndicator>(&item)) {
            gtk_spinner_set_spinning(_spinner, indicator->isSpinning ? TRUE : FALSE);
            const bool isHidden = !indicator->isSpinning && indicator->hidesWhenStopped;
            gtk_widget_set_visible(GTK_WIDGET(_spinner), isHidden ? FALSE : TRUE);
        } else if (const auto* label = std::get_if<ui::Label>(&item)) {
            _metrics.setFont(_status, label->font);
            gtk_label_set_text(_status, shownText(label->text).c_str());
        } else if (const auto* button = std::get_if<ui::SaveButton>(&item)) {
            _saveAction = button->action;
            canSave = true;
        }
    }
    gtk_widget_set_visible(GTK_WIDGET(_save), canSave ? TRUE : FALSE);
}

void MainFrame::modalChanged() {
    const bool isOpen = _stack != nullptr && _stack->modal() != nullptr;
    if (_modal != nullptr) {
        gtk_stack_set_visible_child_name(_layers, kPanesPage);
        gtk_stack_remove(_layers, std::exchange(_modal, nullptr));
    }
    if (isOpen) {
        _modal = saveScreen(*_stack->modal(), _guard);
        gtk_stack_add_named(_layers, _modal, kModalPage);
        gtk_stack_set_visible_child_name(_layers, kModalPage);
        gtk_widget_grab_focus(widgetTextField(_stack->modal()->field()).widget());
    }
}

void MainFrame::showWork(const std::string& words, std::function<void()> stop) {
    _work.show(_layers, _guard, words, std::move(stop));
}

void MainFrame::endWork() {
    _work.hide();
}

void MainFrame::present(const std::string& token) {
    if (!token.empty()) {
        gtk_window_set_startup_id(window(), token.c_str());
    }
    gtk_window_present(window());
}

void MainFrame::hide() {
    gtk_widget_set_visible(_window.get(), FALSE);
}

void MainFrame::showAlert(const ui::Alert& alert) {
    constexpr const char* kClose = "close";
    auto* dialog = ADW_MESSAGE_DIALOG(adw_message_dialog_new(
        window(), shownText(alert.title).c_str(), shownText(alert.message).c_str()));
    adw_message_dialog_add_response(dialog, kClose, alert.button.c_str());
    adw_message_dialog_set_close_response(dialog, kClose);
    gtk_window_present(GTK_WINDOW(dialog));
}

void MainFrame::setOrigin(const std::string& technology, const std::string& source) {
    const std::string text = technology.empty() ? source : technology + " · " + source;
    adw_window_title_set_subtitle(_title, shownText(text).c_str());
}

void MainFrame::setOldValues(const std::string& time) {
    showText(_oldValues,
             time.empty() ? "" : translated("The link was restarted: values from before ") + time);
}

void MainFrame::showEnded(const std::string& sentence) {
    const EndedPage page = endedPage(sentence, _guard, _actions.closed);
    gtk_stack_add_named(_layers, page.widget, kEndedPage);
    gtk_stack_set_visible_child_name(_layers, kEndedPage);
    gtk_widget_grab_focus(page.button);
}

void MainFrame::back() {
    if (_pages.isOpen()) {
        _pages.close();
    } else if (_stack != nullptr && _stack->modal() != nullptr) {
        _stack->modal()->cancelPressed();
    } else if (_stack != nullptr) {
        _stack->back();
    }
}

/// Comes before the widget with the focus, because rows of a list take the space bar. A widget that
/// needs a key itself gets it: letters go to a field, the space bar presses a button.
gboolean MainFrame::handleKey(guint key, guint /*code*/, GdkModifierType state) {
    if (_work.isShown()) {
        return _work.handleKey(key) ? TRUE : FALSE;
    }
    const bool isAlt = (state & GDK_ALT_MASK) != 0;
    const bool isControl = (state & GDK_CONTROL_MASK) != 0;
    GtkWidget* focus = gtk_window_get_focus(window());
    const bool isTyping = focus != nullptr && GTK_IS_EDITABLE(focus) != FALSE;
    const bool isPressed =
        focus != nullptr && (GTK_IS_BUTTON(focus) || GTK_IS_TOGGLE_BUTTON(focus));
    if (key == GDK_KEY_Back || (isAlt && key == GDK_KEY_Left) ||
        (key == GDK_KEY_Escape && !isTyping)) {
        back();
        return TRUE;
    }
    if ((isTyping && !isControl) || (isPressed && key == GDK_KEY_space) ||
        (_stack != nullptr && _stack->modal() != nullptr)) {
        return FALSE;
    }
    return _key(key, state) ? TRUE : FALSE;
}

} // namespace pallax::gtk
