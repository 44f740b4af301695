#pragma once

#include "query/QueryTable.h"

#include <memory>

namespace pallax {

class Timeline;

/// `state`: a row for each display tick with new data, with the values of the fields that are in no
/// list, and their ages in seconds.
std::unique_ptr<QueryTable> stateTable(Timeline& timeline);

} // namespace pallax
