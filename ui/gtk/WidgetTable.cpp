#include "ui/gtk/WidgetTable.h"

#include "text/AgeText.h"
#include "ui/gtk/ShownText.h"

#include <algorithm>
#include <cmath>
#include <utility>
#include <vector>

namespace pallax::gtk {

namespace {

constexpr double kFirstWidth = 360; // until the window's is known

} // namespace

WidgetTable& widgetTable(ui::TableView& table) {
    return static_cast<WidgetTable&>(table);
}

WidgetTable::WidgetTable(ui::TableSource& source, const PangoMetrics& metrics, const Guard& guard,
                         double inset, ListLook* look)
    : _source(source), _metrics(metrics), _guard(guard),
      _widget(owned(GTK_OVERLAY(gtk_overlay_new()))),
      _content(GTK_BOX(gtk_box_new(GTK_ORIENTATION_VERTICAL, 0))),
      _scroller(GTK_SCROLLED_WINDOW(gtk_scrolled_window_new())),
      _rows(gtk_string_list_new(nullptr)), _look(look), _inset(inset),
      _width(kFirstWidth - kAccessoryWidth - inset) {
    makeList();
    listen();
}

/// The widgets may outlive the table, while they move off the screen.
WidgetTable::~WidgetTable() {
    for (const auto& [instance, handler] : _handlers) {
        g_signal_handler_disconnect(instance, handler);
    }
    gtk_list_view_set_factory(_list, nullptr);
}

void WidgetTable::makeList() {
    GtkListItemFactory* factory = gtk_signal_list_item_factory_new();
    const auto on = [&](const char* signal, void (WidgetTable::*action)(GtkListItem*)) {
        const gulong handler =
            connect(factory, signal, _guard,
                    std::function<void(GtkListItem*)>(
                        [this, action](GtkListItem* item) { (this->*action)(item); }));
        _handlers.emplace_back(factory, handler);
    };
    on("setup", &WidgetTable::setUp);
    on("bind", &WidgetTable::bind);
    on("teardown", &WidgetTable::tearDown);
    auto* selection = gtk_no_selection_new(shared(G_LIST_MODEL(_rows.get())).release());
    _list = GTK_LIST_VIEW(gtk_list_view_new(GTK_SELECTION_MODEL(selection), factory));
    gtk_list_view_set_single_click_activate(_list, TRUE);
    gtk_list_view_set_show_separators(_list, TRUE);
    gtk_widget_add_css_class(GTK_WIDGET(_list), "pallax-rows");

    _placeholder = GTK_LABEL(gtk_label_new(nullptr));
    gtk_widget_add_css_class(GTK_WIDGET(_placeholder), "dim-label");
    gtk_label_set_wrap(_placeholder, TRUE);
    gtk_widget_set_can_target(GTK_WIDGET(_placeholder), FALSE);
    gtk_scrolled_window_set_policy(_scroller, GTK_POLICY_NEVER, GTK_POLICY_AUTOMATIC);
    gtk_scrolled_window_set_child(_scroller, GTK_WIDGET(_list));
    gtk_widget_set_vexpand(GTK_WIDGET(_scroller), TRUE);
    gtk_box_append(_content, GTK_WIDGET(_scroller));
    gtk_overlay_set_child(_widget.get(), GTK_WIDGET(_content));
    gtk_overlay_add_overlay(_widget.get(), GTK_WIDGET(_placeholder));
    gtk_widget_set_vexpand(widget(), TRUE);
    gtk_widget_set_hexpand(widget(), TRUE);
}

void WidgetTable::listen() {
    const auto keep = [&](gpointer instance, gulong handler) {
        _handlers.emplace_back(instance, handler);
    };
    keep(_list, connect(_list, "activate", _guard,
                        std::function<void(guint)>([this](guint row) { activate(row); })));
    GtkAdjustment* vertical = gtk_scrolled_window_get_vadjustment(_scroller);
    keep(vertical, onSignal(vertical, "value-changed", _guard, [this] { fillView(true); }));
    keep(vertical, onSignal(vertical, "notify::page-size", _guard,
                            [this] { later(&WidgetTable::widthChanged); }));
    GtkAdjustment* sideways = gtk_scrolled_window_get_hadjustment(_scroller);
    keep(sideways, onSignal(sideways, "notify::page-size", _guard,
                            [this] { later(&WidgetTable::widthChanged); }));
    keep(_list, onSignal(_list, "map", _guard, [this] { later(&WidgetTable::reloadData); }));
    GtkEventController* keys = gtk_event_controller_key_new();
    gtk_event_controller_set_propagation_phase(keys, GTK_PHASE_CAPTURE);
    keep(keys,
         connect(keys, "key-pressed", _guard,
                 std::function<gboolean(guint)>([this](guint key) { return handleKey(key); })));
    gtk_widget_add_controller(GTK_WIDGET(_list), keys);
}

void WidgetTable::later(void (WidgetTable::*action)()) {
    _guard.queue().async([alive = std::weak_ptr<WidgetTable*>(_alive), action] {
        if (const auto table = alive.lock()) {
            ((*table)->*action)();
        }
    });
}

std::shared_ptr<ui::TableCell> WidgetTable::dequeueReusableCell(std::string_view /*identifier*/) {
    return nullptr;
}

ui::Rect WidgetTable::contentBounds() const {
    return {{_inset, 0}, {_width, kRowHeight}};
}

PaneModel& WidgetTable::pane() const {
    if (_pane == nullptr) {
        _pane = &dynamic_cast<PaneOwner&>(_source).pane();
    }
    return *_pane;
}

void WidgetTable::setUp(GtkListItem* item) {
    Bound& bound = _bound[item];
    bound.view = std::make_unique<RowView>(
        _metrics, _guard, [this, &bound](double offset) { remember(bound, offset); });
    gtk_list_item_set_child(item, bound.view->widget());
}

void WidgetTable::bind(GtkListItem* item) {
    fill(_bound.at(item), gtk_list_item_get_position(item));
}

void WidgetTable::tearDown(GtkListItem* item) {
    gtk_list_item_set_child(item, nullptr);
    _bound.erase(item);
}

void WidgetTable::remember(const Bound& bound, double offset) {
    if (offset > 0) {
        _offsets[bound.name] = offset;
    } else {
        _offsets.erase(bound.name);
    }
}

RowNotes WidgetTable::notesOf(const PaneRow& row) const {
    return {.count = row.elements ? std::to_string(*row.elements) : "",
            .age = row.overdue ? ageText(*row.overdue) : "",
            .hasChanged = row.hasChanged,
            .isOpen = row.isBranch && row.name == _openRow};
}

void WidgetTable::fill(Bound& bound, std::size_t shown) {
    if (shown >= pane().shownRows()) {
        return; // the list hears of it soon
    }
    const std::size_t row = pane().rowAt(shown);
    const std::shared_ptr<ui::TableCell> cell = _source.cellForRow(row);
    if (cell->style() == ui::CellStyle::Plain) {
        cell->layoutSubviews(); // the others were laid out by their source
    }
    const PaneRow content = pane().row(row);
    const auto offset = _offsets.find(content.name);
    const double wanted = offset != _offsets.end() ? offset->second : 0;
    bound.name = content.name;
    bound.isStale = false;
    bound.view->fill(*cell, notesOf(content));
    if (bound.view->offset() != wanted) {
        bound.view->setOffset(wanted);
    }
}

WidgetTable::Range WidgetTable::rowsInView() const {
    GtkAdjustment* vertical = gtk_scrolled_window_get_vadjustment(_scroller);
    const double height = _metrics.pixels(kRowHeight) + 1; // with its separator
    const double top = gtk_adjustment_get_value(vertical) / height;
    const double shown = gtk_adjustment_get_page_size(vertical) / height;
    return {static_cast<std::size_t>(std::max(top - 1, 0.0)),
            static_cast<std::size_t>(std::max(top + shown + 2, 0.0))};
}

void WidgetTable::fillView(bool onlyStale) {
    const Range view = rowsInView();
    for (auto& [item, bound] : _bound) {
        const guint position = gtk_list_item_get_position(item);
        if (position == GTK_INVALID_LIST_POSITION) {
            continue;
        }
        if (position < view.first || position >= view.past) {
            bound.isStale = bound.isStale || !onlyStale;
        } else if (bound.isStale || !onlyStale) {
            fill(bound, position);
        }
    }
}

/// Rows that stay keep their widgets, so that the place in the list does, too.
void WidgetTable::reloadData() {
    const auto had = g_list_model_get_n_items(G_LIST_MODEL(_rows.get()));
    const auto has = static_cast<guint>(pane().shownRows());
    if (has < had) {
        gtk_string_list_splice(_rows.get(), has, had - has, nullptr);
    }
    if (has > had) {
        std::vector<const char*> texts(has - had, "");
        texts.push_back(nullptr);
        gtk_string_list_splice(_rows.get(), had, 0, texts.data());
    }
    showPlaceholder();
    refreshTable();
    if (!isSeen(GTK_WIDGET(_list))) {
        for (auto& [item, bound] : _bound) { // filled when it is seen
            bound.isStale = true;
        }
        return;
    }
    const auto focused = std::find_if(_bound.begin(), _bound.end(),
                                      [](const auto& each) { return hasFocus(each.second); });
    const std::string name = focused != _bound.end() ? focused->second.name : "";
    fillView(false);
    if (focused != _bound.end() && focused->second.name != name) {
        focusRow(name);
    }
}

void WidgetTable::showPlaceholder() {
    showText(_placeholder, pane().emptyWords());
}

void WidgetTable::deselectRow(std::size_t /*row*/, bool /*animated*/) {
    // A row is only active while it is pressed: nothing stays selected.
}

void WidgetTable::sizeToFit() {
    constexpr double kMostRows = 6;
    const double rows = std::min(static_cast<double>(pane().totalRows()), kMostRows);
    gtk_scrolled_window_set_min_content_height(
        _scroller, static_cast<int>(rows * (_metrics.pixels(kRowHeight) + 1)));
}

void WidgetTable::activate(guint position) {
    if (position >= pane().shownRows()) {
        return;
    }
    const std::size_t row = pane().rowAt(position);
    pane().moveCursorTo(position);
    openRow(row);
}

void WidgetTable::openRow(std::size_t row) {
    _selecting();
    const PaneRow selected = pane().row(row);
    const std::string path = childPath(pane().path(), selected.name);
    const auto leafSelected = _leafSelected;
    _source.didSelectRow(row);
    if (!selected.isBranch) {
        leafSelected(path, selected.text.value_or(""));
    }
}

bool WidgetTable::hasFocus(const Bound& bound) {
    GtkWidget* row = gtk_widget_get_parent(bound.view->widget());
    return row != nullptr && gtk_widget_has_focus(row) != 0;
}

std::optional<std::size_t> WidgetTable::focusedRow() const {
    for (const auto& [item, bound] : _bound) {
        if (const guint shown = gtk_list_item_get_position(item);
            hasFocus(bound) && shown < pane().shownRows()) {
            return pane().rowAt(shown);
        }
    }
    return std::nullopt;
}

std::optional<std::string> WidgetTable::focusedValue() const {
    const auto row = focusedRow();
    const NodeRef node = row ? pane().nodeAt(*row) : nullptr;
    const bool isValue = node != nullptr && node->childNodes() == nullptr;
    return isValue ? std::optional(childPath(pane().path(), node->displayName())) : std::nullopt;
}

/// The keys that scroll the row with the focus sideways.
gboolean WidgetTable::handleKey(guint key) {
    constexpr double kStep = 40; // points
    const bool isLeft = key == GDK_KEY_Left || key == GDK_KEY_KP_Left;
    if (!isLeft && key != GDK_KEY_Right && key != GDK_KEY_KP_Right) {
        return FALSE;
    }
    for (const auto& [item, bound] : _bound) {
        if (hasFocus(bound)) {
            return bound.view->scrollBy(isLeft ? -kStep : kStep) ? TRUE : FALSE;
        }
    }
    return FALSE;
}

/// The focus stays on its row, by name, when rows come and go above it.
void WidgetTable::focusRow(const std::string& name) {
    for (const auto& [item, bound] : _bound) {
        GtkWidget* row = gtk_widget_get_parent(bound.view->widget());
        if (bound.name == name && row != nullptr &&
            gtk_list_item_get_position(item) != GTK_INVALID_LIST_POSITION) {
            gtk_widget_grab_focus(row);
            return;
        }
    }
}

/// Cells that a table has are not laid out anew: it asks for others.
void WidgetTable::widthChanged() {
    const double pixels =
        gtk_adjustment_get_page_size(gtk_scrolled_window_get_hadjustment(_scroller));
    const double width =
        std::max(std::floor(pixels / _metrics.scale()) - kAccessoryWidth - _inset, 0.0);
    if (pixels > 0 && width != _width) {
        _width = width;
        for (auto& [item, bound] : _bound) {
            bound.isStale = true;
        }
    }
    fillView(true);
    focusWanted();
}

void WidgetTable::setOpenRow(std::optional<std::string> name) {
    if (name != _openRow) {
        _openRow = std::move(name);
        fillView(false);
    }
}

void WidgetTable::setFilter(std::string text) {
    if (isShownAsTable() && _columns != nullptr) {
        _columns->model().setFilter(text);
    }
    pane().setFilter(std::move(text));
    reloadData();
}

} // namespace pallax::gtk
