#pragma once

#include "query/QueryTable.h"

#include <memory>

namespace pallax {

class Timeline;

/// `series(field)` and `series(field, buckets)`: a field over the whole timeline, divided into at
/// most so many buckets (1,000 if they are left out), for each entry of a list. A row for each
/// bucket that has values:
///
/// - `bucket` (from 0), `time` and `packet` of its first packet, `packets` in it;
/// - `first`, `min`, `max`, `last`: values; `min` and `max` are those of numbers;
/// - `entry`.
std::unique_ptr<QueryTable> seriesTable(Timeline& timeline);

} // namespace pallax
