#include "tests/docs/ConsoleBlocks.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using doubles::blockKinds;
using doubles::isShown;
using doubles::shownCommands;

constexpr const char* kDocument = "# Title\n"
                                  "\n"
                                  "$ no command\n"
                                  "```console\n"
                                  "$ first a\n"
                                  "one\n"
                                  "  two\n"
                                  "$ second \\\n"
                                  "    b\n"
                                  "```\n"
                                  "```\n"
                                  "$ a drawing\n"
                                  "```\n"
                                  "1. In a list:\n"
                                  "\n"
                                  "   ```console\n"
                                  "   $ third\n"
                                  "   three\n"
                                  "   ```\n";

TEST(ConsoleBlocks, CommandsStandBehindAPromptAndWhatTheyPrintFollows) {
    const auto commands = shownCommands(kDocument);
    ASSERT_EQ(commands.size(), 3U);
    EXPECT_EQ(commands[0].command, "first a");
    EXPECT_EQ(commands[0].output, (std::vector<std::string>{"one", "  two"}));
    EXPECT_EQ(commands[0].line, 5);
    EXPECT_EQ(commands[1].command, "second \\\n    b");
    EXPECT_TRUE(commands[1].output.empty());
    EXPECT_EQ(commands[2].command, "third");
    EXPECT_EQ(commands[2].output, std::vector<std::string>{"three"});
    EXPECT_EQ(commands[0].block, commands[1].block);
    EXPECT_LT(commands[1].block, commands[2].block);
    EXPECT_EQ(blockKinds(kDocument), (std::vector<std::string>{"console", "", "console"}));
}

TEST(ConsoleBlocks, WhatIsPrintedIsWhatIsShown) {
    EXPECT_TRUE(isShown({"one", "two"}, "one\ntwo\n"));
    EXPECT_FALSE(isShown({"one", "two"}, "one\n"));
    EXPECT_FALSE(isShown({"one"}, "one\ntwo\n"));
    EXPECT_FALSE(isShown({"one"}, "One\n"));
    EXPECT_TRUE(isShown({}, ""));
    EXPECT_FALSE(isShown({"one"}, ""));
}

TEST(ConsoleBlocks, ThreeDotsStandForAnyLines) {
    EXPECT_TRUE(isShown({"one", "..."}, "one\ntwo\nthree\n"));
    EXPECT_TRUE(isShown({"one", "..."}, "one\n"));
    EXPECT_TRUE(isShown({"...", "three"}, "one\ntwo\nthree\n"));
    EXPECT_TRUE(isShown({"one", "...", "three", "..."}, "one\ntwo\nthree\nfour\n"));
    EXPECT_FALSE(isShown({"one", "...", "five", "..."}, "one\ntwo\nthree\nfour\n"));
    EXPECT_FALSE(isShown({"...", "two"}, "one\ntwo\nthree\n"));
}

TEST(ConsoleBlocks, AnEllipsisStandsForAnyTextOfALine) {
    EXPECT_TRUE(isShown({"Uptime: … s"}, "Uptime: 12 s\n"));
    EXPECT_FALSE(isShown({"Uptime: … s"}, "Uptime: 12\n"));
    EXPECT_TRUE(isShown({"{…}"}, "{}\n"));
    EXPECT_TRUE(isShown({"…b…d"}, "abcd\n"));
    EXPECT_FALSE(isShown({"…b…d"}, "abc\n"));
    EXPECT_FALSE(isShown({"a…"}, "ba\n"));
}

} // namespace
} // namespace pallax
