#include "querying/QueryHistory.h"

#include "tests/doubles/Files.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <fstream>

namespace pallax {
namespace {

using doubles::contentOf;
using Lines = std::vector<std::string>;

class QueryHistoryTest : public testing::Test {
protected:
    doubles::TemporaryFolder folder;
    std::string kept = folder.path() + "/state/pallax";
};

TEST_F(QueryHistoryTest, KeepsStatementsInAFileOfItsUserAlone) {
    QueryHistory history(kept);
    EXPECT_EQ(history.load(), Lines{});
    EXPECT_TRUE(history.add(" select 1 -- one\nfrom packet;"));
    EXPECT_TRUE(history.add(".tables"));
    EXPECT_EQ(QueryHistory(kept).load(), (Lines{"select 1 from packet;", ".tables"}));
    EXPECT_EQ(contentOf(kept + "/sql-history"), "select 1 from packet;\n.tables\n");
    using std::filesystem::perms;
    EXPECT_EQ(std::filesystem::status(kept + "/sql-history").permissions(),
              perms::owner_read | perms::owner_write);
    EXPECT_EQ(std::filesystem::status(kept).permissions(), perms::owner_all);
}

TEST_F(QueryHistoryTest, DropsTheOldest) {
    std::filesystem::create_directories(kept);
    {
        std::ofstream file(kept + "/sql-history");
        for (std::size_t number = 0; number <= 2 * QueryHistory::kMostStatements; ++number) {
            file << "select " << number << ";\n";
        }
    }
    const Lines statements = QueryHistory(kept).load();
    ASSERT_EQ(statements.size(), QueryHistory::kMostStatements);
    EXPECT_EQ(statements.back(), "select 2000;");
    EXPECT_EQ(QueryHistory(kept).load(), statements);
}

TEST_F(QueryHistoryTest, TellsThatItCannotBeKept) {
    EXPECT_FALSE(QueryHistory("").add("select 1;"));
    EXPECT_FALSE(QueryHistory("/proc/none").add("select 1;"));
    std::filesystem::create_directories(kept);
    std::filesystem::create_symlink(folder.path() + "/other", kept + "/sql-history");
    EXPECT_FALSE(QueryHistory(kept).add("select 1;")) << "another file";
    EXPECT_FALSE(std::filesystem::exists(folder.path() + "/other"));
}

} // namespace
} // namespace pallax
