#pragma once

#include "app/table/ListTable.h"
#include "app/tree/PallaxModelNode.h"

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

namespace pallax {

/// A row of the display that contains a text.
struct FoundRow {
    /// The row in each pane on the way from the root.
    std::vector<std::size_t> place;
    std::string name;
    std::string value; ///< empty for a branch
    std::string where; ///< "Neighbor Cells List, Physical Cell ID 275"; empty for a section
};

/// The rows with a name or a value that contains `text`, ignoring the case of ASCII letters, in the
/// order of the display: at most `most`, and none for the empty text. The numbers of the elements
/// of a list are not names.
std::vector<FoundRow> findRows(const PallaxModelNode& root, std::string_view text,
                               const EntryPartAt& partAt, std::size_t most);

} // namespace pallax
