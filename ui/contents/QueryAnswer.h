#pragma once

#include "app/table/TableContent.h"

#include <chrono>
#include <cstddef>
#include <cstdint>
#include <functional>
#include <optional>
#include <string>

namespace pallax {

class Database;
class Timeline;

/// The answer to a query, as a table.
struct QueryAnswer {
    /// All rows are laid out at once, which takes longer for more.
    static constexpr std::size_t kMostRows = 10000;

    TableContent table;
    /// The reason if the query could not be run or was stopped; or that there are more rows.
    std::string sentence;
    bool hasFailed = false;
};

/// Runs a query over the tables of a timeline. `mayGoOn` is asked often, and stops it by false;
/// `addFunctions` adds functions to the database.
QueryAnswer answerQuery(Timeline& timeline, const std::string& query,
                        const std::function<bool()>& mayGoOn,
                        const std::function<void(Database&, Timeline&)>& addFunctions);

/// Adds a column `clock` with the time of day after a column `time` of microseconds. Local time is
/// so much ahead of UTC.
void addTimeOfDay(TableContent& table, std::chrono::seconds ahead);

/// The packet of a row: the number in its column `packet`, or the latest packet at the time in its
/// column `time`. Nothing if it has neither.
std::optional<std::uint64_t> packetOf(const TableContent& table, std::size_t row,
                                      const Timeline& timeline);

} // namespace pallax
