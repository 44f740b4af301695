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
                             GtkAdjustment* sideways,
                             std::function<void(std::size_t column)> pressed)
    : _metrics(metrics), _guard(guard), _pressed(std::move(pressed)),
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

GtkWidget* TableHeadings::heading(const TableModel& table, const ColumnPlan::Place& place) const {
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
    onSignal(button, "clicked", _guard, [this, column = place.column] { _pressed(column); });
    return button;
}

} // namespace pallax::gtk
