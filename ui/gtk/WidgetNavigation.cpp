#include "ui/gtk/WidgetNavigation.h"

#include "platform/ui/ModalScreen.h"
#include "ui/gtk/WidgetTable.h"

#include <algorithm>
#include <chrono>
#include <iterator>
#include <optional>
#include <utility>

namespace pallax::gtk {

namespace {

constexpr int kListWidth = 320;                       ///< least width of a pane beside another
constexpr std::chrono::milliseconds kTransition{600}; ///< longer than any page moves

} // namespace

WidgetNavigation::WidgetNavigation(std::shared_ptr<ui::TableScreen> root, const Guard& guard,
                                   Frame frame)
    : _guard(guard), _frame(std::move(frame)), _columns(owned(ADW_LEAFLET(adw_leaflet_new()))),
      _others(ADW_LEAFLET(adw_leaflet_new())), _screens{std::move(root)} {
    for (AdwLeaflet* leaflet : {_columns.get(), _others}) {
        adw_leaflet_set_can_navigate_back(leaflet, TRUE);
        adw_leaflet_set_transition_type(leaflet, ADW_LEAFLET_TRANSITION_TYPE_OVER);
        const auto swiped = [this] { adoptSwipe(); };
        _handlers.emplace_back(
            leaflet, onSignal(leaflet, "notify::child-transition-running", guard, swiped));
    }
    adw_leaflet_set_can_unfold(_others, FALSE);
    add(top(), _columns.get());
    GtkWidget* others = GTK_WIDGET(_others);
    gtk_widget_set_hexpand(others, TRUE);
    gtk_widget_set_size_request(others, kListWidth, -1);
    adw_leaflet_page_set_navigatable(
        adw_leaflet_append(_columns.get(), gtk_separator_new(GTK_ORIENTATION_VERTICAL)), FALSE);
    adw_leaflet_append(_columns.get(), others);
    const auto folded = [this] {
        _guard.queue().async([alive = std::weak_ptr<WidgetNavigation*>(_alive)] {
            if (const auto self = alive.lock()) {
                (*self)->showPages();
                (*self)->_frame.changed();
            }
        });
    };
    _handlers.emplace_back(_columns.get(),
                           onSignal(_columns.get(), "notify::folded", guard, folded));
}

WidgetNavigation::~WidgetNavigation() {
    for (const auto& [instance, handler] : _handlers) {
        g_signal_handler_disconnect(instance, handler);
    }
    setDetail(nullptr); // which others use, too
}

/// A swipe does not go back to it: it is no pane.
void WidgetNavigation::setDetail(GtkWidget* widget) {
    _isShowing = true;
    if (_detail != nullptr) {
        adw_leaflet_remove(_others, _detail);
    }
    _detail = widget;
    if (_detail != nullptr) {
        adw_leaflet_page_set_navigatable(adw_leaflet_prepend(_others, _detail), FALSE);
    }
    _isShowing = false;
    showPages();
}

void WidgetNavigation::showDetail(bool isShown) {
    if (isShown) {
        popTo(0, false);
    }
    _isDetailOnTop = isShown;
    showPages();
}

/// A row that is selected in a pane below the top takes the panes above it off first.
void WidgetNavigation::add(ui::TableScreen& screen, AdwLeaflet* to) {
    WidgetTable& table = widgetTable(screen.table());
    table.onSelecting([this, &screen] {
        const auto found = std::find_if(_screens.begin(), _screens.end(),
                                        [&](const auto& each) { return each.get() == &screen; });
        if (found != _screens.end()) {
            popTo(static_cast<std::size_t>(found - _screens.begin()), false);
        }
    });
    table.onLeaf(_frame.leafSelected);
    gtk_widget_set_size_request(table.widget(), kListWidth, -1);
    _isShowing = true; // the first page of an empty leaflet is shown at once
    adw_leaflet_append(to, table.widget());
    _isShowing = false;
}

void WidgetNavigation::push(std::shared_ptr<ui::TableScreen> screen, bool animated) {
    _isDetailOnTop = false;
    top().viewWillDisappear(animated);
    _screens.push_back(std::move(screen));
    add(top(), _others);
    show(top(), animated);
}

void WidgetNavigation::popTo(std::size_t index, bool animated) {
    if (index + 1 >= _screens.size()) {
        return;
    }
    top().viewWillDisappear(animated);
    const auto past = _screens.begin() + static_cast<std::ptrdiff_t>(index) + 1;
    std::move(past, _screens.end(), std::back_inserter(_leaving));
    _screens.erase(past, _screens.end());
    show(top(), animated);
    _guard.queue().after(kTransition, [alive = std::weak_ptr<WidgetNavigation*>(_alive)] {
        if (const auto self = alive.lock()) {
            (*self)->removeLeaving();
        }
    });
}

void WidgetNavigation::removeLeaving() {
    for (const auto& screen : _leaving) {
        GtkWidget* page = widgetTable(screen->table()).widget();
        if (gtk_widget_get_parent(page) == GTK_WIDGET(_others)) {
            adw_leaflet_remove(_others, page);
        }
    }
    _leaving.clear();
}

void WidgetNavigation::showToolbar() {
    _isToolbarShown = true;
    _frame.toolbarShown();
}

void WidgetNavigation::presentModal(std::shared_ptr<ui::ModalScreen> screen, bool animated) {
    _modal = std::move(screen);
    _modal->viewDidLoad();
    _modal->viewWillAppear(animated);
    _frame.modalChanged();
}

void WidgetNavigation::dismissModal(bool animated) {
    if (const std::shared_ptr<ui::ModalScreen> closing = std::exchange(_modal, nullptr)) {
        closing->viewWillDisappear(animated);
        closing->viewDidUnload();
        _frame.modalChanged();
    }
}

void WidgetNavigation::appear() {
    top().viewWillAppear(false);
    widgetTable(top().table()).reloadData();
    showPages();
    _frame.changed();
}

void WidgetNavigation::back() {
    if (isDetailOnTop() && !isSideBySide()) {
        showDetail(false);
        _frame.changed();
    } else if (!isAtRoot()) {
        popTo(_screens.size() - 2, true);
    }
}

std::optional<std::string> WidgetNavigation::focusedValue() const {
    for (const auto& screen : _screens) {
        if (auto path = widgetTable(screen->table()).focusedValue()) {
            return path;
        }
    }
    return std::nullopt;
}

void WidgetNavigation::show(ui::TableScreen& screen, bool animated) {
    if (_delegate != nullptr) {
        _delegate->navigationControllerWillShow(*this, screen, animated);
    }
    screen.viewWillAppear(animated);
    widgetTable(screen.table()).reloadData();
    showPages();
    _frame.changed();
}

/// How the pages move is up to the toolkit and to the user's settings.
void WidgetNavigation::showPages() {
    _isShowing = true;
    GtkWidget* others = GTK_WIDGET(_others);
    GtkWidget* root = widgetTable(_screens.front()->table()).widget();
    if (!isAtRoot()) {
        adw_leaflet_set_visible_child(_others, widgetTable(top().table()).widget());
    } else if (_detail != nullptr) {
        adw_leaflet_set_visible_child(_others, _detail);
    }
    const bool isRootSeen = isAtRoot() && !isDetailOnTop();
    adw_leaflet_set_visible_child(_columns.get(), isRootSeen ? root : others);
    widgetTable(_screens.front()->table())
        .setOpenRow(isSideBySide() && !isAtRoot() ? std::optional(_screens[1]->title())
                                                  : std::nullopt);
    _isShowing = false;
}

void WidgetNavigation::adoptSwipe() {
    if (_isShowing || isSideBySide() || (isAtRoot() && !_isDetailOnTop)) {
        return;
    }
    if (adw_leaflet_get_child_transition_running(_columns.get()) != FALSE ||
        adw_leaflet_get_child_transition_running(_others) != FALSE) {
        return;
    }
    GtkWidget* root = widgetTable(_screens.front()->table()).widget();
    if (adw_leaflet_get_visible_child(_columns.get()) == root) {
        _isDetailOnTop = false;
        return isAtRoot() ? _frame.changed() : popTo(0, true);
    }
    GtkWidget* shown = adw_leaflet_get_visible_child(_others);
    for (std::size_t index = 1; index + 1 < _screens.size(); ++index) {
        if (widgetTable(_screens[index]->table()).widget() == shown) {
            return popTo(index, true);
        }
    }
}

} // namespace pallax::gtk
