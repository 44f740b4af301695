#pragma once

#include "query/QueryTable.h"
#include "timeline/FieldTable.h"

#include <memory>
#include <string>
#include <utility>
#include <vector>

namespace pallax {

class Timeline;

/// The fields that are read together: those of a section, or of the entries of a list.
struct FieldGroup {
    std::string name; ///< "serving_cell_measurements", "cctrch_sir_sir"
    bool isList = false;
    std::vector<std::pair<FieldIndex, std::string>> fields; ///< with the names of their columns
};

/// All fields in their groups.
std::vector<FieldGroup> fieldGroups(const FieldTable& fields);

/// A row for each reading of the group: of a list, for each entry. A list that is read without
/// entries therefore has no row. Lists that the display hides are there, too.
std::unique_ptr<QueryTable> sectionTable(Timeline& timeline, FieldGroup group);

} // namespace pallax
