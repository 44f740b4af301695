#pragma once

#include "query/QueryTable.h"

#include <memory>

namespace pallax {

class Timeline;

/// `sample`: a row for each value that was read.
std::unique_ptr<QueryTable> sampleTable(Timeline& timeline);

} // namespace pallax
