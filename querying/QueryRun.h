#pragma once

#include "console/ExitStatus.h"
#include "platform/Clock.h"
#include "query/Database.h"
#include "querying/RowWriter.h"

#include <chrono>
#include <functional>
#include <optional>
#include <string>
#include <string_view>

namespace pallax {

/// Runs queries and writes their rows.
class QueryRun {
public:
    struct Request {
        std::optional<std::chrono::nanoseconds> most = std::nullopt; ///< the time for a query
        /// Ctrl-C ends a query, and not the program.
        bool isInterruptible = false;
    };
    struct Seams {
        Output& output;
        const Clock& clock; ///< for the time of a query
        std::function<void()> waiting;
        std::function<void(std::string_view sentence)> tell;
    };

    /// All must outlive it.
    QueryRun(Database& database, const Request& request, Seams seams)
        : _database(database), _request(request), _seams(std::move(seams)) {}

    /// Wrong usage if it is a wrong query. The rows before an error are written.
    ExitStatus run(const std::string& text, RowFormat format);

    Database& database() const { return _database; }
    Output& output() const { return _seams.output; }
    void tell(std::string_view sentence) const { _seams.tell(sentence); }

private:
    ExitStatus write(Query& query, RowFormat format);

    Database& _database;
    Request _request;
    Seams _seams;
    std::string _stopped; ///< the sentence about a query that was stopped
};

} // namespace pallax
