#include "ui/contents/QueryContent.h"

#include "tests/ui/pages/SampleTimeline.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

class QueryContentTest : public testing::Test {
protected:
    using Went = QueryContent::Went;

    std::string words(std::size_t row) const {
        std::string text;
        for (const TableCell& cell : table.content().rows[row].cells) {
            text += (text.empty() ? "" : " | ") + cell.text;
        }
        return text;
    }

    terminal::SampleTimeline drive;
    Moment moment{drive.timeline.get(), drive.timeline->packets()};
    bool mayGoOn = true;
    std::vector<std::uint64_t> went;
    std::vector<std::string> remembered;
    QueryContent content{
        {.moment = [this] { return moment; },
         .goTo = [this](std::uint64_t packet) { went.push_back(packet); },
         .mayGoOn =
             [this] {
                 stateDuring = content.state();
                 return mayGoOn;
             },
         .seams = {.earlier =
                       [] {
                           return std::vector<std::string>{"select 1", "select 2"};
                       },
                   .remember = [this](const auto& query) { remembered.push_back(query); }},
         .ahead = [] { return std::chrono::hours(1); },
         .wording = [](std::string each) { return each == "x" ? "y" : each; }}};
    std::optional<QueryState> stateDuring;
    TableModel table;
};

TEST_F(QueryContentTest, TheAnswerIsATableInTheWordsOfTheFrontEnd) {
    EXPECT_EQ(content.state(), QueryState::NotAsked);
    content.run("select 'x' as letter, time from event order by time", table);
    EXPECT_EQ(content.state(), QueryState::Answered);
    EXPECT_TRUE(content.hasAnswer());
    EXPECT_EQ(table.content().columns[2].name, "clock");
    EXPECT_TRUE(words(0).starts_with("y | 1700000007")) << words(0);
    EXPECT_TRUE(words(0).ends_with(" | 23:13:27")) << words(0);
}

TEST_F(QueryContentTest, ThereMayBeNoRowsOrNothingToAsk) {
    content.run("select 1 where 0", table);
    EXPECT_EQ(content.state(), QueryState::NoRows);
    EXPECT_TRUE(content.hasAnswer());
    moment = {};
    content.run("select 1", table);
    EXPECT_EQ(content.state(), QueryState::NothingToAsk);
    EXPECT_FALSE(content.hasAnswer());
}

TEST_F(QueryContentTest, AFailureIsASentenceAndLeavesNoTable) {
    content.run("select 1", table);
    content.run("select none", table);
    EXPECT_EQ(content.state(), QueryState::Failed);
    EXPECT_EQ(content.sentence(), "no such column: none (line 1, column 8 of the query)");
    EXPECT_TRUE(table.content().rows.empty());
}

TEST_F(QueryContentTest, AQueryCanBeStopped) {
    mayGoOn = false;
    content.run("with recursive n(i) as (select 1 union all select i + 1 from n) "
                "select count(*) from n",
                table);
    EXPECT_EQ(stateDuring, QueryState::Running);
    EXPECT_EQ(content.state(), QueryState::Failed);
    EXPECT_EQ(content.sentence(), "The query was stopped.");
}

TEST_F(QueryContentTest, GoesToTheInstantOfARow) {
    EXPECT_EQ(content.goThere(table), Went::NoRow);
    content.run("select 7 as packet", table);
    EXPECT_EQ(content.goThere(table), Went::There);
    EXPECT_EQ(went, (std::vector<std::uint64_t>{7}));
    content.run("select 'x' as letter", table);
    EXPECT_EQ(content.goThere(table), Went::NoInstant);
}

TEST_F(QueryContentTest, QueriesAreRememberedOnceAndRecalled) {
    EXPECT_EQ(content.recall(false, "typed"), std::nullopt);
    EXPECT_EQ(content.recall(true, "typed"), "select 2");
    EXPECT_EQ(content.recall(true, "changed"), "select 1");
    EXPECT_EQ(content.recall(true, ""), std::nullopt);
    EXPECT_EQ(content.recall(false, ""), "select 2");
    EXPECT_EQ(content.recall(false, ""), "typed");
    content.run("select 2", table);
    content.run("select 3", table);
    EXPECT_EQ(remembered, (std::vector<std::string>{"select 3"})) << "not the same again";
    EXPECT_EQ(content.recall(true, ""), "select 3");
}

} // namespace
} // namespace pallax
