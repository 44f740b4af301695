#include "tests/ui/gtk/WindowDump.h"

#include <adwaita.h>
#include <cmath>
#include <vector>

namespace pallax::gtk {

namespace {

std::vector<GtkWidget*> childrenOf(GtkWidget* widget) {
    std::vector<GtkWidget*> children;
    for (GtkWidget* child = gtk_widget_get_first_child(widget); child != nullptr;
         child = gtk_widget_get_next_sibling(child)) {
        if (gtk_widget_get_mapped(child) != FALSE && gtk_widget_get_opacity(child) > 0) {
            children.push_back(child);
        }
    }
    return children;
}

template <class Object>
Object* findBelow(GtkWidget* widget, GType type) {
    if (g_type_is_a(G_OBJECT_TYPE(widget), type) != FALSE) {
        return reinterpret_cast<Object*>(widget);
    }
    for (GtkWidget* child : childrenOf(widget)) {
        if (auto* found = findBelow<Object>(child, type)) {
            return found;
        }
    }
    return nullptr;
}

graphene_rect_t boundsIn(GtkWidget* widget, GtkWidget* outer) {
    graphene_rect_t bounds;
    if (gtk_widget_compute_bounds(widget, outer, &bounds) == FALSE) {
        graphene_rect_init(&bounds, -1, -1, 0, 0);
    }
    return bounds;
}

std::string number(double value) {
    return std::to_string(static_cast<int>(std::lround(value)));
}

class Dump {
public:
    explicit Dump(GtkWidget* window) : _window(window) {}

    std::string text() {
        add(_window);
        return "\n" + _text;
    }

private:
    void line(const std::string& text) { _text += text + "\n"; }

    void add(GtkWidget* widget) {
        const std::string name = G_OBJECT_TYPE_NAME(widget);
        if (gtk_widget_has_css_class(widget, "pallax-headings") != FALSE) {
            _headings = stripCells(widget);
            return line("columns: " + joined(_headings));
        }
        if (name == "GtkListItemWidget") {
            const bool isCells = gtk_widget_get_ancestor(widget, GTK_TYPE_LIST_VIEW) != nullptr &&
                                 findBelow<GtkWidget>(widget, GTK_TYPE_FIXED) == nullptr;
            return isCells ? addCells(widget) : addRow(widget);
        }
        if (name == "GtkWindowControls") {
            return; // the shell's
        }
        if (ADW_IS_WINDOW_TITLE(widget)) {
            return line(std::string("title: ") +
                        adw_window_title_get_title(ADW_WINDOW_TITLE(widget)) + " / " +
                        adw_window_title_get_subtitle(ADW_WINDOW_TITLE(widget)));
        }
        if (GTK_IS_SPINNER(widget)) {
            return line(gtk_spinner_get_spinning(GTK_SPINNER(widget)) != FALSE ? "spinner: turns"
                                                                               : "spinner");
        }
        if (GTK_IS_BUTTON(widget) || GTK_IS_MENU_BUTTON(widget)) {
            const char* label =
                GTK_IS_BUTTON(widget) ? gtk_button_get_label(GTK_BUTTON(widget)) : nullptr;
            const char* tooltip = gtk_widget_get_tooltip_text(widget);
            return line(std::string("button: ") +
                        (label != nullptr     ? label
                         : tooltip != nullptr ? tooltip
                                              : "?") +
                        (GTK_IS_TOGGLE_BUTTON(widget) != FALSE &&
                                 gtk_toggle_button_get_active(GTK_TOGGLE_BUTTON(widget)) != FALSE
                             ? " (on)"
                             : "") +
                        (gtk_widget_get_sensitive(widget) == FALSE ? " (off)" : "") +
                        (gtk_widget_has_focus(widget) != FALSE ? " (focus)" : ""));
        }
        if (GTK_IS_EDITABLE(widget)) {
            return line(std::string("field: \"") + gtk_editable_get_text(GTK_EDITABLE(widget)) +
                        "\"");
        }
        if (GTK_IS_LEVEL_BAR(widget)) {
            return line("level: " + number(gtk_level_bar_get_value(GTK_LEVEL_BAR(widget)) * 100) +
                        " %");
        }
        if (GTK_IS_SCALE(widget)) {
            return line("scale: " + number(gtk_range_get_value(GTK_RANGE(widget)) * 100) + " %");
        }
        if (GTK_IS_IMAGE(widget)) {
            return;
        }
        if (GTK_IS_LABEL(widget)) {
            const std::string text = gtk_label_get_text(GTK_LABEL(widget));
            return text.empty() ? void() : line("text: " + text);
        }
        for (GtkWidget* child : childrenOf(widget)) {
            add(child);
        }
    }

    /// A heading or a value of a table, which is at least partly seen.
    struct Cell {
        std::string text;
        long left; ///< in the window
        long width;
    };

    /// The cells of a row, or the headings: of the part that stays, and of the one that is pushed.
    std::vector<Cell> stripCells(GtkWidget* strip) {
        std::vector<Cell> cells;
        for (GtkWidget* part : childrenOf(strip)) {
            const graphene_rect_t room = boundsIn(part, _window);
            for (GtkWidget* child : childrenOf(part)) {
                const graphene_rect_t bounds = boundsIn(child, _window);
                const float end = bounds.origin.x + bounds.size.width;
                if (end > room.origin.x + 1 &&
                    bounds.origin.x < room.origin.x + room.size.width - 1) {
                    cells.push_back({textOfCell(child), std::lround(bounds.origin.x),
                                     std::lround(bounds.size.width)});
                }
            }
        }
        return cells;
    }

