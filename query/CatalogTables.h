#pragma once

#include "query/QueryTable.h"

#include <memory>

namespace pallax {

class Database;

/// `tables`: a row for each table of the database, with its schema and the names of its columns.
std::unique_ptr<QueryTable> tablesTable(const Database& database);
/// `columns`: a row for each column of each table.
std::unique_ptr<QueryTable> columnsTable(const Database& database);

} // namespace pallax
