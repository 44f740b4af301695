#include "link/BrowseLink.h"
#include "monitor/PallaxModel.h"
#include "tests/cli/EndToEnd.h"
#include "tests/cli/FaultyService.h"
#include "tests/doubles/FakeStandardOutput.h"
#include "tests/doubles/RecordingLog.h"

#include <algorithm>
#include <csignal>
#include <cstdlib>
#include <filesystem>
#include <thread>
#include <unistd.h>

namespace pallax {
namespace {

using doubles::Fault;
using doubles::FaultyService;
using doubles::noChildLeft;
using doubles::PallaxProcess;
using std::chrono::milliseconds;
using std::chrono::seconds;
using std::chrono::steady_clock;

constexpr milliseconds kShortRetryDelay{20};
/// The viewer must show data again this soon after the service's return.
constexpr seconds kViewerPatience{5};

/// Timers that fire a hundred times as often: a viewer checks its service at the display tick,
/// which is every 2 s.
class QuickTimers final : public TimerScheduler {
public:
    explicit QuickTimers(TimerScheduler& timers) : _timers(timers) {}
    std::unique_ptr<RepeatingTimer> scheduleRepeating(std::chrono::nanoseconds interval,
                                                      std::function<void()> action) override {
        return _timers.scheduleRepeating(interval / 100, std::move(action));
    }

private:
    TimerScheduler& _timers;
};

/// The viewer's side, with real model, ports and sockets, but without a screen and with short
/// delays.
class Viewer final : private ModelObserver {
public:
    Viewer() : _model(platform(), *this) {
        _link.queue().async([this] { _model.startMonitor(); });
    }

    /// Runs until the condition holds; false after the time limit.
    bool runUntil(const std::function<bool()>& condition) {
        const auto end = steady_clock::now() + kViewerPatience;
        while (!condition()) {
            if (steady_clock::now() > end) {
                return false;
            }
            _link.queue().runReady();
            std::this_thread::sleep_for(milliseconds(1));
        }
        return true;
    }
    void runFor(milliseconds time) {
        const auto end = steady_clock::now() + time;
        (void)runUntil([end] { return steady_clock::now() >= end; });
    }
    /// Waits until new data is shown over a working link.
    bool comesIntoView() {
        const int before = _updates;
        return runUntil([&] {
            return _updates > before && _model.isConnected() && _model.topLevelNodes() != nullptr;
        });
    }

private:
    static SocketDirectory directory() {
        auto opened = SocketDirectory::open();
        if (!opened) {
            throw std::runtime_error(opened.error().sentence);
        }
        return std::move(opened).value();
    }
    ModemLink::Platform platform() {
        const ModemLink::Platform real = _link.platform();
        return {real.ports,      real.telephony,    real.queue,         _timers,
                real.generators, real.technologies, real.localPortName, kShortRetryDelay};
    }
    void updateViewControllerFromModel() override {
        ++_updates;
        (void)_model.topLevelNodes(); // like the screen
    }

    int _updates = 0;
    doubles::FakeStandardOutput _notices;
    AsioMainQueue _queue;
    BrowseLink _link{_queue, directory(), OnFatalRecord::Stop, nullptr, _notices};
    QuickTimers _timers{_link.queue()};
    PallaxModel _model;
};

class EndToEndFaults : public EndToEnd {
protected:
    EndToEndFaults() {
        (void)::setenv("XDG_RUNTIME_DIR", world.path().c_str(), 1);
        (void)::setenv("PALLAX_RESOURCES", PALLAX_SOURCE_DIR "/resources", 1);
    }
    ~EndToEndFaults() override {
        (void)::unsetenv("XDG_RUNTIME_DIR");
        (void)::unsetenv("PALLAX_RESOURCES");
    }

