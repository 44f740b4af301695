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

/// The headings of a table, which are buttons.
class TableHeadings {
public:
    /// `metrics` and the adjustment must outlive the headings.
    TableHeadings(const PangoMetrics& metrics, const Guard& guard, GtkAdjustment* sideways,
                  std::function<void(std::size_t column)> pressed);

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

    GtkWidget* heading(const TableModel& table, const ColumnPlan::Place& place) const;

    const PangoMetrics& _metrics;
    Guard _guard;
    std::function<void(std::size_t column)> _pressed;
    ColumnStrip _strip;
    std::optional<Shown> _shown;
    std::vector<GtkWidget*> _buttons; ///< one for each place of the plan
};

} // namespace pallax::gtk
