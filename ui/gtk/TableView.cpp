#include "ui/gtk/TableView.h"

#include "app/table/TableColumns.h"
#include "ui/gtk/ShownText.h"

#include <algorithm>
#include <cmath>

namespace pallax::gtk {

namespace {

constexpr double kRowPoints = 42;

} // namespace

TableView::TableView(const PangoMetrics& metrics, const Guard& guard, std::function<void()> open)
    : _metrics(metrics), _guard(guard), _open(std::move(open)), _planner(metrics),
      _box(owned(GTK_BOX(gtk_box_new(GTK_ORIENTATION_VERTICAL, 0)))),
      _scroller(GTK_SCROLLED_WINDOW(gtk_scrolled_window_new())),
      _items(g_list_store_new(G_TYPE_OBJECT)) {
    makeList();
    GtkAdjustment* sideways = gtk_scrolled_window_get_hadjustment(_scroller);
    // The headings may be made again: not while one of them calls.
    const auto changing = [this](auto change) {
        return [this, change](auto... column) {
            change(column...);
            later(&TableView::columnsChanged);
        };
    };
    _headings = std::make_unique<TableHeadings>(
        _metrics, _guard, sideways,
        TableHeadings::Actions{
            .press = changing([this](std::size_t column) { pressHeading(_model, column); }),
            .hide = changing([this](std::size_t column) { _model.hide(column); }),
            .showAll = changing([this] { _model.showAllColumns(); })});
    gtk_box_append(_box.get(), _headings->widget());
    gtk_box_append(_box.get(), GTK_WIDGET(_scroller));
    gtk_widget_set_vexpand(widget(), TRUE);
    gtk_widget_set_hexpand(widget(), TRUE);
    listen();
}

/// The widgets may outlive the table.
TableView::~TableView() {
    for (const auto& [instance, handler] : _handlers) {
        g_signal_handler_disconnect(instance, handler);
    }
    if (_tick != 0) {
        gtk_widget_remove_tick_callback(GTK_WIDGET(_list), _tick);
    }
    gtk_list_view_set_factory(_list, nullptr);
}

void TableView::makeList() {
    GtkListItemFactory* factory = gtk_signal_list_item_factory_new();
    const auto on = [&](const char* signal, void (TableView::*action)(GtkListItem*)) {
        _handlers.emplace_back(
            factory, connect(factory, signal, _guard,
                             std::function<void(GtkListItem*)>(
                                 [this, action](GtkListItem* item) { (this->*action)(item); })));
    };
    on("setup", &TableView::setUp);
    on("bind", &TableView::bind);
    on("teardown", &TableView::tearDown);
    auto* selection = gtk_no_selection_new(shared(G_LIST_MODEL(_items.get())).release());
    _list = GTK_LIST_VIEW(gtk_list_view_new(GTK_SELECTION_MODEL(selection), factory));
    gtk_list_view_set_single_click_activate(_list, TRUE);
    gtk_list_view_set_show_separators(_list, TRUE);
    gtk_widget_add_css_class(GTK_WIDGET(_list), "pallax-rows");
    gtk_scrolled_window_set_child(_scroller, GTK_WIDGET(_list));
    gtk_widget_add_css_class(GTK_WIDGET(_scroller), "pallax-table");
    gtk_widget_set_vexpand(GTK_WIDGET(_scroller), TRUE);
}

void TableView::listen() {
    const auto keep = [&](gpointer instance, gulong handler) {
        _handlers.emplace_back(instance, handler);
    };
    keep(_list, connect(_list, "activate", _guard, std::function<void(guint)>([this](guint row) {
                            if (row < _model.shownRows()) {
                                _model.moveCursorTo(row);
                                fillView(false);
                                _open();
                            }
                        })));
    keep(_list, onSignal(_list, "notify::focus-child", _guard, [this] { focusMoved(); }));
    keep(_list, onSignal(_list, "map", _guard, [this] { later(&TableView::refresh); }));
    GtkAdjustment* vertical = gtk_scrolled_window_get_vadjustment(_scroller);
    keep(vertical, onSignal(vertical, "value-changed", _guard, [this] { fillView(true); }));
    GtkAdjustment* sideways = gtk_scrolled_window_get_hadjustment(_scroller);
    // A layout may change the value, and nothing can be moved during a layout.
    keep(sideways,
         onSignal(sideways, "value-changed", _guard, [this] { later(&TableView::moveStrips); }));
    for (GtkAdjustment* each : {vertical, sideways}) {
        keep(each,
             onSignal(each, "notify::page-size", _guard, [this] { later(&TableView::refresh); }));
    }
    GtkEventController* keys = gtk_event_controller_key_new();
    gtk_event_controller_set_propagation_phase(keys, GTK_PHASE_CAPTURE);
    keep(keys, connect(keys, "key-pressed", _guard,
                       std::function<gboolean(guint, guint, GdkModifierType)>(
                           [this](guint key, guint /*code*/, GdkModifierType state) {
                               return handleKey(key, state);
                           })));
    gtk_widget_add_controller(widget(), keys);
}

void TableView::later(void (TableView::*action)()) {
    _guard.queue().async([alive = std::weak_ptr<TableView*>(_alive), action] {
        if (const auto table = alive.lock()) {
            ((*table)->*action)();
        }
    });
}

void TableView::setName(const std::string& name) {
    gtk_accessible_update_property(GTK_ACCESSIBLE(_list), GTK_ACCESSIBLE_PROPERTY_LABEL,
                                   shownText(name).c_str(), -1);
}

void TableView::setUp(GtkListItem* item) {
    Bound& bound = _bound[item];
    bound.strip = std::make_unique<ColumnStrip>(ColumnStrip::Kind::Row,
                                                gtk_scrolled_window_get_hadjustment(_scroller));
    gtk_list_item_set_child(item, bound.strip->widget());
}

void TableView::bind(GtkListItem* item) {
    fill(_bound.at(item), gtk_list_item_get_position(item));
}

void TableView::tearDown(GtkListItem* item) {
    gtk_list_item_set_child(item, nullptr);
    _bound.erase(item);
}

void TableView::setFilter(std::string text) {
    _model.setFilter(std::move(text));
    refresh();
}

/// The keyboard stays on the cursor's row.
void TableView::refresh() {
    const bool hadFocus = gtk_widget_get_focus_child(GTK_WIDGET(_list)) != nullptr;
    adoptPlan();
    syncItems();
    if (gtk_widget_get_mapped(GTK_WIDGET(_list)) == FALSE) {
        for (auto& [item, bound] : _bound) { // filled when it is seen
            bound.isStale = true;
        }
        return;
    }
    fillView(false);
    if (hadFocus && focusedRow() != _model.cursor()) {
        focusCursor();
    }
}

void TableView::adoptPlan() {
    const double seen =
        gtk_adjustment_get_page_size(gtk_scrolled_window_get_hadjustment(_scroller));
    const ColumnPlan plan = _planner.plan(_model, static_cast<int>(seen));
    if (plan != _plan || _planNumber == 0) {
        _plan = plan;
        ++_planNumber;
    }
    _headings->show(_model, _plan);
}

int TableView::rowHeight() const {
    return _metrics.pixels(kRowPoints);
}

void TableView::fillView(bool onlyStale) {
    GtkAdjustment* vertical = gtk_scrolled_window_get_vadjustment(_scroller);
    const double height = rowHeight() + 1; // with its separator
    const double top = gtk_adjustment_get_value(vertical);
    const double first = top / height - 1;
    const double past = (top + gtk_adjustment_get_page_size(vertical)) / height + 2;
    for (auto& [item, bound] : _bound) {
        const guint position = gtk_list_item_get_position(item);
        if (position == GTK_INVALID_LIST_POSITION) {
            continue;
        }
        if (position < first || position >= past) {
            bound.isStale = bound.isStale || !onlyStale;
        } else if (bound.isStale || !onlyStale) {
            fill(bound, position);
        }
    }
}

std::optional<std::size_t> TableView::focusedRow() const {
    GtkWidget* focused = gtk_widget_get_focus_child(GTK_WIDGET(_list));
    for (const auto& [item, bound] : _bound) {
        if (focused != nullptr && gtk_widget_get_parent(bound.strip->widget()) == focused) {
            return gtk_list_item_get_position(item);
        }
    }
    return std::nullopt;
}

/// The cursor is where the keyboard is.
void TableView::focusMoved() {
    const auto row = _isSyncing ? std::nullopt : focusedRow();
    if (row && *row < _model.shownRows() && *row != _model.cursor()) {
        _model.moveCursorTo(*row);
        fillView(false);
    }
}

/// A list that has changed cannot scroll before its next layout.
void TableView::afterLayout() {
    constexpr int kFrames = 2; // the first ends with the layout
    _framesToWait = kFrames;
    if (_tick == 0) {
        _tick = gtk_widget_add_tick_callback(
            GTK_WIDGET(_list),
            +[](GtkWidget* /*list*/, GdkFrameClock* /*clock*/, gpointer table) -> gboolean {
                return static_cast<TableView*>(table)->tick();
            },
            this, nullptr);
    }
}

gboolean TableView::tick() {
    GtkAdjustment* vertical = gtk_scrolled_window_get_vadjustment(_scroller);
    if (--_framesToWait > 0 || gtk_adjustment_get_page_size(vertical) <= 0) {
        return TRUE;
    }
    _tick = 0;
    const double height = rowHeight() + 1; // with its separator
    const double top = static_cast<double>(_model.cursor()) * height;
    gtk_adjustment_clamp_page(vertical, top, top + height);
    if (std::exchange(_wantsChosen, false)) {
        revealChosen();
    }
    fillView(false);
    if (std::exchange(_wantsFocus, false)) {
        grabFocus();
    }
    return FALSE;
}

void TableView::columnsChanged() {
    refresh();
    _wantsChosen = true;
    afterLayout();
}

/// Pushes the table until the column is seen by which it is sorted.
void TableView::revealChosen() {
    int left = -_plan.fixedWidth();
    for (const ColumnPlan::Place& place : _plan.places) {
        if (place.column == _model.chosenColumn() && left >= 0) {
            GtkAdjustment* sideways = gtk_scrolled_window_get_hadjustment(_scroller);
            const double seen = gtk_adjustment_get_page_size(sideways) - _plan.fixedWidth();
            const double value = gtk_adjustment_get_value(sideways);
            const double least = left + place.width - seen; // its end is seen
            gtk_adjustment_set_value(sideways, std::min<double>(std::max(value, least), left));
        }
        left += place.width;
    }
}

void TableView::focusCursor() {
    _wantsFocus = true;
    afterLayout();
}

void TableView::grabFocus() {
    for (const auto& [item, bound] : _bound) {
        GtkWidget* row = gtk_widget_get_parent(bound.strip->widget());
        if (row != nullptr && gtk_list_item_get_position(item) == _model.cursor()) {
            gtk_widget_grab_focus(row);
            return;
        }
    }
}

void TableView::moveStrips() {
    _headings->move();
    for (const auto& [item, bound] : _bound) {
        bound.strip->move();
    }
}

bool TableView::pushSideways(double points) {
    GtkAdjustment* sideways = gtk_scrolled_window_get_hadjustment(_scroller);
    const double before = gtk_adjustment_get_value(sideways);
    gtk_adjustment_set_value(sideways, before + points * _metrics.scale());
    return gtk_adjustment_get_value(sideways) != before;
}

void TableView::copy() {
    if (const auto text = _model.copied()) {
        gdk_clipboard_set_text(gtk_widget_get_clipboard(widget()), text->c_str());
    }
}

/// The keys of tables on a terminal, and those of every toolkit.
gboolean TableView::handleKey(guint key, GdkModifierType state) {
    constexpr double kStep = 40; // points
    if ((state & GDK_CONTROL_MASK) != 0) {
        if (key != GDK_KEY_c) {
            return FALSE;
        }
        copy();
        return TRUE;
    }
    switch (key) {
    case GDK_KEY_Left:
    case GDK_KEY_KP_Left:
        return pushSideways(-kStep) ? TRUE : FALSE;
    case GDK_KEY_Right:
    case GDK_KEY_KP_Right:
        return pushSideways(kStep) ? TRUE : FALSE;
    case GDK_KEY_y:
        copy();
        return TRUE;
    default:
        if (!handleColumnKey(_model, gdk_keyval_to_unicode(key))) {
            return FALSE;
        }
        columnsChanged();
        return TRUE;
    }
}

} // namespace pallax::gtk
