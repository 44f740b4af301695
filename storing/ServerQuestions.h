#pragma once

#include "fleet/ServerStore.h"
#include "storing/Questions.h"

#include <string>
#include <vector>

namespace pallax {

/// A table that a server makes for a question.
struct ServerTable {
    std::string name;
    std::vector<std::string> columns;
    std::string query; ///< in the dialect of ClickHouse
};

/// How a question is asked of a server: its shards make sums of what they have, and a query on
/// these tables, the same as of a file, makes the answer of them.
struct ServerQuestion {
    std::vector<ServerTable> tables;
    std::string query; ///< in the dialect of SQLite
};

/// Of any question but Sql.
ServerQuestion serverQuestion(const StoreAskOptions& options,
                              const std::vector<JudgedLevel>& levels, const AskedTime& time,
                              const ServerStore& store);

} // namespace pallax
