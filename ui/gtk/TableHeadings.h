#pragma once

#include "app/table/TableModel.h"
#include "ui/gtk/ColumnPlanner.h"
#include "ui/gtk/ColumnStrip.h"
#include "ui/gtk/Signals.h"

#include <cstddef>
#include <functional>
#include <gtk/gtk.h>
#include <optional>
#include <vector>

namespace pallax::gtk {

/// The headings of a table, which are buttons. A long press, or the other button of a mouse, opens
/// the menu of a column.
class TableHeadings {
public:
    struct Actions {
        std::function<void(std::size_t column)> press;
        std::function<void(std::size_t column)> hide;
        std::function<void()> showAll;
    };

    /// `metrics` and the adjustment must outlive the headings.
    TableHeadings(const PangoMetrics& metrics, const Guard& guard, GtkAdjustment* sideways,
                  Actions actions);
    ~TableHeadings() { closeMenu(); }
    TableHeadings(const TableHeadings&) = delete;
    TableHeadings& operator=(const TableHeadings&) = delete;

    /// Marks the column by which the rows are sorted.
    void show(const TableModel& table, const ColumnPlan& plan);
    /// The table was pushed sideways.
    void move() { _strip.move(); }
    GtkWidget* widget() const { return _strip.widget(); }

private:
    struct Shown {
        ColumnPlan plan;
        std::optional<std::size_t> chosen;
        bool isDescending;
        bool operator==(const Shown&) const = default;
    };

    GtkWidget* heading(const TableModel& table, const ColumnPlan::Place& place);
    void openMenu(GtkWidget* heading, std::size_t column);
    void closeMenu();

    const PangoMetrics& _metrics;
    Guard _guard;
    Actions _actions;
    ColumnStrip _strip;
    std::optional<Shown> _shown;
    std::vector<GtkWidget*> _buttons; ///< one for each place of the plan
    GtkWidget* _menu = nullptr;       ///< the latest, on one of the buttons
};

} // namespace pallax::gtk
