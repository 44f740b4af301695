#include "tests/docs/ConsoleBlocks.h"
#include "tests/doubles/Files.h"
#include "tests/doubles/Shell.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <array>
#include <filesystem>
#include <map>
#include <set>
#include <sstream>
#include <string_view>

// Runs every command that a document shows, in a folder with the parts of a clone that commands
// use, and compares its output with the output shown.

namespace pallax {
namespace {

namespace fs = std::filesystem;
using doubles::blockKinds;
using doubles::contentOf;
using doubles::isShown;
using doubles::runCommand;
using doubles::ShownCommand;
using doubles::shownCommands;

/// Beginnings of commands that are not run: they build, install, or need more than a test has.
constexpr auto kNotRun = std::to_array<std::string_view>({
    "./run", "./test", "pallax-window", "cmake ", "cpack ", "systemctl ",
    "build/dev/reference/make_reference", "build/dev/tests/",
    "pallax modem", // they need one
    "pallax service --modem", "pallax record --modem",
    "ssh -L ", // it needs a port that may be taken
});

/// Commands that run until the user quits: they get Ctrl-C after two seconds and must succeed.
constexpr auto kUntilLeft = std::to_array<std::string_view>({
    "pallax",
    "pallax demo lte --seed 7",
    "pallax demo gsm --seed 7 --speed 4",
    "pallax service --simulate lte",
    "pallax web demo lte",
    "pallax drive.pcap",
    "pallax drive.pcap --speed 4",
    "pallax record drive.pcapng",
    "pallax record --technology lte lte.pcapng",
    "pallax record --rotate-size 100M parts.pcapng",
    "pallax record --rotate-seconds 3600 hours.pcapng",
});

/// Recordings and programs of the reader that the documents presume.
constexpr const char* kSurroundings = R"sh(
cp samples/lte-drive.pcap drive.pcap
cp samples/gsm-attach.pcap other.pcap
mkdir monday && cp samples/lte-drive.pcap samples/cdma-drive.pcap monday
mkdir parts && cp samples/lte-drive.pcap parts/drive-0001.pcapng
cat >"$BIN/modem-dump" <<'END'
#!/bin/sh
head -c 24 samples/lte-drive.pcap
sleep 3
tail -c +25 samples/lte-drive.pcap
END
cat >"$BIN/ssh" <<'END'
#!/bin/sh
shift
exec "$@"
END
chmod +x "$BIN/modem-dump" "$BIN/ssh"
)sh";

/// Begins the script: one shell runs all commands in order.
constexpr const char* kBegin = R"sh(
untilServed() {
    for ((look = 0; look < 200; ++look)); do
        [ -z "$(find "$XDG_RUNTIME_DIR" -type s -name '*telephony*')" ] || return
        sleep 0.05
    done
}
endJobs() {
    local processes=$(jobs -p)
    [ -z "$processes" ] || kill $processes 2>/dev/null
    wait 2>/dev/null
}
)sh";

std::vector<std::string> documents() {
    std::vector<std::string> names{"README.md", "CONTRIBUTING.md"};
    for (const auto& entry : fs::directory_iterator(PALLAX_SOURCE_DIR "/docs")) {
        if (entry.path().extension() == ".md") {
            names.push_back("docs/" + entry.path().filename().string());
        }
    }
    std::sort(names.begin(), names.end());
    return names;
}

std::vector<ShownCommand> commandsOf(const std::string& document) {
    return shownCommands(contentOf(fs::path(PALLAX_SOURCE_DIR) / document));
}

std::string withoutComment(const std::string& command) {
    const std::string bare = command.substr(0, command.find(" #"));
    return bare.substr(0, bare.find_last_not_of(' ') + 1);
}

bool isRun(const ShownCommand& command) {
    return std::none_of(kNotRun.begin(), kNotRun.end(), [&](std::string_view prefix) {
        return command.command.starts_with(prefix);
    });
}

bool goesOn(const ShownCommand& command) {
    return std::find(kUntilLeft.begin(), kUntilLeft.end(), withoutComment(command.command)) !=
           kUntilLeft.end();
}

bool isInBackground(const ShownCommand& command) {
    return withoutComment(command.command).ends_with('&');
}

/// Removes the notice of viewers and recorders that wait for a live modem.
std::string withoutWaiting(std::string printed) {
    constexpr std::string_view kWaiting = "pallax: No telephony service is running; waiting.\n";
    if (const auto at = printed.find(kWaiting); at != std::string::npos) {
        printed.erase(at, kWaiting.size());
    }
    return printed;
}

/// A clone, a home folder, and the scripts that run in them.
class DocumentedWorld : public testing::Test {
protected:
    DocumentedWorld() {
        fs::create_directories(folder.path("clone/tests"));
        fs::create_directories(folder.path("clone/build"));
        for (const char* part : {"samples", "scripts", "tests/data"}) {
            fs::copy(fs::path(PALLAX_SOURCE_DIR) / part, folder.path("clone") + "/" + part,
                     fs::copy_options::recursive);
        }
        fs::create_symlink(PALLAX_BINARY_DIR, folder.path("clone/build/dev"));
        for (const char* name : {"bin", "home", "sockets", "out"}) {
            fs::create_directory(folder.path(name));
        }
        fs::permissions(folder.path("sockets"), fs::perms::owner_all);
        fs::create_symlink(PALLAX_BINARY_DIR "/pallax", folder.path("bin/pallax"));
    }

