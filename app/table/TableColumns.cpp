#include "app/table/TableColumns.h"

#include <algorithm>
#include <utility>

namespace pallax {

bool isFlushRight(const TableContent& table, std::size_t column) {
    bool hasNumbers = false;
    for (const TableRow& row : table.rows) {
        const TableCell& cell = row.cells[column];
        const bool isNumber = cell.number || cell.opens;
        if (!isNumber && !cell.text.empty()) {
            return false;
        }
        hasNumbers = hasNumbers || isNumber;
    }
    return hasNumbers;
}

std::string headingOf(const TableColumn& column) {
    return column.unit.empty() ? column.name : column.name + " " + column.unit;
}

std::vector<std::string> narrowed(const std::string& heading,
                                  const std::function<int(std::string_view)>& widthOf) {
    std::vector<std::string> best{heading};
    int width = widthOf(heading);
    for (std::size_t blank = heading.find(' '); blank != std::string::npos;
         blank = heading.find(' ', blank + 1)) {
        std::vector<std::string> lines{heading.substr(0, blank), heading.substr(blank + 1)};
        const int wider = std::max(widthOf(lines[0]), widthOf(lines[1]));
        if (wider < width) {
            width = wider;
            best = std::move(lines);
        }
    }
    return best;
}

bool handleColumnKey(TableModel& table, char32_t character) {
    switch (character) {
    case U'<':
        table.choosePrevious();
        return true;
    case U'>':
        table.chooseNext();
        return true;
    case U'r':
        table.reverse();
        return true;
    case U'x':
        table.hideChosen();
        return true;
    case U'X':
        table.showAllColumns();
        return true;
    default:
        return false;
    }
}

void pressHeading(TableModel& table, std::size_t column) {
    if (table.chosenColumn() == column) {
        table.reverse();
    } else {
        table.choose(column);
    }
}

} // namespace pallax
