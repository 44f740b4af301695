#include "query/QueryTable.h"
#include "tests/query/QueryFixture.h"

#include <algorithm>
#include <cstdio>

namespace pallax {
namespace {

namespace any = doubles::any;

/// Any conditions on the columns of any table give the rows that SQLite finds in a copy of it.
class ConstraintsTest : public testing::TestWithParam<const char*> {
protected:
    ConstraintsTest() : _fixture(GetParam()) {
        _fixture.drive(5, std::chrono::seconds(8));
        _timeline = _fixture.indexed();
        addTimelineTables(_database, *_timeline);
        for (const Database::Table& table : _database.tables()) {
            if (table.name != "series") { // its arguments are no conditions
                _tables.push_back(table);
            }
        }
    }

    /// A value that stands in the table, or one beside it.
    std::string anyValue(const Database::Table& table, const Column& column) {
        const std::string name = "\"" + column.name + "\"";
        if (any::between(0, 8) == 0) {
            return any::elementOf(
                std::vector<std::string>{"null", "'x'", "-1", "1e300", "2.5", "x'00'", "'3'"});
        }
        const auto values = linesOf(_database, "select quote(" + name + ") from \"" + table.schema +
                                                   "\".\"" + table.name + "\" limit 1 offset " +
                                                   std::to_string(any::between(0, 200)));
        const std::string value = values.empty() ? std::string("0") : values[0];
        return any::boolean() || value[0] == '\'' || value == "NULL"
                   ? value
                   : value + " + " + std::to_string(any::between(-3, 4) * 250'000 / 4);
    }
    std::string anyCondition(const Database::Table& table) {
        // Mostly a column that bounds the rows.
        std::vector<Column> columns = table.columns;
        std::erase_if(columns, [](const Column& each) { return each.role == Column::Role::Plain; });
        if (columns.empty() || any::between(0, 4) == 0) {
            columns = table.columns;
        }
        const Column column = any::elementOf(columns);
        const std::string left = "\"" + column.name + "\" ";
        const std::string value = anyValue(table, column);
        switch (any::between(0, 4)) {
        case 0:
            return left + "between " + value + " and " + anyValue(table, column);
        case 1:
            return left + "in (" + value + ", " + anyValue(table, column) + ", " +
                   anyValue(table, column) + ")";
        default:
            return left +
                   any::elementOf(std::vector<std::string>{"=", "<", "<=", ">", ">=", "<>", "is",
                                                           "is not", "like", "glob"}) +
                   " " + value + (any::between(0, 6) == 0 ? " collate nocase" : "");
        }
    }
    /// Sorted: OR and IN can change the order.
    std::vector<std::string> ask(const std::string& text) {
        auto lines = linesOf(_database, text);
        std::sort(lines.begin(), lines.end());
        return lines;
    }
    void compare(const Database::Table& table, const std::string& conditions) {
        std::string columns;
        std::string results;
        for (const Column& column : table.columns) {
            columns.append(columns.empty() ? "\"" : ", \"").append(column.name).append("\"");
            // A copy has whole numbers of such a column as real ones.
            results.append(results.empty() ? "\"" : ", \"").append(column.name);
            results.append(column.type == "REAL" ? "\" * 1.0" : "\"");
        }
        const std::string select = "select " + results + " from ";
        const std::string name = "\"" + table.schema + "\".\"" + table.name + "\"";
        const auto found = ask(select + name + " where " + conditions);
        const auto expected = ask("with copied as materialized (select " + columns + " from " +
                                  name + ") " + select + "copied where " + conditions);
        _rows += found.size();
        if (found != expected) {
            std::printf("%s where %s: %zu rows, not %zu\n", name.c_str(), conditions.c_str(),
                        found.size(), expected.size());
        }
        RC_ASSERT(found == expected);
    }

    TimelineFixture _fixture;
    std::unique_ptr<Timeline> _timeline;
    Database _database;
    std::vector<Database::Table> _tables;
    std::size_t _rows = 0;
};

INSTANTIATE_TEST_SUITE_P(All, ConstraintsTest, testing::ValuesIn(technologyNames()));

TEST_P(ConstraintsTest, GiveTheRowsThatTheConditionsSay) {
    EXPECT_TRUE(doubles::holds([&] {
        for (int repeated = 0; repeated < 2; ++repeated) {
            const Database::Table table = any::elementOf(_tables);
            std::string text = anyCondition(table);
            for (int more = any::between(0, 4); more > 0; --more) {
                text += any::between(0, 4) == 0 ? " or " : " and ";
                text += anyCondition(table);
            }
            compare(table, text);
        }
    }));
    // One in three conditions finds rows.
    EXPECT_GT(_rows, 0U);
}

} // namespace
} // namespace pallax
