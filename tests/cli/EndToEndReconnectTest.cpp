#include "tests/cli/EndToEnd.h"
#include "tests/doubles/Pattern.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <csignal>
#include <filesystem>
#include <fstream>
#include <sstream>

namespace pallax {
namespace {

using doubles::eventually;
using doubles::PallaxProcess;
using std::chrono::milliseconds;
using std::chrono::steady_clock;

/// Real processes during the 5 seconds between two attempts to connect.
class EndToEndReconnect : public EndToEnd {
protected:
    /// The retry delay, less the time it may take to see the line from which it is measured, and
    /// plus the delays of a busy machine.
    static constexpr milliseconds kLeastDelay{4700};
    static constexpr milliseconds kMostDelay{5900};

    static constexpr const char* kStarted = "<3>Starting the display update timer\n";
    static constexpr const char* kNoPorts = "<3>Could not create the ports necessary\n";

    /// The arguments of a service that plays one registration state in a loop.
    std::vector<std::string> serviceOf(const std::string& name, unsigned state) const {
        std::vector<Packet> packets;
        for (int count = 0; count < 100; ++count) {
            packets.emplace_back(milliseconds(100) * count, registration(state));
        }
        return {"service", "--play", record(name, packets), "--loop", "--speed", "10"};
    }

    /// The time at which the viewer's log has the line `count` times.
    static steady_clock::time_point seen(const PallaxProcess& viewer, const std::string& line,
                                         int count = 1) {
        EXPECT_TRUE(eventually([&] { return occurrences(viewer.err(), line) >= count; }))
            << line << viewer.err();
        return steady_clock::now();
    }

    static int occurrences(const std::string& text, const std::string& part) {
        int count = 0;
        for (auto at = text.find(part); at != std::string::npos; at = text.find(part, at + 1)) {
            ++count;
        }
        return count;
    }

    static void end(PallaxProcess& process) {
        process.signal(SIGTERM);
        EXPECT_EQ(process.wait(), 0);
    }
};

/// The lines of a log from the first with `text` on, without addresses.
std::vector<std::string> linesFrom(const std::string& log, const std::string& text) {
    std::vector<std::string> lines;
    std::istringstream stream(log);
    for (std::string line; std::getline(stream, line);) {
        if (!lines.empty() || line.find(text) != std::string::npos) {
            lines.push_back(doubles::replaced(line, "0x[0-9a-f]+", "0xADDRESS"));
        }
    }
    return lines;
}

/// The time of the last printed block.
std::string lastTick(const std::string& printed) {
    const std::size_t at = printed.rfind("== ") + 3;
    return printed.substr(at, printed.find('\n', at) - at);
}

TEST_F(EndToEndReconnect, AfterAKilledServiceTheViewerTriesAgain5SecondsLaterAndItsDisplayStays) {
    PallaxProcess service(world, serviceOf("first.pcap", 2));
    EXPECT_TRUE(eventually([this] { return !world.sockets().empty(); }));
    PallaxProcess viewer(world, {"--log-level", "3"});
    EXPECT_TRUE(viewer.says("  MM Service State: REG_STATE_REGISTERING\n"));
    service.signal(SIGKILL);
    EXPECT_EQ(service.wait(), -SIGKILL);

    const auto failed = seen(viewer, kNoPorts);
    EXPECT_TRUE(viewer.says("Connecting...\n"));
    const std::string before = viewer.out();
    PallaxProcess again(world, serviceOf("second.pcap", 0));
    const auto started = seen(viewer, kStarted, 2);
    EXPECT_GE(started - failed, kLeastDelay);
    EXPECT_LE(started - failed, kMostDelay) << "it reconnects 5 s after the service's return";
    EXPECT_EQ(linesFrom(viewer.err(), "INVALIDATED"),
              (std::vector<std::string>{
                  "<3> ***** INVALIDATED 0xADDRESS *****", "<3>Could not create HXServerConnection",
                  "<3>Could not create the ports necessary",
                  "pallax: No telephony service is running; waiting.",
                  "<3> ***** Created ports (send=0xADDRESS, recv=0xADDRESS)",
                  "<3>Creating ZOR_GSMLogGenerator object",
                  "<3>Creating ZORLogGenerator2 object with 0xADDRESS", "<3>Class Index: 1",
                  "<3>Got log generated: 0xADDRESS",
                  "pallax: The link was restarted: values from before " + lastTick(before) +
                      " stay on display (after-reconnect = fresh in pallax.conf starts afresh).",
                  "<3>Starting the display update timer"}));

    // First nothing is shown, then the display with the values of the first service.
    EXPECT_TRUE(eventually([&] {
        return occurrences(viewer.out(), "\nSIM Info\n") > occurrences(before, "\nSIM Info\n");
    }));
    const std::string since = viewer.out().substr(before.size());
    EXPECT_TRUE(before.ends_with("\nConnecting...\n")) << before;
    EXPECT_TRUE(since.starts_with("Deallocing ZOR_GSMClassIndex\nDeallocing ClassIndex\n== "))
        << since;
    EXPECT_NE(since.find("\n  MM Service State: REG_STATE_REGISTERING\n"), std::string::npos)
        << since;
    EXPECT_EQ(since.find("INACTIVE"), std::string::npos) << since;
    EXPECT_EQ(since.find('*'), std::string::npos) << "nothing has changed\n" << since;
    end(viewer);
    end(again);
}

TEST_F(EndToEndReconnect, WithTheSettingTheDisplayStartsAfreshAfterAReconnect) {
    std::filesystem::create_directories(world.path("config/pallax"));
    std::ofstream(world.path("config/pallax/pallax.conf")) << "after-reconnect = fresh\n";
    PallaxProcess service(world, serviceOf("first.pcap", 2));
    EXPECT_TRUE(eventually([this] { return !world.sockets().empty(); }));
    PallaxProcess viewer(world, {"--print"});
    EXPECT_TRUE(viewer.says("  MM Service State: REG_STATE_REGISTERING\n"));
    end(service);
    EXPECT_TRUE(viewer.says("Connecting...\n"));
    PallaxProcess again(world, serviceOf("second.pcap", 0));
    EXPECT_TRUE(viewer.says("  MM Service State: REG_STATE_INACTIVE\n"));
    EXPECT_EQ(viewer.err(), "pallax: No telephony service is running; waiting.\n"
                            "pallax: The link was restarted: the display starts afresh.\n");
    EXPECT_EQ(viewer.out().find('*'), std::string::npos) << "its first block marks no changes";
    end(viewer);
    end(again);
}

} // namespace
} // namespace pallax
