#include "query/QueryTable.h"
#include "tests/query/QueryFixture.h"

#include <malloc.h>

namespace pallax {
namespace {

/// The numbers from 1 to 10, as packets; counts the rows that it was asked for.
class Numbers final : public QueryTable {
public:
    explicit Numbers(int& given) : _given(given) {}

    const std::vector<Column>& columns() const override {
        static const std::vector<Column> columns = {
            {"number", "INTEGER", Column::Role::PacketNumber},
            {"name", "TEXT"},
            {"secret", "TEXT", Column::Role::Plain, true}};
        return columns;
    }
    std::unique_ptr<Rows> rows(const RowBounds& bounds) override {
        return std::make_unique<Counting>(bounds, _given);
    }
    double expectedRows() const override { return kMost; }

    static constexpr std::uint64_t kMost = 10;

private:
    class Counting final : public Rows {
    public:
        Counting(const RowBounds& bounds, int& given)
            : _number(std::max<std::uint64_t>(bounds.firstPacket, 1) - 1),
              _last(std::min(bounds.lastPacket, kMost)), _given(given) {}
        bool next() override {
            ++_given;
            if (++_number == kTrouble && _last == kMost) {
                return true;
            }
            return _number <= _last;
        }
        void give(std::size_t column, ColumnValue& value) const override {
            if (column == 0) {
                value.integer(static_cast<std::int64_t>(_number));
            } else if (column == 1) {
                value.text("n" + std::to_string(_number));
            } else {
                value.real(0.5);
            }
        }

    private:
        static constexpr std::uint64_t kTrouble = 100;
        std::uint64_t _number;
        std::uint64_t _last;
        int& _given;
    };

    int& _given;
};

/// Throws when its rows are asked for, or when the first one is.
class Failing final : public QueryTable {
public:
    explicit Failing(bool late) : _late(late) {}
    const std::vector<Column>& columns() const override {
        static const std::vector<Column> columns = {{"value", ""}};
        return columns;
    }
    std::unique_ptr<Rows> rows(const RowBounds& /*bounds*/) override {
        if (!_late) {
            throw std::runtime_error("no rows");
        }
        return std::make_unique<NoNext>();
    }
    double expectedRows() const override { return 1; }

private:
    class NoNext final : public Rows {
    public:
        bool next() override { throw std::runtime_error("no next row"); }
        void give(std::size_t /*column*/, ColumnValue& /*value*/) const override {}
    };
    bool _late;
};

class DatabaseTest : public testing::Test {
protected:
    DatabaseTest() { _database.add("main", "numbers", std::make_unique<Numbers>(_given)); }

    std::vector<std::string> ask(const std::string& text) { return linesOf(_database, text); }
    int rowsGivenFor(const std::string& text) {
        _given = 0;
        (void)ask(text);
        return _given;
    }

