#pragma once

struct sqlite3;

namespace pallax {

/// Adds the aggregate function quantile(value, weight, q): the least value at or below which a
/// share q (0 to 1) of the weights lies. Values that are not numbers and weights that are not
/// positive do not count; NULL without any. Returns false on failure.
bool addQuantile(sqlite3& connection);

} // namespace pallax
