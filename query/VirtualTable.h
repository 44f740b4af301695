#pragma once

struct sqlite3;

namespace pallax {

class QueryTable;

/// A table of a connection.
struct AddedTable {
    QueryTable& table;
    /// Set while SQLite reads the table's own declaration, which writes to no file.
    bool& isDeclaring;
};

/// Adds a table under a name that is written as SQL wants it (schema."name"). It must outlive the
/// connection. Returns false on failure, which the connection then tells.
bool addVirtualTable(sqlite3& connection, const char* name, AddedTable& added);

} // namespace pallax
