// Conditions on the columns of a table: they give the rows that SQLite finds in a copy of the
// table. The input: a byte that chooses the table, then for each condition four bytes: column,
// operator, and two for the value, which is one of the table or lies beside it; the operator's
// highest bit joins it by OR.

#include "fuzz/QueryTimeline.h"
#include "query/QueryTable.h"
#include "query/SqlText.h"

#include <algorithm>
#include <array>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <string>

namespace {

using namespace pallax;

using Answer = std::vector<std::vector<QueryValue>>;

/// Sorted: OR can change the order.
Answer answerOf(Database& database, const std::string& text) {
    Query query = database.prepare(text).value();
    Answer answer;
    while (auto row = query.next().value()) {
        answer.push_back(*std::move(row));
    }
    std::sort(answer.begin(), answer.end());
    return answer;
}

/// Numbers of a REAL column come as whole ones from a table, and as real ones from its copy.
std::string columnsOf(const Database::Table& table, bool asReal) {
    std::string columns;
    for (const Column& column : table.columns) {
        columns += (columns.empty() ? "" : ", ") + quotedName(column.name);
        columns += asReal && column.type == "REAL" ? " * 1.0" : "";
    }
    return columns;
}

std::string conditionOf(Database& database, const Database::Table& table, const std::string& name,
                        const std::uint8_t* input) {
    static constexpr auto kOperators =
        std::to_array<const char*>({"=", "<", "<=", ">", ">=", "<>", "is", "is not", "like"});
    constexpr std::uint8_t kLow = 0x7F;
    const std::string column = quotedName(table.columns[input[0] % table.columns.size()].name);
    const Answer values = answerOf(database, "select quote(" + column + ") from " + name +
                                                 " limit 1 offset " + std::to_string(input[2]));
    std::string value = values.empty() ? std::string("null") : std::get<std::string>(values[0][0]);
    if (value != "NULL" && value[0] != '\'') {
        value += " + " + std::to_string((input[3] - 128) * (input[3] % 2 == 0 ? 1 : 10'000));
    }
    return column + " " + kOperators.at((input[1] & kLow) % kOperators.size()) + " " + value;
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    constexpr std::size_t kCondition = 4;
    constexpr std::size_t kMostConditions = 6;
    constexpr std::uint8_t kOr = 0x80;
    static QueryTimeline timeline;
    static const std::vector<Database::Table> tables = timeline.database.tables();
    if (size < 1 + kCondition) {
        return 0;
    }
    const Database::Table& table = tables[data[0] % tables.size()];
    if (table.name == "series") { // its arguments are no conditions
        return 0;
    }
    const std::string name = quotedName(table.schema) + "." + quotedName(table.name);
    std::string conditions;
    for (std::size_t at = 1; at + kCondition <= std::min(size, 1 + kCondition * kMostConditions);
         at += kCondition) {
        conditions += conditions.empty() ? "" : (data[at + 1] & kOr) != 0 ? " or " : " and ";
        conditions += conditionOf(timeline.database, table, name, data + at);
    }
    const std::string select = "select " + columnsOf(table, true) + " from ";
    if (answerOf(timeline.database, select + name + " where " + conditions) !=
        answerOf(timeline.database, "with copied as materialized (select " +
                                        columnsOf(table, false) + " from " + name + ") " + select +
                                        "copied where " + conditions)) {
        (void)std::fprintf(stderr, "%s where %s\n", name.c_str(), conditions.c_str());
        std::abort();
    }
    return 0;
}
