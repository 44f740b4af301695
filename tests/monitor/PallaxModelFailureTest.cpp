#include "tests/doubles/ModelFixture.h"

namespace pallax {
namespace {

using namespace std::chrono_literals;
using doubles::FakeGenerator;

class PallaxModelFailureTest : public doubles::ModelFixture {
protected:
    static constexpr const char* kNoPorts = "Could not create the ports necessary";
    static constexpr const char* kNoGenerator = "No log generator technology works";

    bool asked(const std::string& what) const {
        return std::find(linkDiary.begin(), linkDiary.end(), what) != linkDiary.end();
    }
    /// Checks that both ports are closed and the next start follows 5 seconds later.
    void expectTeardownAndRetry() {
        EXPECT_EQ(ports.local(), nullptr);
        EXPECT_EQ(ports.remote(), nullptr);
        EXPECT_TRUE(retriesAfter5Seconds());
    }
};

TEST_F(PallaxModelFailureTest, ALocalPortThatCannotBeMadeFailsTheStart) {
    ports.failLocal = true;
    start();
    EXPECT_EQ(log.lines(), (Lines{{3, "Could not create local message port"}, {3, kNoPorts}}));
    EXPECT_FALSE(asked("connect"));
    expectTeardownAndRetry();
}

TEST_F(PallaxModelFailureTest, LocalPortNameAlreadyInUseFailsCreatePortsAndIsRetriedAfter5s) {
    ports.localExists = true;
    EXPECT_FALSE(model->createPorts());
    EXPECT_NE(ports.local(), nullptr); // the handle is stored anyway
    EXPECT_EQ(errors(), Diary{"Local messsage port already exists"});
    model->destroyPorts();
    start();
    EXPECT_EQ(log.lines(), (Lines{{3, "Local messsage port already exists"}, {3, kNoPorts}}));
    EXPECT_FALSE(asked("connect"));
    expectTeardownAndRetry();
}

TEST_F(PallaxModelFailureTest, ATelephonyServiceThatCannotBeReachedFailsTheStart) {
    telephony.reachable = false;
    start();
    EXPECT_EQ(log.lines(), (Lines{{3, "Could not create HXServerConnection"}, {3, kNoPorts}}));
    EXPECT_TRUE(asked("connect"));
    EXPECT_FALSE(asked("channel com.norvane.BasebandStateReport.LogChannel"));
    expectTeardownAndRetry();
}

TEST_F(PallaxModelFailureTest, AnErrorCodeOfTheLogChannelFailsTheStartAndReleasesTheConnection) {
    telephony.channel = {7, -536870212, "modem"};
    start();
    EXPECT_EQ(
        log.lines(),
        (Lines{{3, "_HXServerConnectionNetworkMonitorCreateLogChannel returns error: -536870212!"},
               {3, kNoPorts}}));
    EXPECT_TRUE(asked("release connection"));
    expectTeardownAndRetry();
}

TEST_F(PallaxModelFailureTest, AnErrorDomainAloneIsNoFailure) {
    telephony.channel.errorDomain = 7;
    EXPECT_TRUE(model->createPorts());
}

TEST_F(PallaxModelFailureTest, ALogChannelWithoutARemotePortNameFailsTheStart) {
    for (const auto& name : {std::optional<std::string>(), std::optional<std::string>("")}) {
        telephony.channel.remotePortName = name;
        start();
        EXPECT_EQ(errors(),
                  (Diary{"Could not create a log channel (HX returned null port)!", kNoPorts}));
        EXPECT_TRUE(asked("release connection"));
        EXPECT_EQ(ports.local(), nullptr);
        linkDiary.clear();
    }
    queue.advance(5s);
    EXPECT_EQ(starts(), 2U); // each failure is retried
}

TEST_F(PallaxModelFailureTest, ARemotePortThatCannotBeMadeFailsTheStart) {
    ports.failRemote = true;
    start();
    EXPECT_EQ(log.lines(), (Lines{{3, "Could not create the remote port!"}, {3, kNoPorts}}));
    expectTeardownAndRetry();
}

TEST_F(PallaxModelFailureTest, AQueryThatCannotBeSentIsLoggedWithItsError) {
    reply = {SendError::ReplyTimedOut, std::nullopt};
    start();
    EXPECT_EQ(errors().at(1), " ***** Could not send the GetTechnology command (got error=2)");
    expectTeardownAndRetry();
}

TEST_F(PallaxModelFailureTest, AnErrorWinsOverAReplyThatCameBackAnyway) {
    reply.error = SendError::SendTimedOut;
    start();
    EXPECT_EQ(errors().back(), kNoGenerator);
    EXPECT_TRUE(FakeGenerator::living.empty());
}

TEST_F(PallaxModelFailureTest, AQueryWithoutReplyDataIsLogged) {
    for (const auto& data :
         {std::optional<ByteBuffer>(), std::optional<ByteBuffer>(ByteBuffer{})}) {
        reply.reply = data;
        start();
        const Diary logged = errors();
        ASSERT_EQ(logged.size(), 3U);
        EXPECT_EQ(logged[1], " ***** No response to GetTechnology; cannot configure");
        EXPECT_EQ(logged[2], kNoGenerator);
    }
}

TEST_F(PallaxModelFailureTest, AReplyThatDoesNotParseIsLogged) {
    reply.reply = ByteBuffer{'<', 'p', 'l'};
    start();
    EXPECT_EQ(errors().at(1), " ***** Could not parse reply to GetTechnology; cannot configure");
    expectTeardownAndRetry();
}

TEST_F(PallaxModelFailureTest, ReplyWithoutTheGetTechnologyKeyLeavesTheGeneratorUnset) {
    reply.reply = xml(Dictionary{{"Technology", "Fake"}});
    start();
    const Diary logged = errors();
    ASSERT_EQ(logged.size(), 3U);
    EXPECT_EQ(logged[1], " ***** Reply to GetTechnology had no answer; cannot configure");
    EXPECT_EQ(logged[2], kNoGenerator);
    EXPECT_TRUE(FakeGenerator::living.empty());
    EXPECT_EQ(ports.requests.size(), 1U); // no start command
    expectTeardownAndRetry();
}

TEST_F(PallaxModelFailureTest, AReplyThatIsNoDictionaryHasNoAnswer) {
    for (const PropertyList& object : {PropertyList("Fake"), PropertyList(Array{"Fake"})}) {
        reply.reply = xml(object);
        start();
        EXPECT_EQ(errors().at(1), " ***** Reply to GetTechnology had no answer; cannot configure");
    }
}

TEST_F(PallaxModelFailureTest, AnUnknownTechnologyIsLoggedAsNilAndRetried) {
    reply = technology("Other");
    start();
    const Diary logged = errors();
    ASSERT_EQ(logged.size(), 3U);
    EXPECT_EQ(logged[1], "Got log generated: (nil)");
    EXPECT_EQ(logged[2], kNoGenerator);
    expectTeardownAndRetry();
}

TEST_F(PallaxModelFailureTest, ATechnologyThatIsNoStringIsUnknown) {
    reply = technology(PropertyList::integer(1));
    start();
    EXPECT_EQ(errors().at(1), "Got log generated: (nil)");
}

TEST_F(PallaxModelFailureTest, AnUnknownTechnologyOverwritesAnEarlierGenerator) {
    start();
    reply = technology("Other");
    model->restartMonitor();
    EXPECT_TRUE(FakeGenerator::living.empty());
    EXPECT_EQ(errors().back(), kNoGenerator);
    EXPECT_EQ(model->topLevelNodes(), nullptr);
}

TEST_F(PallaxModelFailureTest, AGeneratorOfAnEarlierAttemptStaysWhenALaterQueryFails) {
    start();
    const FakeGenerator* first = &generator();
    errors();
    reply = {SendError::InvalidPort, std::nullopt};
    model->restartMonitor();
    EXPECT_EQ(errors(), (Diary{createdPorts(),
                               " ***** Could not send the GetTechnology command (got error=3)",
                               "Starting the display update timer"}));
    EXPECT_EQ(&generator(), first);
    EXPECT_EQ(ports.requests.back().data, xml(Dictionary{{"Start", "Fake"}}));
}

TEST_F(PallaxModelFailureTest, AQueryThatCannotBeWrittenLeavesTheGeneratorUnset) {
    platform.serialize = [](const PropertyList&) -> Result<std::string, CodecError> {
        return CodecError{0, "nothing can be written today"};
    };
    model = std::make_unique<PallaxModel>(platform, observer);
    start();
    const Diary logged = errors();
    ASSERT_EQ(logged.size(), 3U);
    EXPECT_EQ(logged[1], " Could not generate GetTechnology command; cannot configure");
    EXPECT_EQ(logged[2], "No log generator technology works");
    EXPECT_TRUE(ports.requests.empty());
    expectTeardownAndRetry();
}

TEST_F(PallaxModelFailureTest, AStartCommandThatIsNoPropertyListFailsTheStart) {
    reply = technology("Mute");
    start();
    EXPECT_EQ(errors().back(), " Could not generate PLIST");
    EXPECT_EQ(ports.requests.size(), 1U);
    EXPECT_EQ(FakeGenerator::living.size(), 1U);
    expectTeardownAndRetry();
}

TEST_F(PallaxModelFailureTest, AStartCommandThatCannotBeSentIsLoggedWithItsErrorAndRetried) {
    startOutcome.error = SendError::TooLarge;
    start();
    EXPECT_EQ(errors().back(), " ***** Could not send the START command (got error=4)");
    expectTeardownAndRetry();
    model->updateWithData({});
    queue.advance(4s);
    EXPECT_EQ(observer.updates, 0); // no timer was started
}

TEST_F(PallaxModelFailureTest, WithoutARemotePortTheQueryCannotBeSent) {
    model->configureGenerator();
    EXPECT_EQ(log.lines(),
              (Lines{{3, " ***** Could not send the GetTechnology command (got error=3)"}}));
}

TEST_F(PallaxModelFailureTest, EveryFailureIsRetriedForever) {
    telephony.reachable = false;
    start();
    for (int retry = 0; retry < 10; ++retry) {
        EXPECT_TRUE(retriesAfter5Seconds());
    }
    telephony.reachable = true;
    errors();
    EXPECT_TRUE(retriesAfter5Seconds());
    EXPECT_EQ(errors().back(), "Starting the display update timer");
    queue.advance(60s);
    EXPECT_EQ(starts(), 12U);
}

TEST_F(PallaxModelFailureTest, APendingRetryAfterALaterSuccessDoesNothing) {
    telephony.reachable = false;
    start();
    telephony.reachable = true;
    queue.advance(1s);
    start();
    EXPECT_EQ(errors().back(), "Starting the display update timer");
    queue.advance(60s);
    EXPECT_EQ(starts(), 2U);
    EXPECT_TRUE(log.lines().empty());
}

} // namespace
} // namespace pallax
