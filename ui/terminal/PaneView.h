#pragma once

#include "ui/terminal/Grid.h"
#include "ui/terminal/HitMap.h"
#include "ui/terminal/Marks.h"
#include "ui/terminal/TerminalNavigation.h"
#include "ui/terminal/TerminalTable.h"

#include <cstddef>
#include <optional>
#include <string>

namespace pallax::terminal {

class LineEditor;

/// What the toolbar of a pane shows beside the pane's own items.
struct PaneStatus {
    std::size_t spinnerTurn = 0;              ///< counts up while the spinner turns
    const LineEditor* filterEditor = nullptr; ///< while a filter is being typed
    std::optional<std::string> message;       ///< in the status text's place
    std::string note;                         ///< behind the status text
};

/// Whether the toolbar's activity indicator turns.
bool isLoading(const ui::BarItems& items);
/// The toolbar's save button, or null.
const ui::SaveButton* saveButtonOf(const ui::BarItems& items);

/// Draws the topmost pane: the way to it, its rows, and the toolbar.
class PaneView {
public:
    PaneView(Grid& grid, const Marks& marks, HitMap& hits)
        : _grid(grid), _marks(marks), _hits(hits) {}

    /// Also tells the pane's table how much room it has.
    void draw(TerminalNavigation& navigation, const PaneStatus& status);

private:
    void drawTitle(const TerminalNavigation& navigation, TerminalTable& table);
    void drawRows(TerminalTable& table);
    void drawRow(TerminalTable& table, std::size_t shown, int y);
    void drawCell(const TerminalTable& table, ui::TableCell& cell, const ui::RowText& row, int y,
                  bool isSelected);
    void drawLabel(const ui::Label& label, int x, int y, Style style, Span clip,
                   std::string_view filter);
    void drawToolbar(const TerminalNavigation& navigation, const TerminalTable& table,
                     const PaneStatus& status);
    void drawFilterPrompt(const LineEditor& editor);
    int drawCutInFront(int x, int y, std::string_view text);
    int drawStatus(const ui::BarItems& items, const PaneStatus& status);
    void drawHints(const ui::BarItems& items, const TerminalTable& table, int from);

    Grid& _grid;
    const Marks& _marks;
    HitMap& _hits;
};

} // namespace pallax::terminal
