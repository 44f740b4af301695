#include "tests/ui/pages/SampleTimeline.h"
#include "tests/ui/terminal/StageFixture.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace pallax::terminal {
namespace {

class QueryPageTest : public StageFixture {
protected:
    QueryPageTest() {
        stage.tick(display());
        stage.frontEnd.resize(80, 12);
        stage.moment = {drive.timeline.get(), drive.timeline->packets()};
    }
    void ask(const std::string& query) {
        stage.type(";" + query);
        stage.press(Key::Enter);
    }
    bool isOpen() { return stage.line(0).find("Pallax › Query") != std::string::npos; }
    bool shows(const std::string& text) { return stage.screen().find(text) != std::string::npos; }
    /// The line that is being typed, or the whole last row.
    std::string lastRow() { return stage.line(11); }

    SampleTimeline drive;
};

TEST_F(QueryPageTest, OpensWithAnEmptyLineAndAnExample) {
    stage.type(";");
    EXPECT_EQ(stage.screen(60, 8), R"(
 Pallax › Query
 ──────────────────────────────────────────────────────────
 Ask in SQL, for example: select kind, count(*) from event
 group by kind. The table "tables" lists all tables.


 ──────────────────────────────────────────────────────────
 ;                                                Esc close
)");
    EXPECT_TRUE(draw().cursor().has_value());
    stage.type("jq?;");
    EXPECT_EQ(stage.line(7).substr(0, 8), " ; jq?; ") << "letters are text";
    stage.press(Key::Escape);
    EXPECT_FALSE(isOpen());
    stage.type(";");
    stage.press(Key::Enter);
    stage.type("  ");
    stage.press(Key::Enter);
    EXPECT_TRUE(isOpen()) << "blanks ask nothing";
    EXPECT_TRUE(stage.remembered.empty());
    stage.press(Key::Backspace, 3);
    EXPECT_FALSE(isOpen());
}

TEST_F(QueryPageTest, TheAnswerIsATable) {
    ask("select kind, count(*) as number, 1.5 as real, null as missing from event group by kind");
    EXPECT_EQ(stage.screen(80, 10), R"(
 Pallax › Query                                                          3 rows
 ──────────────────────────────────────────────────────────────────────────────
 kind          number  real  missing
▌cell-change        1   1.5
 context-down       1   1.5
 context-up         2   1.5


 ──────────────────────────────────────────────────────────────────────────────
 Updated 2023-11-14 at 22:13:20      Enter go there  < > sort  / filter  ? help
)");
    EXPECT_EQ(faultOf(draw()), "");
    stage.type(">>r");
    EXPECT_EQ(stage.line(3), " context-up         2   1.5");
    stage.type("/down");
    stage.press(Key::Enter);
    EXPECT_TRUE(shows("1 of 3 rows"));
    stage.press(Key::Escape);
    EXPECT_TRUE(shows("3 rows"));
    stage.type("y");
    EXPECT_EQ(stage.copied, (std::vector<std::string>{"1"}));
}

TEST_F(QueryPageTest, TheExampleCanBeAsked) {
    ask("select kind, count(*) from event group by kind");
    EXPECT_TRUE(shows("cell-change"));
    ask("select name from tables where name = 'packet'");
    EXPECT_TRUE(shows("packet"));
}

TEST_F(QueryPageTest, AMistakeIsASentenceAndTheLineStays) {
    ask("select measured_rspr from lte.serving_cell_measurements");
    EXPECT_EQ(stage.screen(80, 8), R"(
 Pallax › Query
 ──────────────────────────────────────────────────────────────────────────────
 no such column: measured_rspr. Did you mean "measured_rsrp"? (line 1, column 8
 of the query)


 ──────────────────────────────────────────────────────────────────────────────
 ; select measured_rspr from lte.serving_cell_measurements            Esc close
)");
    stage.pressControl('u');
    stage.type("select 1 as one");
    stage.press(Key::Enter);
    EXPECT_TRUE(shows(" one\n"));
    EXPECT_FALSE(draw().cursor().has_value());
}

TEST_F(QueryPageTest, ASemicolonAtTheEndMayBeThere) {
    ask("select 1 as one;");
    EXPECT_TRUE(shows(" one\n"));
}

TEST_F(QueryPageTest, AnAnswerWithoutRowsSaysSo) {
    ask("select 1 where 0");
    EXPECT_TRUE(shows("The query gave no rows."));
    stage.type("ry");
    stage.press(Key::Enter);
    EXPECT_TRUE(stage.went.empty());
    stage.press(Key::Escape);
    EXPECT_FALSE(isOpen());
}

TEST_F(QueryPageTest, WithoutATimelineThereIsNothingToAsk) {
    stage.moment = {};
    ask("select 1");
    EXPECT_TRUE(shows("There is nothing to ask yet: no packet has come."));
}

TEST_F(QueryPageTest, EnterGoesToThePacketOrTheTimeOfARow) {
    ask("select packet, kind from event order by packet");
    stage.press(Key::Enter);
    EXPECT_FALSE(isOpen());
    const Event& first = drive.timeline->events().front();
    EXPECT_EQ(stage.went, (std::vector<std::uint64_t>{first.packet}));
    ask("select time from event order by time");
    stage.click(3, 3);
    EXPECT_FALSE(isOpen());
    ASSERT_EQ(stage.went.size(), 2U);
    EXPECT_EQ(stage.went.back(), drive.timeline->instantAt(first.time));
}

TEST_F(QueryPageTest, ATimeHasItsTimeOfDayBesideIt) {
    stage.ahead = std::chrono::hours(1);
    ask("select 7 as number, 1700000000999999 as time union all select 8, null");
    EXPECT_EQ(stage.line(2), " number              time  clock");
    EXPECT_EQ(stage.line(3), "▌     7  1700000000999999  23:13:20");
    EXPECT_EQ(stage.line(4), "      8");
    for (const char* query : {";select -5 as time", ";select 'noon' as time", ";select 7 as times",
                              ";select 0 as time where false"}) {
        stage.type(query);
        stage.press(Key::Enter);
        EXPECT_FALSE(shows("clock")) << query;
    }
}

TEST_F(QueryPageTest, ARowWithoutAnInstantSaysSo) {
    for (const char* query :
         {"select kind from event", "select 99999999 as packet", "select -1 as packet",
          "select 'x' as packet", "select -5 as time", "select 9223372036854775807 as time",
          "select 0 as time", "select null as packet"}) {
        ask(query);
        ASSERT_TRUE(isOpen());
        stage.press(Key::Enter);
        EXPECT_TRUE(shows("The row has no packet and no time to go to.")) << query;
        stage.press(Key::Down);
        EXPECT_FALSE(shows("to go to"));
        stage.press(Key::Escape);
        ASSERT_FALSE(isOpen());
    }
    EXPECT_TRUE(stage.went.empty());
}

TEST_F(QueryPageTest, MoreRowsThanTheMostAreLeftOutAndThatIsSaid) {
    ask("with recursive n(x) as (select 1 union all select x + 1 from n where x < 10001) "
        "select x from n");
    EXPECT_TRUE(shows("10000 rows"));
    EXPECT_TRUE(shows("Only the first 10,000 rows are shown."));
    stage.press(Key::End);
    EXPECT_TRUE(shows("▌10000"));
    ask("with recursive n(x) as (select 1 union all select x + 1 from n where x < 10000) "
        "select x from n");
    EXPECT_FALSE(shows("Only the first"));
}

TEST_F(QueryPageTest, UpAndDownRecallEarlierQueries) {
    stage.earlier = {"select 1", "select 2"};
    stage.type(";draft");
    const auto lineAfter = [this](Key key) {
        stage.press(key);
        return lastRow().substr(0, 12);
    };
    EXPECT_EQ(lineAfter(Key::Down), " ; draft    ");
    EXPECT_EQ(lineAfter(Key::Up), " ; select 2 ");
    EXPECT_EQ(lineAfter(Key::Up), " ; select 1 ");
    EXPECT_EQ(lineAfter(Key::Up), " ; select 1 ");
    EXPECT_EQ(lineAfter(Key::Down), " ; select 2 ");
    EXPECT_EQ(lineAfter(Key::Down), " ; draft    ");
    stage.press(Key::Up);
    stage.press(Key::Enter);
    EXPECT_TRUE(stage.remembered.empty()) << "the latest one again";
    ask("select 3");
    EXPECT_EQ(stage.remembered, (std::vector<std::string>{"select 3"}));
    stage.type(";");
    EXPECT_EQ(lastRow().substr(0, 12), " ;          ") << "Up has the latest";
}

TEST_F(QueryPageTest, AQueryCanBeStopped) {
    int asked = 0;
    std::string during;
    stage.mayGoOn = [&] {
        during = stage.screen();
        return ++asked < 3;
    };
    ask("with recursive n(x) as (select 1 union all select x + 1 from n) select max(x) from n");
    EXPECT_EQ(asked, 3);
    EXPECT_NE(during.find("The query is running."), std::string::npos);
    EXPECT_TRUE(shows("The query was stopped."));
    EXPECT_TRUE(draw().cursor().has_value()) << "the line stays";
}

TEST_F(QueryPageTest, EscLeavesTheLineForTheAnswer) {
    ask("select 1 as one");
    stage.type(";xyz");
    stage.press(Key::Escape);
    EXPECT_TRUE(isOpen());
    EXPECT_TRUE(shows(" one\n"));
    EXPECT_EQ(lastRow(),
              " Updated 2023-11-14 at 22:13:20      Enter go there  < > sort  / filter  ? help");
    stage.type("q");
    EXPECT_FALSE(isOpen());
    EXPECT_EQ(stage.quits, 0);
}

TEST_F(QueryPageTest, EverySizeCanBeDrawn) {
    for (const char* query : {"", "select * from event", "select '漢字\x1b', x'00'", "wrong"}) {
        ask(query);
        for (int columns = 0; columns < 90; columns += 3) {
            for (const int rows : {0, 1, 4, 5, 6, 7, 24}) {
                stage.frontEnd.resize(columns, rows);
                ASSERT_EQ(faultOf(draw()), "") << columns << "x" << rows;
            }
        }
        stage.press(Key::Escape, 2);
    }
}

} // namespace
} // namespace pallax::terminal
