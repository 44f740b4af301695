#include "ui/gtk/TableHeadings.h"

#include "app/table/TableColumns.h"
#include "ui/gtk/ShownText.h"
#include "ui/gtk/Translation.h"

#include <algorithm>
#include <string>
#include <utility>
#include <vector>

namespace pallax::gtk {

namespace {

constexpr double kOneLine = 26; // points
constexpr double kAnotherLine = 18;

/// The lines of a heading, and the mark of a sorted column.
GtkWidget* buildContent(const ColumnPlan::Place& place, const char* icon,
                        const PangoMetrics& metrics) {
    std::string text;
    for (const std::string& line : place.heading) {
        text += (text.empty() ? "" : "\n") + shownText(line);
    }
    GtkWidget* label = gtk_label_new(text.c_str());
    metrics.setFont(GTK_LABEL(label), icon != nullptr ? kChangedFont : kCellFont);
    gtk_label_set_xalign(GTK_LABEL(label), place.isRight ? 1 : 0);
    gtk_label_set_justify(GTK_LABEL(label), place.isRight ? GTK_JUSTIFY_RIGHT : GTK_JUSTIFY_LEFT);
    gtk_label_set_ellipsize(GTK_LABEL(label), PANGO_ELLIPSIZE_END);
    gtk_widget_set_hexpand(label, TRUE);
    if (icon == nullptr) {
        gtk_widget_add_css_class(label, "dim-label");
    }
    GtkWidget* mark = gtk_image_new_from_icon_name(icon);
    gtk_widget_set_size_request(mark, kRoomBehind, -1);
    GtkWidget* box = gtk_box_new(GTK_ORIENTATION_HORIZONTAL, 0);
    gtk_widget_set_margin_start(box, kRoomBefore);
    gtk_box_append(GTK_BOX(box), label);
    gtk_box_append(GTK_BOX(box), mark);
    return box;
}

} // namespace

TableHeadings::TableHeadings(const PangoMetrics& metrics, const Guard& guard,
                             GtkAdjustment* sideways, Actions actions)
    : _metrics(metrics), _guard(guard), _actions(std::move(actions)),
      _strip(ColumnStrip::Kind::Headings, sideways) {
    gtk_widget_add_css_class(widget(), "pallax-headings");
}

/// They are made again if something in them is another; the keyboard stays on its column.
void TableHeadings::show(const TableModel& table, const ColumnPlan& plan) {
    Shown wanted{plan, table.chosenColumn(), table.isDescending()};
    if (_shown == wanted) {
        return;
    }
    const auto focused = std::find_if(_buttons.begin(), _buttons.end(), gtk_widget_has_focus);
    std::vector<std::size_t> focusedColumn; // one, or none
    if (focused != _buttons.end()) {
        const auto index = static_cast<std::size_t>(focused - _buttons.begin());
        focusedColumn.push_back(_shown->plan.places[index].column);
    }
    _shown = std::move(wanted);
    closeMenu();
    _buttons.clear();
    std::size_t lines = 1;
    for (const ColumnPlan::Place& place : plan.places) {
        _buttons.push_back(heading(table, place));
        lines = std::max(lines, place.heading.size());
    }
    _strip.setCells(plan, _buttons);
    for (std::size_t index = 0; index < _buttons.size(); ++index) {
        if (focusedColumn == std::vector{plan.places[index].column}) {
            gtk_widget_grab_focus(_buttons[index]);
        }
    }
    gtk_widget_set_size_request(
        widget(), -1, _metrics.pixels(kOneLine + kAnotherLine * static_cast<double>(lines - 1)));
    gtk_widget_set_visible(widget(), _buttons.empty() ? FALSE : TRUE);
}

GtkWidget* TableHeadings::heading(const TableModel& table, const ColumnPlan::Place& place) {
    const bool isChosen = table.chosenColumn() == place.column;
    const bool isDescending = table.isDescending();
    const char* icon = !isChosen ? nullptr : isDescending ? "pan-down-symbolic" : "pan-up-symbolic";
    GtkWidget* button = gtk_button_new();
    gtk_button_set_child(GTK_BUTTON(button), buildContent(place, icon, _metrics));
    for (const char* look : {"flat", "pallax-heading"}) {
        gtk_widget_add_css_class(button, look);
    }
    const char* sorted = !isChosen      ? ""
                         : isDescending ? translated(", sorted, greatest first")
                                        : translated(", sorted, least first");
    const std::string name = shownText(headingOf(table.content().columns[place.column])) + sorted;
    nameWidget(button, name.c_str());
    const std::size_t column = place.column;
    onSignal(button, "clicked", _guard, [this, column] { _actions.press(column); });
    GtkGesture* click = gtk_gesture_click_new();
    gtk_gesture_single_set_button(GTK_GESTURE_SINGLE(click), GDK_BUTTON_SECONDARY);
    for (GtkGesture* gesture : {click, gtk_gesture_long_press_new()}) {
        // Before the button gets it, which then is not pressed.
        gtk_event_controller_set_propagation_phase(GTK_EVENT_CONTROLLER(gesture),
                                                   GTK_PHASE_CAPTURE);
        onSignal(gesture, "pressed", _guard, [this, gesture, button, column] {
            gtk_gesture_set_state(gesture, GTK_EVENT_SEQUENCE_CLAIMED);
            openMenu(button, column);
        });
        gtk_widget_add_controller(button, GTK_EVENT_CONTROLLER(gesture));
    }
    return button;
}

void TableHeadings::openMenu(GtkWidget* heading, std::size_t column) {
    closeMenu();
    _menu = gtk_popover_new();
    GtkWidget* entries = gtk_box_new(GTK_ORIENTATION_VERTICAL, 0);
    const auto add = [&](const char* words, std::function<void()> action) {
        GtkWidget* entry = gtk_button_new_with_label(words);
        gtk_widget_add_css_class(entry, "flat");
        onSignal(entry, "clicked", _guard, [this, action = std::move(action)] {
            gtk_popover_popdown(GTK_POPOVER(_menu));
            action();
        });
        gtk_box_append(GTK_BOX(entries), entry);
    };
    add(translated("Hide Column"), [this, column] { _actions.hide(column); });
    add(translated("Show All Columns"), _actions.showAll);
    gtk_popover_set_child(GTK_POPOVER(_menu), entries);
    gtk_widget_set_parent(_menu, heading);
    gtk_popover_popup(GTK_POPOVER(_menu));
}

void TableHeadings::closeMenu() {
    if (_menu != nullptr) {
        gtk_widget_unparent(std::exchange(_menu, nullptr));
    }
}

} // namespace pallax::gtk
