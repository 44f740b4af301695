#include "host/AsioMainQueue.h"
#include "host/SocketMessagePorts.h"
#include "telephony/SocketTelephonyService.h"
#include "telephony/TelephonyServer.h"
#include "tests/cli/EndToEnd.h"

#include <csignal>
#include <cstdlib>
#include <fcntl.h>
#include <filesystem>
#include <sys/file.h>

namespace pallax {
namespace {

using doubles::eventually;
using doubles::PallaxProcess;
using std::chrono::milliseconds;

/// A service, viewers and recorders with a bad folder or an unfriendly peer of the same user.
class EndToEndUnfriendlyPeer : public EndToEnd {
protected:
    EndToEndUnfriendlyPeer() {
        for (int count = 0; count < 100; ++count) {
            packets.emplace_back(milliseconds(100) * count, registration(2));
        }
        recording = record("a.pcap", packets);
        service = {"service", "--play", recording, "--loop", "--speed", "10"};
    }

    static void end(PallaxProcess& process) {
        process.signal(SIGTERM);
        EXPECT_EQ(process.wait(), 0);
    }

    std::vector<Packet> packets;
    std::string recording;
    std::vector<std::string> service;
};

TEST_F(EndToEndUnfriendlyPeer, InAFolderWhosePathIsLongerThanASocketsEverythingWorks) {
    const std::string folder = world.path(std::string(250, 'x') + "/" + std::string(250, 'y'));
    std::filesystem::create_directories(folder);
    world.environment.push_back("XDG_RUNTIME_DIR=" + folder);
    PallaxProcess source(world, service);
    ASSERT_TRUE(eventually([&] {
        return std::filesystem::exists(folder + "/pallax/com.norvane.telephony");
    })) << source.err();
    PallaxProcess viewer(world, {"--print"});
    EXPECT_TRUE(viewer.says("  MM Service State: REG_STATE_REGISTERING\n"));
    PallaxProcess recorder(world, {"record", world.path("b.pcapng")});
    EXPECT_TRUE(eventually([this] {
        return run({"service", "--status"}).out.find("\nClients: 2\n") != std::string::npos;
    }));
    EXPECT_EQ(run({recording, "--print", "--speed", "max"}).status, 0) << "it has its own service";
    end(recorder);
    end(viewer);
    end(source);
    EXPECT_EQ(viewer.err(), "");
    EXPECT_TRUE(std::filesystem::is_empty(folder + "/pallax"));
}

TEST_F(EndToEndUnfriendlyPeer, APeerThatKeepsTheFoldersLockKeepsNobodyOut) {
    PallaxProcess killed(world, service);
    ASSERT_TRUE(eventually([this] { return !world.sockets().empty(); }));
    killed.signal(SIGKILL); // its socket remains
    EXPECT_EQ(killed.wait(), -SIGKILL);
    const Descriptor folder(::open(world.path("pallax").c_str(), O_RDONLY | O_CLOEXEC));
    ASSERT_EQ(::flock(folder.number(), LOCK_EX), 0);
    PallaxProcess source(world, service);
    ASSERT_TRUE(eventually([this] { return run({"service", "--status"}).status == 0; }));
    PallaxProcess viewer(world, {"--print"});
    EXPECT_TRUE(viewer.says("  MM Service State: REG_STATE_REGISTERING\n"));
    PallaxProcess second(world, {"--print"});
    EXPECT_TRUE(second.says("  MM Service State: REG_STATE_REGISTERING\n"));
    EXPECT_EQ(run({recording, "--print", "--speed", "max"}).status, 0);
    end(second);
    end(viewer);
    end(source);
    EXPECT_EQ(source.err(), "");
}

TEST_F(EndToEndUnfriendlyPeer, SixtyFourIdleChannelsKeepNobodyOut) {
    PallaxProcess source(world, service);
    ASSERT_TRUE(eventually([this] { return !world.sockets().empty(); }));
    ASSERT_EQ(::setenv("XDG_RUNTIME_DIR", world.path().c_str(), 1), 0);
    auto directory = SocketDirectory::open();
    (void)::unsetenv("XDG_RUNTIME_DIR");
    ASSERT_TRUE(directory);
    AsioMainQueue queue;
    SocketMessagePorts ports(queue, std::move(directory).value());
    const auto local = ports.createLocal("idler", [](std::int32_t, Bytes) { return std::nullopt; });
    local.port->setDispatchQueue(queue);
    SocketTelephonyService telephony(ports);
    const auto connection = telephony.connect({});
    ASSERT_NE(connection, nullptr);
    for (std::size_t count = 0; count < TelephonyServer::kMostChannels; ++count) {
        ASSERT_EQ(connection->HXServerConnectionNetworkMonitorCreateLogChannel("idler").errorCode,
                  0);
    }
    PallaxProcess viewer(world, {"--print"});
    EXPECT_TRUE(viewer.says("  MM Service State: REG_STATE_REGISTERING\n"));
    EXPECT_TRUE(source.says("pallax: idler never started its log channel, which is closed now.\n"));
    end(viewer);
    EXPECT_EQ(viewer.err(), "");
    end(source);
}

} // namespace
} // namespace pallax
