#pragma once

#include "ui/drawing/Bars.h"
#include "ui/terminal/TerminalNavigation.h"
#include "ui/terminal/TerminalTable.h"

#include <chrono>
#include <cstddef>
#include <string_view>

namespace pallax::terminal {

/// Draws the topmost pane: its path, its rows, and the toolbar.
class PaneView {
public:
    PaneView(Grid& grid, const Marks& marks, HitMap& hits)
        : _grid(grid), _marks(marks), _hits(hits) {}

    /// Also sets the size of the pane's table. Click actions refer to the navigation.
    void draw(TerminalNavigation& navigation, const PaneStatus& status);

private:
    void drawTitle(TerminalNavigation& navigation, TerminalTable& table, Bars& bars);
    void drawBreadcrumbs(TerminalNavigation& navigation, int right);
    void drawUpperRule(TerminalTable& table, Bars& bars, const PaneStatus& status);
    void drawGone(const TerminalTable& table, int y, int right);
    void drawRows(TerminalTable& table, const PaneStatus& status);
    void drawRow(TerminalTable& table, std::size_t shown, int y, const PaneStatus& status);
    void drawCurve(const ui::CellContents& contents, const PaneStatus& status,
                   const std::string& path, int y);
    void drawCell(const TerminalTable& table, ui::TableCell& cell, const PaneRow& row, int y,
                  bool isSelected, std::string_view standing);
    void drawAge(std::chrono::nanoseconds age, int y, Span room, int markColumn);
    bool drawNote(std::string_view text, int y, Span room);

    Grid& _grid;
    const Marks& _marks;
    HitMap& _hits;
};

} // namespace pallax::terminal
