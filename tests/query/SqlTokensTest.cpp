#include "query/SqlTokens.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

TEST(SqlTokens, AStatementEndsAtASemicolonOutsideOfTexts) {
    const std::map<std::string, std::optional<std::size_t>> ends = {
        {"select 1;", 9},
        {"select 1; select 2;", 9},
        {"select ';' ;", 12},
        {"select 'it''s;' ;", 17},
        {"select \";\" ;", 12},
        {"select [;] ;", 12},
        {"select `;` ;", 12},
        {"select 1 -- ;\n ;", 16},
        {"select /* ; */ 1;", 17},
        {"select 1", std::nullopt},
        {"select 'a;", std::nullopt},
        {"select 1 -- ;", std::nullopt},
        {"select /* ;", std::nullopt},
        {"", std::nullopt},
    };
    for (const auto& [text, end] : ends) {
        EXPECT_EQ(StatementSearch().end(text), end) << text;
    }
}

TEST(SqlTokens, AStatementCanGrowByLines) {
    for (const char* text : {"select\n1\n;", "select 'a\n;''b\n'';\n' ;", "a [\n;\n] /*\n;\n*/ ;",
                             "\"a\n\" -- ;\n ;", "`\n;`;", "a -\n- 1 /\n* 2\n;"}) {
        const std::string_view all = text;
        StatementSearch search;
        for (std::size_t end = all.find('\n'); end != std::string_view::npos;
             end = all.find('\n', end + 1)) {
            EXPECT_EQ(search.end(all.substr(0, end)), std::nullopt) << all.substr(0, end);
        }
        EXPECT_EQ(search.end(all), all.size()) << all;
    }
}

TEST(SqlTokens, TellWhetherThereIsAnything) {
    for (const char* text : {"", " \n\t", ";", "-- select", "/* a */ ;", "/* open"}) {
        EXPECT_TRUE(isEmptyStatement(text)) << text;
    }
    for (const char* text : {"1", "; x", "'", "-- a\nb"}) {
        EXPECT_FALSE(isEmptyStatement(text)) << text;
    }
}

TEST(SqlTokens, AWordHasItsDots) {
    const std::string_view text = "lte.a_b.c$1.5x+1.5";
    const auto word = sqlTokenAt(text, 0);
    ASSERT_TRUE(word);
    EXPECT_EQ(word->kind, SqlToken::Kind::Word);
    EXPECT_EQ(text.substr(0, word->end), "lte.a_b.c$1.5x");
    const auto number = sqlTokenAt(text, word->end + 1);
    ASSERT_TRUE(number);
    EXPECT_EQ(number->kind, SqlToken::Kind::Number);
    EXPECT_EQ(number->end, text.size());
    EXPECT_FALSE(sqlTokenAt(text, text.size()));
}

} // namespace
} // namespace pallax