    std::string output(std::size_t number) const {
        return contentOf(folder.path("out/" + std::to_string(number)));
    }
    int status(std::size_t number) const {
        return std::stoi(contentOf(folder.path("out/" + std::to_string(number) + ".status")));
    }

    std::string scriptsBegin() const {
        std::ostringstream script;
        script << "export BIN=" << folder.path("bin") << " HOME=" << folder.path("home")
               << " XDG_RUNTIME_DIR=" << folder.path("sockets") << " TZ=UTC LC_ALL=C.UTF-8\n"
               << "unset XDG_CONFIG_HOME XDG_STATE_HOME PALLAX_RESOURCES\nPATH=$BIN:$PATH\n"
               << "cd " << folder.path("clone") << "\n"
               << kSurroundings << kBegin;
        return script.str();
    }

    /// Runs the commands in one shell and writes the output of each to its own file.
    void run(const std::vector<ShownCommand>& commands) const {
        std::ostringstream script;
        script << scriptsBegin();
        for (std::size_t number = 0; number < commands.size(); ++number) {
            const ShownCommand& command = commands[number];
            if (number > 0 && commands[number - 1].block != command.block) {
                script << "endJobs\n";
            }
            if (isRun(command)) {
                const std::string name = folder.path("out/" + std::to_string(number));
                script << "{ "
                       << (goesOn(command) ? "timeout --foreground --preserve-status -s INT 2 "
                                           : "")
                       << command.command << "\n} >" << name << " 2>&1 </dev/null\necho $? >"
                       << name << ".status\n";
            }
            script << (isInBackground(command) ? "untilServed\n" : "");
        }
        script << "endJobs\n";
        const auto result = runCommand("bash " + folder.write("script", script.str()));
        EXPECT_EQ(result.out, "");
    }

    doubles::TemporaryFolder folder;
};

/// The world of one document.
class Documents : public DocumentedWorld, public testing::WithParamInterface<std::string> {};

TEST_P(Documents, EveryCommandDoesWhatIsShown) {
    const std::vector<ShownCommand> commands = commandsOf(GetParam());
    run(commands);
    for (std::size_t number = 0; number < commands.size(); ++number) {
        const ShownCommand& command = commands[number];
        if (!isRun(command)) {
            continue;
        }
        SCOPED_TRACE(GetParam() + ":" + std::to_string(command.line) + ": " + command.command);
        if (!command.output.empty()) {
            EXPECT_TRUE(isShown(command.output, output(number))) << output(number).substr(0, 2000);
            continue;
        }
        EXPECT_EQ(status(number), 0) << output(number).substr(0, 2000);
        if (!isInBackground(command)) {
            EXPECT_EQ(withoutWaiting(output(number)).find("pallax: "), std::string::npos)
                << output(number);
        }
    }
}

TEST_P(Documents, CommandsStandInConsoleBlocksOnly) {
    for (const std::string& kind :
         blockKinds(contentOf(fs::path(PALLAX_SOURCE_DIR) / GetParam()))) {
        EXPECT_TRUE(kind == "console" || (kind != "sh" && kind != "bash" && kind != "shell"))
            << kind << " blocks are not run";
    }
}

INSTANTIATE_TEST_SUITE_P(All, Documents, testing::ValuesIn(documents()), [](const auto& document) {
    std::string name = document.param;
    std::replace_if(
        name.begin(), name.end(), [](char each) { return std::isalnum(each) == 0; }, '_');
    return name;
});

TEST_F(DocumentedWorld, TheRelayOfTheTourWorksWithoutAPauseBetweenItsCommands) {
    std::vector<ShownCommand> commands = commandsOf("docs/tour.md");
    const auto relay = std::find_if(commands.begin(), commands.end(), [](const auto& each) {
        return each.command.find("--relay") != std::string::npos;
    });
    ASSERT_NE(relay, commands.end());
    std::ostringstream script;
    script << scriptsBegin() << "exec 2>/dev/null </dev/null\n"
           << "pallax simulate lte --seconds 60 --seed 7 -o drive.pcap\n";
    constexpr int kRounds = 5;
    for (int round = 0; round < kRounds; ++round) {
        for (auto each = relay; each != commands.end() && each->block == relay->block; ++each) {
            script << each->command << "\n";
        }
        script << "rm relayed.pcapng\n";
    }
    script << "wait\n";
    const auto result = runCommand("bash " + folder.write("script", script.str()));
    EXPECT_EQ(result.out, "2400\n2400\n2400\n2400\n2400\n");
}

TEST(DocumentedCommands, TheTourShowsMostOfWhatThereIs) {
    std::set<std::string> shown;
    for (const ShownCommand& command : commandsOf("docs/tour.md")) {
        std::istringstream words(command.command);
        for (std::string word; words >> word;) {
            shown.insert(word);
        }
    }
    for (const char* word :
         {"decode", "demo", "record", "service", "simulate", "explain", "--relay", "csv"}) {
        EXPECT_TRUE(shown.contains(word)) << word;
    }
}

TEST(DocumentedCommands, EveryExceptionIsOfSomeDocument) {
    std::map<std::string_view, int> uses;
    for (const std::string& document : documents()) {
        for (const ShownCommand& command : commandsOf(document)) {
            for (const std::string_view prefix : kNotRun) {
                uses[prefix] += command.command.starts_with(prefix) ? 1 : 0;
            }
            for (const std::string_view whole : kUntilLeft) {
                uses[whole] += withoutComment(command.command) == whole ? 1 : 0;
            }
        }
    }
    for (const auto& [exception, count] : uses) {
        EXPECT_GT(count, 0) << exception;
    }
}

} // namespace
} // namespace pallax
