#pragma once

#include "fleet/AnswerRows.h"
#include "fleet/HttpExchange.h"

#include <functional>
#include <string>
#include <string_view>
#include <vector>

namespace pallax {

/// A text as ClickHouse has it, quoted.
std::string clickHouseText(std::string_view text);

/// What a server was asked and refuses, such as a wrong query.
struct ServerRefusal {
    int code = 0; ///< as ClickHouse numbers errors; 0: unknown
    std::string message;
};

/// A database of ClickHouse. Failures are StoreFailure with sentences that name it.
class ClickHouse {
public:
    explicit ClickHouse(const StoreAddress& address, Patience patience = {});

    /// Runs a statement that returns no rows. With `isInDatabase` false, the database need not
    /// exist.
    void run(const std::string& statement, bool isInDatabase = true);
    /// Rows of a query, which can only read. `refused` is called instead of throwing what the
    /// server says of the query, if it is given. Whole answers only: a shard that is missing, or an
    /// error after the first rows, is a failure before any row is given.
    using Refused = std::function<void(const ServerRefusal& refusal)>;
    void ask(const std::string& query, const AnswerRows::TakeColumns& takeColumns,
             const AnswerRows::TakeRow& takeRow, const Refused& refused = {});
    /// Gives the rows of a query with that many columns one by one.
    void eachRow(const std::string& query, std::size_t columns, const AnswerRows::TakeRow& take);
    /// All of them.
    std::vector<std::vector<QueryValue>> rows(const std::string& query, std::size_t columns);
    /// Inserts rows in the format RowBinary. Returns when all shards have them.
    void insert(const std::string& tableAndColumns, const HttpExchange::Give& give);

    const StoreAddress& address() const { return _address; }

private:
    int post(const std::string& parameters, const HttpExchange::Give& give,
             const std::function<void(std::string_view)>& take, std::string& error);
    ServerRefusal refusalOf(int status, const std::string& text) const;
    [[noreturn]] void fail(const ServerRefusal& refusal) const;

    StoreAddress _address;
    HttpExchange _http;
};

} // namespace pallax
