#include "cli/Completion.h"

#include "cli/CommandLine.h"
#include "tests/doubles/Files.h"
#include "tests/doubles/Shell.h"

#include <gtest/gtest.h>

#include <algorithm>

namespace pallax {
namespace {

using doubles::isInstalled;
using doubles::runCommand;

std::string script(const char* shell) {
    return completionScript(CommandLine().description(), shell);
}

class Completion : public testing::Test {
protected:
    Completion() {
        folder.write("drive.pcap", "");
        folder.write("other.pcap", "");
    }

    /// The output of a real shell for `lines`, one word a line, in a folder with two recordings.
    std::string offered(const char* shell, const std::string& lines) const {
        folder.write(".script", script(shell));
        folder.write(".ask", lines);
        const auto run = runCommand("cd " + folder.path() + " && " + shell + " ./.ask");
        EXPECT_EQ(run.status, 0) << run.out;
        return run.out;
    }

    /// Bash's completions of the last word; the words are split as bash does.
    std::string inBash(const std::string& words, int current) const {
        return offered("bash", "set -u\nsource ./.script\nCOMP_WORDS=(" + words +
                                   ")\nCOMP_CWORD=" + std::to_string(current) +
                                   "\n_pallax\nfor each in \"${COMPREPLY[@]}\"; do "
                                   "echo \"$each\"; done\n");
    }

    doubles::TemporaryFolder folder;
};

TEST_F(Completion, BashOffersCommands) {
    EXPECT_EQ(inBash("pallax de", 1), "decode\ndemo\n");
    EXPECT_EQ(inBash("pallax f", 1), "fields\n");
    folder.write("seven.pcap", "");
    EXPECT_EQ(inBash("pallax s", 1),
              "service\nsimulate\nsnapshot\nsql\nstatus\nstore\nseven.pcap\n")
        << "and files";
}

TEST_F(Completion, BashOffersTheOptionsOfTheCommand) {
    EXPECT_EQ(inBash("pallax record --rot", 2), "--rotate-size\n--rotate-seconds\n");
    EXPECT_EQ(inBash("pallax --k", 1), "--keep-going\n");
    EXPECT_EQ(inBash("pallax decode --k", 2), "");
}

TEST_F(Completion, BashOffersTheChoicesOfAnOption) {
    EXPECT_EQ(inBash("pallax decode --every ''", 3), "end\ntick\npacket\n");
    EXPECT_EQ(inBash("pallax decode --technology c", 3), "cdma\n");
    EXPECT_EQ(inBash("pallax --color = n", 3), "never\n") << "--color=n comes as three words";
    EXPECT_EQ(inBash("pallax --color =", 2), "auto\nalways\nnever\n");
    EXPECT_EQ(inBash("pallax --speed ''", 2), "max\n");
    EXPECT_EQ(inBash("pallax --log-level ''", 2), "0\n1\n2\n3\n4\n5\n6\n7\n");
    EXPECT_EQ(inBash("pallax demo ''", 2), "ifx\ngsm\ncdma\nlte\nutran\n");
    EXPECT_EQ(inBash("pallax fields c", 2), "cdma\n");
    EXPECT_EQ(inBash("pallax store l", 2), "load\n");
    EXPECT_EQ(inBash("pallax explain --profile f", 3), "field\n");
    EXPECT_EQ(inBash("pallax demo --seed ''", 3), "") << "numbers are not completed";
}

TEST_F(Completion, BashOffersFilesWhereARecordingOrFileIsTaken) {
    EXPECT_EQ(inBash("pallax decode dr", 2), "drive.pcap\n");
    EXPECT_EQ(inBash("pallax decode drive.pcap oth", 3), "other.pcap\n");
    EXPECT_EQ(inBash("pallax dri", 1), "drive.pcap\n");
    EXPECT_EQ(inBash("pallax service --play oth", 3), "other.pcap\n");
    EXPECT_EQ(inBash("pallax simulate -o oth", 3), "other.pcap\n");
    EXPECT_EQ(inBash("pallax watch condition dr", 3), "drive.pcap\n");
    EXPECT_EQ(inBash("pallax demo dr", 2), "");
}

TEST_F(Completion, EveryOptionIsInEveryScript) {
    const CommandDescription program = CommandLine().description();
    ASSERT_EQ(program.commands.size(), 20U);
    const std::string fish = script("fish");
    for (const CommandDescription& command : program.commands) {
        ASSERT_GE(command.options.size(), 3U);
        for (const OptionDescription& option : command.options) {
            for (const std::string& name : option.names) {
                const bool isLong = name.starts_with("--");
                EXPECT_NE(fish.find(isLong ? " -l " + name.substr(2) : " -s " + name.substr(1)),
                          std::string::npos);
                EXPECT_NE(
                    script("zsh").find(")" + name + (option.value.empty() || !isLong ? "[" : "=[")),
                    std::string::npos)
                    << name;
                EXPECT_NE(script("bash").find(name), std::string::npos) << name;
            }
        }
    }
}

TEST_F(Completion, TheHiddenCommandsAreNotOffered) {
    for (const char* shell : {"bash", "zsh", "fish"}) {
        EXPECT_EQ(script(shell).find("manual"), std::string::npos) << shell;
        EXPECT_TRUE(script(shell).starts_with("#")) << shell;
    }
    EXPECT_EQ(script("csh"), "");
}

TEST_F(Completion, FishOffersCommandsOptionsChoicesAndFiles) {
    if (!isInstalled("fish")) {
        GTEST_SKIP() << "fish is not installed";
    }
    const auto inFish = [this](const std::string& line) {
        return offered("fish", "set -x HOME $PWD\nsource ./.script\ncomplete -C '" + line + "'\n");
    };
    EXPECT_EQ(inFish("pallax dec"), "decode\tConvert recordings to JSON or CSV\n");
    EXPECT_EQ(inFish("pallax decode --ev"),
              "--every\tWhen to write the display (default: end; for csv, tick)\n");
    EXPECT_EQ(inFish("pallax simulate cd"), "cdma\n");
    EXPECT_EQ(inFish("pallax fields --j"), "--json\tJSON, one object per line\n");
    EXPECT_EQ(inFish("pallax --color n"),
              "never\tColour on the screen (default: auto; never if NO_COLOR is set)\n");
    EXPECT_EQ(inFish("pallax decode dr"), "drive.pcap\n");
    EXPECT_EQ(inFish("pallax demo dr"), "");
}

TEST_F(Completion, ZshTakesTheScript) {
    if (!isInstalled("zsh")) {
        GTEST_SKIP() << "zsh is not installed";
    }
    // Stand-ins for the completion system's functions, which print their arguments.
    const std::string told =
        offered("zsh", "compdef() { print compdef $* }\n_arguments() { print -l -- \"$@\" }\n"
                       "source ./.script\nwords=(pallax simulate '')\nCURRENT=3\n_pallax\n");
    EXPECT_TRUE(told.starts_with("compdef _pallax pallax\n-s\n")) << told;
    EXPECT_NE(told.find("\n(-o --output)-o[The file to write; - is standard output]:FILE:_files\n"),
              std::string::npos)
        << told;
    EXPECT_NE(told.find(":ifx|gsm|cdma|lte|utran:(ifx gsm cdma lte utran)\n"), std::string::npos)
        << told;
}

} // namespace
} // namespace pallax
