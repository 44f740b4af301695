#include "ui/pages/Overlays.h"

#include "ui/drawing/TextWidth.h"

#include <algorithm>
#include <string>
#include <string_view>
#include <utility>

namespace pallax::terminal {

namespace {

constexpr int kFrameColumns = 4; // frame and blanks
constexpr int kKeyColumns = 18;  // of the help page

} // namespace

void drawAlert(Grid& grid, const Marks& marks, const ui::Alert& alert) {
    constexpr int kAir = 2;
    const std::string button = buttonFace(alert.button);
    const int wanted =
        std::max({columnsOf(alert.title), columnsOf(alert.message) + kAir, columnsOf(button)});
    const int inside = std::min(wanted + kFrameColumns, grid.columns()) - kFrameColumns;
    const std::vector<std::string> lines = wrappedText(alert.message, inside);
    const int rows = static_cast<int>(lines.size()) + 1;
    const Box box = centeredBox(grid, wanted + kFrameColumns, rows + Box::kFrame);
    drawBox(grid, marks, box, alert.title);
    const int buttonRow = box.y + box.rows - 2;
    for (int row = 0; row < rows - 1 && box.y + 1 + row < buttonRow; ++row) {
        grid.put(box.inside().left, box.y + 1 + row, lines[static_cast<std::size_t>(row)], {},
                 box.inside());
    }
    drawButton(grid, box.inside().right, buttonRow, button, true);
}

std::vector<std::string> helpLines(int columns, std::optional<HelpPlace> place) {
    std::vector<KeyHelp> shown;
    for (KeyHelp help : keyHelp()) {
        if (place && help.keys == "?") {
            help.meaning = "all keys";
        }
        if (!place || help.worksIn(*place)) {
            shown.push_back(help);
        }
    }
    int wanted = 0;
    for (const KeyHelp& help : shown) {
        wanted = std::max(wanted, kKeyColumns + columnsOf(help.meaning));
    }
    const bool isNarrow = wanted + kFrameColumns > columns;
    std::vector<std::string> lines;
    for (const KeyHelp& help : shown) {
        std::string line(help.keys);
        if (isNarrow) {
            lines.push_back(std::move(line));
            for (const std::string& part : wrappedText(help.meaning, columns - kFrameColumns - 1)) {
                lines.push_back(std::string(1, ' ').append(part));
            }
        } else {
            line.resize(kKeyColumns, ' ');
            lines.push_back(line.append(help.meaning));
        }
    }
    return lines;
}

int drawHelp(Grid& grid, const Marks& marks, int first, std::optional<HelpPlace> place) {
    const std::vector<std::string> lines = helpLines(grid.columns(), place);
    int columns = 0;
    for (const std::string& line : lines) {
        columns = std::max(columns, columnsOf(line));
    }
    const Box box =
        centeredBox(grid, columns + kFrameColumns, static_cast<int>(lines.size()) + Box::kFrame);
    drawBox(grid, marks, box, "Keys");
    const int shown = box.rows - Box::kFrame;
    const int begin = std::min(first, std::max(static_cast<int>(lines.size()) - shown, 0));
    for (int row = 0; row < shown; ++row) {
        const int index = begin + row;
        if (index < static_cast<int>(lines.size())) {
            const std::string& line = lines[static_cast<std::size_t>(index)];
            grid.put(box.inside().left, box.y + 1 + row, line, {}, box.inside());
        }
    }
    const int below = static_cast<int>(lines.size()) - begin - shown;
    if (below > 0) {
        const std::string text = std::string(" ").append(marks.down) + " " + std::to_string(below);
        grid.put(box.inside().right - columnsOf(text) - 1, box.y + box.rows - 1, text + " ");
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
