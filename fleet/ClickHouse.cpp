#include "fleet/ClickHouse.h"

#include "store/MeasurementStore.h"
#include "text/Format.h"

#include <array>
#include <charconv>
#include <utility>

namespace pallax {

namespace {

constexpr int kOk = 200;
// Of ClickHouse:
constexpr int kNoTable = 60;
constexpr int kNoDatabase = 81;
constexpr int kNoShard = 279;

std::string escaped(std::string_view text) {
    constexpr std::string_view kDigits = "0123456789ABCDEF";
    std::string result;
    for (const char character : text) {
        const auto byte = static_cast<unsigned char>(character);
        result.append(1, '%').append(1, kDigits[byte >> 4U]).append(1, kDigits[byte & 0xFU]);
    }
    return result;
}

/// Gives a text once.
HttpExchange::Give once(const std::string& text) {
    return [piece = std::string_view(text)]() mutable { return std::exchange(piece, {}); };
}

} // namespace

std::string clickHouseText(std::string_view text) {
    std::string quoted = "'";
    for (const char character : text) {
        if (character == '\'' || character == '\\') {
            quoted += '\\';
        }
        quoted += character == '\0' ? std::string("\\0") : std::string(1, character);
    }
    return quoted + "'";
}

ClickHouse::ClickHouse(const StoreAddress& address, Patience patience)
    : _address(address), _http(address, patience) {}

/// Gives an answer's body to `take`, and that of an error to `error`.
int ClickHouse::post(const std::string& parameters, const HttpExchange::Give& give,
                     const std::function<void(std::string_view)>& take, std::string& error) {
    constexpr std::size_t kLongestError = 4096;
    return _http.post(parameters, give, [&](int status, std::string_view piece) {
        if (status == kOk) {
            take(piece);
        } else {
            error += piece.substr(0, kLongestError - std::min(kLongestError, error.size()));
        }
    });
}

/// "Code: 60, e.displayText() = DB::Exception: Table a.b doesn't exist., e.what() = DB::Exception"
ServerRefusal ClickHouse::refusalOf(int status, const std::string& text) const {
    constexpr std::string_view kCode = "Code: ";
    constexpr std::string_view kException = "Exception: "; // also of DB::NetException
    const std::size_t exception = text.find(kException);
    ServerRefusal refusal;
    if (!text.starts_with(kCode) || exception == std::string::npos) {
        throw StoreFailure(formatText("%@ is no server of ClickHouse: it answers with status %d.",
                                      {_address.text(), status}));
    }
    (void)std::from_chars(text.data() + kCode.size(), text.data() + text.size(), refusal.code);
    std::string_view message = std::string_view(text).substr(exception + kException.size());
    for (const std::string_view end : {", e.what()", " (version ", "\n"}) {
        message = message.substr(0, message.find(end));
    }
    while (message.ends_with('.') || message.ends_with(' ')) {
        message.remove_suffix(1);
    }
    refusal.message = message;
    return refusal;
}

void ClickHouse::fail(const ServerRefusal& refusal) const {
    const std::string where = _address.text();
    if (refusal.code == kNoTable || refusal.code == kNoDatabase) {
        throw StoreFailure(formatText("There is no store %@ (see pallax store setup): %@.",
                                      {where, refusal.message}));
    }
    if (refusal.code == kNoShard) {
        throw StoreFailure(formatText("%@: a server of the cluster does not answer, and without it "
                                      "nothing is whole.",
                                      {where}));
    }
    throw StoreFailure(formatText("%@: %@.", {where, refusal.message}));
}

void ClickHouse::run(const std::string& statement, bool isInDatabase) {
    std::string error;
    const std::string parameters = isInDatabase ? "?database=" + _address.database : "";
    const int status = post(
        parameters, once(statement), [](std::string_view /*piece*/) {}, error);
    if (status != kOk) {
        fail(refusalOf(status, error));
    }
}

void ClickHouse::ask(const std::string& query, const AnswerRows::TakeColumns& takeColumns,
                     const AnswerRows::TakeRow& takeRow, const Refused& refused) {
    // The server waits with the answer until it is whole. Some need more than these settings allow
    // to change, so readonly comes with them.
    const std::string parameters =
        "?database=" + _address.database +
        "&default_format=TabSeparatedWithNamesAndTypes&wait_end_of_query=1&readonly=2"
        "&enable_optimize_predicate_expression=1";
    std::string error;
    AnswerRows answer(takeColumns, takeRow);
    try {
        const int status = post(
            parameters, once(query), [&](std::string_view piece) { answer.add(piece); }, error);
        if (status != kOk) {
            const ServerRefusal refusal = refusalOf(status, error);
            if (refused && refusal.code != kNoShard && refusal.code != kNoDatabase) {
                return refused(refusal);
            }
            fail(refusal);
        }
        answer.finish();
    } catch (const NoAnswer& nonsense) {
        throw StoreFailure(formatText("%@ does not answer as a server of ClickHouse: %@.",
                                      {_address.text(), nonsense.what()}));
    }
}

void ClickHouse::eachRow(const std::string& query, std::size_t columns,
                         const AnswerRows::TakeRow& take) {
    ask(
        query,
        [&](const std::vector<std::string>& names) {
            if (names.size() != columns) {
                throw NoAnswer("it has other columns");
            }
        },
        take);
}

std::vector<std::vector<QueryValue>> ClickHouse::rows(const std::string& query,
                                                      std::size_t columns) {
    std::vector<std::vector<QueryValue>> all;
    eachRow(query, columns, [&](std::vector<QueryValue> row) { all.push_back(std::move(row)); });
    return all;
}

void ClickHouse::insert(const std::string& tableAndColumns, const HttpExchange::Give& give) {
    std::string error;
    const int status = post(
        "?database=" + _address.database + "&insert_distributed_sync=1&query=" +
            escaped("INSERT INTO " + tableAndColumns + " FORMAT RowBinary"),
        give, [](std::string_view /*piece*/) {}, error);
    if (status != kOk) {
        fail(refusalOf(status, error));
    }
}

} // namespace pallax
