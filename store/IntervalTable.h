#pragma once

#include "store/IntervalBatch.h"
#include "store/NamedRows.h"
#include "store/StoreConnection.h"

#include <cstdint>

namespace pallax {

/// Writes the intervals of a batch as rows of a recording in a file, within a transaction, and
/// empties it.
void writeIntervals(IntervalBatch& batch, StoreConnection& store, std::int64_t recording,
                    NamedRows& names);

} // namespace pallax
