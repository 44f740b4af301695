#include "query/Printf.h"

#include <algorithm>
#include <cstdint>
#include <map>
#include <memory>
#include <span>
#include <sqlite3.h>
#include <string>
#include <string_view>

namespace pallax {

namespace {

using Values = std::span<sqlite3_value*>;

struct Release {
    void operator()(sqlite3* connection) const { sqlite3_close_v2(connection); }
    void operator()(sqlite3_stmt* statement) const { sqlite3_finalize(statement); }
};

/// Adds up how often "%c" repeats its characters.
class Repetitions {
public:
    Repetitions(std::string_view format, Values arguments)
        : _format(format), _arguments(arguments) {}

    std::uint64_t count() {
        while ((_place = _format.find('%', _place)) != std::string_view::npos) {
            ++_place;
            takeConversion();
        }
        return _count;
    }

private:
    void takeConversion() {
        std::uint64_t number = 0; // the last one is the precision, if there is a dot
        bool hasPrecision = false;
        for (; _place < _format.size() && isOption(_format[_place]); ++_place) {
            const char option = _format[_place];
            if (option >= '0' && option <= '9') {
                constexpr std::uint64_t kTen = 10;
                number = std::min(number * kTen + static_cast<std::uint64_t>(option - '0'), kMost);
            } else if (option == '*') {
                number = nextArgument();
            } else if (option == '.') {
                hasPrecision = true;
                number = 0;
            }
        }
        const char conversion = _place < _format.size() ? _format[_place++] : '%';
        if (conversion == 'c' && hasPrecision) {
            _count = std::min(_count + number, kMost);
        }
        _next += conversion != '%' ? 1U : 0U;
    }
    static bool isOption(char character) {
        return std::string_view("-+ #!0123456789,.*l").find(character) != std::string_view::npos;
    }
    std::uint64_t nextArgument() {
        if (_next >= _arguments.size()) {
            return 0;
        }
        const std::int64_t number = sqlite3_value_int64(_arguments[_next++]);
        const auto magnitude = static_cast<std::uint64_t>(number);
        return std::min(number < 0 ? 0 - magnitude : magnitude, kMost);
    }

    static constexpr std::uint64_t kMost = std::uint64_t{1} << 32U;

    std::string_view _format;
    Values _arguments;
    std::size_t _place = 0;
    std::size_t _next = 0; ///< of the arguments
    std::uint64_t _count = 0;
};

/// Asks the printf() of SQLite through a connection of its own, where it is not replaced.
class Printf {
public:
    explicit Printf(sqlite3& asking) : _longest(sqlite3_limit(&asking, SQLITE_LIMIT_LENGTH, -1)) {
        sqlite3* connection = nullptr;
        _isOpen = sqlite3_open_v2(":memory:", &connection,
                                  SQLITE_OPEN_READWRITE | SQLITE_OPEN_MEMORY, nullptr) == SQLITE_OK;
        _connection.reset(connection);
        if (_isOpen) {
            sqlite3_limit(connection, SQLITE_LIMIT_LENGTH, _longest);
        }
    }

    bool isOpen() const { return _isOpen; }

    void call(sqlite3_context* context, Values values) {
        const auto* text = values.empty() ? nullptr : sqlite3_value_text(values[0]);
        if (text == nullptr) {
            return; // NULL
        }
        // SQLite, too, ends it at a zero byte.
        const std::string format(static_cast<const char*>(static_cast<const void*>(text)));
        if (Repetitions(format, values.subspan(1)).count() > static_cast<std::uint64_t>(_longest)) {
            return sqlite3_result_error_toobig(context);
        }
        sqlite3_stmt* statement = statementOf(values.size());
        if (statement == nullptr) {
            return sqlite3_result_error_nomem(context);
        }
        int result = step(*statement, values, format);
        if (result == SQLITE_ROW && sqlite3_column_type(statement, 0) != SQLITE_NULL) {
            sqlite3_result_value(context, sqlite3_column_value(statement, 0));
        } else if (result == SQLITE_ROW) {
            // An empty text is NULL as well; with one more character it is not.
            result = step(*statement, values, "." + format);
            if (result == SQLITE_ROW && sqlite3_column_type(statement, 0) == SQLITE_NULL) {
                result = SQLITE_TOOBIG;
            }
        }
        if (result != SQLITE_ROW) {
            sqlite3_result_error_code(context, result);
        }
        sqlite3_reset(statement);
        sqlite3_clear_bindings(statement);
    }

private:
    sqlite3_stmt* statementOf(std::size_t arguments) {
        auto& statement = _statements[arguments];
        if (!statement) {
            std::string text = "SELECT printf(?";
            for (std::size_t index = 1; index < arguments; ++index) {
                text += ",?";
            }
            text += ")";
            sqlite3_stmt* prepared = nullptr;
            (void)sqlite3_prepare_v2(_connection.get(), text.c_str(), -1, &prepared, nullptr);
            statement.reset(prepared);
        }
        return statement.get();
    }
    static int step(sqlite3_stmt& statement, Values values, const std::string& format) {
        sqlite3_reset(&statement);
        int result = sqlite3_bind_text64(&statement, 1, format.data(), format.size(),
                                         SQLITE_TRANSIENT, SQLITE_UTF8);
        for (std::size_t index = 1; index < values.size() && result == SQLITE_OK; ++index) {
            result = sqlite3_bind_value(&statement, static_cast<int>(index + 1), values[index]);
        }
        return result == SQLITE_OK ? sqlite3_step(&statement) : result;
    }

    int _longest;
    bool _isOpen = false;
    std::unique_ptr<sqlite3, Release> _connection;
    std::map<std::size_t, std::unique_ptr<sqlite3_stmt, Release>> _statements; ///< by arguments
};

void callPrintf(sqlite3_context* context, int count, sqlite3_value** values) {
    static_cast<Printf*>(sqlite3_user_data(context))
        ->call(context, {values, static_cast<std::size_t>(count)});
}

bool addPrintfAs(const char* name, sqlite3& connection) {
    auto made = std::make_unique<Printf>(connection);
    if (!made->isOpen()) {
        return false;
    }
    constexpr int kAnyNumber = -1;
    return sqlite3_create_function_v2(&connection, name, kAnyNumber,
                                      SQLITE_UTF8 | SQLITE_DETERMINISTIC | SQLITE_INNOCUOUS,
                                      made.release(), callPrintf, nullptr, nullptr, [](void* held) {
                                          std::unique_ptr<Printf>(static_cast<Printf*>(held));
                                      }) == SQLITE_OK;
}

} // namespace

bool addPrintf(sqlite3& connection) {
    return addPrintfAs("printf", connection) && addPrintfAs("format", connection);
}

} // namespace pallax
