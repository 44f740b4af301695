#include "tests/docs/SourceTree.h"
#include "tests/doubles/Files.h"
#include "tests/doubles/Pattern.h"
#include "tests/doubles/Shell.h"

#include <gtest/gtest.h>

#include <sstream>

// The manual page pallax-sql(7) has every table, column and function, and its recipes give what it
// shows.

namespace pallax {
namespace {

using doubles::matchesIn;
using doubles::replaced;
using doubles::runCommand;
using doubles::sourceText;
using Blocks = std::vector<std::string>;

const std::string kPage = "docs/man/pallax-sql.7";

/// A text of the page as it is read.
std::string unescaped(std::string text) {
    const std::pair<const char*, const char*> escapes[] = {
        {R"(\\f[BIR])", ""}, {R"(\\&)", ""},     {R"(\\-)", "-"},
        {R"(\\\(aq)", "'"},  {R"(\\\(ga)", "`"}, {R"(\\\(ha)", "^"},
        {R"(\\\(ti)", "~"},  {R"(\\\(->)", "→"}, {R"(\\e)", "\\"}};
    for (const auto& [escape, character] : escapes) {
        text = replaced(text, escape, character);
    }
    return text;
}

/// The examples of the recipes: first the commands that make the recordings, then in turn a command
/// and what it prints.
Blocks examples() {
    const std::string page = sourceText(kPage);
    Blocks blocks;
    for (std::size_t begin = page.find(".EX\n", page.find(".SH RECIPES"));
         begin != std::string::npos; begin = page.find(".EX\n", begin)) {
        begin += std::string(".EX\n").size();
        blocks.push_back(unescaped(page.substr(begin, page.find(".EE\n", begin) - begin)));
    }
    return blocks;
}

class SqlPage : public testing::Test {
protected:
    doubles::CommandRun run(const std::string& commands) const {
        const std::string script = folder.write("script", commands);
        return runCommand("cd " + folder.path() +
                          " && PATH=" PALLAX_BINARY_DIR ":\"$PATH\" LC_ALL=C.UTF-8 bash " + script);
    }

    doubles::TemporaryFolder folder;
    Blocks blocks = examples();
};

TEST_F(SqlPage, ItsRecipesGiveWhatItShows) {
    ASSERT_GE(blocks.size(), 41U) << "at least twenty recipes";
    ASSERT_EQ(blocks.size() % 2, 1U);
    EXPECT_EQ(run(blocks.front()).out, "");
    for (std::size_t place = 1; place < blocks.size(); place += 2) {
        const auto ran = run(blocks[place]);
        EXPECT_EQ(ran.status, 0) << blocks[place];
        EXPECT_EQ(ran.out, blocks[place + 1]) << blocks[place];
    }
}

TEST_F(SqlPage, HasEveryTableAndColumn) {
    EXPECT_EQ(run(blocks.front()).out, "");
    const auto columns = run("pallax sql --format csv drive.pcap \"select table_name, name from "
                             "columns where schema = 'main' and table_name not in ('state', "
                             "'series')\" | tail -n +2");
    ASSERT_EQ(columns.status, 0) << columns.out;
    const std::string page = unescaped(sourceText(kPage));
    std::istringstream lines(columns.out);
    std::size_t count = 0;
    for (std::string line; std::getline(lines, line); ++count) {
        const std::string table = line.substr(0, line.find(','));
        const std::string column = line.substr(line.find(',') + 1);
        std::size_t start = page.find("\n.SS " + table);
        if (start == std::string::npos) {
            start = page.find(", " + table + "\n.I");
        }
        ASSERT_NE(start, std::string::npos) << "no table " << table;
        const std::string text = page.substr(start, page.find("\n.S", start + 1) - start);
        EXPECT_FALSE(matchesIn(text, "[^a-z_]" + column + "[^a-z_]").empty()) << line;
    }
    EXPECT_GT(count, 40U);
}

TEST(SqlPageOfFunctions, HasEachOfThem) {
    const std::string page = unescaped(sourceText(kPage));
    std::size_t count = 0;
    for (const char* source : {"query/Functions.cpp", "query/TimelineTables.cpp"}) {
        for (const auto& found : matchesIn(sourceText(source), "addFunction\\(\\s*\"([a-z_]+)\"")) {
            ++count;
            EXPECT_NE(page.find(".BR " + found[1] + "("), std::string::npos) << found[1];
        }
    }
    EXPECT_GE(count, 7U);
    EXPECT_NE(page.find(".BR quantile("), std::string::npos);
}

} // namespace
} // namespace pallax
