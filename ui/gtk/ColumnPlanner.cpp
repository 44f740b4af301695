#include "ui/gtk/ColumnPlanner.h"

#include "app/table/TableColumns.h"
#include "text/Utf8.h"
#include "ui/gtk/ShownText.h"

#include <algorithm>
#include <cmath>

namespace pallax::gtk {

namespace {

constexpr double kWidestText = 420; // points; more ends in dots
constexpr int kLeastText = 12;

} // namespace

int ColumnPlan::widthOf(std::size_t past) const {
    int width = 0;
    for (std::size_t index = 0; index < past; ++index) {
        width += places[index].width;
    }
    return width;
}

/// In bold, which a changed cell has.
int ColumnPlanner::textWidth(std::string_view text) {
    constexpr std::size_t kTimes = 16; // a length is a whole number of pixels
    const std::string shown = shownText(text);
    double width = 0;
    for (std::size_t at = 0; at < shown.size();) {
        const Utf8CodePoint each = utf8At(shown, at);
        if (each.size == 0) {
            break;
        }
        const auto [known, isNew] = _chars.try_emplace(each.value, 0);
        if (isNew) {
            std::string repeated;
            for (std::size_t time = 0; time < kTimes; ++time) {
                repeated.append(shown, at, each.size);
            }
            known->second = _metrics.measure(repeated, kChangedFont).width / kTimes;
        }
        width += known->second;
        at += each.size;
    }
    return static_cast<int>(std::ceil(std::min(width, kWidestText) * _scale));
}

void ColumnPlanner::measure(const TableModel& table) {
    if (_scale != _metrics.scale()) {
        _scale = _metrics.scale();
        _chars.clear();
        _version = 0;
    }
    if (_version == table.version()) {
        return;
    }
    _version = table.version();
    const TableContent& content = table.content();
    _widest.assign(content.columns.size(), kLeastText);
    for (const TableRow& row : content.rows) {
        for (std::size_t column = 0; column < row.cells.size(); ++column) {
            _widest[column] = std::max(_widest[column], textWidth(row.cells[column].text));
        }
    }
}

ColumnPlan ColumnPlanner::plan(const TableModel& table, int width) {
    measure(table);
    ColumnPlan plan{.places = {}, .fixed = 0, .scale = _scale};
    for (const std::size_t column : table.columns()) {
        const TableContent& content = table.content();
        const std::string heading = headingOf(content.columns[column]);
        const auto widthOf = [this](std::string_view text) { return textWidth(text); };
        ColumnPlan::Place place{.column = column,
                                .width = _widest[column],
                                .isRight = isFlushRight(content, column),
                                .heading = textWidth(heading) <= _widest[column]
                                               ? std::vector<std::string>{heading}
                                               : narrowed(heading, widthOf)};
        for (const std::string& line : place.heading) {
            place.width = std::max(place.width, textWidth(line));
        }
        place.width += kRoomBefore + kRoomBehind;
        plan.places.push_back(std::move(place));
    }
    // The columns that tell the rows apart, as far as they leave room for others.
    while (plan.fixed < plan.places.size() &&
           table.content().columns[plan.places[plan.fixed].column].isIdentity) {
        ++plan.fixed;
        if (plan.fixedWidth() > width / 3 * 2) {
            --plan.fixed;
            break;
        }
    }
    return plan;
}

} // namespace pallax::gtk
