#pragma once

#include "ui/gtk/ColumnPlanner.h"
#include "ui/gtk/Ref.h"

#include <gtk/gtk.h>
#include <vector>

namespace pallax::gtk {

/// The cells of one row, or the headings. Those of the fixed columns stay at the left edge; the
/// others are pushed below them by what the adjustment says.
class ColumnStrip {
public:
    enum class Kind {
        Headings, ///< never wider than its place
        Row,      ///< as wide as the table, in what scrolls by the adjustment
    };

    /// The adjustment must outlive the strip.
    ColumnStrip(Kind kind, GtkAdjustment* sideways);
    ~ColumnStrip();
    ColumnStrip(const ColumnStrip&) = delete;
    ColumnStrip& operator=(const ColumnStrip&) = delete;

    /// Shows these widgets instead of those before, one for each place of the plan.
    void setCells(const ColumnPlan& plan, const std::vector<GtkWidget*>& cells);
    /// The table was pushed sideways.
    void move();
    GtkWidget* widget() const { return _outer.get(); }

private:
    static ColumnStrip* stripOf(GtkWidget* widget);
    static Ref<GtkWidget> box(GtkCustomMeasureFunc measure, GtkCustomAllocateFunc allocate);
    void adopt(GtkWidget* widget);
    void placeParts(int width, int height) const;
    /// Of the cells in one of the two parts.
    void placeCells(GtkWidget* part, int height) const;

    Kind _kind;
    GtkAdjustment* _sideways;
    ColumnPlan _plan;
    std::vector<GtkWidget*> _cells; ///< the parts own them
    Ref<GtkWidget> _outer;
    GtkWidget* _fixed; ///< the outer one owns it and what follows
    GtkWidget* _pushed;
};

} // namespace pallax::gtk
