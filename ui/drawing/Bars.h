#pragma once

#include "platform/ui/Views.h"
#include "ui/drawing/Grid.h"
#include "ui/drawing/HitMap.h"
#include "ui/drawing/Keys.h"
#include "ui/drawing/Marks.h"
#include "ui/drawing/Origin.h"

#include <cstddef>
#include <functional>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace pallax::terminal {

class LineEditor;

/// The rows around a screen's content: title and rule above it, rule and status below it.
inline constexpr int kTitleRow = 0;
inline constexpr int kRowsAbove = 2;
inline constexpr int kRowsBelow = 2;
inline constexpr int kMargin = 1; ///< columns before title and status
inline constexpr int kGap = 2;    ///< columns between texts of one row

/// A key that is offered in the last row.
struct Hint {
    std::string_view text; ///< "? help"
    KeyEvent key;
};

inline constexpr Hint kClearFilter{"Esc clear filter", {.key = Key::Escape}};

/// A line that is being typed in the last row.
struct Prompt {
    std::string_view mark; ///< "/"
    const LineEditor* editor;
    Hint hint; ///< how to leave it
};

/// Where in time the screen is. Places are from 0 to 1.
struct TimeBar {
    std::string words; ///< "held, 12 s behind"
    std::string clock; ///< "22:14:06"
    double shown = 0.0;
    std::optional<double> marked = {};
    std::vector<double> events = {};
    bool isPlaying = false;
    std::function<void(double)> go = [](double) {}; ///< by a click or by dragging
};

/// What is shown around the content besides the pane's own items.
struct PaneStatus {
    std::size_t spinnerTurn = 0;        ///< increases while the spinner turns
    std::optional<Prompt> prompt;       ///< while a line is being typed
    std::optional<TimeBar> timeBar;     ///< while another instant than the present is shown
    std::optional<std::string> message; ///< replaces the status text
    std::string note;      ///< after the status text, or in the rule above if it does not fit
    Origin origin;         ///< in the title
    std::string oldValues; ///< the time of values that are no longer updated
    std::string stream;    ///< why nothing changes; in the title
    std::vector<std::string> alarms; ///< the names of those that are true; in the title
    bool isSafe = false;             ///< nothing that identifies a person is shown; in the title
    std::string zone;                ///< for the time in the status text
    std::function<void(const KeyEvent&)> press = [](const KeyEvent&) {}; ///< by a click
    /// What the value at a path of the display says about itself: "out of range", or nothing.
    std::function<std::string_view(const std::string&)> standing = [](const std::string&) {
        return std::string_view();
    };
    /// The curve of the value at a path of the display in so many columns; empty if it has none.
    std::function<std::string(const std::string&, int)> curve = [](const std::string&, int) {
        return std::string();
    };
};

/// Whether the toolbar's activity indicator is animated.
bool isLoading(const ui::BarItems& items);
/// The toolbar's save button, or null.
const ui::SaveButton* saveButtonOf(const ui::BarItems& items);

/// Draws parts of the rows around the content. What can be clicked acts like a key.
class Bars {
public:
    Bars(Grid& grid, const Marks& marks, HitMap& hits, const PaneStatus& status)
        : _grid(grid), _marks(marks), _hits(hits), _status(status) {}

    /// Whether time is held, alarms, the state of the stream, and the origin of the values, in at
    /// most `columns` columns of the title row, before column `right`. Only the origin leaves the
    /// title its room; a click on it opens or closes the overview. Returns where the room for the
    /// title ends.
    int drawOrigin(int right, int columns);
    /// A rule that ends with the number of rows outside the window; returns the first column of the
    /// number.
    int drawRule(int y, std::string_view mark, std::size_t hiddenRows, Key key);
    /// The last row: the line that is being typed, or the status and hints. While another instant
    /// is shown, a bar of the time and its keys take their place.
    void drawLastRow(const ui::BarItems& items, int ruleRight, const std::vector<Hint>& hints);
    /// The status in the last row; a note that does not fit there goes to the rule, before column
    /// `ruleRight`. Returns the column after the status.
    int drawStatus(const ui::BarItems& items, int ruleRight);
    /// As many hints as fit after column `from`, the last ones first; of the last one, at least its
    /// key.
    void drawHints(const std::vector<Hint>& hints, int from);
    void drawHint(int left, std::string_view text, const KeyEvent& key);

private:
    int drawCutInFront(int x, int y, std::string_view text);
    int drawTimeBar(const TimeBar& bar);

    Grid& _grid;
    const Marks& _marks;
    HitMap& _hits;
    const PaneStatus& _status;
};

} // namespace pallax::terminal
