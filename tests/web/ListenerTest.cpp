#include "web/Listener.h"

#include "web/InternetAddress.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

TEST(Listener, TakesAFreePortOfThisMachineAlone) {
    const auto listener = Listener::at("127.0.0.1", 0);
    ASSERT_TRUE(listener) << listener.error().sentence;
    EXPECT_GT(listener->port, 0);
    EXPECT_TRUE(listener->isLoopback);
    EXPECT_TRUE(InternetAddress::ofSocket(listener->socket.number()).isLoopback());
}

TEST(Listener, OfAllAddressesIsNotOfThisMachineAlone) {
    const auto listener = Listener::at("0.0.0.0", 0);
    ASSERT_TRUE(listener) << listener.error().sentence;
    EXPECT_FALSE(listener->isLoopback);
}

TEST(Listener, APortThatIsTakenIsOneSentence) {
    const auto first = Listener::at("127.0.0.1", 0);
    ASSERT_TRUE(first);
    const auto second = Listener::at("127.0.0.1", first->port);
    ASSERT_FALSE(second);
    EXPECT_EQ(second.error().sentence, "Cannot listen on port " + std::to_string(first->port) +
                                           " of 127.0.0.1: Address already in use.");
}

TEST(Listener, ANameIsNoAddress) {
    for (const char* name : {"", "localhost", "127.0.0.1:80", "[::1]", "127.1", "evil.example"}) {
        const auto listener = Listener::at(name, 0);
        ASSERT_FALSE(listener) << name;
        EXPECT_EQ(listener.error().sentence,
                  std::string(name) + " is no address of the form 127.0.0.1 or ::1.");
    }
}

TEST(InternetAddress, KnowsThisMachine) {
    for (const char* own : {"127.0.0.1", "127.1.2.3", "::1"}) {
        EXPECT_TRUE(InternetAddress::parse(own, 1)->isLoopback()) << own;
    }
    for (const char* other : {"128.0.0.1", "0.0.0.0", "::", "fe80::1", "::ffff:10.0.0.1"}) {
        EXPECT_FALSE(InternetAddress::parse(other, 1)->isLoopback()) << other;
    }
}

} // namespace
} // namespace pallax
