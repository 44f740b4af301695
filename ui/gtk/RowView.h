#pragma once

#include "platform/ui/TableView.h"
#include "ui/gtk/PangoMetrics.h"
#include "ui/gtk/Ref.h"
#include "ui/gtk/Signals.h"

#include <functional>
#include <gtk/gtk.h>
#include <optional>
#include <string>
#include <vector>

namespace pallax::gtk {

/// Points that a row keeps for what stands right of its content area: a count and an accessory.
inline constexpr double kAccessoryWidth = 48;
inline constexpr double kRowHeight = 50;

/// What a row shows beside its cell.
struct RowNotes {
    std::string count; ///< of a list's elements
    std::string age;   ///< of a value that is overdue
    bool hasChanged = false;
    bool isOpen = false; ///< its pane is shown beside it
    bool operator==(const RowNotes&) const = default;
};

/// The widgets of one row. The labels of a cell are placed as the cell says, in a container that
/// scrolls sideways where the cell has one.
class RowView {
public:
    /// `metrics` must outlive the row. `scrolled` is told of each new sideways offset.
    RowView(const PangoMetrics& metrics, const Guard& guard, std::function<void(double)> scrolled);
    RowView(const RowView&) = delete;
    RowView& operator=(const RowView&) = delete;
    ~RowView();

    GtkWidget* widget() const { return GTK_WIDGET(_box.get()); }

    void fill(const ui::TableCell& cell, const RowNotes& notes);
    /// In points. What is beyond the end is the end.
    void setOffset(double offset);
    double offset() const;
    /// Scrolls by so many points; false where there is nothing more on that side.
    bool scrollBy(double distance);

private:
    void buildSide();
    GtkLabel* labelAt(std::size_t index);
    /// `area` is that of a cell that does not scroll.
    void place(GtkLabel* label, const ui::Label& content, const ui::Rect& area, bool isBold);
    void showNotes(const ui::TableCell& cell, const RowNotes& notes);
    void showAge(const ui::CellContents& contents, const std::string& age);
    void listen(const Guard& guard, std::function<void(double)> scrolled);

    /// What is shown, to leave a row alone that stays as it is.
    struct Shown {
        std::vector<ui::Label> labels;
        std::optional<ui::ScrollContainer> container;
        ui::Rect area; ///< where a cell that does not scroll cuts its texts
        ui::CellAccessory accessory = ui::CellAccessory::None;
        RowNotes notes;
        double scale = 0;
    };
    static bool isSame(const Shown& shown, const Shown& other);

    const PangoMetrics& _metrics;
    Shown _shown;
    Ref<GtkBox> _box;
    GtkScrolledWindow* _scroller; // the box owns it and what follows
    GtkFixed* _content;
    std::vector<GtkLabel*> _labels;
    GtkBox* _side; ///< right of the content area
    GtkLabel* _age;
    GtkLabel* _count;
    GtkImage* _accessory;
    gulong _scrolling = 0;
};

} // namespace pallax::gtk
