#include "ui/terminal/Overlays.h"

#include "ui/terminal/TextWidth.h"

#include <algorithm>
#include <string>

namespace pallax::terminal {

namespace {

constexpr int kFrameColumns = 4; // frame and blanks
constexpr int kFrameRows = 2;

} // namespace

void drawAlert(Grid& grid, const Marks& marks, const ui::Alert& alert) {
    constexpr int kAir = 2;
    const std::string button = buttonFace(alert.button);
    const int columns =
        std::max({columnsOf(alert.title), columnsOf(alert.message) + kAir, columnsOf(button)});
    const Box box = centeredBox(grid, columns + kFrameColumns, 2 + kFrameRows);
    drawBox(grid, marks, box, alert.title);
    grid.put(box.inside().left, box.y + 1, alert.message, {}, box.inside());
    drawButton(grid, box.inside().right, box.y + 2, button, true);
}

const std::vector<std::string_view>& helpLines() {
    static const std::vector<std::string_view> kLines{
        "Up Down  k j      one row up or down",
        "PgUp PgDn         one page up or down",
        "Home End  g G     first or last row",
        "Enter Right l     open the row",
        "Right Left        scroll a long row",
        "Left h Backspace  back",
        "Esc               clear the filter, or back",
        "/                 filter rows by name or value",
        "s                 save a snapshot",
        "y                 copy the value",
        "Tab               next field of the save screen",
        "Ctrl-L            draw the screen again",
        "Ctrl-Z            suspend; fg comes back",
        "?                 this help",
        "q                 back; at the first pane, quit",
    };
    return kLines;
}

int drawHelp(Grid& grid, const Marks& marks, int first) {
    const auto& lines = helpLines();
    int columns = 0;
    for (const std::string_view line : lines) {
        columns = std::max(columns, columnsOf(line));
    }
    const Box box =
        centeredBox(grid, columns + kFrameColumns, static_cast<int>(lines.size()) + kFrameRows);
    drawBox(grid, marks, box, "Keys");
    const int shown = box.rows - kFrameRows;
    const int begin = std::min(first, std::max(static_cast<int>(lines.size()) - shown, 0));
    for (int row = 0; row < shown; ++row) {
        const int index = begin + row;
        if (index < static_cast<int>(lines.size())) {
            const std::string_view line = lines[static_cast<std::size_t>(index)];
            grid.put(box.inside().left, box.y + 1 + row, line, {}, box.inside());
        }
    }
    return shown;
}

void drawTooSmall(Grid& grid) {
    const std::string need = std::to_string(kLeastColumns) + "x" + std::to_string(kLeastRows);
    constexpr std::string_view kNeeds = "Pallax needs";
    const bool fitsInOneRow = grid.columns() > columnsOf(kNeeds) + columnsOf(need);
    if (fitsInOneRow) {
        grid.put(0, 0, std::string(kNeeds) + " " + need);
    } else if (grid.rows() > 1) {
        grid.put(0, 0, kNeeds);
        grid.put(0, 1, need);
    } else {
        grid.put(0, 0, need);
    }
}

} // namespace pallax::terminal
