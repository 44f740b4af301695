#include "host/SocketMessagePorts.h"

#include "tests/doubles/PortPair.h"

#include <filesystem>

namespace pallax {
namespace {

using doubles::PortTest;
using doubles::runUntil;
using namespace std::chrono_literals;

class SocketMessagePortsTest : public PortTest {
protected:
    /// A living port.
    std::unique_ptr<LocalMessagePort> open(SocketMessagePorts& ports, std::string_view name) {
        auto local = ports.createLocal(name, [this](std::int32_t, Bytes data) {
            _received.emplace_back(data.begin(), data.end());
            return std::nullopt;
        });
        if (local.port == nullptr || local.alreadyExisted) {
            return nullptr;
        }
        local.port->setDispatchQueue(_queue);
        return std::move(local.port);
    }
    /// Whether a message arrives at the other end.
    bool carries(SocketMessagePorts& ports, std::string_view name) {
        const auto remote = ports.createRemote(name);
        const std::size_t before = _received.size();
        return remote != nullptr &&
               remote->sendRequest({0, bytesOf("hello"), 1s, 0s, false}).error == SendError::None &&
               runUntil(_queue, [&] { return _received.size() > before; });
    }

    std::vector<std::string> _received;
};

TEST_F(SocketMessagePortsTest, WorkInAFolderWhosePathIsTooLongForASocket) {
    const std::string folder = _folder.file(std::string(250, 'x'));
    std::filesystem::create_directory(folder);
    ASSERT_EQ(::setenv("XDG_RUNTIME_DIR", folder.c_str(), 1), 0);
    SocketMessagePorts ports(_queue, doubles::openDirectory());
    const auto local = open(ports, "a.port");
    ASSERT_NE(local, nullptr) << ports.lastError();
    EXPECT_TRUE(carries(ports, "a.port"));
    EXPECT_TRUE(ports.createLocal("a.port", {}).alreadyExisted);
    EXPECT_EQ(_folder.socketCount(), 1U);
    local->invalidate();
    EXPECT_EQ(_folder.socketCount(), 0U);
}

TEST_F(SocketMessagePortsTest, APeerThatKeepsTheLockKeepsNobodyOut) {
    (void)listenAt(socketPath("stale")); // closed at once, but the file remains
    const Descriptor kept = _ports.directory().lock();
    ASSERT_TRUE(kept);
    const auto fresh = open(_ports, "fresh");
    ASSERT_NE(fresh, nullptr) << _ports.lastError();
    EXPECT_TRUE(carries(_ports, "fresh"));
    const auto again = open(_ports, "stale");
    ASSERT_NE(again, nullptr) << _ports.lastError();
    EXPECT_TRUE(carries(_ports, "stale"));
    EXPECT_TRUE(_ports.createLocal("fresh", {}).alreadyExisted);
    EXPECT_EQ(_folder.socketCount(), 2U) << "no moved socket remains";
    again->invalidate();
    fresh->invalidate();
    EXPECT_EQ(_folder.socketCount(), 0U);
}

TEST_F(SocketMessagePortsTest, ANameIsTakenAlsoByAPortThatTakesNoConnectionNow) {
    EXPECT_FALSE(_ports.isTaken("port"));
    Descriptor listener = listenAt(socketPath("port")); // accepts nothing
    std::vector<std::unique_ptr<RemoteMessagePort>> waiting;
    do { // until no further connection can wait
        waiting.push_back(_ports.createRemote("port"));
    } while (waiting.back() != nullptr);
    EXPECT_TRUE(_ports.isTaken("port"));
    listener.reset();
    EXPECT_FALSE(_ports.isTaken("port"));
}

} // namespace
} // namespace pallax
