#pragma once

#include "app/table/TableContent.h"
#include "app/tree/PallaxModelNode.h"

#include <chrono>
#include <functional>
#include <optional>
#include <string>
#include <vector>

namespace pallax {

/// What a field says about which entry of a list an entry is.
enum class EntryPart {
    None,
    Identity, ///< tells which entry it is
    Cell,     ///< tells which cell it is
};

/// Returns the part of a field, by its path in the display: "/Neighbor Cells List/*/E-ARFCN".
using EntryPartAt = std::function<EntryPart(const std::string& path)>;

/// Returns how long ago the value of a leaf was read, by its path ("/Neighbor Cells
/// List/2/E-ARFCN"); nothing if that is unknown.
using LeafAgeAt = std::function<std::optional<std::chrono::nanoseconds>(const std::string& path)>;

/// Whether a node is a list with fields in each entry, which can be shown as a table.
bool isTable(const PallaxModelNode& node);

/// The table of a list at a path: its fields in the order of the display, those of the identity
/// first. An entry that is a branch is shown as its number of elements.
TableContent tableOf(const PallaxModelNode& list, const std::string& path,
                     const EntryPartAt& partAt);

/// How long ago anything of each entry was read.
std::vector<TableCell> agesOf(const PallaxModelNode& list, const std::string& path,
                              const LeafAgeAt& ageAt);
/// Adds them as an extra column, unless all are unknown.
void addAges(TableContent& table, const std::vector<TableCell>& ages);

} // namespace pallax
