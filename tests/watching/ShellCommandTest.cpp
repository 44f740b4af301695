#include "watching/ShellCommand.h"

#include "tests/doubles/Files.h"

#include <gtest/gtest.h>

#include <csignal>
#include <fcntl.h>
#include <filesystem>
#include <sys/stat.h>
#include <unistd.h>

namespace pallax {
namespace {

using Mode = ShellCommand::Mode;

constexpr const char* kTime = "2023-11-14T22:13:20.000Z";
constexpr const char* kLater = "2023-11-14T22:13:30.000Z";

/// Commands in a folder of their own, which is in the variable FOLDER.
class ShellCommandTest : public testing::Test {
protected:
    ShellCommand command(const std::string& text, Mode mode = Mode::Wait) {
        return {text, mode, [this](std::string_view sentence) { reports.emplace_back(sentence); }};
    }
    /// Runs a command to its end with this variable.
    void run(const std::string& text, const std::string& name = "X",
             const std::string& value = "") {
        command(text).run(kTime, {{"FOLDER", folder.path()}, {name, value}});
    }
    std::string said() const { return doubles::contentOf(folder.path("said")); }

    doubles::TemporaryFolder folder;
    std::vector<std::string> reports;
};

TEST_F(ShellCommandTest, HasTheVariablesAndTheEnvironment) {
    ASSERT_EQ(::setenv("OUTER", "kept", 1), 0);
    ASSERT_EQ(::setenv("PALLAX_TIME", "replaced", 1), 0);
    run(R"(echo "$PALLAX_TIME $OUTER" > "$FOLDER/said"; env | grep -c ^PALLAX_TIME= >> "$FOLDER/said")",
        "PALLAX_TIME", kTime);
    EXPECT_EQ(said(), "2023-11-14T22:13:20.000Z kept\n1\n");
    EXPECT_TRUE(reports.empty());
}

TEST_F(ShellCommandTest, AValueIsNeverAPartOfTheCommand) {
    const std::string value = "$(touch \"$FOLDER/x\") `touch x` '; touch x; \" \n\\ $HOME * &";
    run(R"(printf %s "$PALLAX_VALUE" > "$FOLDER/said")", "PALLAX_VALUE", value);
    EXPECT_EQ(said(), value);
    EXPECT_FALSE(std::filesystem::exists(folder.path("x")));
    EXPECT_TRUE(reports.empty());
}

TEST_F(ShellCommandTest, HasNoInputAndNoFilesOfThisProcess) {
    constexpr int kInherited = 50; // the shell has none of its own there
    ASSERT_EQ(::dup2(STDERR_FILENO, kInherited), kInherited);
    run(R"(cat > "$FOLDER/said"; readlink /proc/$$/fd/0 >> "$FOLDER/said"; )"
        R"([ -e /proc/$$/fd/2 ] && ! [ -e "/proc/$$/fd/$FILE" ])",
        "FILE", std::to_string(kInherited));
    (void)::close(kInherited);
    EXPECT_EQ(said(), "/dev/null\n");
    EXPECT_TRUE(reports.empty());
}

TEST_F(ShellCommandTest, EndsByABrokenPipeAsUsual) {
    (void)std::signal(SIGPIPE, SIG_IGN);
    run("kill -PIPE $$");
    EXPECT_EQ(reports, std::vector<std::string>{
                           "--exec: the command for 2023-11-14T22:13:20.000Z was ended by signal "
                           "13."});
}

TEST_F(ShellCommandTest, TellsItsStatusEvenIfTheParentIgnoresChildren) {
    (void)std::signal(SIGCHLD, SIG_IGN);
    run("exit 3");
    EXPECT_EQ(reports, std::vector<std::string>{
                           "--exec: the command for 2023-11-14T22:13:20.000Z ended with status "
                           "3."});
}

TEST_F(ShellCommandTest, TellsThatItCannotBeStarted) {
    run("true", "X", std::string(std::size_t{1} << 22U, 'x'));
    EXPECT_EQ(reports, std::vector<std::string>{
                           "--exec: the command for 2023-11-14T22:13:20.000Z cannot be started: "
                           "Argument list too long."});
    EXPECT_EQ(::access("/bin/sh", X_OK), 0);
}

TEST_F(ShellCommandTest, BesideIsNotWaitedForAndNotRunTwiceAtATime) {
    const std::string gate = folder.path("gate");
    ASSERT_EQ(::mkfifo(gate.c_str(), S_IRUSR | S_IWUSR), 0);
    ShellCommand beside = command(R"(read line < "$GATE"; exit 4)", Mode::Beside);
    beside.run(kTime, {{"GATE", gate}});
    beside.look();
    EXPECT_TRUE(reports.empty()) << "it waits";
    beside.run(kLater, {{"GATE", gate}});
    EXPECT_EQ(reports, std::vector<std::string>{
                           "--exec: the command is not run for 2023-11-14T22:13:30.000Z, because "
                           "that for 2023-11-14T22:13:20.000Z still runs."});
    reports.clear();
    const int writer = ::open(gate.c_str(), O_WRONLY | O_CLOEXEC);
    (void)::close(writer);
    beside.finish();
    EXPECT_EQ(reports, std::vector<std::string>{
                           "--exec: the command for 2023-11-14T22:13:20.000Z ended with status "
                           "4."});
    beside.finish();
    EXPECT_EQ(reports.size(), 1U) << "it is told once";
    beside.run(kLater, {{"GATE", "/dev/null"}});
    beside.finish();
    EXPECT_EQ(reports.back(), "--exec: the command for 2023-11-14T22:13:30.000Z ended with status "
                              "4.");
}

} // namespace
} // namespace pallax
