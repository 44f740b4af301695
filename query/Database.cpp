#include "query/Database.h"

#include "query/Printf.h"
#include "query/Quantile.h"
#include "query/QueryMemory.h"
#include "query/QueryTable.h"
#include "query/SqlText.h"
#include "query/VirtualTable.h"

#include <algorithm>
#include <set>
#include <sqlite3.h>
#include <stdexcept>
#include <utility>

namespace pallax {

namespace {

/// Of a text or a query.
constexpr int kLongestText = 16 << 20;
constexpr int kStepsBetweenQuestions = 4000;
constexpr const char* kOnlyReading = "A query can only read.";

bool isHarmless(std::string_view function) {
    return function != "load_extension" && function != "fts3_tokenizer";
}

/// Whether an action only reads.
bool isReading(int action, const char* second) {
    switch (action) {
    case SQLITE_SELECT:
    case SQLITE_READ:
    case SQLITE_RECURSIVE:
        return true;
    case SQLITE_FUNCTION:
        return isHarmless(second != nullptr ? second : "");
    default:
        return false;
    }
}

/// Allows what only reads. It is asked while a query is prepared; a table that is opened then is
/// declared meanwhile.
int authorize(void* data, int action, const char* first, const char* second, const char* /*schema*/,
              const char* /*inner*/) {
    auto& authority = *static_cast<Authority*>(data);
    if (action == SQLITE_READ && first != nullptr && second != nullptr) {
        authority.reads.push_back({first, second});
    }
    if (authority.isDeclaring || isReading(action, second)) {
        return SQLITE_OK;
    }
    authority.hasRefused = true;
    return SQLITE_DENY;
}

int askWhetherToStop(void* mayContinue) {
    return (*static_cast<std::function<bool()>*>(mayContinue))() ? 0 : 1;
}

QueryError errorOf(sqlite3& connection) {
    const int place = sqlite3_error_offset(&connection);
    const int code = sqlite3_errcode(&connection);
    std::string sentence = code == SQLITE_AUTH        ? kOnlyReading
                           : code == SQLITE_INTERRUPT ? kStopped
                           : code == SQLITE_NOMEM ? "The query needs more than 256 MiB of memory."
                                                  : sqlite3_errmsg(&connection);
    return {std::move(sentence),
            place >= 0 ? std::optional(static_cast<std::size_t>(place)) : std::nullopt};
}

std::string_view bytesOf(sqlite3_value* value) {
    const auto* bytes = static_cast<const char*>(sqlite3_value_blob(value));
    const auto length = static_cast<std::size_t>(sqlite3_value_bytes(value));
    return bytes != nullptr ? std::string_view(bytes, length) : std::string_view();
}

std::string hexadecimal(std::string_view bytes) {
    constexpr std::string_view kDigits = "0123456789ABCDEF";
    constexpr unsigned kBitsPerDigit = 4;
    constexpr unsigned kLastDigit = 0xF;
    std::string digits;
    digits.reserve(bytes.size() * 2);
    for (const char character : bytes) {
        const auto byte = static_cast<unsigned char>(character);
        digits += kDigits[byte >> kBitsPerDigit];
        digits += kDigits[byte & kLastDigit];
    }
    return digits;
}

QueryValue valueOf(sqlite3_value* value) {
    switch (sqlite3_value_type(value)) {
    case SQLITE_INTEGER:
        return std::int64_t{sqlite3_value_int64(value)};
    case SQLITE_FLOAT:
        return sqlite3_value_double(value);
    case SQLITE_NULL:
        return {};
    case SQLITE_BLOB:
        return hexadecimal(bytesOf(value));
    default:
        return std::string(bytesOf(value));
    }
}

void giveTo(sqlite3_context& context, const QueryValue& value) {
    ColumnValue result(context);
    if (const auto* number = std::get_if<std::int64_t>(&value)) {
        result.integer(*number);
    } else if (const auto* real = std::get_if<double>(&value)) {
        result.real(*real);
    } else if (const auto* text = std::get_if<std::string>(&value)) {
        result.text(*text);
    }
}

void call(sqlite3_context* context, int count, sqlite3_value** arguments) {
    const auto& function = *static_cast<Database::Function*>(sqlite3_user_data(context));
    std::vector<QueryValue> values;
    values.reserve(static_cast<std::size_t>(count));
    for (int index = 0; index < count; ++index) {
        values.push_back(valueOf(arguments[index]));
    }
    try {
        giveTo(*context, function(values));
    } catch (const std::exception& error) {
        sqlite3_result_error(context, error.what(), -1);
    }
}

void run(sqlite3& connection, const std::string& text) {
    if (sqlite3_exec(&connection, text.c_str(), nullptr, nullptr, nullptr) != SQLITE_OK) {
        throw std::runtime_error(sqlite3_errmsg(&connection));
    }
}

} // namespace

std::string sqliteFileName(const std::string& file) {
    return file.starts_with('/') ? file : "./" + file;
}

void Query::Finalize::operator()(sqlite3_stmt* statement) const {
    sqlite3_finalize(statement);
}

Query::Query(sqlite3& connection, std::unique_ptr<sqlite3_stmt, Finalize> statement,
             std::vector<ColumnRead> reads)
    : _connection(&connection), _statement(std::move(statement)), _reads(std::move(reads)) {
    const int count = sqlite3_column_count(_statement.get());
    for (int column = 0; column < count; ++column) {
        _columns.emplace_back(sqlite3_column_name(_statement.get(), column));
    }
}

std::vector<std::string> Query::columnsRead(std::string_view table) const {
    std::set<std::string> names;
    for (const ColumnRead& read : _reads) {
        if (read.table == table && !read.column.empty()) { // count(*) reads one without a name
            names.insert(read.column);
        }
    }
    return {names.begin(), names.end()};
}

Result<std::optional<std::vector<QueryValue>>, QueryError> Query::next() {
    using Row = std::optional<std::vector<QueryValue>>;
    const int result = sqlite3_step(_statement.get());
    if (result == SQLITE_DONE) {
        return Row();
    }
    if (result != SQLITE_ROW) {
        return errorOf(*_connection);
    }
    std::vector<QueryValue> row;
    row.reserve(_columns.size());
    for (std::size_t column = 0; column < _columns.size(); ++column) {
        row.push_back(valueOf(sqlite3_column_value(_statement.get(), static_cast<int>(column))));
    }
    return Row(std::move(row));
}

void Query::restart() {
    sqlite3_reset(_statement.get());
}

void Database::Close::operator()(sqlite3* connection) const {
    sqlite3_close_v2(connection);
}

Database::Database() : _authority(std::make_unique<Authority>()), _schemas{"main"} {
    open(":memory:", SQLITE_OPEN_READWRITE | SQLITE_OPEN_MEMORY);
}

Database::Database(const std::string& file)
    : _authority(std::make_unique<Authority>()), _schemas{"main"} {
    // For writing, because only then can SQLite clean up after a writer that was killed; queries do
    // not write.
    open(sqliteFileName(file), SQLITE_OPEN_READWRITE);
    run(*_connection, "PRAGMA query_only = true");
    // Anybody may have made it.
    sqlite3_db_config(_connection.get(), SQLITE_DBCONFIG_DEFENSIVE, 1, nullptr);
    sqlite3_db_config(_connection.get(), SQLITE_DBCONFIG_TRUSTED_SCHEMA, 0, nullptr);
    constexpr int kMostWait = 10'000; // milliseconds, for a writer that recovers the file
    sqlite3_busy_timeout(_connection.get(), kMostWait);
}

void Database::open(const std::string& name, int flags) {
    limitQueryMemory();
    sqlite3* connection = nullptr;
    const int result =
        sqlite3_open_v2(name.c_str(), &connection, flags | SQLITE_OPEN_NOMUTEX, nullptr);
    _connection.reset(connection);
    if (result != SQLITE_OK) {
        throw std::runtime_error(connection != nullptr ? sqlite3_errmsg(connection)
                                                       : "no memory for queries");
    }
    sqlite3_limit(connection, SQLITE_LIMIT_LENGTH, kLongestText);
    sqlite3_limit(connection, SQLITE_LIMIT_SQL_LENGTH, kLongestText);
    run(*connection, "PRAGMA temp_store = memory");
    // Opens them while that is allowed; later they only read.
    run(*connection, "SELECT 1 FROM json_each('[]'), json_tree('[]')");
    if (!addQuantile(*connection) || !addPrintf(*connection)) {
        throw std::runtime_error(sqlite3_errmsg(connection));
    }
}

Database::~Database() = default;

void Database::add(const std::string& schema, const std::string& name,
                   std::unique_ptr<QueryTable> table) {
    sqlite3_set_authorizer(_connection.get(), nullptr, nullptr);
    run(*_connection, "PRAGMA query_only = false");
    if (std::find(_schemas.begin(), _schemas.end(), schema) == _schemas.end()) {
        run(*_connection, "ATTACH ':memory:' AS " + quotedName(schema));
        _schemas.push_back(schema);
    }
    _names.push_back(name);
    for (const Column& column : table->columns()) {
        _names.push_back(column.name);
    }
    _tables.push_back({schema, name, std::move(table)});
    _added.push_back(std::make_unique<AddedTable>(AddedTable{*_tables.back().table, *_authority}));
    const std::string qualified = quotedName(schema) + "." + quotedName(name);
    if (!addVirtualTable(*_connection, qualified.c_str(), *_added.back())) {
        throw std::runtime_error(sqlite3_errmsg(_connection.get()));
    }
    run(*_connection, "PRAGMA query_only = true");
}

std::vector<Database::Table> Database::tables() const {
    std::vector<Table> tables;
    for (const Named& each : _tables) {
        tables.push_back({each.schema, each.name, each.table->columns()});
    }
    return tables;
}

void Database::addFunction(const char* name, int arguments, Function function) {
    _functions.push_back(std::make_unique<Function>(std::move(function)));
    if (sqlite3_create_function_v2(_connection.get(), name, arguments,
                                   SQLITE_UTF8 | SQLITE_DETERMINISTIC, _functions.back().get(),
                                   call, nullptr, nullptr, nullptr) != SQLITE_OK) {
        throw std::runtime_error(sqlite3_errmsg(_connection.get()));
    }
    _names.emplace_back(name);
    if (std::find(_functionNames.begin(), _functionNames.end(), name) == _functionNames.end()) {
        _functionNames.emplace_back(name);
    }
}

void Database::setMayContinue(std::function<bool()> mayContinue) {
    _mayContinue = std::move(mayContinue);
    _authority->mayContinue = _mayContinue ? &_mayContinue : nullptr;
    sqlite3_progress_handler(_connection.get(), _mayContinue ? kStepsBetweenQuestions : 0,
                             askWhetherToStop, &_mayContinue);
}

Result<Query, QueryError> Database::prepare(std::string_view text) {
    sqlite3_set_authorizer(_connection.get(), authorize, _authority.get());
    _authority->hasRefused = false;
    _authority->reads.clear();
    sqlite3_stmt* statement = nullptr;
    const char* rest = nullptr;
    const auto length = static_cast<int>(std::min<std::size_t>(text.size(), kLongestText));
    const int result =
        sqlite3_prepare_v2(_connection.get(), text.data(), length, &statement, &rest);
    std::unique_ptr<sqlite3_stmt, Query::Finalize> owned(statement);
    if (_authority->hasRefused) {
        return QueryError{kOnlyReading, std::nullopt};
    }
    if (result != SQLITE_OK) {
        return errorOf(*_connection);
    }
    if (!owned) {
        return QueryError{"There is no query.", std::nullopt};
    }
    // VACUUM and the like ask for nothing before they run.
    if (sqlite3_stmt_readonly(owned.get()) == 0 || sqlite3_column_count(owned.get()) == 0) {
        return QueryError{kOnlyReading, std::nullopt};
    }
    const auto end = static_cast<std::size_t>(rest - text.data());
    if (text.find_first_not_of(" \t\r\n;", end) != std::string_view::npos) {
        return QueryError{"Only one query can be run.", end};
    }
    return Query(*_connection, std::move(owned), std::exchange(_authority->reads, {}));
}

} // namespace pallax
