#include "tests/cli/EndToEndScreen.h"

#include <csignal>
#include <filesystem>
#include <optional>

namespace pallax {
namespace {

using doubles::eventually;
using doubles::PallaxProcess;
using std::chrono::milliseconds;

constexpr const char* kNoService = "No telephony service is running; waiting";

/// The messages of programs without a connection.
class EndToEndWaiting : public EndToEndScreen {
protected:
    std::vector<std::string> service() const {
        return {"service", "--play", changing(), "--loop", "--speed", "10"};
    }
    bool serviceIsThere() const {
        return eventually([this] { return !world.sockets().empty(); });
    }
    static void end(PallaxProcess& process) {
        process.signal(SIGTERM);
        EXPECT_EQ(process.wait(), 0);
    }
    static int occurrences(const std::string& text, const std::string& part) {
        int count = 0;
        for (auto at = text.find(part); at != std::string::npos; at = text.find(part, at + 1)) {
            ++count;
        }
        return count;
    }
};

TEST_F(EndToEndWaiting, ARecorderSaysOnceWhatItWaitsForAndTriesTwiceASecond) {
    PallaxProcess recorder(world, {"record", "--log-level", "3", world.path("a.pcapng")});
    ASSERT_TRUE(recorder.says(std::string("pallax: ") + kNoService + ".\n"));
    const std::string before = recorder.err().substr(0, recorder.err().find("pallax: "));
    EXPECT_GE(occurrences(before, "<3>Could not create HXServerConnection\n"), 2)
        << "within the first second\n"
        << before;
    PallaxProcess source(world, service());
    EXPECT_TRUE(recorder.says("<3>Starting the display update timer\n"));
    EXPECT_TRUE(
        eventually([this] { return std::filesystem::file_size(world.path("a.pcapng")) > 1000; }));
    end(recorder);
    EXPECT_EQ(occurrences(recorder.err(), "pallax: "), 1) << recorder.err();
    end(source);
}

TEST_F(EndToEndWaiting, AViewerThatPrintsSaysItOnStandardError) {
    PallaxProcess viewer(world, {"--print"});
    ASSERT_TRUE(viewer.says(std::string("pallax: ") + kNoService + ".\n"));
    EXPECT_EQ(viewer.out(), "Connecting...\n");
    PallaxProcess source(world, service());
    EXPECT_TRUE(viewer.says("  MM Service State: REG_STATE_"));
    EXPECT_EQ(viewer.err(), std::string("pallax: ") + kNoService + ".\n");
    end(viewer);
    end(source);
}

TEST_F(EndToEndWaiting, AViewerOnTheScreenSaysItInTheStatusUntilItIsConnected) {
    PallaxTerminal terminal(world, {}, {});
    EXPECT_TRUE(terminal.shows(kNoService));
    EXPECT_TRUE(terminal.shows("connecting: no service"));
    PallaxProcess source(world, service());
    EXPECT_TRUE(terminal.shows("Updated "));
    EXPECT_TRUE(terminal.showsNoMore("connecting:"));
    EXPECT_TRUE(terminal.showsNoMore(kNoService));
    source.signal(SIGKILL);
    EXPECT_EQ(source.wait(), -SIGKILL);
    EXPECT_TRUE(terminal.shows(kNoService)) << "again after the link is lost";
    terminal.type("q");
    EXPECT_EQ(terminal.wait(), 0);
}

TEST_F(EndToEndWaiting, AServiceThatIsBusyIsToldFromOneThatIsMissing) {
    PallaxProcess source(world, {"service", "--play", "-", "--speed", "0.01"}, changing());
    ASSERT_TRUE(serviceIsThere());
    PallaxProcess first(world, {"--log-level", "3"}); // standard input is played once
    ASSERT_TRUE(first.says("<3>Starting the display update timer\n"));
    PallaxProcess second(world, {"--print"});
    EXPECT_TRUE(second.says(
        "pallax: The telephony service has nothing to play to this client; waiting.\n"));
    end(second);
    end(first);
    end(source);
}

TEST_F(EndToEndWaiting, AServiceThatDoesNotAnswerIsToldAndHasNoStatus) {
    constexpr const char* kSilent = "pallax: The telephony service does not answer";
    PallaxProcess source(world, service());
    ASSERT_TRUE(serviceIsThere());
    EXPECT_EQ(run({"service", "--status"}).status, 0);
    source.signal(SIGSTOP);
    const Run status = run({"service", "--status"});
    EXPECT_EQ(status.status, 1);
    EXPECT_EQ(status.out, "");
    EXPECT_EQ(status.err, std::string(kSilent) + ".\n");
    PallaxProcess recorder(world, {"record", world.path("a.pcapng")});
    EXPECT_TRUE(recorder.says(std::string(kSilent) + "; waiting.\n"));
    source.signal(SIGCONT);
    EXPECT_TRUE(
        eventually([this] { return std::filesystem::file_size(world.path("a.pcapng")) > 1000; }));
    end(recorder);
    end(source);
}

TEST_F(EndToEndWaiting, AFolderThatIsLostIsTold) {
    const std::string folder = world.path("pallax");
    PallaxProcess recorder(world, {"record", world.path("a.pcapng")});
    ASSERT_TRUE(recorder.says(kNoService));
    std::filesystem::remove_all(folder);
    const std::string name =
        "com.norvane.BasebandStateReport.LogChannel.Recorder." + std::to_string(recorder.id());
    EXPECT_TRUE(recorder.says("pallax: The message port " + name + " cannot be made at " + folder +
                              "/" + name + ": No such file or directory; waiting.\n"));
    end(recorder);
}

TEST_F(EndToEndWaiting, SeveralViewersOfOneServiceShowItAtOnce) {
    constexpr const char* kFixedName = "com.norvane.BasebandStateReport.LogChannel";
    PallaxProcess source(world, service());
    ASSERT_TRUE(serviceIsThere());
    PallaxProcess first(world, {"--print"});
    ASSERT_TRUE(first.says("  MM Service State: REG_STATE_"));
    PallaxProcess second(world, {"--print"});
    EXPECT_TRUE(second.says("  MM Service State: REG_STATE_"));
    PallaxTerminal third(world, {}, {});
    EXPECT_TRUE(third.shows("Process CO"));
    const std::string status = run({"service", "--status"}).out;
    EXPECT_NE(status.find("\nClients: 3\n"), std::string::npos) << status;
    EXPECT_NE(status.find(std::string("\n  ") + kFixedName + ": streaming"), std::string::npos);
    EXPECT_NE(status.find(std::string("\n  ") + kFixedName + ".Viewer." +
                          std::to_string(second.id()) + ": streaming"),
              std::string::npos)
        << status;
    end(first);
    const std::size_t shown = second.out().size();
    EXPECT_TRUE(eventually([&] { return second.out().size() > shown; })) << "it goes on";
    third.type("q");
    EXPECT_EQ(third.wait(), 0);
    end(second);
    end(source);
    EXPECT_EQ(second.err(), "");
    expectNothingLeft();
}

} // namespace
} // namespace pallax
