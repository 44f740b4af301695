#pragma once

struct sqlite3;

namespace pallax {

/// Replaces printf() and format() by ones for which a text above the longest of the connection is
/// an error. Those of SQLite 3.40 give NULL for it, and build "%.*c" to its end before they do,
/// which nothing can stop. Returns false on failure, which the connection then tells.
bool addPrintf(sqlite3& connection);

} // namespace pallax
