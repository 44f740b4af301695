#pragma once

#include "ui/terminal/Grid.h"
#include "ui/terminal/HitMap.h"
#include "ui/terminal/Keys.h"
#include "ui/terminal/Marks.h"
#include "ui/terminal/Origin.h"
#include "ui/terminal/TerminalNavigation.h"
#include "ui/terminal/TerminalTable.h"

#include <cstddef>
#include <functional>
#include <optional>
#include <string>

namespace pallax::terminal {

class LineEditor;

/// What is shown around a pane's rows besides the pane's own items.
struct PaneStatus {
    std::size_t spinnerTurn = 0;              ///< increases while the spinner turns
    const LineEditor* filterEditor = nullptr; ///< while a filter is being typed
    std::optional<std::string> message;       ///< replaces the status text
    std::string note;      ///< after the status text, or in the rule above if it does not fit
    Origin origin;         ///< in the title
    std::string oldValues; ///< the time of values that are no longer updated
    std::string zone;      ///< for the time in the status text
    std::function<void(const KeyEvent&)> press = [](const KeyEvent&) {}; ///< by a click
};

/// Whether the toolbar's activity indicator is animated.
bool isLoading(const ui::BarItems& items);
/// The toolbar's save button, or null.
const ui::SaveButton* saveButtonOf(const ui::BarItems& items);

/// Draws the topmost pane: its path, its rows, and the toolbar.
class PaneView {
public:
    PaneView(Grid& grid, const Marks& marks, HitMap& hits)
        : _grid(grid), _marks(marks), _hits(hits) {}

    /// Also sets the size of the pane's table. Click actions refer to the navigation.
    void draw(TerminalNavigation& navigation, const PaneStatus& status);

private:
    void drawTitle(TerminalNavigation& navigation, TerminalTable& table, const Origin& origin);
    void drawBreadcrumbs(TerminalNavigation& navigation, int right);
    void drawUpperRule(const TerminalTable& table, const PaneStatus& status);
    int drawLowerRule(const TerminalTable& table, std::size_t windowRows, const PaneStatus& status);
    int drawHiddenRows(int y, std::string_view mark, std::size_t rows, Key key,
                       const PaneStatus& status);
    void drawRows(TerminalTable& table);
    void drawRow(TerminalTable& table, std::size_t shown, int y);
    void drawCell(const TerminalTable& table, ui::TableCell& cell, const PaneRow& row, int y,
                  bool isSelected);
    void drawLabel(const ui::Label& label, int x, int y, Style style, Span clip,
                   std::string_view filter);
    void drawToolbar(const TerminalNavigation& navigation, const TerminalTable& table,
                     const PaneStatus& status, int ruleRight);
    void drawFilterPrompt(const LineEditor& editor, const PaneStatus& status);
    void drawHint(int left, std::string_view text, const KeyEvent& key, const PaneStatus& status);
    int drawCutInFront(int x, int y, std::string_view text);
    int drawStatus(const ui::BarItems& items, const PaneStatus& status, int ruleRight);
    void drawHints(const ui::BarItems& items, const TerminalTable& table, int from,
                   const PaneStatus& status);

    Grid& _grid;
    const Marks& _marks;
    HitMap& _hits;
};

} // namespace pallax::terminal