    static bool isLogged(const doubles::RecordingLog& log, const std::string& text) {
        return std::any_of(log.lines().begin(), log.lines().end(), [&](const auto& line) {
            return line.priority == static_cast<int>(LogPriority::Error) &&
                   line.text.starts_with(text);
        });
    }
    /// A viewer meets the fault and logs one of the lines (the kernel decides between a refused and
    /// a broken connection), then shows data once the service works.
    void meets(Fault fault, const std::vector<std::string>& lines) {
        doubles::RecordingLog log(static_cast<int>(LogPriority::Error));
        std::optional<FaultyService> service(fault);
        Viewer viewer;
        EXPECT_TRUE(viewer.runUntil([&] {
            return std::any_of(lines.begin(), lines.end(),
                               [&](const auto& line) { return isLogged(log, line); });
        })) << testing::PrintToString(log.lines());
        if (viewer.runUntil([&] { return service->hasEnded(); })) {
            service.emplace(Fault::None);
        }
        EXPECT_TRUE(viewer.comesIntoView()) << testing::PrintToString(log.lines());
    }
    /// The same for a service that fails once and then works.
    void meetsOnce(Fault fault, const std::string& line) {
        doubles::RecordingLog log(static_cast<int>(LogPriority::Error));
        const FaultyService service(fault);
        Viewer viewer;
        EXPECT_TRUE(viewer.comesIntoView());
        EXPECT_TRUE(isLogged(log, line)) << testing::PrintToString(log.lines());
        EXPECT_TRUE(isLogged(log, "No log generator technology works"));
        EXPECT_TRUE(isLogged(log, "Starting the display update timer"));
    }
};

TEST_F(EndToEndFaults, AServiceKilledBeforeTheConnectionLeavesAStaleSocket) {
    meets(Fault::KilledBeforeTheConnection, {"Could not create HXServerConnection"});
}

TEST_F(EndToEndFaults, AServiceKilledAtTheChannelRequest) {
    meets(Fault::KilledAtTheChannelRequest,
          {"_HXServerConnectionNetworkMonitorCreateLogChannel returns error: 3!"});
}

TEST_F(EndToEndFaults, AServiceKilledAfterTheChannel) {
    meets(Fault::KilledAfterTheChannel,
          {"Could not create the remote port!",
           " ***** Could not send the GetTechnology command (got error=3)"});
}

TEST_F(EndToEndFaults, AServiceKilledBeforeTheReply) {
    meets(Fault::KilledBeforeTheReply,
          {" ***** Could not send the GetTechnology command (got error=3)"});
}

TEST_F(EndToEndFaults, AServiceKilledAfterTheReplyAndBeforeTheStartCommand) {
    meets(Fault::KilledAfterTheReply,
          {" ***** Could not send the START command (got error=3)", " ***** INVALIDATED 0x"});
}

TEST_F(EndToEndFaults, AServiceKilledAtTheStartCommand) {
    meets(Fault::KilledAtTheStartCommand, {" ***** INVALIDATED 0x"});
}

TEST_F(EndToEndFaults, AServiceKilledWhileStreaming) {
    meets(Fault::KilledWhileStreaming, {" ***** INVALIDATED 0x"});
}

TEST_F(EndToEndFaults, AClosedPortIsNoticedWhileALiveStreamGoesOnWhoseStampsStand) {
    const FaultyService service(Fault::ChannelClosedWhileLive);
    PallaxProcess viewer(world, {"--log-level", "3"});
    EXPECT_TRUE(viewer.says("<3>Starting the display update timer\n"));
    EXPECT_TRUE(viewer.says(" ***** INVALIDATED "));
    viewer.signal(SIGTERM);
    EXPECT_EQ(viewer.wait(), 0);
}

TEST_F(EndToEndFaults, AReplyThatComesTooLateIsNoneAndTheNextQueryIsAnswered) {
    meetsOnce(Fault::ReplyTooLate, " ***** Could not send the GetTechnology command (got error=2)");
}

TEST_F(EndToEndFaults, AReplyThatIsNoPropertyList) {
    meetsOnce(Fault::ReplyIsNoPropertyList,
              " ***** Could not parse reply to GetTechnology; cannot configure");
}

TEST_F(EndToEndFaults, AReplyWithoutTheKey) {
    meetsOnce(Fault::ReplyWithoutTheKey,
              " ***** Reply to GetTechnology had no answer; cannot configure");
}

TEST_F(EndToEndFaults, AnUnknownTechnologyIsTriedAgain) {
    meetsOnce(Fault::UnknownTechnology, "Got log generated: (nil)");
}

std::ptrdiff_t openDescriptors() {
    return std::distance(std::filesystem::directory_iterator("/proc/self/fd"), {});
}

TEST_F(EndToEndFaults, After200KilledServicesNothingHasLeakedAndTheViewerIsInView) {
    constexpr int kRounds = 200;
    std::vector<Packet> packets;
    for (int count = 0; count < 100; ++count) {
        packets.emplace_back(seconds(count), registration(2));
    }
    const std::vector<std::string> arguments{"service", "--play",  record("a.pcap", packets),
                                             "--loop",  "--speed", "100"};
    std::ptrdiff_t atFirst = 0;
    {
        Viewer viewer;
        for (int round = 0; round < kRounds; ++round) {
            PallaxProcess service(world, arguments);
            if (round % 4 == 3) { // killed at some point during the start
                viewer.runFor(milliseconds(round % 30));
            } else {
                ASSERT_TRUE(viewer.comesIntoView()) << "round " << round << "\n" << service.err();
            }
            service.signal(SIGKILL);
            ASSERT_EQ(service.wait(), -SIGKILL) << "round " << round << "\n" << service.err();
            if (round == 0) {
                viewer.runFor(2 * kShortRetryDelay);
                atFirst = openDescriptors();
            }
        }
        viewer.runFor(2 * kShortRetryDelay);
        EXPECT_EQ(openDescriptors(), atFirst);
        EXPECT_LE(world.sockets().size(), 3U) << "those of the last service, and the viewer's";

        PallaxProcess service(world, arguments);
        EXPECT_TRUE(viewer.comesIntoView());
        service.signal(SIGTERM);
        EXPECT_EQ(service.wait(), 0);
    }
    EXPECT_EQ(world.sockets(), std::vector<std::string>());
    EXPECT_TRUE(noChildLeft());
}

/// All programs that need the socket folder refuse it with the same sentence.
class EndToEndSocketFolder : public EndToEnd {
protected:
    void isRefused(const std::string& path, const std::string& why) const {
        const std::string recording = record("a.pcap", {{milliseconds(0), registration(0)}});
        const std::string sentence =
            "pallax: The folder for message ports, " + path + ", " + why + ".\n";
        for (const std::vector<std::string>& arguments : {std::vector<std::string>{"--print"},
                                                          {recording, "--print"},
                                                          {"record", world.path("b.pcapng")},
                                                          {"service", "--play", recording},
                                                          {"service", "--status"}}) {
            const Run refused = run(arguments);
            EXPECT_EQ(refused.status, 1);
            EXPECT_EQ(refused.err, sentence) << arguments.front();
        }
        EXPECT_FALSE(std::filesystem::exists(world.path("b.pcapng")));
    }
    std::string folder() const { return world.path("pallax"); }
};

TEST_F(EndToEndSocketFolder, InAFolderThatIsMissing) {
    world.environment.push_back("XDG_RUNTIME_DIR=" + world.path("missing"));
    isRefused(world.path("missing/pallax"), "cannot be made: No such file or directory");
}

TEST_F(EndToEndSocketFolder, WhereAServiceRunsAlreadyASecondOneIsRefused) {
    const std::string recording = record("a.pcap", {{milliseconds(0), registration(0)}});
    PallaxProcess first(world, {"service", "--play", recording});
    EXPECT_TRUE(doubles::eventually([this] { return !world.sockets().empty(); }));
    const Run second = run({"service", "--play", recording});
    EXPECT_EQ(second.status, 1);
    EXPECT_EQ(second.err,
              "pallax: A telephony service named com.norvane.telephony is already running.\n");
    EXPECT_EQ(run({"service", "--status"}).status, 0) << "the first is unaffected";
    first.signal(SIGTERM);
    EXPECT_EQ(first.wait(), 0);
}

TEST_F(EndToEndSocketFolder, OfAnotherUser) {
    if (::geteuid() != 0) {
        GTEST_SKIP() << "only root can give a folder away";
    }
    constexpr uid_t kNobody = 65534;
    std::filesystem::create_directory(folder());
    std::filesystem::permissions(folder(), std::filesystem::perms::owner_all);
    ASSERT_EQ(::chown(folder().c_str(), kNobody, kNobody), 0);
    isRefused(folder(), "belongs to another user");
}

TEST_F(EndToEndSocketFolder, ThatIsWorldWritable) {
    std::filesystem::create_directory(folder());
    std::filesystem::permissions(folder(), std::filesystem::perms::all);
    isRefused(folder(), "can be entered by other users (its mode must be 0700)");
}

} // namespace
} // namespace pallax
