#pragma once

#include "query/QueryTable.h"

#include <memory>

namespace pallax {

class Timeline;

/// `span`: a row for each time that a field, of an entry if it is in a list, held a value. It ends
/// when another value is read, when the field or the entry is gone, and where the packets have a
/// gap or their times step back.
std::unique_ptr<QueryTable> spanTable(Timeline& timeline);

} // namespace pallax
