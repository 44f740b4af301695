#pragma once

#include "text/Result.h"

#include <cstddef>
#include <cstdint>
#include <functional>
#include <memory>
#include <optional>
#include <span>
#include <string>
#include <string_view>
#include <variant>
#include <vector>

struct sqlite3;
struct sqlite3_stmt;

namespace pallax {

struct AddedTable;
struct Authority;
struct Column;
class QueryTable;

/// The name of a file as SQLite needs it, so that it is not taken for a URI, an option or a
/// temporary database.
std::string sqliteFileName(const std::string& file);

/// Why a query cannot be run or has been stopped.
struct QueryError {
    std::string sentence;
    std::optional<std::size_t> place; ///< in the text of the query, in bytes
};

/// The error of a query that was asked to stop.
inline constexpr const char* kStopped = "The query was stopped.";

/// A value of a result: NULL, an integer, a real number, or a text. Bytes come as a text of
/// hexadecimal digits, as of hex().
using QueryValue = std::variant<std::monostate, std::int64_t, double, std::string>;

/// A column that a query names.
struct ColumnRead {
    std::string table;
    std::string column;
};

/// A query that runs.
class Query {
public:
    /// The names of the columns.
    const std::vector<std::string>& columns() const { return _columns; }
    /// The columns of the table that the query reads, sorted, each once.
    std::vector<std::string> columnsRead(std::string_view table) const;
    /// The next row; nothing after the last.
    Result<std::optional<std::vector<QueryValue>>, QueryError> next();
    /// Runs it again from the first row.
    void restart();

private:
    friend class Database;
    struct Finalize {
        void operator()(sqlite3_stmt* statement) const;
    };
    Query(sqlite3& connection, std::unique_ptr<sqlite3_stmt, Finalize> statement,
          std::vector<ColumnRead> reads);

    sqlite3* _connection;
    std::unique_ptr<sqlite3_stmt, Finalize> _statement;
    std::vector<std::string> _columns;
    std::vector<ColumnRead> _reads;
};

/// Tables that answer queries in SQL. Queries can only read; they cannot write,
/// attach a file, load an extension or change a setting.
class Database {
public:
    /// Throws std::runtime_error without memory.
    Database();
    /// Has the tables of a file, which it only reads. Throws std::runtime_error if it cannot be
    /// opened.
    explicit Database(const std::string& file);
    ~Database();
    Database(const Database&) = delete;
    Database& operator=(const Database&) = delete;

    /// Adds a table under `schema`.`name`; "main" is the schema that is always there. Throws
    /// std::runtime_error if there is such a table.
    void add(const std::string& schema, const std::string& name, std::unique_ptr<QueryTable> table);
    /// Computes a value from the arguments of a call. A std::exception that it throws is the error
    /// of the query.
    using Function = std::function<QueryValue(std::span<const QueryValue> arguments)>;
    /// Adds a function of that many arguments; -1 for any number. Its value must depend on nothing
    /// but them.
    void addFunction(const char* name, int arguments, Function function);
    struct Table {
        std::string schema;
        std::string name;
        const std::vector<Column>& columns;
    };
    /// All tables, in the order in which they were added.
    std::vector<Table> tables() const;
    /// The names of the functions that were added.
    const std::vector<std::string>& functions() const { return _functionNames; }
    /// The names of all tables, columns and functions, for suggestions.
    const std::vector<std::string>& names() const { return _names; }
    /// Asked every few thousand steps of a query; false stops it.
    void setMayContinue(std::function<bool()> mayContinue);

    /// Prepares the one query in `text`. The database must outlive it.
    Result<Query, QueryError> prepare(std::string_view text);

private:
    struct Close {
        void operator()(sqlite3* connection) const;
    };

    void open(const std::string& name, int flags);

    struct Named {
        std::string schema;
        std::string name;
        std::unique_ptr<QueryTable> table;
    };

    // These outlive the connection.
    std::vector<Named> _tables;
    std::vector<std::unique_ptr<AddedTable>> _added;
    std::vector<std::unique_ptr<Function>> _functions;
    std::vector<std::string> _names;
    std::unique_ptr<Authority> _authority;
    std::vector<std::string> _functionNames;

    std::unique_ptr<sqlite3, Close> _connection;
    std::vector<std::string> _schemas;
    std::function<bool()> _mayContinue;
};

} // namespace pallax
