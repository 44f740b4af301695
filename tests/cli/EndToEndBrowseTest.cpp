#include "tests/cli/EndToEnd.h"

#include <algorithm>
#include <csignal>
#include <filesystem>
#include <fstream>
#include <map>
#include <sstream>

namespace pallax {
namespace {

using doubles::eventually;
using doubles::noChildLeft;
using doubles::PallaxProcess;
using std::chrono::milliseconds;
using std::chrono::seconds;

std::vector<std::string> headersOf(const std::string& text) {
    std::vector<std::string> headers;
    std::istringstream stream(text);
    for (std::string line; std::getline(stream, line);) {
        if (line.starts_with("== ")) {
            headers.push_back(line);
        }
    }
    return headers;
}

class EndToEndBrowse : public EndToEnd {
protected:
    /// A recording that plays for a minute, with a packet every 100 ms.
    std::string minute() const {
        std::vector<Packet> packets;
        for (int count = 0; count < 600; ++count) {
            packets.emplace_back(milliseconds(100) * count, registration(count % 2 == 0 ? 0 : 2));
        }
        return record("minute.pcap", packets);
    }

    bool nothingLeft() const {
        return noChildLeft() && eventually([this] { return world.sockets().empty(); });
    }
};

TEST_F(EndToEndBrowse, ARecordingIsPrintedAtTheTicksOfItsOwnTime) {
    const std::string recording = record("a.pcap", {{milliseconds(0), registration(0)},
                                                    {milliseconds(1500), registration(2)},
                                                    {seconds(7), registration(2)},
                                                    {seconds(9), registration(0)}});
    const Run played = run({recording, "--print", "--speed", "max"});
    EXPECT_EQ(played.status, 0);
    EXPECT_EQ(played.err, "");
    EXPECT_EQ(headersOf(played.out), (std::vector<std::string>{"== 2023-11-14 22:13:22 +0000",
                                                               "== 2023-11-14 22:13:28 +0000",
                                                               "== 2023-11-14 22:13:30 +0000"}));
    EXPECT_NE(played.out.find("\nProcess CO\n  MM Service State: REG_STATE_REGISTERING\n"),
              std::string::npos)
        << played.out;
    EXPECT_NE(played.out.find("\nProcess CO\n* MM Service State: REG_STATE_INACTIVE\n"),
              std::string::npos)
        << played.out;
    EXPECT_TRUE(nothingLeft());
}

TEST_F(EndToEndBrowse, PlainOutputTellsOnlyWhatChanges) {
    const std::string recording =
        record("plain.pcap", {{std::chrono::seconds(0), registration(0)},
                              {std::chrono::seconds(3), registration(2)},
                              {std::chrono::seconds(5), registration(2)}});
    const Run played = run({recording, "--plain", "--speed", "max"});
    EXPECT_EQ(played.status, 0) << played.err;
    constexpr std::string_view kChange =
        "In Process CO:\nMM Service State: REG_STATE_REGISTERING\n";
    const std::size_t at = played.out.find(kChange);
    ASSERT_NE(at, std::string::npos) << played.out;
    EXPECT_NE(played.out.find("\nMM Service State: REG_STATE_INACTIVE\n"), std::string::npos);
    EXPECT_EQ(played.out.find("In Process CO", at + 1), std::string::npos) << "no other change";
    EXPECT_EQ(played.out.find("=="), std::string::npos);
    EXPECT_TRUE(nothingLeft());
}

TEST_F(EndToEndBrowse, TheTicksAreThoseOfDecode) {
    const std::string recording = gsmAttach();
    const Run decoded = run({"decode", "--every", "tick", recording});
    const Run played = run({recording, "--speed", "max"});
    EXPECT_EQ(played.status, 0);
    EXPECT_EQ(static_cast<std::ptrdiff_t>(headersOf(played.out).size()),
              std::count(decoded.out.begin(), decoded.out.end(), '\n'));
    EXPECT_EQ(played.out, run({recording, "--speed", "max"}).out) << "both runs print the same";
    EXPECT_EQ(played.out, run({"-", "--speed", "max"}, recording).out);
    EXPECT_TRUE(nothingLeft());
}

TEST_F(EndToEndBrowse, TheSampleShowsThePhoneComeUpUpdateItsLocationAndDetach) {
    const Run played = run({gsmAttach(), "--print", "--speed", "max"});
    EXPECT_EQ(played.status, 0) << played.err;
    // The printed trees' content of the two sections, with one line for each run of equal ones.
    std::map<std::string, std::vector<std::string>> shown;
    std::string section;
    std::istringstream stream(played.out);
    for (std::string line; std::getline(stream, line);) {
        if (!line.starts_with(' ') && !line.starts_with('*')) {
            section = line;
        }
        constexpr std::string_view kStateLine = "  MM State: ";
        constexpr std::string_view kChangedLine = "* MM State: ";
        if (line.starts_with(kStateLine) || line.starts_with(kChangedLine)) {
            auto& states = shown[section];
            const std::string state = line.substr(kStateLine.size());
            const bool isNew = states.empty() || states.back() != state;
            EXPECT_EQ(isNew && !states.empty(), line.starts_with('*')) << line;
            if (isNew) {
                states.push_back(state);
            }
        }
    }
    const std::vector<std::string> states{"MM_IDLE", "MM_LOCATION_UPDATE_INITIATED", "MM_IDLE",
                                          "MM_IMSI_DETACH_INITIATED", "MM_NULL"};
    EXPECT_EQ(shown["Process CO"], states);
    EXPECT_EQ(shown["Process CS"], states);
}

TEST_F(EndToEndBrowse, ARecordingThatCannotBeOpenedIsAFailure) {
    const Run missing = run({world.path("missing.pcap")});
    EXPECT_EQ(missing.status, 1);
    EXPECT_EQ(missing.out, "");
    EXPECT_EQ(missing.err, "pallax: " + world.path("missing.pcap") +
                               " cannot be opened: No such file or directory.\n");
    EXPECT_TRUE(nothingLeft());
}

TEST_F(EndToEndBrowse, ACutRecordingIsPlayedReportedAndAFailure) {
    const std::string recording =
        record("a.pcap", {{milliseconds(0), registration(2)}, {seconds(1), registration(0)}});
    std::filesystem::resize_file(recording, std::filesystem::file_size(recording) - 1);
    const Run cut = run({recording, "--speed", "max"});
    EXPECT_EQ(cut.status, 1);
    EXPECT_EQ(headersOf(cut.out).size(), 1U);
    EXPECT_EQ(cut.err, "pallax: " + recording + " ends in the middle of a packet.\n");
    EXPECT_TRUE(nothingLeft());
}

TEST_F(EndToEndBrowse, WhileItPlaysThereAreSocketsAndAfterASignalThereAreNone) {
    for (const int number : {SIGINT, SIGTERM}) {
        PallaxProcess viewer(world, {minute(), "--speed", "10"});
        EXPECT_TRUE(viewer.says("== "));
        EXPECT_GE(world.sockets().size(), 3U) << "control port, log channel, viewer's port";
        viewer.signal(number);
        EXPECT_EQ(viewer.wait(), 0);
        EXPECT_EQ(viewer.err(), "");
        EXPECT_TRUE(nothingLeft());
    }
}

TEST_F(EndToEndBrowse, AKilledViewerTakesItsServiceAlong) {
    {
        PallaxProcess viewer(world, {minute(), "--speed", "10"});
        EXPECT_TRUE(viewer.says("== "));
        viewer.signal(SIGKILL);
        EXPECT_EQ(viewer.wait(), -SIGKILL);
    }
    EXPECT_TRUE(noChildLeft());
    EXPECT_EQ(run({gsmAttach(), "--speed", "max"}).status, 0);
    EXPECT_TRUE(nothingLeft()) << "the next run removes what the killed one left";
}

TEST_F(EndToEndBrowse, TwoRecordingsCanBeBrowsedAtOnce) {
    const std::string recording = minute();
    PallaxProcess first(world, {recording, "--speed", "10"});
    EXPECT_TRUE(first.says("== "));
    PallaxProcess second(world, {recording, "--speed", "10"});
    EXPECT_TRUE(second.says("== "));
    first.signal(SIGINT);
    EXPECT_EQ(first.wait(), 0);
    second.signal(SIGINT);
    EXPECT_EQ(second.wait(), 0);
    EXPECT_TRUE(nothingLeft());
}

TEST_F(EndToEndBrowse, AServiceCannotBeStartedTwice) {
    const std::string recording = minute();
    PallaxProcess service(world, {"service", "--play", recording, "--loop"});
    EXPECT_TRUE(eventually([this] { return !world.sockets().empty(); }));
    const Run second = run({"service", "--play", recording});
    EXPECT_EQ(second.status, 1);
    EXPECT_NE(second.err.find("already running"), std::string::npos) << second.err;
    service.signal(SIGTERM);
    EXPECT_EQ(service.wait(), 0);
    EXPECT_TRUE(nothingLeft());
}

TEST_F(EndToEndBrowse, AViewerFindsAServiceThatComesLater) {
    PallaxProcess viewer(world, {"--log-level", "3"});
    EXPECT_TRUE(viewer.says("<3>Could not create HXServerConnection\n"));
    EXPECT_TRUE(viewer.says("Connecting...\n"));
    PallaxProcess service(world, {"service", "--play", minute(), "--speed", "10"});
    EXPECT_TRUE(viewer.says("== ")) << "retried 5 seconds later";
    viewer.signal(SIGTERM);
    EXPECT_EQ(viewer.wait(), 0);
    service.signal(SIGTERM);
    EXPECT_EQ(service.wait(), 0);
    EXPECT_TRUE(nothingLeft());
}

TEST_F(EndToEndBrowse, ARecordThatThrowsEndsTheViewerWithStatus70) {
    // The viewer does not request the second packet's code, but the packet counts.
    const std::string recording =
        record("a.pcap", {{milliseconds(0), registration(0)},
                          {seconds(1), doubles::Record(0x1234).prefixed()},
                          {seconds(3), unreadableSimFiles()},
                          {seconds(5), registration(2)}});
    const std::string sentence =
        "packet 3 (log code 0xFF0000): the embedded property list cannot be parsed\n";
    const Run stopped = run({recording, "--speed", "max"});
    EXPECT_EQ(stopped.status, 70);
    EXPECT_EQ(stopped.err, "pallax: " + sentence);
    EXPECT_EQ(headersOf(stopped.out).size(), 1U);
    EXPECT_TRUE(nothingLeft());

    const Run kept = run({recording, "--speed", "max", "--keep-going", "--log-level", "3"});
    EXPECT_EQ(kept.status, 0);
    EXPECT_NE(kept.err.find("<3>" + sentence), std::string::npos) << kept.err;
    EXPECT_EQ(headersOf(kept.out).size(), 2U);

    std::filesystem::create_directories(world.path("config/pallax"));
    std::ofstream(world.path("config/pallax/pallax.conf")) << "on-fatal-record = skip\n";
    EXPECT_EQ(run({recording, "--speed", "max"}).status, 0);
    EXPECT_TRUE(nothingLeft());
}

TEST_F(EndToEndBrowse, AMistakeInTheSettingsIsNamed) {
    std::filesystem::create_directories(world.path("config/pallax"));
    const std::string file = world.path("config/pallax/pallax.conf");
    std::ofstream(file) << "colour = red\n";
    const Run wrong = run({gsmAttach()});
    EXPECT_EQ(wrong.status, 1);
    EXPECT_EQ(wrong.err, "pallax: " + file + ", line 1: there is no setting \"colour\".\n");
}

} // namespace
} // namespace pallax
