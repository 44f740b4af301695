#include "monitor/ModemLink.h"

#include "tests/doubles/ModelFixture.h"

namespace pallax {
namespace {

using namespace std::chrono_literals;
using doubles::FakeGenerator;

/// A link without a model. The calls of its client appear among the log lines.
class ModemLinkTest : public doubles::ModelFixture, public ModemLinkClient {
protected:
    ModemLinkTest() { model.reset(); }

    bool wantsTechnology(const PropertyList& technology) override {
        answers.push_back(technology.description());
        return wants;
    }
    void setGenerator(std::unique_ptr<LogGenerator> generator) override {
        made = std::move(generator);
        generators.push_back(made != nullptr ? "generator" : "none");
        linesBefore = log.lines().size();
    }
    const LogGenerator* generator() const override { return made.get(); }
    void generatorChosen(const std::string& technology) override {
        generators.push_back(technology);
    }
    void packetArrived(Bytes packet) override {
        packets.emplace_back(packet.begin(), packet.end());
    }
    void displayTick() override { ++ticks; }

    using Texts = std::vector<std::string>;
    static ByteBuffer bytesOf(std::string_view text) { return {text.begin(), text.end()}; }

    bool wants = true;
    Texts answers;
    Texts generators;
    Texts packets;
    int ticks = 0;
    std::size_t linesBefore = 0; ///< log lines when the generator was set
    std::unique_ptr<LogGenerator> made;
    std::unique_ptr<ModemLink> link = std::make_unique<ModemLink>(platform, *this);
};

TEST_F(ModemLinkTest, PacketsGoToTheClientAndOtherMessagesDoNot) {
    link->startMonitor();
    ports.deliver(bytesOf("one"));
    ports.deliver({});
    ports.deliver(bytesOf("no packet"), 1);
    queue.runReady();
    EXPECT_EQ(packets, (Texts{"one", ""}));
    EXPECT_EQ(ports.replies(), (std::vector<std::optional<ByteBuffer>>(3, std::nullopt)));
}

TEST_F(ModemLinkTest, TheClientGetsTheGeneratorThenTheLineIsLoggedThenItHearsOfTheTechnology) {
    link->startMonitor();
    EXPECT_EQ(answers, Texts{"Fake"});
    EXPECT_EQ(generators, (Texts{"generator", "Fake"}));
    const Lines lines = log.take();
    ASSERT_LT(linesBefore, lines.size());
    EXPECT_EQ(lines[linesBefore],
              (doubles::RecordingLog::Line{
                  3, formatText("Got log generated: %p", {static_cast<const void*>(made.get())})}));
    EXPECT_EQ(ports.requests.at(kStart).data, xml(Dictionary{{"Start", "Fake"}}));
}

TEST_F(ModemLinkTest, AnUnknownTechnologyTakesTheClientsGeneratorAway) {
    link->startMonitor();
    reply = technology("Unknown");
    link->restartMonitor();
    EXPECT_EQ(generators, (Texts{"generator", "Fake", "none"}));
    EXPECT_EQ(errors().back(), "No log generator technology works");
    EXPECT_FALSE(link->isConnected());
}

TEST_F(ModemLinkTest, AnUnwantedTechnologyCountsAsNoResponse) {
    wants = false;
    link->startMonitor();
    const Diary logged = errors();
    ASSERT_EQ(logged.size(), 3U);
    EXPECT_EQ(logged[1], " ***** No response to GetTechnology; cannot configure");
    EXPECT_EQ(logged[2], "No log generator technology works");
    EXPECT_EQ(generators, Texts{});
    EXPECT_EQ(ports.requests.size(), 1U) << "no start command";
    EXPECT_FALSE(link->isConnected());
}

TEST_F(ModemLinkTest, AnUnwantedTechnologyLeavesTheGeneratorOfAnEarlierStart) {
    link->startMonitor();
    const LogGenerator* first = made.get();
    wants = false;
    link->restartMonitor();
    EXPECT_EQ(errors().back(), "Starting the display update timer");
    EXPECT_EQ(made.get(), first);
    EXPECT_EQ(generators.size(), 2U);
}

TEST_F(ModemLinkTest, TheClientIsAskedOnlyOfATechnologyThatWasAnswered) {
    for (const Outcome& outcome :
         {Outcome{SendError::ReplyTimedOut, xml("Fake")}, Outcome{SendError::None, std::nullopt},
          Outcome{SendError::None, bytesOf("{ Technology = Fake; }")}}) {
        reply = outcome;
        link->startMonitor();
    }
    EXPECT_EQ(answers, Texts{});
}

TEST_F(ModemLinkTest, ItTicksEvery2SecondsWhetherPacketsArriveOrNot) {
    link->startMonitor();
    queue.advance(2s - 1ns);
    EXPECT_EQ(ticks, 0);
    queue.advance(1ns);
    EXPECT_EQ(ticks, 1);
    queue.advance(2s);
    EXPECT_EQ(ticks, 2);
    link->destroyPorts();
    queue.advance(60s);
    EXPECT_EQ(ticks, 2);
}

TEST_F(ModemLinkTest, AModemThatHasGoneIsFoundAtTheTickAndTheLinkRestarts) {
    link->startMonitor();
    ports.endRemote();
    queue.advance(2s);
    EXPECT_EQ(starts(), 2U);
    EXPECT_EQ(ticks, 1) << "after the restart";
    EXPECT_TRUE(link->isConnected());
}

TEST_F(ModemLinkTest, ItRetriesAfterTheDelayThatItWasGiven) {
    platform.retryDelay = 500ms;
    link = std::make_unique<ModemLink>(platform, *this);
    telephony.reachable = false;
    link->startMonitor();
    queue.advance(500ms - 1ns);
    EXPECT_EQ(starts(), 1U);
    queue.advance(1ns);
    EXPECT_EQ(starts(), 2U);
}

TEST_F(ModemLinkTest, AfterItsEndNeitherARetryNorAPacketComes) {
    link->startMonitor();
    ports.deliver(bytesOf("late"));
    telephony.reachable = false;
    link->restartMonitor();
    link.reset();
    queue.advance(60s);
    EXPECT_EQ(packets, Texts{});
    EXPECT_EQ(starts(), 2U);
    EXPECT_EQ(ports.local(), nullptr);
}

} // namespace
} // namespace pallax
