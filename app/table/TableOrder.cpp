#include "app/table/TableOrder.h"

#include <algorithm>
#include <cmath>

namespace pallax {

namespace {

enum class CellKind { Number, Text, None };

CellKind kindOf(const TableCell& cell) {
    if (cell.number && !std::isnan(*cell.number)) {
        return CellKind::Number;
    }
    return cell.text.empty() ? CellKind::None : CellKind::Text;
}

} // namespace

void sortRows(std::vector<std::size_t>& rows, const std::vector<TableRow>& all, std::size_t column,
              bool isDescending) {
    std::stable_sort(rows.begin(), rows.end(), [&](std::size_t leftRow, std::size_t rightRow) {
        const TableCell& left = all[leftRow].cells[column];
        const TableCell& right = all[rightRow].cells[column];
        const CellKind kind = kindOf(left);
        if (kind != kindOf(right)) {
            return kind < kindOf(right);
        }
        if (kind == CellKind::Number) {
            return isDescending ? *right.number < *left.number : *left.number < *right.number;
        }
        return isDescending ? right.text < left.text : left.text < right.text;
    });
}

} // namespace pallax
