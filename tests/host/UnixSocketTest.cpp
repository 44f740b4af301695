#include "host/UnixSocket.h"

#include "tests/doubles/Files.h"

#include <gtest/gtest.h>

#include <array>
#include <cerrno>
#include <filesystem>

namespace pallax {
namespace {

/// A folder whose path alone is longer than a socket address.
class UnixSocketTest : public testing::Test {
protected:
    UnixSocketTest() { std::filesystem::create_directories(folder); }

    doubles::TemporaryFolder temporary;
    std::string folder = temporary.path(std::string(200, 'a') + "/" + std::string(200, 'b'));
};

TEST_F(UnixSocketTest, APathOfAnyLengthIsListenedAtAndConnectedTo) {
    const std::string path = folder + "/port";
    EXPECT_EQ(listenerAt(path), Listener::None);
    Descriptor listener = listenAt(path);
    ASSERT_TRUE(listener);
    EXPECT_TRUE(std::filesystem::is_socket(path));
    EXPECT_EQ(listenerAt(path), Listener::Living);
    (void)acceptFrom(listener); // the probe's connection
    const Descriptor near = connectTo(path);
    ASSERT_TRUE(near);
    const Descriptor far = acceptFrom(listener);
    ASSERT_TRUE(far);
    EXPECT_EQ(sendTo(near, ByteBuffer{'h', 'i'}).count, 2U);
    std::array<std::uint8_t, 8> received{};
    EXPECT_EQ(receiveFrom(far, received).count, 2U);
    listener.reset();
    EXPECT_EQ(listenerAt(path), Listener::Stale);
    EXPECT_FALSE(connectTo(path));
}

TEST_F(UnixSocketTest, TheLongestNameHasRoomInAnyFolder) {
    EXPECT_TRUE(listenAt(folder + "/" + std::string(longestSocketName(), 'n')));
    EXPECT_FALSE(listenAt(folder + "/" + std::string(longestSocketName() + 20, 'n')));
    EXPECT_EQ(errno, ENAMETOOLONG);
}

TEST_F(UnixSocketTest, ALongPathWithoutItsFolderIsNone) {
    const std::string path = folder + "/missing/port";
    EXPECT_EQ(listenerAt(path), Listener::None);
    EXPECT_FALSE(connectTo(path));
    EXPECT_FALSE(listenAt(path));
    EXPECT_EQ(errno, ENOENT);
    EXPECT_FALSE(listenAt(std::string(200, 'n')));
    EXPECT_EQ(errno, ENAMETOOLONG);
}

} // namespace
} // namespace pallax
