#include "querying/SqlShell.h"

#include "console/Output.h"
#include "query/QueryTable.h"
#include "querying/LineReader.h"
#include "querying/QueryRun.h"
#include "querying/SqlCompletion.h"
#include "tests/doubles/ManualClock.h"

#include <gtest/gtest.h>

#include <utility>

namespace pallax {
namespace {

using Lines = std::vector<std::string>;

/// A table of one row.
class OneRowTable final : public QueryTable {
public:
    explicit OneRowTable(std::vector<Column> columns) : _columns(std::move(columns)) {}
    const std::vector<Column>& columns() const override { return _columns; }
    double expectedRows() const override { return 1; }
    std::unique_ptr<Rows> rows(const RowBounds& /*bounds*/) override {
        return std::make_unique<OneRow>();
    }

private:
    class OneRow final : public Rows {
    public:
        bool next() override { return !std::exchange(_isRead, true); }
        void give(std::size_t column, ColumnValue& value) const override {
            value.text("value " + std::to_string(column));
        }

    private:
        bool _isRead = false;
    };

    std::vector<Column> _columns;
};

/// Lines of a user; "^C" takes back what was typed.
class ScriptedLines final : public LineReader {
public:
    Outcome read(const std::string& /*before*/, std::string& line) override {
        if (next == lines.size()) {
            return Outcome::End;
        }
        line = lines[next++];
        return line == "^C" ? Outcome::Cleared : Outcome::Line;
    }
    void remember(const std::string& statement) override { remembered.push_back(statement); }

    Lines lines;
    std::size_t next = 0;
    Lines remembered;
};

class SqlShellTest : public testing::Test {
protected:
    SqlShellTest() {
        database.add("main", "state",
                     std::make_unique<OneRowTable>(std::vector<Column>{
                         {"time", "INTEGER"}, {"rsrp", ""}, {"rsrp_age", "REAL", {}, true}}));
        database.add("main", "field",
                     std::make_unique<OneRowTable>(std::vector<Column>{
                         {"name", "TEXT"}, {"unit", "TEXT"}, {"meaning", "TEXT"}}));
        database.add("lte", "cells",
                     std::make_unique<OneRowTable>(std::vector<Column>{{"pci", ""}}));
        database.addFunction("mhz", 2, [](auto) { return QueryValue(); });
    }

    ExitStatus run(Lines lines, SqlShell::Errors errors) {
        user.lines = std::move(lines);
        user.next = 0;
        written.clear();
        told.clear();
        Output output([this](std::string_view block) { written += block; });
        QueryRun queries(database, request,
                         {output, clock, [this] { clock.advance(std::chrono::seconds(1)); },
                          [this](auto text) { told.emplace_back(text); }});
        SqlShell shell(queries, user, RowFormat::Csv, errors);
        return shell.run();
    }

