#pragma once

#include "app/table/TableContent.h"

#include <cstddef>
#include <vector>

namespace pallax {

/// Sorts rows, which are indices into `all`, by a column: numbers, then other texts by their bytes,
/// then rows without a value. A descending order reverses numbers and texts, not this sequence.
/// Equal rows keep their order.
void sortRows(std::vector<std::size_t>& rows, const std::vector<TableRow>& all, std::size_t column,
              bool isDescending);

} // namespace pallax
