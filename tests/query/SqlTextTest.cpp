#include "query/SqlText.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

TEST(SqlText, QuotesInATextAreDoubled) {
    EXPECT_EQ(quotedText("it's"), "'it''s'");
    EXPECT_EQ(quotedText("a \"b\""), "'a \"b\"'");
    EXPECT_EQ(quotedText(""), "''");
}

TEST(SqlText, QuotesInANameAreDoubled) {
    EXPECT_EQ(quotedName("a \"b\""), "\"a \"\"b\"\"\"");
    EXPECT_EQ(quotedName("it's"), "\"it's\"");
    EXPECT_EQ(quotedName(""), "\"\"");
}

} // namespace
} // namespace pallax
