#pragma once

#include "query/Database.h"

#include <functional>
#include <vector>

struct sqlite3;

namespace pallax {

class QueryTable;

/// What a connection allows.
struct Authority {
    /// Set while SQLite reads a table's own declaration, which writes to no file.
    bool isDeclaring = false;
    bool hasRefused = false;                            ///< since it was last set to false
    const std::function<bool()>* mayContinue = nullptr; ///< RowBounds
    std::vector<ColumnRead> reads = {};                 ///< of the query that is being prepared
};

/// A table of a connection.
struct AddedTable {
    QueryTable& table;
    Authority& authority;
};

/// Adds a table under a name that is written as SQL wants it (schema."name"). It must outlive the
/// connection. Returns false on failure, which the connection then tells.
bool addVirtualTable(sqlite3& connection, const char* name, AddedTable& added);

} // namespace pallax
