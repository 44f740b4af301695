#pragma once

#include "store/MeasurementStore.h"

#include <cstdint>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <utility>

struct sqlite3;
struct sqlite3_stmt;

namespace pallax {

/// A statement of SQL that can run many times. Parameters and columns count from 1 and 0.
class Statement {
public:
    Statement& bind(int parameter, std::int64_t number);
    Statement& bind(int parameter, double number);
    Statement& bind(int parameter, std::string_view text);
    Statement& bind(int parameter, const char* text) {
        return bind(parameter, std::string_view(text));
    }
    Statement& bindNull(int parameter);
    template <class Value>
    Statement& bind(int parameter, const std::optional<Value>& value) {
        return value ? bind(parameter, *value) : bindNull(parameter);
    }

    /// The next row; false after the last, when it can be bound and run again.
    bool step();
    /// Runs a statement that gives no rows.
    void run() {
        while (step()) {
        }
    }
    /// Ends before the last row.
    void reset();

    std::int64_t integer(int column) const;
    double real(int column) const;
    std::string text(int column) const;
    bool isInteger(int column) const;
    bool isNull(int column) const;

private:
    friend class StoreConnection;
    struct Finalize {
        void operator()(sqlite3_stmt* statement) const;
    };
    Statement(sqlite3_stmt* statement, std::string file);

    std::unique_ptr<sqlite3_stmt, Finalize> _statement;
    std::string _file;
};

/// A store's file that is open. Failures are StoreFailure.
class StoreConnection {
public:
    /// Creates the file, which only its user may read, if it is missing. Refuses, before anything
    /// is written, what is no store or one of a later version.
    static std::unique_ptr<StoreConnection> open(const std::string& file);
    /// Opens an existing store, which cannot be changed by it.
    static std::unique_ptr<StoreConnection> openToRead(const std::string& file);
    /// Why an existing file cannot be asked as a store; nothing if it can.
    static std::optional<std::string> refusal(const std::string& file);

    Statement prepare(const char* sql);
    void run(const char* sql);
    const std::string& file() const { return _file; }
    /// Called once for each wait of more than half a second for another program that writes.
    void setWaiting(std::function<void()> waiting) { _waiting = std::move(waiting); }

    /// Waits for other writers. Ends without `commit` as if nothing had been written.
    class Transaction {
    public:
        explicit Transaction(StoreConnection& connection);
        ~Transaction();
        Transaction(const Transaction&) = delete;
        Transaction& operator=(const Transaction&) = delete;
        void commit();

    private:
        StoreConnection& _connection;
        bool _isOpen = true;
    };

private:
    struct Close {
        void operator()(sqlite3* connection) const;
    };

    enum class Mode { Read, Write };
    enum class Empty { Refused, Allowed };

    explicit StoreConnection(const std::string& file);
    StoreConnection(std::string file, Mode mode);
    /// Throws unless it is a store of this version.
    void check(Empty empty);
    void makeTables();
    static int waitForWriter(void* connection, int times);
    bool isEmpty();
    std::int64_t number(const char* sql);

    std::string _file;
    std::function<void()> _waiting;
    std::unique_ptr<sqlite3, Close> _connection;
};

} // namespace pallax
