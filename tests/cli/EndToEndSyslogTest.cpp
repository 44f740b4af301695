#include "host/Descriptor.h"
#include "tests/cli/EndToEndScreen.h"
#include "tests/doubles/Pattern.h"
#include "tests/doubles/Shell.h"

#include <algorithm>
#include <array>
#include <atomic>
#include <csignal>
#include <fstream>
#include <poll.h>
#include <sys/socket.h>
#include <sys/un.h>
#include <thread>

namespace pallax {
namespace {

/// The real system log: the program sees a socket of the test as /dev/log.
class EndToEndSyslog : public EndToEndScreen {
protected:
    EndToEndSyslog() {
        std::filesystem::create_directory(world.path("dev"));
        socket = Descriptor(::socket(AF_UNIX, SOCK_DGRAM | SOCK_CLOEXEC, 0));
        sockaddr_un address{};
        address.sun_family = AF_UNIX;
        const std::string path = world.path("log");
        std::copy(path.begin(), path.end(), std::begin(address.sun_path));
        EXPECT_EQ(
            ::bind(socket.number(), reinterpret_cast<const sockaddr*>(&address), sizeof address),
            0);
    }

    void SetUp() override {
        const auto result = runWithLog("test -S /dev/log");
        if (result.status != 0) {
            GTEST_SKIP() << "no namespaces here: " << result.out;
        }
    }

    /// Runs a command with its own /dev.
    doubles::CommandRun runWithLog(const std::string& command) const {
        const std::string dev = world.path("dev");
        const std::string script = world.path("script");
        std::ofstream(script) << "set -e\n"
                              << "mount -t tmpfs none " << dev << "\n"
                              << "touch " << dev << "/null\n"
                              << "mount --bind /dev/null " << dev << "/null\n"
                              << "ln -s " << world.path("log") << " " << dev << "/log\n"
                              << "mount --rbind " << dev << " /dev\n"
                              << "exec " << command << "\n";
        return doubles::runCommand("unshare --user --map-root-user --mount sh " + script);
    }

    /// The lines that the program sends to the system log, each "<priority>text".
    std::vector<std::string> linesOf(const std::string& arguments) const {
        std::string command = "env";
        for (const std::string& setting : doubles::programEnvironment(world)) {
            command += " '" + setting + "'";
        }
        std::atomic<bool> isOver{false};
        std::vector<std::string> lines;
        std::thread daemon([&] { receive(lines, isOver); });
        const auto result = runWithLog(command + " " + doubles::programPath() + " " + arguments);
        isOver = true;
        daemon.join();
        EXPECT_EQ(result.status, 0) << result.out;
        return lines;
    }

    void configureLevel(int level) const {
        std::ofstream(world.path("config/pallax/pallax.conf"))
            << "system-log-level = " << level << "\n";
    }

    static std::size_t count(const std::vector<std::string>& lines, const std::string& line) {
        return static_cast<std::size_t>(std::count(lines.begin(), lines.end(), line));
    }

private:
    /// Receives until the program has ended and nothing is left; the program blocks without a
    /// receiver.
    void receive(std::vector<std::string>& lines, const std::atomic<bool>& isOver) const {
        constexpr int kLook = 20; // milliseconds
        std::array<char, 65536> message{};
        for (;;) {
            const bool wasOver = isOver;
            pollfd waiting{socket.number(), POLLIN, 0};
            if (::poll(&waiting, 1, kLook) > 0) {
                const ssize_t size = ::recv(socket.number(), message.data(), message.size(), 0);
                lines.push_back(shortened({message.data(), static_cast<std::size_t>(size)}));
            } else if (wasOver) {
                return;
            }
        }
    }

    /// The message without time, process number and addresses.
    static std::string shortened(const std::string& message) {
        const auto* const head =
            R"(^(<[0-9]+>)[A-Z][a-z]{2} [ 0-9]{2} [0-9:]{8} pallax\[[0-9]+\]: )";
        return doubles::replaced(doubles::replaced(message, head, "$1"), "0x[0-9a-f]{6,}",
                                 "0xADDRESS");
    }

    Descriptor socket;
};

// A line's priority is its level plus 8, the facility of user programs.

TEST_F(EndToEndSyslog, GetsFailuresOnly) {
    EXPECT_EQ(linesOf("--print --speed max " + brief()),
              (std::vector<std::string>{
                  "<11> ***** Created ports (send=0xADDRESS, recv=0xADDRESS)",
                  "<11>Creating ZOR_GSMLogGenerator object",
                  "<11>Creating ZORLogGenerator2 object with 0xADDRESS",
                  "<11>Class Index: 1",
                  "<11>Got log generated: 0xADDRESS",
                  "<11>Starting the display update timer",
              }));
}

TEST_F(EndToEndSyslog, GetsMoreWhereTheSettingsSaySo) {
    configureLevel(4);
    const auto warnings = linesOf("--print --speed max " + brief());
    EXPECT_EQ(count(warnings, "<11>Starting the display update timer"), 1U);
    EXPECT_EQ(count(warnings, "<12>ZOR_GSMLogGenerator is destructed 0xADDRESS"), 2U);
    EXPECT_TRUE(std::all_of(warnings.begin(), warnings.end(), [](const std::string& line) {
        return line.starts_with("<11>") || line.starts_with("<12>");
    }));
    configureLevel(0);
    EXPECT_EQ(linesOf("--print --speed max " + brief()), std::vector<std::string>());
}

TEST_F(EndToEndSyslog, OfARecorderFollowsTheSettingsToo) {
    const doubles::PallaxProcess service(world, {"service", "--play", brief(), "--speed", "max"});
    ASSERT_TRUE(doubles::eventually([this] { return !world.sockets().empty(); }));
    const auto failures = linesOf("record " + world.path("a.pcapng"));
    EXPECT_EQ(count(failures, "<11>Starting the display update timer"), 1U);
    EXPECT_EQ(count(failures, "<12>ZOR_GSMLogGenerator is destructed 0xADDRESS"), 0U);
    configureLevel(7);
    const auto everything = linesOf("record " + world.path("b.pcapng"));
    EXPECT_EQ(count(everything, "<12>ZOR_GSMLogGenerator is destructed 0xADDRESS"), 2U);
}

} // namespace
} // namespace pallax
