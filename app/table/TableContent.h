#pragma once

#include <cstddef>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace pallax {

/// One value of a table.
struct TableCell {
    std::string text = {};                       ///< without the column's unit; empty: no value
    std::optional<double> number = std::nullopt; ///< that the text shows
    bool opens = false;                          ///< stands for more, which the row opens
};

struct TableColumn {
    std::string name;
    std::string unit = {};   ///< of all its numbers, or empty
    bool isIdentity = false; ///< tells the rows apart; identity columns come first
    /// About the row and not of it: shown while it is chosen or all columns are, and neither
    /// searched, copied with the row nor marked as changed.
    bool isExtra = false;
};

struct TableRow {
    /// Tells which row it is when the table is filled again. Several rows may have the same key.
    std::string key;
    std::vector<TableCell> cells; ///< one for each column
    bool isSecondary = false;     ///< drawn less prominently
};

/// What a table shows.
struct TableContent {
    std::vector<TableColumn> columns = {};
    std::vector<TableRow> rows = {};
    std::string_view one = "row"; ///< what a row is
    std::string_view many = "rows";
};

} // namespace pallax
