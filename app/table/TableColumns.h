#pragma once

#include "app/table/TableModel.h"

#include <cstddef>
#include <functional>
#include <string>
#include <string_view>
#include <vector>

namespace pallax {

/// Whether all values of a column are numbers, or stand for more: such a column is flush right.
bool isFlushRight(const TableContent& table, std::size_t column);

/// Name and unit of a column: "RSRP dBm".
std::string headingOf(const TableColumn& column);
/// One or two lines of a heading, as narrow as possible in the units of `widthOf`.
std::vector<std::string> narrowed(const std::string& heading,
                                  const std::function<int(std::string_view)>& widthOf);

/// Chooses, sorts, hides or shows columns by a key; false for other keys.
bool handleColumnKey(TableModel& table, char32_t character);
/// A press on a heading: sorts by its column, or reverses if it is already sorted so.
void pressHeading(TableModel& table, std::size_t column);

} // namespace pallax
