#pragma once

#include "app/table/TableModel.h"
#include "ui/gtk/PangoMetrics.h"

#include <cstddef>
#include <cstdint>
#include <map>
#include <string>
#include <string_view>
#include <vector>

namespace pallax::gtk {

/// The fonts of a table.
inline constexpr ui::Font kCellFont{ui::FontFace::System, 14};
inline constexpr ui::Font kChangedFont{ui::FontFace::BoldSystem, 14};

/// The room around the text of a cell, in pixels. The greater one, at the right, has the mark of
/// the column by which the table is sorted.
inline constexpr int kRoomBefore = 10;
inline constexpr int kRoomBehind = 18;

/// Where the columns of a table stand, in pixels.
struct ColumnPlan {
    struct Place {
        std::size_t column = 0;
        int width = 0; ///< with the room around its text
        bool isRight = false;
        std::vector<std::string> heading = {}; ///< its lines
        bool operator==(const Place&) const = default;
    };
    std::vector<Place> places = {}; ///< from the left
    std::size_t fixed = 0;          ///< how many of them stay when the others are pushed sideways
    double scale = 1;               ///< pixels per point
    bool operator==(const ColumnPlan&) const = default;

    int fixedWidth() const { return widthOf(fixed); }
    int width() const { return widthOf(places.size()); }

private:
    int widthOf(std::size_t past) const;
};

/// Measures the columns of a table. Texts are measured by their characters, which is fast enough
/// for thousands of rows.
class ColumnPlanner {
public:
    /// `metrics` must outlive the planner.
    explicit ColumnPlanner(const PangoMetrics& metrics) : _metrics(metrics) {}

    /// For a place of this width.
    ColumnPlan plan(const TableModel& table, int width);

private:
    int textWidth(std::string_view text);
    void measure(const TableModel& table);

    const PangoMetrics& _metrics;
    std::uint64_t _version = 0;        ///< of the content that was measured
    double _scale = 0;                 ///< in which it was measured
    std::vector<int> _widest;          ///< text of each column
    std::map<char32_t, double> _chars; ///< widths in this scale
};

} // namespace pallax::gtk
