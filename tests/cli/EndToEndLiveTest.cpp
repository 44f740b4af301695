#include "tests/cli/EndToEnd.h"
#include "tests/doubles/Pattern.h"

#include <nlohmann/json.hpp>

#include <algorithm>
#include <csignal>
#include <filesystem>
#include <fstream>

namespace pallax {
namespace {

using doubles::eventually;
using doubles::PallaxProcess;
using std::chrono::milliseconds;

/// The live modem as a recording: `--live` of the commands that look into recordings.
class EndToEndLive : public EndToEnd {
protected:
    static constexpr const char* kQuery =
        "select count(*), min(time), max(time), sum(length) from packet union all "
        "select count(*), min(time), max(packet), round(sum(number)) from sample union all "
        "select count(*), min(time), max(packet), sum(length(words)) from event";

    std::string drive(const char* technology) const {
        const std::string path = world.path(std::string(technology) + ".pcap");
        EXPECT_EQ(run({"simulate", technology, "--seconds", "120", "-o", path}).status, 0);
        return path;
    }
    bool serviceIsThere() const {
        return eventually([this] { return !world.sockets().empty(); });
    }
    static void end(PallaxProcess& process) {
        process.signal(SIGTERM);
        EXPECT_EQ(process.wait(), 0);
    }
    /// Registrations of one state, ten a second.
    std::string registrations(const std::string& name) const {
        std::vector<Packet> packets;
        for (int index = 0; index < 100; ++index) {
            packets.emplace_back(milliseconds(100) * index, registration(2));
        }
        return record(name, packets);
    }
};

TEST_F(EndToEndLive, AnswersAndEventsAreThoseOfTheRecordingThatIsPlayed) {
    for (const char* technology : {"ifx", "gsm", "cdma", "lte", "utran"}) {
        const std::string path = drive(technology);
        PallaxProcess service(world, {"service", "--play", path, "--speed", "max"});
        ASSERT_TRUE(serviceIsThere());
        const Run live = run({"sql", "--live", kQuery});
        EXPECT_EQ(live.status, 0);
        EXPECT_EQ(live.err, "") << technology;
        EXPECT_EQ(live.out, run({"sql", path, kQuery}).out) << technology;
        const Run events = run({"events", "--live"});
        EXPECT_EQ(events.status, 0);
        EXPECT_EQ(events.err, "") << technology;
        EXPECT_EQ(events.out, run({"events", path}).out) << technology;
        const Run status = run({"status", "--for", "1000"});
        EXPECT_EQ(status.status, 0);
        EXPECT_EQ(status.err, "") << technology;
        EXPECT_EQ(doubles::replaced(status.out, "live modem", path), run({"status", path}).out);
        end(service);
    }
}

TEST_F(EndToEndLive, ASimulationAnswersLikeItsRecording) {
    PallaxProcess service(world,
                          {"service", "--simulate", "lte", "--seconds", "120", "--speed", "max"});
    ASSERT_TRUE(serviceIsThere());
    EXPECT_EQ(run({"sql", "--live", kQuery}).out, run({"sql", drive("lte"), kQuery}).out);
    end(service);
}

TEST_F(EndToEndLive, ForEndsByTheTimeOfTheSource) {
    PallaxProcess service(world, {"service", "--play", registrations("a.pcap"), "--speed", "max"});
    ASSERT_TRUE(serviceIsThere());
    const Run live = run({"sql", "--live", "--for", "5", "select max(packet) from packet"});
    EXPECT_EQ(live.status, 0) << live.err;
    EXPECT_EQ(live.out, "max(packet)\n         50\n") << "those of the first 5 seconds";
    end(service);
}

TEST_F(EndToEndLive, EventsAreWrittenAsTheyHappenUntilASignal) {
    PallaxProcess service(world, {"service", "--simulate", "gsm", "--speed", "100"});
    ASSERT_TRUE(serviceIsThere());
    PallaxProcess events(world, {"events", "--live", "--json"});
    ASSERT_TRUE(eventually([&] { return events.out().find('\n') != std::string::npos; }));
    const auto first = nlohmann::json::parse(events.out().substr(0, events.out().find('\n')));
    EXPECT_EQ(first["recording"], "live modem");
    const std::string before = events.out();
    EXPECT_TRUE(eventually([&] { return events.out().size() > before.size(); }));
    events.signal(SIGINT);
    EXPECT_EQ(events.wait(), 0) << events.err();
    end(service);
}

TEST_F(EndToEndLive, ASignalEndsTheReceptionAndTheQueryIsAnswered) {
    PallaxProcess service(
        world, {"service", "--play", registrations("a.pcap"), "--loop", "--speed", "10"});
    ASSERT_TRUE(serviceIsThere());
    PallaxProcess query(world, {"sql", "--live", "select count(*) > 0 as any from packet"});
    EXPECT_TRUE(eventually([this] {
        const std::string status = run({"service", "--status"}).out;
        return status.find(" packets sent") != std::string::npos &&
               status.find(" 0 packets sent") == std::string::npos;
    }));
    query.signal(SIGINT);
    EXPECT_EQ(query.wait(), 0) << query.err();
    EXPECT_EQ(query.out(), "any\n  1\n");
    end(service);
}

TEST_F(EndToEndLive, AStatusTakesFiveSecondsOfTheSource) {
    PallaxProcess service(world, {"service", "--play", drive("lte"), "--speed", "max"});
    ASSERT_TRUE(serviceIsThere());
    const auto status = nlohmann::json::parse(run({"status", "--json"}).out);
    EXPECT_EQ(status["time"].get<std::string>().substr(0, 19), "2023-11-14T22:13:24");
    EXPECT_EQ(status["recording"], "live modem");
    end(service);
}

TEST_F(EndToEndLive, WithoutAModemIsAFailureThatSaysWhy) {
    for (const auto& [command, status] :
         {std::pair(std::vector<std::string>{"sql", "--live", "--for", "1.5", "select 1"}, 1),
          {{"events", "--live", "--for", "1.5"}, 1},
          {{"status", "--for", "1.5"}, 3}}) {
        const Run run = this->run(command);
        EXPECT_EQ(run.status, status);
        EXPECT_EQ(run.out, "");
        EXPECT_EQ(run.err, "pallax: No telephony service is running; waiting.\n"
                           "pallax: No packet has come from the live modem.\n");
    }
}

TEST_F(EndToEndLive, AnotherTechnologyThanTheWantedOneIsRefused) {
    PallaxProcess service(world, {"service", "--play", registrations("a.pcap")});
    ASSERT_TRUE(serviceIsThere());
    for (const auto& [command, status] :
         {std::pair(std::vector<std::string>{"sql", "--live", "--technology", "lte", "select 1"},
                    1),
          {{"events", "--live", "--technology", "lte"}, 1},
          {{"status", "--technology", "lte"}, 3}}) {
        const Run run = this->run(command);
        EXPECT_EQ(run.status, status);
        EXPECT_EQ(run.err, "pallax: The modem's technology is Zorell_GSM (gsm), not lte.\n");
    }
    end(service);
}

TEST_F(EndToEndLive, AModemThatReturnsWithAnotherTechnologyEndsTheEvents) {
    PallaxProcess events(world, {"events", "--live"});
    PallaxProcess first(world, {"service", "--simulate", "gsm", "--speed", "100"});
    ASSERT_TRUE(eventually([&] { return !events.out().empty(); }));
    first.signal(SIGKILL);
    EXPECT_EQ(first.wait(), -SIGKILL);
    PallaxProcess second(world, {"service", "--simulate", "lte", "--speed", "100"});
    EXPECT_EQ(events.wait(), 1);
    EXPECT_TRUE(events.says("pallax: The modem's technology is now Zorell_LTE (lte), not gsm.\n"))
        << events.err();
    end(second);
}

TEST_F(EndToEndLive, ARecordThatCannotBeReadEndsIt) {
    const std::string path = record(
        "a.pcap", {{milliseconds(0), registration(2)}, {milliseconds(10), unreadableSimFiles()}});
    PallaxProcess service(world, {"service", "--play", path, "--speed", "max"});
    ASSERT_TRUE(serviceIsThere());
    const Run events = run({"events", "--live"});
    EXPECT_EQ(events.status, 70);
    EXPECT_EQ(events.err, "pallax: live modem: packet 2 cannot be read; the events end there.\n");
    const Run query = run({"sql", "--live", "select count(*) from packet"});
    EXPECT_EQ(query.status, 1);
    EXPECT_TRUE(query.err.starts_with("pallax: Packet 2 cannot be read: ")) << query.err;
    end(service);
}

TEST_F(EndToEndLive, WrongUsageIsOneSentence) {
    const auto refused = [this](const std::vector<std::string>& command) {
        const Run run = this->run(command);
        EXPECT_EQ(run.status, 2);
        return run.err;
    };
    const std::string sql =
        "pallax: sql --live takes a query and no recording (see pallax sql --help)\n";
    EXPECT_EQ(refused({"sql", "--live", "a.pcap", "select 1"}), sql);
    EXPECT_EQ(refused({"sql", "--live"}), sql);
    EXPECT_EQ(refused({"sql"}), "pallax: RECORDING is required (see pallax sql --help)\n");
    EXPECT_EQ(refused({"events"}), "pallax: RECORDING is required (see pallax events --help)\n");
    EXPECT_EQ(refused({"events", "--live", "a.pcap"}),
              "pallax: --live excludes RECORDING (see pallax events --help)\n");
    EXPECT_EQ(refused({"status", "--at", "22:13"}),
              "pallax: --at requires RECORDING (see pallax status --help)\n");
    EXPECT_EQ(refused({"status", "--for", "3", "a.pcap"}),
              "pallax: RECORDING excludes --for (see pallax status --help)\n");
    EXPECT_EQ(refused({"events", "--for", "3", "a.pcap"}),
              "pallax: --for requires --live (see pallax events --help)\n");
    EXPECT_EQ(refused({"events", "--live", "--where", "rsrp >"}),
              "pallax: --where: This is not a whole condition.\n");
    EXPECT_EQ(refused({"sql", "--live", "--for", "0", "select 1"}),
              "pallax: --for: \"0\" is out of range, which is above 0 and up to 1000000000 (see "
              "pallax sql --help)\n");
}

TEST_F(EndToEndLive, AnEmptyNameIsNotTheLiveModem) {
    const Run run = this->run({"status", ""});
    EXPECT_EQ(run.status, 3);
    EXPECT_EQ(run.err, "pallax:  cannot be opened: No such file or directory.\n");
}

TEST_F(EndToEndLive, WrongSettingsAreOneSentence) {
    std::filesystem::create_directories(world.path("config/pallax"));
    std::ofstream(world.path("config/pallax/pallax.conf")) << "journal-hours = 0\n";
    for (const auto& command : {std::vector<std::string>{"events", "--live"}, {"status"}}) {
        const Run run = this->run(command);
        EXPECT_EQ(run.status, 1);
        EXPECT_NE(run.err.find("journal-hours is a number from 1 to 8760"), std::string::npos);
    }
}

} // namespace
} // namespace pallax
