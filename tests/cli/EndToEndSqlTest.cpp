#include "tests/cli/EndToEnd.h"
#include "tests/cli/PallaxTerminal.h"
#include "tests/doubles/Files.h"

#include <csignal>
#include <fstream>

namespace pallax {
namespace {

using doubles::contentOf;
using doubles::PallaxProcess;
using doubles::PallaxTerminal;

constexpr const char* kInterrupt = "\x03";
constexpr const char* kEndOfFile = "\x04";
constexpr const char* kEndless =
    "with recursive c(x) as (select 1 union all select x + 1 from c) select max(x) from c";

class EndToEndSql : public EndToEnd {
protected:
    EndToEndSql() { world.environment.push_back("XDG_STATE_HOME=" + world.path("state")); }

    std::string fileOf(const std::string& content) const {
        std::ofstream(world.path("queries.sql")) << content;
        return world.path("queries.sql");
    }

    std::string drive = std::string(PALLAX_SOURCE_DIR) + "/samples/lte-drive.pcap";
    std::string history = world.path("state/pallax/sql-history");
};

TEST_F(EndToEndSql, AnswersAUser) {
    PallaxTerminal terminal(world, {"sql", drive}, {});
    ASSERT_TRUE(terminal.shows("pallax>"));
    terminal.type("select count(*) as packets\r");
    ASSERT_TRUE(terminal.shows("   ...>"));
    terminal.type("from packet;\r");
    ASSERT_TRUE(terminal.shows("packets\n   1200\n"));
    terminal.type(".mode csv\r.schema event\r");
    ASSERT_TRUE(terminal.shows("words TEXT"));
    terminal.type(".quit\r");
    EXPECT_EQ(terminal.wait(), 0);
    EXPECT_TRUE(terminal.isRestored());
    EXPECT_EQ(contentOf(history), "select count(*) as packets from packet;\n.mode csv\n"
                                  ".schema event\n.quit\n");
}

TEST_F(EndToEndSql, CtrlDEndsIt) {
    PallaxTerminal terminal(world, {"sql", drive}, {});
    ASSERT_TRUE(terminal.shows("pallax>"));
    (void)terminal.settled();
    terminal.type(kEndOfFile);
    EXPECT_EQ(terminal.wait(), 0);
    EXPECT_TRUE(terminal.isRestored());
}

TEST_F(EndToEndSql, CompletesNamesAndRemembersStatements) {
    PallaxTerminal terminal(world, {"sql", drive}, {});
    ASSERT_TRUE(terminal.shows("pallax>"));
    terminal.type("sel\tcount(*) from ser\t");
    ASSERT_TRUE(terminal.shows("pallax> select count(*) from"));
    terminal.type("\x15select measured_rsr\t\t");
    ASSERT_TRUE(terminal.shows("measured_rsrp  measured_rsrp_age  measured_rsrq"));
    terminal.type("\x15select 6 * 7 as answer;\r");
    ASSERT_TRUE(terminal.shows("    42\n"));
    terminal.type("\x10"); // the line before
    ASSERT_TRUE(terminal.shows("pallax> select 6 * 7 as answer;\n"));
    terminal.type("\x15.quit\r");
    EXPECT_EQ(terminal.wait(), 0);

    PallaxTerminal again(world, {"sql", drive}, {});
    ASSERT_TRUE(again.shows("pallax>"));
    again.type("\x10\x10\r");
    EXPECT_TRUE(again.shows("    42\n"));
    again.type(".quit\r");
    EXPECT_EQ(again.wait(), 0);
}

TEST_F(EndToEndSql, CtrlCStopsAQueryOrClearsTheLine) {
    PallaxTerminal terminal(world, {"sql", drive}, {});
    ASSERT_TRUE(terminal.shows("pallax>"));
    terminal.type("select 1,\r");
    ASSERT_TRUE(terminal.shows("   ...>"));
    (void)terminal.settled();
    terminal.type(kInterrupt);
    terminal.type(std::string(kEndless) + ";\r");
    ASSERT_TRUE(terminal.shows("querying"));
    terminal.type(kInterrupt);
    ASSERT_TRUE(terminal.shows("pallax: The query was stopped.\n"));
    terminal.type("select 6 * 7 as answer;\r");
    EXPECT_TRUE(terminal.shows("    42\n"));
    terminal.type(".quit\r");
    EXPECT_EQ(terminal.wait(), 0);
    EXPECT_TRUE(terminal.isRestored());
}

// Until the prompt stands, Ctrl-C arrives as a signal and not as a key.
TEST_F(EndToEndSql, AnInterruptAtThePromptClearsTheLineToo) {
    PallaxTerminal terminal(world, {"sql", drive}, {});
    ASSERT_TRUE(terminal.shows("pallax>"));
    terminal.type("select 1,\r");
    ASSERT_TRUE(terminal.shows("   ...>"));
    (void)terminal.settled();
    terminal.signal(SIGINT);
    ASSERT_TRUE(terminal.shows("   ...>\npallax>"));
    terminal.type("select 'ä' || (6 * 7) as answer;\r");
    EXPECT_TRUE(terminal.shows("ä42\n"));
    terminal.type(".quit\r");
    EXPECT_EQ(terminal.wait(), 0);
    EXPECT_TRUE(terminal.isRestored());
}

TEST_F(EndToEndSql, CtrlCEndsASingleQueryAtOnce) {
    PallaxTerminal terminal(world, {"sql", drive, kEndless}, {});
    ASSERT_TRUE(terminal.shows("querying"));
    terminal.type(kInterrupt);
    EXPECT_EQ(terminal.wait(), -SIGINT);
}

TEST_F(EndToEndSql, TellsThatTheHistoryCannotBeKept) {
    world.environment = {"XDG_STATE_HOME=/proc/none"};
    PallaxTerminal terminal(world, {"sql", drive}, {});
    ASSERT_TRUE(terminal.shows("pallax>"));
    terminal.type("select 1 as a;\r");
    EXPECT_TRUE(
        terminal.shows("pallax: The history cannot be kept in /proc/none/pallax/sql-history.\n"));
    terminal.type(".quit\r");
    EXPECT_EQ(terminal.wait(), 0);
}

TEST_F(EndToEndSql, ReadsQueriesFromStandardInput) {
    const std::string queries =
        fileOf("select 1 as a; -- the first\n.mode json\nselect 2\n  as b;select 3 as c");
    PallaxProcess script(world, {"sql", "--format", "csv", drive}, queries);
    EXPECT_EQ(script.wait(), 0);
    EXPECT_EQ(script.out(), "a\n1\n{\"b\":2}\n{\"c\":3}\n");
    EXPECT_EQ(script.err(), "");

    PallaxProcess wrong(world, {"sql", drive, drive},
                        fileOf("select 1 as a;\nselect x;\nselect 2;"));
    EXPECT_EQ(wrong.wait(), 2);
    EXPECT_EQ(wrong.out(), "a\n1\n");
    EXPECT_EQ(wrong.err(), "pallax: no such column: x (line 1, column 8 of the query)\n");
}

TEST_F(EndToEndSql, AQueryBesideAFileIsWrongUsage) {
    const std::string query = fileOf("select 1 as a");
    for (const std::vector<std::string>& words : {std::vector<std::string>{drive}, {}}) {
        std::vector<std::string> command = {"sql", "--file", query};
        command.insert(command.end(), words.begin(), words.end());
        command.emplace_back("select 2");
        PallaxProcess process(world, command);
        EXPECT_EQ(process.wait(), 2);
        EXPECT_EQ(process.out(), "");
        EXPECT_EQ(process.err(), "pallax: sql takes a query or --file, not both, and there is no "
                                 "recording \"select 2\"\n");
    }
    PallaxProcess process(world, {"sql", "--file", query, "--format", "csv", drive});
    EXPECT_EQ(process.wait(), 0);
    EXPECT_EQ(process.out(), "a\n1\n");
}

TEST_F(EndToEndSql, AQueryThatFailsBeforeItsFirstRowWritesNoHead) {
    for (const char* format : {"table", "csv", "json"}) {
        PallaxProcess process(
            world, {"sql", "--format", format, drive, "select * from series('nosuch', 5)"});
        EXPECT_EQ(process.wait(), 1);
        EXPECT_EQ(process.out(), "") << format;
        EXPECT_EQ(process.err(), "pallax: \"nosuch\" is not a field\n");
    }
}

TEST_F(EndToEndSql, TellsThatAPartIsMissing) {
    const std::string first = world.path("drive-0001.pcap");
    const std::string third = world.path("drive-0003.pcap");
    std::filesystem::copy(drive, first);
    std::filesystem::copy(drive, third);
    PallaxProcess process(
        world, {"sql", "--format", "csv", first, third, "select count(*) as packets from packet"});
    EXPECT_EQ(process.wait(), 0);
    EXPECT_EQ(process.out(), "packets\n2400\n");
    EXPECT_EQ(process.err(), "pallax: " + first + " and " + third +
                                 " are read as one, without the part between them: " +
                                 world.path("drive-0002.pcap") + ".\n");
}

TEST_F(EndToEndSql, StopsAQueryAfterItsTime) {
    PallaxProcess process(world, {"sql", "--timeout", "0.2", "--format", "csv", drive, kEndless});
    EXPECT_EQ(process.wait(), 1);
    EXPECT_EQ(process.err(), "pallax: The query was stopped after its time (--timeout).\n");
}

} // namespace
} // namespace pallax