    Database database;
    doubles::ManualClock clock;
    QueryRun::Request request;
    ScriptedLines user;
    std::string written;
    Lines told;
};

TEST_F(SqlShellTest, JoinsLinesUntilTheSemicolon) {
    EXPECT_EQ(run({"select 1", "  as a; select", "';' as b -- ;", ";"}, SqlShell::Errors::Go),
              kExitSuccess);
    EXPECT_EQ(written, "a\n1\nb\n;\n");
    EXPECT_EQ(user.remembered, (Lines{"select 1\n  as a;", " select\n';' as b -- ;\n;"}));
    EXPECT_EQ(told, Lines{});
}

TEST_F(SqlShellTest, TheUserCanTakeLinesBackAndGoOnAfterErrors) {
    EXPECT_EQ(run({"select", "^C", "select 1 as a;", "select rspr from state;", "select 2 as b;",
                   "select 3"},
                  SqlShell::Errors::Go),
              kExitSuccess);
    EXPECT_EQ(written, "a\n1\nb\n2\n") << "a statement without its end is not run";
    EXPECT_EQ(told, Lines{"no such column: rspr. Did you mean \"rsrp\"? (line 1, column 8 of the "
                          "query)"});
}

TEST_F(SqlShellTest, AScriptEndsAtItsFirstError) {
    EXPECT_EQ(run({"select 1 as a; select x; select 2;", "select 3;"}, SqlShell::Errors::End),
              kExitWrongUsage);
    EXPECT_EQ(written, "a\n1\n");
    EXPECT_EQ(run({"-- two", "select 1 as a;", "select 2 as b"}, SqlShell::Errors::End),
              kExitSuccess);
    EXPECT_EQ(written, "a\n1\nb\n2\n") << "the last one needs no semicolon";
    EXPECT_EQ(run({"select abs(-9223372036854775807 - 1);", "select 1;"}, SqlShell::Errors::End),
              kExitFailure);
    EXPECT_EQ(told, Lines{"integer overflow"});
    EXPECT_EQ(run({"", " -- nothing", ";"}, SqlShell::Errors::End), kExitWrongUsage);
    EXPECT_EQ(told, Lines{"sql takes recordings and then a query, or queries on standard input "
                          "(see pallax sql --help)"});
    EXPECT_EQ(run({".mode", "select 1;"}, SqlShell::Errors::End), kExitWrongUsage);
}

TEST_F(SqlShellTest, CommandsTellAboutTheTables) {
    (void)run({".tables", ".schema state", ".schema lte.cells", ".schema cells"},
              SqlShell::Errors::Go);
    EXPECT_EQ(written, "state\nfield\nlte.cells\n"
                       "time INTEGER\nrsrp\nrsrp_age REAL (hidden)\npci\npci\n");
    (void)run({".schema stat", ".schema", ".tabels", ".mode xml"}, SqlShell::Errors::Go);
    EXPECT_EQ(told,
              (Lines{"no such table: stat. Did you mean \"state\"?", "Which table? (.schema TABLE)",
                     "There is no command \".tabels\". Did you mean \".tables\"?",
                     "\"xml\" is not one of table|csv|json"}));
    EXPECT_EQ(written, "");
}

TEST_F(SqlShellTest, CommandsChangeWhatIsWritten) {
    (void)run({".mode json", "select 1 as a;", ".mode table", "select 22 as a;", ".fields *e 0",
               ".fields it's", ".quit", "select 3;"},
              SqlShell::Errors::Go);
    EXPECT_EQ(written, "{\"a\":1}\na\n22\nname     unit     meaning\nvalue 0  value 1  value 2\n"
                       "name  unit  meaning\n");
    EXPECT_EQ(told, Lines{});
    (void)run({".help"}, SqlShell::Errors::Go);
    for (const std::string& command : SqlShell::commands()) {
        EXPECT_NE(written.find("  " + command), std::string::npos) << command;
    }
}

TEST_F(SqlShellTest, AStatementHasALimit) {
    EXPECT_EQ(run({std::string(kLongestStatement, '-'), "", "select 1;"}, SqlShell::Errors::End),
              kExitSuccess);
    EXPECT_EQ(run({"select '", std::string(kLongestStatement, 'a')}, SqlShell::Errors::End),
              kExitWrongUsage);
    EXPECT_EQ(told, Lines{"The query is longer than 1 MiB."});
}

TEST_F(SqlShellTest, LinesWithoutAnEndAreReadOnce) {
    for (const char* first : {"y", "select 'y", "y /*"}) {
        const auto start = std::chrono::steady_clock::now();
        Lines lines(kLongestStatement / 2 + 1, "y");
        lines.front() = first;
        EXPECT_EQ(run(std::move(lines), SqlShell::Errors::End), kExitWrongUsage);
        EXPECT_EQ(told, Lines{"The query is longer than 1 MiB."});
        EXPECT_LT(std::chrono::steady_clock::now() - start, std::chrono::seconds(10)) << first;
    }
}

TEST_F(SqlShellTest, AQueryIsStoppedAfterItsTime) {
    request.most = std::chrono::milliseconds(2500);
    const std::string endless = "with recursive c(x) as (select 1 union all select x + 1 from c) "
                                "select max(x) from c;";
    EXPECT_EQ(run({endless}, SqlShell::Errors::End), kExitFailure);
    EXPECT_EQ(told, Lines{"The query was stopped after its time (--timeout)."});
    EXPECT_EQ(run({"select 1 as a;"}, SqlShell::Errors::End), kExitSuccess) << "each has its time";
}

TEST_F(SqlShellTest, CompletesNames) {
    const auto words = [this](std::string_view text) {
        const SqlCompletion completion = completionOf(database, text);
        Lines all = completion.words;
        all.insert(all.begin(), std::string(text.substr(0, completion.begin)));
        return all;
    };
    EXPECT_EQ(words("sel"), (Lines{"", "select"}));
    EXPECT_EQ(words("select rs"), (Lines{"select ", "rsrp", "rsrp_age"}));
    EXPECT_EQ(words("select state.r"), (Lines{"select ", "state.rsrp", "state.rsrp_age"}));
    EXPECT_EQ(words("select pc"), (Lines{"select ", "pci"}));
    EXPECT_EQ(words("select * from state where p"),
              (Lines{"select * from state where ", "partition"}))
        << "only columns of the tables that are named";
    EXPECT_EQ(words("select * from lt"), (Lines{"select * from ", "lte."}));
    EXPECT_EQ(words("select * from lte."), (Lines{"select * from ", "lte.cells"}));
    EXPECT_EQ(words("select lte.cells.P"), (Lines{"select ", "lte.cells.pci"}));
    EXPECT_EQ(words("select mh"), (Lines{"select ", "mhz("}));
    EXPECT_EQ(words(".s"), (Lines{"", ".schema"}));
    EXPECT_EQ(words(".schema st"), (Lines{".schema ", "state"}));
    EXPECT_EQ(words(".mode c"), (Lines{".mode ", "csv"}));
    EXPECT_EQ(words("select xyz"), Lines{"select "});
    EXPECT_EQ(commonStart({"rsrp", "rsrp_age", "rsrq"}), "rsr");
    EXPECT_EQ(commonStart({"a", "b"}), "");
}

} // namespace
} // namespace pallax
