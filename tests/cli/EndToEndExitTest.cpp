#include "host/Descriptor.h"
#include "tests/cli/EndToEndScreen.h"

#include <csignal>
#include <fcntl.h>
#include <sys/stat.h>

namespace pallax {
namespace {

using doubles::PallaxProcess;
using std::chrono::milliseconds;
using std::chrono::seconds;

/// The preferences and processes that the application leaves at its exits.
class EndToEndExit : public EndToEndScreen {
protected:
    std::string fatal() const {
        return record("fatal.pcap", {{milliseconds(0), registration(0)},
                                     {seconds(5), registration(2)},
                                     {seconds(6), unreadableSimFiles()}});
    }

    void forgetPreference() const {
        std::filesystem::remove_all(world.path("config/pallax/preferences"));
    }
};

constexpr const char* kNotices = "Deallocing ZOR_GSMClassIndex\r\nDeallocing ClassIndex\r\n";
constexpr const char* kOtherScreenLeft = "\x1b[?1049l";

TEST_F(EndToEndExit, OfTheScreenPrintsTheDestructionNoticesOnTheRestoredTerminal) {
    PallaxTerminal terminal(world, {brief(), "--speed", "max"}, {});
    ASSERT_TRUE(terminal.shows("End of the recording"));
    EXPECT_EQ(terminal.bytes().find("Deallocing"), std::string::npos);
    terminal.type("q");
    EXPECT_EQ(terminal.wait(), 0);
    EXPECT_TRUE(terminal.bytes().ends_with(kNotices)) << terminal.bytes();
    EXPECT_LT(terminal.bytes().rfind(kOtherScreenLeft), terminal.bytes().find("Deallocing"));
}

TEST_F(EndToEndExit, OfTheScreenByAFatalRecordPrintsTheNoticesBeforeTheSentence) {
    PallaxTerminal terminal(world, {fatal(), "--speed", "8"}, {});
    EXPECT_EQ(terminal.wait(), 70);
    EXPECT_NE(terminal.bytes().find(std::string(kNotices) + "pallax: packet 3 (log code 0xFF0000)"),
              std::string::npos)
        << terminal.bytes();
    expectHomeScreenPreference();
}

TEST_F(EndToEndExit, BySigquitIsAnExitTooAndEndsAsTheSignalDoes) {
    PallaxTerminal terminal(world, {changing(), "--speed", "4"}, {});
    ASSERT_TRUE(terminal.shows("Process CO"));
    terminal.type("\x1c"); // Ctrl-backslash
    EXPECT_EQ(terminal.wait(), -SIGQUIT);
    EXPECT_TRUE(terminal.isRestored());
    EXPECT_TRUE(terminal.bytes().ends_with(kNotices)) << terminal.bytes();
    expectHomeScreenPreference();
    expectNothingLeft();
}

TEST_F(EndToEndExit, OfAPrintedTreeSwitchesThePreferenceOff) {
    EXPECT_EQ(run({brief(), "--print", "--speed", "max"}).status, 0);
    expectHomeScreenPreference();
    forgetPreference();
    EXPECT_EQ(run({fatal(), "--print", "--speed", "max"}).status, 70);
    expectHomeScreenPreference();
    for (const int number : {SIGTERM, SIGQUIT}) {
        forgetPreference();
        PallaxProcess process(world, {changing(), "--print", "--speed", "4"});
        ASSERT_TRUE(process.says("== "));
        process.signal(number);
        EXPECT_EQ(process.wait(), number == SIGQUIT ? -SIGQUIT : 0);
        EXPECT_TRUE(process.out().ends_with("Deallocing ZOR_GSMClassIndex\nDeallocing "
                                            "ClassIndex\n"))
            << process.out();
        expectHomeScreenPreference();
        expectNothingLeft();
    }
}

TEST_F(EndToEndExit, OfUnreadableSettingsIsOneSentence) {
    const std::string file = world.path("config/pallax/pallax.conf");
    std::filesystem::remove(file);
    ASSERT_EQ(::mkfifo(file.c_str(), S_IRUSR | S_IWUSR), 0);
    const std::vector<std::vector<std::string>> commands{{brief(), "--print"},
                                                         {"record", world.path("a.pcapng")}};
    for (const auto& arguments : commands) {
        const Run result = run(arguments);
        EXPECT_EQ(result.status, 1);
        EXPECT_EQ(result.out, "");
        EXPECT_EQ(result.err, "pallax: " + file + " cannot be read: it is not a regular file.\n");
    }
    std::filesystem::remove(file);
    EXPECT_EQ(run({brief(), "--print", "--speed", "max"}).status, 0) << "it may be missing";
}

TEST_F(EndToEndExit, OfAPrintedTreeWithoutAReaderSwitchesThePreferenceOff) {
    const std::string pipe = world.path("pipe");
    ASSERT_EQ(::mkfifo(pipe.c_str(), S_IRUSR | S_IWUSR), 0);
    Descriptor reader(::open(pipe.c_str(), O_RDONLY | O_NONBLOCK | O_CLOEXEC));
    PallaxProcess process(world, {"demo", "--print", "--speed", "max"}, "/dev/null", pipe);
    EXPECT_TRUE(doubles::waitsForItsReader(process.id()));
    reader.reset();
    EXPECT_EQ(process.wait(), 0);
    expectHomeScreenPreference();
}

} // namespace
} // namespace pallax
