#include "tests/doubles/ModelFixture.h"

namespace pallax {
namespace {

using namespace std::chrono_literals;
using doubles::FakeGenerator;

class PallaxModelStartTest : public doubles::ModelFixture {};

TEST_F(PallaxModelStartTest, NothingStartsWithTheModelItself) {
    queue.advance(60s);
    EXPECT_EQ(linkDiary, Diary{});
    EXPECT_TRUE(log.lines().empty());
    EXPECT_FALSE(model->isConnected());
}

TEST_F(PallaxModelStartTest, AStartMakesPortsChannelAndGeneratorInThisOrder) {
    start();
    EXPECT_EQ(linkDiary, (Diary{"local com.norvane.BasebandStateReport.LogChannel",
                                "set queue of local", "set callback of local", "connect",
                                "channel com.norvane.BasebandStateReport.LogChannel",
                                "release connection", "remote modem", "start timer"}));
    EXPECT_TRUE(model->isConnected());
}

TEST_F(PallaxModelStartTest, AStartLogsEveryStepAtLevel3) {
    start();
    const auto* object = static_cast<const void*>(&generator());
    EXPECT_EQ(log.lines(), (Lines{{3, createdPorts()},
                                  {4, formatText("Creating Log object: %p", {object})},
                                  {3, gotGenerator()},
                                  {3, "Starting the display update timer"}}));
}

TEST_F(PallaxModelStartTest, TheTechnologyQueryIsMessage0WithOneSecondToSendAndToReply) {
    start();
    ASSERT_EQ(ports.requests.size(), 2U);
    const auto& [request, data] = ports.requests[kQuery];
    EXPECT_EQ(request.identifier, 0);
    EXPECT_EQ(request.sendTimeout, 1s);
    EXPECT_EQ(request.replyTimeout, 1s);
    EXPECT_TRUE(request.awaitReply);
    EXPECT_EQ(data, xml(Dictionary{{"GetTechnology", "GetTechnology"}}));
    EXPECT_EQ(std::string(data.begin(), data.begin() + 5), "<?xml");
}

TEST_F(PallaxModelStartTest, TheStartCommandIsMessage0WithOneSecondToSendAndNoReply) {
    start();
    ASSERT_EQ(ports.requests.size(), 2U);
    const auto& [request, data] = ports.requests[kStart];
    EXPECT_EQ(request.identifier, 0);
    EXPECT_EQ(request.sendTimeout, 1s);
    EXPECT_EQ(request.replyTimeout, 0s);
    EXPECT_FALSE(request.awaitReply);
    EXPECT_EQ(data, xml(Dictionary{{"Start", "Fake"}}));
}

TEST_F(PallaxModelStartTest, ASecondStartMonitorWhileTheTimerRunsDoesNothing) {
    start();
    log.take();
    start();
    EXPECT_TRUE(log.lines().empty());
    EXPECT_EQ(starts(), 1U);
    EXPECT_EQ(ports.requests.size(), 2U);
}

TEST_F(PallaxModelStartTest, TheDisplayTimerRepeatsEvery2Seconds) {
    start();
    for (int tick = 1; tick <= 3; ++tick) {
        model->updateWithData({});
        queue.advance(2s - 1ns);
        EXPECT_EQ(observer.updates, tick - 1);
        queue.advance(1ns);
        EXPECT_EQ(observer.updates, tick);
    }
}

TEST_F(PallaxModelStartTest, TheReplyMayBeOfAnyFormThatTheServiceSends) {
    const std::string text = "{ GetTechnology = Fake; }";
    reply.reply = ByteBuffer(text.begin(), text.end());
    start();
    EXPECT_EQ(errors().back(), "Starting the display update timer");

    reply.reply = *serializeBinary(Dictionary{{"GetTechnology", "Fake"}});
    model->restartMonitor();
    EXPECT_EQ(errors().back(), "Starting the display update timer");
    EXPECT_EQ(ports.requests.size(), 4U);
}

TEST_F(PallaxModelStartTest, ARestartTakesANewGeneratorAndLetsTheOldOneGo) {
    start();
    const FakeGenerator* first = &generator();
    model->restartMonitor();
    EXPECT_NE(&generator(), first); // made while the old one still existed
    EXPECT_EQ(FakeGenerator::living.size(), 1U);
    EXPECT_EQ(errors().at(4), gotGenerator());
}

TEST_F(PallaxModelStartTest, ARestartWhileRunningStartsExactlyOneTimer) {
    start();
    model->restartMonitor();
    model->updateWithData({});
    queue.advance(2s);
    EXPECT_EQ(observer.updates, 1);
    EXPECT_EQ(starts(), 2U);
}

TEST_F(PallaxModelStartTest, ConnectedMeansThatBothPortsAreSet) {
    EXPECT_FALSE(model->isConnected());
    ASSERT_TRUE(model->createPorts());
    EXPECT_TRUE(model->isConnected());
    model->destroyPorts();
    EXPECT_FALSE(model->isConnected());
    ports.failRemote = true;
    EXPECT_FALSE(model->createPorts());
    EXPECT_FALSE(model->isConnected()); // only the local port exists
    EXPECT_NE(ports.local(), nullptr);
}

TEST_F(PallaxModelStartTest, ANotificationOfTheTelephonyConnectionRefreshes) {
    model->updateWithData({});
    telephony.duringChannel = [this] { EXPECT_TRUE(telephony.notify()); };
    EXPECT_TRUE(model->createPorts());
    EXPECT_EQ(observer.updates, 0);
    queue.runReady();
    EXPECT_EQ(observer.updates, 1);
    EXPECT_FALSE(telephony.notify()); // the connection has been released
}

} // namespace
} // namespace pallax
