#include "store/StoreConnection.h"

#include "host/Descriptor.h"
#include "query/Database.h"
#include "store/StoreSchema.h"
#include "text/Format.h"

#include <cerrno>
#include <chrono>
#include <cstring>
#include <fcntl.h>
#include <filesystem>
#include <sqlite3.h>
#include <thread>
#include <utility>

namespace pallax {

namespace {

/// The sentence of an error of SQLite.
std::string sentenceOf(const std::string& file, sqlite3* connection, int code) {
    constexpr int kPrimary = 0xFF;
    switch (code & kPrimary) {
    case SQLITE_FULL:
        return formatText("%@ cannot be written: the disk is full.", {file});
    case SQLITE_NOTADB:
        return formatText("%@ is no file of SQLite.", {file});
    case SQLITE_CORRUPT:
        return formatText("%@ is damaged: %@.", {file, sqlite3_errmsg(connection)});
    case SQLITE_READONLY:
        return formatText("%@ may not be written.", {file});
    case SQLITE_CANTOPEN:
        return formatText("%@ cannot be opened.", {file});
    default:
        return formatText("%@: %@.",
                          {file, connection != nullptr ? sqlite3_errmsg(connection) : "no memory"});
    }
}

/// Another program makes or tidies up the file, for which SQLite does not wait.
class StoreBusy : public StoreFailure {
public:
    using StoreFailure::StoreFailure;
};

[[noreturn]] void fail(const std::string& file, sqlite3* connection, int code) {
    constexpr int kPrimary = 0xFF;
    const std::string sentence = sentenceOf(file, connection, code);
    if ((code & kPrimary) == SQLITE_BUSY) {
        throw StoreBusy(sentence);
    }
    throw StoreFailure(sentence);
}

/// What the tables of a file are, without those of SQLite itself.
std::string tablesOf(sqlite3* connection, const std::string& file) {
    constexpr const char* kTables = "SELECT group_concat(type || ' ' || name || ' ' || sql, ';') "
                                    "FROM (SELECT * FROM sqlite_schema "
                                    "WHERE name NOT LIKE 'sqlite@_%' ESCAPE '@' ORDER BY name)";
    std::string tables;
    const auto take = [](void* taken, int /*count*/, char** values, char** /*names*/) {
        *static_cast<std::string*>(taken) = values[0] != nullptr ? values[0] : "";
        return 0;
    };
    const int code = sqlite3_exec(connection, kTables, take, &tables, nullptr);
    if (code != SQLITE_OK) {
        fail(file, connection, code);
    }
    return tables;
}

/// The same of a store that was just made.
std::string tablesOfStore() {
    sqlite3* memory = nullptr;
    (void)sqlite3_open(":memory:", &memory);
    const std::unique_ptr<sqlite3, int (*)(sqlite3*)> closing(memory, sqlite3_close_v2);
    (void)sqlite3_exec(memory, storeSchema(), nullptr, nullptr, nullptr);
    return tablesOf(memory, "memory");
}

/// Opens it again while it is busy, for some seconds.
template <class Open>
auto whenFree(const Open& open) {
    constexpr std::chrono::milliseconds kPause{5};
    constexpr int kMostPauses = 2000;
    for (int pause = 0; pause < kMostPauses; ++pause) {
        try {
            return open();
        } catch (const StoreBusy&) {
            std::this_thread::sleep_for(kPause);
        }
    }
    return open();
}

} // namespace

void Statement::Finalize::operator()(sqlite3_stmt* statement) const {
    sqlite3_finalize(statement);
}

Statement::Statement(sqlite3_stmt* statement, std::string file)
    : _statement(statement), _file(std::move(file)) {}

Statement& Statement::bind(int parameter, std::int64_t number) {
    sqlite3_bind_int64(_statement.get(), parameter, number);
    return *this;
}

Statement& Statement::bind(int parameter, double number) {
    sqlite3_bind_double(_statement.get(), parameter, number);
    return *this;
}

Statement& Statement::bind(int parameter, std::string_view text) {
    // Null would be NULL.
    sqlite3_bind_text64(_statement.get(), parameter, text.data() != nullptr ? text.data() : "",
                        text.size(), SQLITE_TRANSIENT, SQLITE_UTF8);
    return *this;
}

Statement& Statement::bindNull(int parameter) {
    sqlite3_bind_null(_statement.get(), parameter);
    return *this;
}

bool Statement::step() {
    const int code = sqlite3_step(_statement.get());
    if (code == SQLITE_ROW) {
        return true;
    }
    if (code != SQLITE_DONE) {
        sqlite3* connection = sqlite3_db_handle(_statement.get());
        sqlite3_reset(_statement.get()); // the connection keeps the error
        fail(_file, connection, code);
    }
    sqlite3_reset(_statement.get());
    return false;
}

void Statement::reset() {
    sqlite3_reset(_statement.get());
}

std::int64_t Statement::integer(int column) const {
    return sqlite3_column_int64(_statement.get(), column);
}

std::string Statement::text(int column) const {
    const void* bytes = sqlite3_column_text(_statement.get(), column);
    const int size = sqlite3_column_bytes(_statement.get(), column);
    return bytes != nullptr
               ? std::string(static_cast<const char*>(bytes), static_cast<std::size_t>(size))
               : std::string();
}

double Statement::real(int column) const {
    return sqlite3_column_double(_statement.get(), column);
}

bool Statement::isInteger(int column) const {
    return sqlite3_column_type(_statement.get(), column) == SQLITE_INTEGER;
}

bool Statement::isNull(int column) const {
    return sqlite3_column_type(_statement.get(), column) == SQLITE_NULL;
}

void StoreConnection::Close::operator()(sqlite3* connection) const {
    sqlite3_close_v2(connection);
}

StoreConnection::StoreConnection(std::string file, Mode mode) : _file(std::move(file)) {
    sqlite3* connection = nullptr;
    const int flags = mode == Mode::Read ? SQLITE_OPEN_READONLY : SQLITE_OPEN_READWRITE;
    const int code = sqlite3_open_v2(sqliteFileName(_file).c_str(), &connection,
                                     flags | SQLITE_OPEN_NOMUTEX, nullptr);
    _connection.reset(connection);
    if (code != SQLITE_OK) {
        fail(_file, connection, code);
    }
    sqlite3_busy_handler(connection, waitForWriter, this);
    // The file may be anybody's.
    sqlite3_db_config(connection, SQLITE_DBCONFIG_DEFENSIVE, 1, nullptr);
    sqlite3_db_config(connection, SQLITE_DBCONFIG_TRUSTED_SCHEMA, 0, nullptr);
}

StoreConnection::StoreConnection(const std::string& file) : StoreConnection(file, Mode::Write) {
    check(Empty::Allowed);
    // Readers go on while a recording is loaded, and a load that was killed has no effect.
    run("PRAGMA journal_mode = WAL");
    run("PRAGMA synchronous = NORMAL");
    run("PRAGMA cache_size = -32768");
    if (isEmpty()) {
        makeTables();
    }
    check(Empty::Refused);
}

/// SQLite asks it while another program writes, for as long as that takes.
int StoreConnection::waitForWriter(void* connection, int times) {
    constexpr std::chrono::milliseconds kPause{5};
    constexpr std::chrono::milliseconds kPatience{500};
    const auto& waiting = static_cast<StoreConnection*>(connection)->_waiting;
    if (waiting && times == kPatience / kPause) {
        waiting();
    }
    std::this_thread::sleep_for(kPause);
    return 1;
}

std::unique_ptr<StoreConnection> StoreConnection::open(const std::string& file) {
    // As SQLite would create it, but for its user alone.
    constexpr mode_t kPrivate = 0600;
    constexpr int kFlags = O_WRONLY | O_CREAT | O_EXCL | O_CLOEXEC;
    const Descriptor created(
        ::open(sqliteFileName(file).c_str(), kFlags, kPrivate)); // NOLINT(*-vararg)
    if (!created && errno != EEXIST) {
        throw StoreFailure(formatText("%@ cannot be created: %@.", {file, std::strerror(errno)}));
    }
    return whenFree([&] { return std::unique_ptr<StoreConnection>(new StoreConnection(file)); });
}

std::unique_ptr<StoreConnection> StoreConnection::openToRead(const std::string& file) {
    std::error_code ignored;
    if (!std::filesystem::exists(file, ignored)) {
        throw StoreFailure(formatText("There is no store %@ (see pallax store load).", {file}));
    }
    return whenFree([&] {
        StoreConnection(file, Mode::Read).check(Empty::Refused); // it may be of another program
        // Only one that may write cleans up after itself, and after a writer that was killed.
        std::unique_ptr<StoreConnection> store(new StoreConnection(file, Mode::Write));
        store->run("PRAGMA query_only = true");
        return store;
    });
}

std::optional<std::string> StoreConnection::refusal(const std::string& file) {
    try {
        (void)openToRead(file);
    } catch (const StoreFailure& failure) {
        return failure.what();
    }
    return std::nullopt;
}

std::int64_t StoreConnection::number(const char* sql) {
    Statement statement = prepare(sql);
    return statement.step() ? statement.integer(0) : 0;
}

bool StoreConnection::isEmpty() {
    return number("PRAGMA application_id") == 0 && tablesOf(_connection.get(), _file).empty();
}

void StoreConnection::check(Empty empty) {
    if (empty == Empty::Allowed && isEmpty()) {
        return;
    }
    if (number("PRAGMA application_id") != kStoreApplication) {
        throw StoreFailure(formatText("%@ is no store of measurements, but a file of another "
                                      "program.",
                                      {_file}));
    }
    const std::int64_t version = number("PRAGMA user_version");
    if (version > kStoreVersion) {
        throw StoreFailure(formatText("%@ is a store of a later version of Pallax: its tables have "
                                      "version %lld, and this program knows version %lld.",
                                      {_file, version, kStoreVersion}));
    }
    if (version < kStoreVersion || tablesOf(_connection.get(), _file) != tablesOfStore()) {
        throw StoreFailure(formatText("%@ has other tables than a store.", {_file}));
    }
}

void StoreConnection::makeTables() {
    Transaction transaction(*this);
    if (isEmpty()) { // another program may have made them meanwhile
        run(storeSchema());
        run(("PRAGMA application_id = " + std::to_string(kStoreApplication)).c_str());
        run(("PRAGMA user_version = " + std::to_string(kStoreVersion)).c_str());
    }
    transaction.commit();
}

Statement StoreConnection::prepare(const char* sql) {
    sqlite3_stmt* statement = nullptr;
    const int code = sqlite3_prepare_v3(_connection.get(), sql, -1, SQLITE_PREPARE_PERSISTENT,
                                        &statement, nullptr);
    if (code != SQLITE_OK) {
        fail(_file, _connection.get(), code);
    }
    return {statement, _file};
}

void StoreConnection::run(const char* sql) {
    const int code = sqlite3_exec(_connection.get(), sql, nullptr, nullptr, nullptr);
    if (code != SQLITE_OK) {
        fail(_file, _connection.get(), code);
    }
}

StoreConnection::Transaction::Transaction(StoreConnection& connection) : _connection(connection) {
    _connection.run("BEGIN IMMEDIATE");
}

StoreConnection::Transaction::~Transaction() {
    if (_isOpen) { // an error may have ended it already
        sqlite3_exec(_connection._connection.get(), "ROLLBACK", nullptr, nullptr, nullptr);
    }
}

void StoreConnection::Transaction::commit() {
    _connection.run("COMMIT");
    _isOpen = false;
}

} // namespace pallax
