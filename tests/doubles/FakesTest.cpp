#include "tests/doubles/FakeBundle.h"
#include "tests/doubles/FakeFileSystem.h"
#include "tests/doubles/FakePorts.h"
#include "tests/doubles/FakePreferences.h"
#include "tests/doubles/FakeResources.h"
#include "tests/doubles/FakeTelephony.h"
#include "tests/doubles/ManualClock.h"
#include "tests/doubles/SteppedQueue.h"

#include <gtest/gtest.h>

namespace pallax::doubles {
namespace {

using Diary = std::vector<std::string>;

TEST(ManualClock, StandsUntilItIsMoved) {
    ManualClock clock;
    EXPECT_EQ(dateText(dateOf(clock.now())), "2023-11-14 22:13:20 +0000");
    clock.advance(std::chrono::seconds(2));
    EXPECT_EQ(dateText(dateOf(clock.now())), "2023-11-14 22:13:22 +0000");
    clock.setZone({std::chrono::hours(2), true});
    EXPECT_EQ(clock.zone(clock.now()).offset, std::chrono::hours(2));
    EXPECT_TRUE(clock.zone(clock.now()).daylightSaving);
}

class FakePortsTest : public testing::Test {
protected:
    MessagePorts::Local makeLocal() {
        return ports.createLocal("name", [this](std::int32_t identifier, Bytes data) {
            received.emplace_back(identifier, ByteBuffer(data.begin(), data.end()));
            return std::optional(ByteBuffer{9});
        });
    }

    FakePorts ports;
    SteppedQueue queue;
    std::vector<std::pair<std::int32_t, ByteBuffer>> received;
};

TEST_F(FakePortsTest, DeliversOnTheQueueOfALivingValidPortOnly) {
    ports.deliver({1});
    auto local = makeLocal();
    ports.deliver({2}); // before the port has its queue
    local.port->setDispatchQueue(queue);
    ports.deliver({3}, 7);
    EXPECT_TRUE(received.empty());
    queue.runReady();
    EXPECT_EQ(received, (std::vector<std::pair<std::int32_t, ByteBuffer>>{{7, {3}}}));
    EXPECT_EQ(ports.replies(), (std::vector<std::optional<ByteBuffer>>{ByteBuffer{9}}));
    ports.deliver({4});
    local.port->invalidate();
    queue.runReady();
    EXPECT_EQ(received.size(), 1U);
}

TEST_F(FakePortsTest, APortEndsOnceAndMayBeDestroyedInsideItsCallback) {
    auto local = makeLocal();
    int ended = 0;
    local.port->setInvalidationCallback([&](MessagePort& port) {
        EXPECT_FALSE(port.isValid());
        ++ended;
    });
    ports.endLocal();
    local.port->invalidate();
    EXPECT_EQ(ended, 1);

    auto remote = ports.createRemote("modem");
    remote->setInvalidationCallback([&](MessagePort& /*port*/) { remote.reset(); });
    ports.endRemote();
    EXPECT_EQ(remote, nullptr);
    EXPECT_EQ(ports.remote(), nullptr);
}

TEST_F(FakePortsTest, AnswersAreScriptedAndRequestsKept) {
    const auto remote = ports.createRemote("modem");
    const ByteBuffer data{1, 2};
    EXPECT_EQ(remote->sendRequest({.data = data}).error, SendError::None);
    ports.answer = [](const RemoteMessagePort::Request& /*request*/) {
        return RemoteMessagePort::Outcome{SendError::ReplyTimedOut, std::nullopt};
    };
    EXPECT_EQ(remote->sendRequest({.data = data}).error, SendError::ReplyTimedOut);
    ports.endRemote();
    EXPECT_EQ(remote->sendRequest({.data = data}).error, SendError::InvalidPort);
    ASSERT_EQ(ports.requests.size(), 3U);
    EXPECT_EQ(ports.requests.back().data, data);
}

TEST_F(FakePortsTest, FailsOnDemand) {
    ports.failRemote = true;
    EXPECT_EQ(ports.createRemote("modem"), nullptr);
    ports.localExists = true;
    const auto local = makeLocal();
    EXPECT_TRUE(local.alreadyExisted);
    EXPECT_FALSE(local.port->isValid());
    ports.failLocal = true;
    EXPECT_EQ(makeLocal().port, nullptr);
}

TEST(FakeTelephony, NotifiesWhileTheConnectionLives) {
    FakeTelephony telephony;
    int notices = 0;
    auto connection = telephony.connect([&] { ++notices; });
    EXPECT_TRUE(telephony.notify());
    const auto channel = connection->HXServerConnectionNetworkMonitorCreateLogChannel("local");
    EXPECT_EQ(channel.remotePortName, "modem");
    connection.reset();
    EXPECT_FALSE(telephony.notify());
    EXPECT_EQ(notices, 1);
    EXPECT_EQ(telephony.diary, (Diary{"connect", "channel local", "release connection"}));
    telephony.reachable = false;
    EXPECT_EQ(telephony.connect({}), nullptr);
}

TEST(FakeResources, GivesWhatWasAdded) {
    FakeResources resources;
    resources.add("LTE", Dictionary{{"a", "b"}});
    resources.add("C2KTemplate", Array{});
    EXPECT_EQ(resources.propertyList("LTE"), PropertyList(Dictionary{{"a", "b"}}));
    EXPECT_EQ(resources.propertyList("lte"), std::nullopt);
    EXPECT_EQ(resources.propertyListPaths(),
              (Diary{"resources/C2KTemplate.plist", "resources/LTE.plist"}));
}

TEST(FakeBundle, SaysWhatItIsTold) {
    FakeBundle bundle;
    bundle.bundleVersion = std::nullopt;
    bundle.builtAt = "Jan  1 2024 00:00:00";
    EXPECT_EQ(bundle.version(), std::nullopt);
    EXPECT_EQ(bundle.buildDate(), "Jan  1 2024 00:00:00");
}

TEST(FakePreferences, KeepsValuesByDomainAndTheOrderOfCalls) {
    FakePreferences preferences;
    preferences.setValue("key", PropertyList::boolean(false), "domain");
    EXPECT_TRUE(preferences.synchronize("domain"));
    preferences.failSynchronize = true;
    EXPECT_FALSE(preferences.synchronize("domain"));
    preferences.postChangedNotice("domain", "key");
    EXPECT_EQ(preferences.diary, (Diary{"set domain key", "synchronize domain",
                                        "synchronize domain", "post domain key"}));
    EXPECT_EQ(*preferences.domain("domain").find("key"), PropertyList::boolean(false));
    EXPECT_TRUE(preferences.domain("other").empty());
}

TEST(FakeFileSystem, KeepsWhatIsWrittenUnlessItIsToFail) {
    FakeFileSystem files;
    files.present.insert("/marker");
    EXPECT_TRUE(files.exists("/marker"));
    EXPECT_TRUE(files.writePropertyList("/file", "x"));
    EXPECT_TRUE(files.exists("/file"));
    files.failWrite = true;
    EXPECT_FALSE(files.writePropertyList("/other", "x"));
    EXPECT_FALSE(files.exists("/other"));
}

} // namespace
} // namespace pallax::doubles
