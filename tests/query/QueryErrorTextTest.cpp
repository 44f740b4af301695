#include "query/QueryErrorText.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

const std::vector<std::string> kNames = {"state", "measured_rsrp", "band"};

TEST(QueryErrorText, SuggestsANameAndTellsThePlace) {
    EXPECT_EQ(queryErrorText({"no such column: measured_rspr", 7}, "select measured_rspr", kNames),
              "no such column: measured_rspr. Did you mean \"measured_rsrp\"? (line 1, column 8 of "
              "the query)");
    EXPECT_EQ(queryErrorText({"no such column: s.measured_rspr", {}}, "", kNames),
              "no such column: s.measured_rspr. Did you mean \"measured_rsrp\"?");
    EXPECT_EQ(queryErrorText({"no such table: stat", {}}, "", kNames),
              "no such table: stat. Did you mean \"state\"?");
    EXPECT_EQ(queryErrorText({"no such column: rsrp", {}}, "", kNames),
              "no such column: rsrp. Did you mean \"measured_rsrp\"?");
    EXPECT_EQ(queryErrorText({"no such column: quite_another", {}}, "", kNames),
              "no such column: quite_another");
}

TEST(QueryErrorText, CountsLines) {
    EXPECT_EQ(queryErrorText({"near \"x\": syntax error", 11}, "select 1\n, x y", kNames),
              "near \"x\": syntax error (line 2, column 3 of the query)");
    EXPECT_EQ(queryErrorText({"e", 0}, "x", kNames), "e (line 1, column 1 of the query)");
    EXPECT_EQ(queryErrorText({"e", 2}, "x", kNames), "e") << "no such place";
}

TEST(QueryErrorText, AWordOfANameSuggestsIt) {
    const std::vector<std::string> names{"mm_state", "rrc_state", "rrc_state_rrc"};
    EXPECT_EQ(queryErrorText({"no such column: state", {}}, "", names, "query"),
              "no such column: state. Did you mean \"mm_state\"?");
    EXPECT_EQ(queryErrorText({"no such column: mm", {}}, "", names, "query"),
              "no such column: mm. Did you mean \"mm_state\"?");
    EXPECT_EQ(queryErrorText({"no such column: rrc", {}}, "", names, "query"),
              "no such column: rrc. Did you mean \"rrc_state_rrc\"?")
        << "at the end, it names the value";
    EXPECT_EQ(queryErrorText({"no such column: tate", {}}, "", names, "query"),
              "no such column: tate");
}

} // namespace
} // namespace pallax