    static std::string textOfCell(GtkWidget* cell) {
        const bool isHeading = GTK_IS_BUTTON(cell) != FALSE;
        auto* label = findBelow<GtkLabel>(cell, GTK_TYPE_LABEL);
        std::string text =
            isHeading ? gtk_widget_get_tooltip_text(cell) : gtk_label_get_text(label);
        text += isHeading && gtk_label_get_xalign(label) > 0.5F ? " (right)" : "";
        text += gtk_widget_has_css_class(cell, "pallax-changed") != FALSE ? " (changed)" : "";
        return text;
    }

    static std::string joined(const std::vector<Cell>& cells) {
        std::string text;
        for (const Cell& cell : cells) {
            text += (text.empty() ? "" : " | ") + cell.text;
        }
        return text;
    }

    void addCells(GtkWidget* row) {
        GtkWidget* list = gtk_widget_get_ancestor(row, GTK_TYPE_SCROLLED_WINDOW);
        const graphene_rect_t bounds = boundsIn(row, list);
        if (bounds.origin.y + bounds.size.height <= 0 ||
            bounds.origin.y >= static_cast<float>(gtk_widget_get_height(list))) {
            return;
        }
        GtkWidget* strip = gtk_widget_get_first_child(row);
        const std::vector<Cell> cells = stripCells(strip);
        std::string text = "cells";
        text += gtk_widget_has_css_class(strip, "pallax-open") != FALSE ? " (cursor)" : "";
        text += gtk_widget_has_focus(row) != FALSE ? " (focus)" : "";
        text += gtk_widget_has_css_class(strip, "dim-label") != FALSE ? " (dim)" : "";
        bool isBelowHeadings = cells.size() == _headings.size();
        for (std::size_t index = 0; isBelowHeadings && index < cells.size(); ++index) {
            // A margin of the label is not in its place.
            const Cell& heading = _headings[index];
            isBelowHeadings =
                cells[index].left >= heading.left &&
                cells[index].left + cells[index].width <= heading.left + heading.width &&
                cells[index].left < heading.left + 12;
        }
        line(text + ": " + joined(cells) + (isBelowHeadings ? "" : " (not below the headings)"));
    }

    void addRow(GtkWidget* row) {
        GtkWidget* list = gtk_widget_get_ancestor(row, GTK_TYPE_SCROLLED_WINDOW);
        const graphene_rect_t bounds = boundsIn(row, list);
        const double height = gtk_widget_get_height(list);
        auto* content = findBelow<GtkWidget>(row, GTK_TYPE_FIXED);
        if (bounds.origin.y + bounds.size.height <= 0 || bounds.origin.y >= height ||
            content == nullptr) {
            return;
        }
        line("row: " + labels(content) + scrolling(row) + notes(row));
    }

    /// The labels in the row's content, each with its place.
    static std::string labels(GtkWidget* content) {
        GtkWidget* scroller = gtk_widget_get_ancestor(content, GTK_TYPE_SCROLLED_WINDOW);
        const double width = gtk_widget_get_width(scroller);
        std::string text;
        double end = 0;
        for (GtkWidget* child : childrenOf(content)) {
            const graphene_rect_t bounds = boundsIn(child, content);
            const double x = bounds.origin.x;
            const double middle = bounds.origin.y + bounds.size.height / 2;
            text += text.empty() ? "" : " | ";
            text += gtk_label_get_text(GTK_LABEL(child));
            const bool isFlush = end > 0 && std::abs(x + bounds.size.width - width) < 2;
            text += isFlush   ? " (flush right"
                    : end > 0 ? " (" + number(x - end) + " behind"
                              : " (at " + number(x);
            text += std::abs(middle - gtk_widget_get_height(content) / 2.0) <= 1 ? ")"
                                                                                 : ", not centred)";
            end = x + bounds.size.width;
        }
        return text;
    }

    static std::string scrolling(GtkWidget* row) {
        auto* scroller = findBelow<GtkScrolledWindow>(row, GTK_TYPE_SCROLLED_WINDOW);
        GtkAdjustment* sideways = gtk_scrolled_window_get_hadjustment(scroller);
        const double beyond =
            gtk_adjustment_get_upper(sideways) - gtk_adjustment_get_page_size(sideways);
        if (beyond < 1) {
            return "";
        }
        const double value = gtk_adjustment_get_value(sideways);
        return value > 0 ? ", scrolled by " + number(value) : ", scrolls";
    }

    /// What stands right of the content.
    static std::string notes(GtkWidget* row) {
        std::string text;
        GtkWidget* box = gtk_widget_get_first_child(row);
        for (GtkWidget* child :
             childrenOf(gtk_widget_get_first_child(gtk_widget_get_last_child(box)))) {
            if (GTK_IS_LABEL(child)) {
                const std::string words = gtk_label_get_text(GTK_LABEL(child));
                text += words.empty() ? "" : " " + words;
            } else if (GTK_IS_IMAGE(child)) {
                const char* icon = gtk_image_get_icon_name(GTK_IMAGE(child));
                text += icon != nullptr ? std::string(" [") + icon + "]" : "";
            }
        }
        const int height = gtk_widget_get_height(box);
        text += height != 50 ? ", " + std::to_string(height) + " high" : "";
        text += gtk_widget_has_css_class(box, "pallax-open") != FALSE ? ", open" : "";
        return text;
    }

    GtkWidget* _window;
    std::string _text;
    std::vector<Cell> _headings; ///< of the table above the rows
};

} // namespace

std::string windowDump(GtkWidget* window) {
    return Dump(window).text();
}

} // namespace pallax::gtk