    Database _database;
    int _given = 0;
};

using Lines = std::vector<std::string>;

TEST_F(DatabaseTest, GivesTheRowsOfATable) {
    EXPECT_EQ(ask("select number, name from numbers where number < 3"), (Lines{"1|n1", "2|n2"}));
    EXPECT_EQ(ask("select count(*) from numbers"), Lines{"10"});
    EXPECT_EQ(ask("select * from numbers limit 1"), Lines{"1|n1"}) << "hidden columns are left out";
    EXPECT_EQ(ask("select secret from numbers limit 1"), Lines{"0.500000"});
}

TEST_F(DatabaseTest, AsksATableOnlyForTheRowsThatAQueryNeeds) {
    EXPECT_EQ(rowsGivenFor("select * from numbers"), 11);
    EXPECT_EQ(rowsGivenFor("select * from numbers where number = 4"), 2);
    EXPECT_EQ(rowsGivenFor("select * from numbers where number between 3 and 5"), 4);
    EXPECT_EQ(rowsGivenFor("select * from numbers where number > 8.5 and name like 'n%'"), 5);
    EXPECT_EQ(rowsGivenFor("select * from numbers where name = 'n3'"), 11);
}

TEST_F(DatabaseTest, ChecksConditionsThatATableOnlyComesNear) {
    EXPECT_EQ(ask("select number from numbers where number > 8.5"), (Lines{"9", "10"}));
    EXPECT_EQ(ask("select number from numbers where number < 2.5"), (Lines{"1", "2"}));
    EXPECT_EQ(ask("select number from numbers where number = '3'"), Lines{"3"});
    EXPECT_EQ(ask("select number from numbers where number = null"), Lines{});
    EXPECT_EQ(ask("select number from numbers where number > 1e300"), Lines{});
    EXPECT_EQ(ask("select count(*) from numbers where number > -1e300"), Lines{"10"});
    EXPECT_EQ(ask("select count(*) from numbers where number < 1e300"), Lines{"10"});
}

TEST_F(DatabaseTest, TakesTheNameOfAFieldForAnExpression) {
    int given = 0;
    _database.add("lte", "cells", std::make_unique<Numbers>(given));
    EXPECT_EQ(ask("select lte.cells.number from cells where lte.cells.number = 2"), Lines{"2"});
}

TEST_F(DatabaseTest, RefusesEverythingThatWouldDoMoreThanRead) {
    const Lines refused{"A query can only read."};
    for (const char* text : {"attach 'x.db' as x",
                             "create table t(a)",
                             "pragma journal_mode",
                             "drop table numbers",
                             "insert into numbers values (1, 'x')",
                             "delete from numbers",
                             "vacuum",
                             "select load_extension('x')",
                             "select fts3_tokenizer('simple')",
                             "begin",
                             "create temp table t(a)",
                             "detach lte",
                             "update numbers set name = 'x'",
                             "analyze",
                             "reindex",
                             "vacuum into 'x.db'",
                             "commit",
                             "savepoint x",
                             "pragma temp_store = file",
                             "select * from pragma_table_info('numbers')",
                             "select * from dbstat",
                             "create virtual table t using fts5(x)",
                             "with x as (select 1) delete from numbers"}) {
        const auto query = _database.prepare(text);
        ASSERT_FALSE(query) << text << " is refused before it runs";
        EXPECT_TRUE(query.error().sentence == refused[0] ||
                    query.error().sentence == "table numbers may not be modified" ||
                    query.error().sentence == "no such table: dbstat")
            << text << ": " << query.error().sentence;
    }
    EXPECT_EQ(ask("select count(*) from numbers"), Lines{"10"});
}

TEST_F(DatabaseTest, TellsWhatIsWrongWithAQueryAndWhere) {
    const auto error = [&](const std::string& text) {
        const auto query = _database.prepare(text);
        EXPECT_FALSE(query) << text;
        return query ? QueryError{} : query.error();
    };
    const QueryError column = error("select numbr from numbers");
    EXPECT_EQ(column.sentence, "no such column: numbr");
    EXPECT_EQ(column.place, 7U);
    EXPECT_EQ(error("select from").sentence, "near \"from\": syntax error");
    EXPECT_EQ(error("select * from cellar").sentence, "no such table: cellar");
    EXPECT_EQ(error("  ").sentence, "There is no query.");
    const QueryError second = error("select 1; select 2");
    EXPECT_EQ(second.sentence, "Only one query can be run.");
    EXPECT_EQ(second.place, 9U);
    EXPECT_TRUE(_database.prepare("select 1 ; ")) << "an empty rest is no query";
}

TEST_F(DatabaseTest, TellsWhyATableHasFailed) {
    _database.add("main", "early", std::make_unique<Failing>(false));
    _database.add("main", "late", std::make_unique<Failing>(true));
    EXPECT_EQ(ask("select * from early"), Lines{"no rows"});
    EXPECT_EQ(ask("select * from late"), Lines{"no next row"});
}

TEST_F(DatabaseTest, StopsAQueryWhenItIsAskedTo) {
    int asked = 0;
    _database.setMayContinue([&] { return ++asked < 3; });
    EXPECT_EQ(ask("with recursive c(n) as (select 1 union all select n + 1 from c) "
                  "select count(*) from c"),
              Lines{"The query was stopped."});
    EXPECT_EQ(asked, 3);
}

TEST_F(DatabaseTest, AQueryThatWantsTooMuchMemoryFailsAndNothingElse) {
    const Lines answer = ask("select length(hex(zeroblob(1 << 30)))");
    ASSERT_EQ(answer.size(), 1U);
    EXPECT_NE(answer[0], "2147483648");
    EXPECT_EQ(ask("select 1"), Lines{"1"});
}

TEST_F(DatabaseTest, SortsInABoundedMemory) {
    const Lines answer =
        ask("with recursive c(n) as (select 1 union all select n + 1 from c limit 1000) select "
            "sum(length(x)) from (select hex(zeroblob(300000)) || n as x from c order by x limit "
            "2000)");
    EXPECT_EQ(answer, Lines{"The query needs more than 256 MiB of memory."});
    EXPECT_EQ(ask("select count(*) from (select * from numbers order by name desc)"), Lines{"10"});
}

#ifndef PALLAX_SANITIZED // whose allocator mallinfo2() does not know
TEST_F(DatabaseTest, SmallRowsAreCountedWithTheRoomAroundThem) {
    const auto used = [] {
        const auto info = ::mallinfo2();
        return info.uordblks + info.hblkhd;
    };
    const std::size_t before = used();
    std::size_t most = before;
    int asked = 0;
    _database.setMayContinue([&] {
        constexpr int kBetween = 200; // mallinfo2() looks at all free blocks
        most = ++asked % kBetween == 0 ? std::max(most, used()) : most;
        return true;
    });
    const Lines answer = ask("with recursive c(n) as (select 1 union all select n + 1 from c limit "
                             "20000000) select 'abcd' from c order by random()");
    EXPECT_EQ(answer, Lines{"The query needs more than 256 MiB of memory."});
    EXPECT_LT(most - before, std::size_t{345} << 20U);
}
#endif

TEST_F(DatabaseTest, ATextThatIsTooLongIsAnErrorOfTheQuery) {
    for (const char* text : {"printf('%.*c', 2000000000, 'x')", "printf('%.2000000000c', 'x')",
                             "format('%d%.*c', 1, -2147483647, 'x')", "printf('%20000000d', 1)",
                             "printf('%s%s', hex(zeroblob(8000000)), hex(zeroblob(8000000)))"}) {
        EXPECT_EQ(ask(std::string("select length(") + text + ")"), Lines{"string or blob too big"})
            << text;
    }
    EXPECT_EQ(
        ask("select length(printf('%.*c', 10000000, 'x')), printf('%.*s', 2000000000, 'abc')"),
        Lines{"10000000|abc"});
    EXPECT_EQ(ask("select printf('%05.1f%%|%-*d|%s', 2.25, 4, 7, 'x'), format('a'), printf('%s')"),
              Lines{"002.3%|7   |x|a|"});
    EXPECT_EQ(ask("select printf(''), printf('%s', ''), printf(null, 1), printf()"),
              Lines{"NULL||NULL|NULL"});
    EXPECT_EQ(ask("select group_concat(printf('%d', number), ' ') from numbers where number < 4"),
              Lines{"1 2 3"});
}

TEST_F(DatabaseTest, ReadsJson) {
    EXPECT_EQ(ask("select key, value from json_each('[5,7]')"), (Lines{"0|5", "1|7"}));
    EXPECT_EQ(ask("select value from json_tree('{\"a\":[1]}') where atom = 1"), Lines{"1"});
    EXPECT_EQ(ask("select json_group_array(number) from numbers where number < 3"), Lines{"[1,2]"});
}

TEST_F(DatabaseTest, GivesBytesAsDigits) {
    EXPECT_EQ(ask("select x'00FF1a', cast('a' as blob), x'', cast(x'61' as text)"),
              Lines{"00FF1A|61||a"});
}

TEST_F(DatabaseTest, KnowsItsTables) {
    int given = 0;
    _database.add("lte", "cells", std::make_unique<Numbers>(given));
    const auto tables = _database.tables();
    ASSERT_EQ(tables.size(), 2U);
    EXPECT_EQ(tables[0].schema + "." + tables[0].name, "main.numbers");
    EXPECT_EQ(tables[1].schema + "." + tables[1].name, "lte.cells");
    ASSERT_EQ(tables[1].columns.size(), 3U);
    EXPECT_EQ(tables[1].columns[2].name, "secret");
}

TEST_F(DatabaseTest, QuantilesAreWeighted) {
    EXPECT_EQ(ask("select quantile(number, 1, 0.5) from numbers"), Lines{"5.000000"});
    EXPECT_EQ(ask("select quantile(number, 1, 0), quantile(number, 1, 1) from numbers"),
              Lines{"1.000000|10.000000"});
    EXPECT_EQ(ask("select quantile(number, number = 7, 0.5) from numbers"), Lines{"7.000000"});
    EXPECT_EQ(ask("select quantile(name, 1, 0.5) from numbers"), Lines{"NULL"});
    EXPECT_EQ(ask("select quantile(number, 1, 0.5) from numbers where number < 1"), Lines{"NULL"});
    EXPECT_EQ(ask("select number % 2, quantile(number, 1, 0.5) from numbers group by 1"),
              (Lines{"0|6.000000", "1|5.000000"}));
}

} // namespace
} // namespace pallax
