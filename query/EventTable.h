#pragma once

#include "query/QueryTable.h"

#include <memory>

namespace pallax {

class Timeline;

/// `event`: a row for each event.
std::unique_ptr<QueryTable> eventTable(const Timeline& timeline);

} // namespace pallax
