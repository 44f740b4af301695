#include "tests/doubles/ModelFixture.h"

namespace pallax {
namespace {

using namespace std::chrono_literals;
using doubles::FakeGenerator;

class PallaxModelLifecycleTest : public doubles::ModelFixture {
protected:
    const Diary kTeardown = {"end timer",     "clear callback of local",  "invalidate local",
                             "release local", "clear callback of remote", "invalidate remote",
                             "release remote"};

    static std::string invalidated(const MessagePort* port) {
        return formatText(" ***** INVALIDATED %p *****", {static_cast<const void*>(port)});
    }
};

TEST_F(PallaxModelLifecycleTest, ATeardownEndsTimerThenLocalThenRemotePortEachCallbackFirst) {
    start();
    linkDiary.clear();
    model->destroyPorts();
    EXPECT_EQ(linkDiary, kTeardown);
    EXPECT_FALSE(model->isConnected());
}

TEST_F(PallaxModelLifecycleTest, TearingDownThroughDestroyPortsNeverCallsRestartMonitor) {
    start();
    log.take();
    model->destroyPorts();
    queue.advance(60s);
    EXPECT_EQ(starts(), 1U);
    EXPECT_TRUE(log.lines().empty());
}

TEST_F(PallaxModelLifecycleTest, InvalidationByThePeerAlwaysCallsRestartMonitor) {
    start();
    for (std::size_t restart = 1; restart <= 3; ++restart) {
        errors();
        const std::string ended = invalidated(ports.local());
        ports.endLocal();
        EXPECT_EQ(errors(), (Diary{ended, createdPorts(), gotGenerator(),
                                   "Starting the display update timer"}));
        EXPECT_EQ(starts(), 1 + restart);
        EXPECT_TRUE(model->isConnected());
    }
}

TEST_F(PallaxModelLifecycleTest, ARestartThatFailsIsRetriedToo) {
    start();
    telephony.reachable = false;
    ports.endLocal();
    EXPECT_EQ(errors().back(), "Could not create the ports necessary");
    EXPECT_FALSE(model->isConnected());
    telephony.reachable = true;
    EXPECT_TRUE(retriesAfter5Seconds());
    EXPECT_TRUE(model->isConnected());
}

TEST_F(PallaxModelLifecycleTest, ADestroyedTimerNoLongerRefreshes) {
    start();
    model->updateWithData({});
    model->destroyPorts();
    queue.advance(60s);
    EXPECT_EQ(observer.updates, 0);
}

TEST_F(PallaxModelLifecycleTest, ARefreshThatFindsTheSendPortGoneRestartsTheMonitor) {
    start();
    errors();
    const std::string ended = invalidated(ports.local());
    ports.endRemote();
    EXPECT_TRUE(log.lines().empty()); // the remote port has no invalidation callback
    queue.advance(2s);                // the timer is destroyed in its own action
    EXPECT_EQ(errors(),
              (Diary{ended, createdPorts(), gotGenerator(), "Starting the display update timer"}));
    EXPECT_EQ(starts(), 2U);
    EXPECT_TRUE(ports.remote()->isValid());
}

TEST_F(PallaxModelLifecycleTest, TheTimerOfTheRestartCountsItsOwn2Seconds) {
    start();
    queue.advance(1s);
    ports.endLocal();
    model->updateWithData({});
    queue.advance(2s - 1ns);
    EXPECT_EQ(observer.updates, 0);
    queue.advance(1ns);
    EXPECT_EQ(observer.updates, 1);
}

TEST_F(PallaxModelLifecycleTest, ARefreshWithoutPortsChecksNothing) {
    model->refresh();
    EXPECT_TRUE(log.lines().empty());
    EXPECT_EQ(linkDiary, Diary{});
}

TEST_F(PallaxModelLifecycleTest, ARefreshRestartsFirstAndThenReportsNewData) {
    start();
    model->updateWithData({});
    ports.endRemote();
    observer.onUpdate = [this] { EXPECT_EQ(starts(), 2U); };
    queue.advance(2s);
    EXPECT_EQ(observer.updates, 1);
}

TEST_F(PallaxModelLifecycleTest, MessageWithANonZeroIdentifierIsIgnoredAndDoesNotSetUpdated) {
    start();
    ports.deliver({1, 2}, 1);
    ports.deliver({3}, -1);
    queue.runReady();
    EXPECT_TRUE(generator().packets.empty());
    queue.advance(2s);
    EXPECT_EQ(observer.updates, 0);
    EXPECT_EQ(ports.replies(), (std::vector<std::optional<ByteBuffer>>{{}, {}}));
}

TEST_F(PallaxModelLifecycleTest, AMessageGoesToTheGeneratorOnTheMainQueueAndGetsNoReply) {
    start();
    ports.deliver({1, 2});
    ports.deliver({});
    EXPECT_TRUE(generator().packets.empty());
    queue.runReady();
    EXPECT_EQ(generator().packets, (std::vector<ByteBuffer>{{1, 2}, {}}));
    EXPECT_EQ(ports.replies(), (std::vector<std::optional<ByteBuffer>>{{}, {}}));
    queue.advance(2s);
    EXPECT_EQ(observer.updates, 1);
}

TEST_F(PallaxModelLifecycleTest, AMessageOfTheOldLinkIsDroppedAfterItsTeardown) {
    start();
    ports.deliver({1});
    model->destroyPorts();
    queue.advance(60s);
    EXPECT_TRUE(generator().packets.empty());
}

TEST_F(PallaxModelLifecycleTest, ARecordsExceptionLeavesThroughTheQueueAndSetsNothing) {
    start();
    generator().refusePackets = true;
    ports.deliver({1});
    EXPECT_THROW(queue.runReady(), std::runtime_error);
    queue.advance(2s);
    EXPECT_EQ(observer.updates, 0);
    generator().refusePackets = false;
    ports.deliver({2});
    queue.advance(2s);
    EXPECT_EQ(generator().packets, (std::vector<ByteBuffer>{{2}}));
    EXPECT_EQ(observer.updates, 1);
}

TEST_F(PallaxModelLifecycleTest, TheObserverIsToldOfEachGeneratorAndOfADisplayThatItKeeps) {
    using Told = std::vector<std::string>;
    start();
    EXPECT_EQ(observer.generators, Told{"Fake"});
    ports.endLocal();
    EXPECT_EQ(observer.generators, (Told{"Fake", "Fake"})) << "there was no display";
    generator().display = Dictionary{{"SIM", "1"}};
    (void)model->topLevelNodes();
    ports.endLocal();
    EXPECT_EQ(observer.generators, (Told{"Fake", "Fake", "Fake, keeps the display"}));
    reply = technology("Unknown");
    ports.endLocal();
    EXPECT_EQ(observer.generators.size(), 3U) << "no generator was made";
    reply = {SendError::ReplyTimedOut, std::nullopt};
    queue.advance(PallaxModel::kRetryDelay);
    EXPECT_EQ(observer.generators.size(), 3U);
}

TEST_F(PallaxModelLifecycleTest, TheStateSurvivesRestarts) {
    start();
    generator().display = Dictionary{{"Serving", "1"}};
    ASSERT_NE(model->topLevelNodes(), nullptr);
    ports.endLocal(); // the new generator uses the same state
    model->updateWithData({});
    model->refresh();
    ASSERT_NE(model->nodeAtPath("/Serving"), nullptr);
    EXPECT_EQ(model->nodeAtPath("/Serving")->value()->string(), "1");
    EXPECT_EQ(generator().displaysMade, 1);
}

TEST_F(PallaxModelLifecycleTest, TheEndOfTheModelTearsEverythingDownWithoutARestart) {
    start();
    linkDiary.clear();
    log.take();
    model.reset();
    EXPECT_EQ(linkDiary, kTeardown);
    EXPECT_TRUE(FakeGenerator::living.empty());
    EXPECT_TRUE(log.lines().empty());
}

TEST_F(PallaxModelLifecycleTest, AfterTheModelsEndAPendingRetryDoesNothing) {
    telephony.reachable = false;
    start();
    model.reset();
    queue.advance(60s);
    EXPECT_EQ(starts(), 1U);
}

TEST_F(PallaxModelLifecycleTest, AfterTheModelsEndAQueuedViewUpdateDoesNothing) {
    start();
    model->updateWithData({});
    model->refresh();
    model.reset();
    queue.advance(60s);
    EXPECT_EQ(observer.updates, 0);
}

TEST_F(PallaxModelLifecycleTest, TheModelMayEndInsideAViewUpdate) {
    start();
    model->updateWithData({});
    observer.onUpdate = [this] { model.reset(); };
    queue.advance(60s);
    EXPECT_EQ(observer.updates, 1);
    EXPECT_EQ(ports.local(), nullptr);
}

} // namespace
} // namespace pallax
