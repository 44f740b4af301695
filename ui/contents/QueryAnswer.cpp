#include "ui/contents/QueryAnswer.h"

#include "query/Database.h"
#include "query/QueryErrorText.h"
#include "query/TimelineTables.h"
#include "timeline/Timeline.h"
#include "ui/contents/TimeOfDay.h"

#include <algorithm>
#include <charconv>
#include <cmath>
#include <system_error>
#include <utility>

namespace pallax {

namespace {

constexpr std::string_view kMoreRows = "Only the first 10,000 rows are shown.";
static_assert(QueryAnswer::kMostRows == 10000);

std::string textOfReal(double number) {
    constexpr std::size_t kEnough = 32;
    std::string text(kEnough, ' ');
    const auto end = std::to_chars(text.data(), text.data() + text.size(), number);
    text.resize(static_cast<std::size_t>(end.ptr - text.data()));
    return text;
}

TableCell cellOf(QueryValue&& value) {
    if (const auto* integer = std::get_if<std::int64_t>(&value)) {
        return {std::to_string(*integer), static_cast<double>(*integer)};
    }
    if (const auto* real = std::get_if<double>(&value)) {
        return {textOfReal(*real), *real};
    }
    if (auto* text = std::get_if<std::string>(&value)) {
        return {std::move(*text)};
    }
    return {};
}

void readRows(Query& query, QueryAnswer& answer) {
    for (const std::string& name : query.columns()) {
        answer.table.columns.push_back({name});
    }
    while (true) {
        auto next = query.next();
        if (!next) {
            answer.sentence = next.error().sentence;
            answer.hasFailed = true;
            return;
        }
        auto values = std::move(next).value();
        if (!values) {
            return;
        }
        if (answer.table.rows.size() == QueryAnswer::kMostRows) {
            answer.sentence = kMoreRows;
            return;
        }
        TableRow row{std::to_string(answer.table.rows.size()), {}};
        for (QueryValue& value : *values) {
            row.cells.push_back(cellOf(std::move(value)));
        }
        answer.table.rows.push_back(std::move(row));
    }
}

/// The column with times, in microseconds.
constexpr std::string_view kTime = "time";

/// The whole number in the column of that name.
std::optional<std::int64_t> numberIn(const TableContent& table, std::size_t row,
                                     std::string_view name) {
    for (std::size_t column = 0; column < table.columns.size(); ++column) {
        const std::string& text = table.rows[row].cells[column].text;
        std::int64_t number = 0;
        const char* const end = text.data() + text.size();
        const auto read = std::from_chars(text.data(), end, number);
        if (table.columns[column].name == name && read.ec == std::errc() && read.ptr == end) {
            return number;
        }
    }
    return std::nullopt;
}

std::optional<Time> timeIn(const TableContent& table, std::size_t row) {
    constexpr std::int64_t kLatest =
        std::chrono::duration_cast<std::chrono::microseconds>(kLatestTime.time_since_epoch())
            .count();
    const auto time = numberIn(table, row, kTime);
    return time && *time >= 0 && *time <= kLatest
               ? std::optional(Time(std::chrono::microseconds(*time)))
               : std::nullopt;
}

} // namespace

QueryAnswer answerQuery(Timeline& timeline, const std::string& query,
                        const std::function<bool()>& mayGoOn,
                        const std::function<void(Database&, Timeline&)>& addFunctions) {
    QueryAnswer answer;
    Database database;
    addTimelineTables(database, timeline);
    addFunctions(database, timeline);
    database.setMayContinue(mayGoOn);
    auto prepared = database.prepare(query);
    if (!prepared) {
        answer.sentence = queryErrorText(prepared.error(), query, database.names());
        answer.hasFailed = true;
        return answer;
    }
    Query running = std::move(prepared).value();
    readRows(running, answer);
    return answer;
}

void addTimeOfDay(TableContent& table, std::chrono::seconds ahead) {
    auto& columns = table.columns;
    const auto found = std::find_if(columns.begin(), columns.end(),
                                    [](const auto& column) { return column.name == kTime; });
    std::vector<std::optional<Time>> times;
    for (std::size_t row = 0; row < table.rows.size(); ++row) {
        times.push_back(timeIn(table, row));
    }
    const bool hasTimes =
        std::any_of(times.begin(), times.end(), [](const auto& time) { return time.has_value(); });
    if (found == columns.end() || !hasTimes) {
        return;
    }
    const auto place = found - columns.begin() + 1;
    columns.insert(columns.begin() + place, {"clock"});
    for (std::size_t row = 0; row < times.size(); ++row) {
        auto& cells = table.rows[row].cells;
        cells.insert(cells.begin() + place,
                     {times[row] ? timeOfDay(*times[row], ahead) : std::string()});
    }
}

std::optional<std::uint64_t> packetOf(const TableContent& table, std::size_t row,
                                      const Timeline& timeline) {
    if (const auto packet = numberIn(table, row, "packet")) {
        const auto number = static_cast<std::uint64_t>(*packet);
        const bool isThere = number >= timeline.firstInstant() && number <= timeline.packets();
        return isThere ? std::optional(number) : std::nullopt;
    }
    const auto time = timeIn(table, row);
    if (!time) {
        return std::nullopt;
    }
    // The column is truncated, and its packet belongs to the instant.
    constexpr std::chrono::nanoseconds kRest =
        std::chrono::microseconds(1) - std::chrono::nanoseconds(1);
    return timeline.instantAt(*time + kRest);
}

} // namespace pallax
