#include "tests/cli/EndToEnd.h"
#include "tests/doubles/Files.h"
#include "tests/doubles/WholeGsm.h"

#include <nlohmann/json.hpp>

#include <algorithm>
#include <fcntl.h>
#include <filesystem>
#include <fstream>
#include <sstream>
#include <sys/stat.h>
#include <unistd.h>

namespace pallax {
namespace {

using doubles::contentOf;
using std::chrono::milliseconds;
using std::chrono::seconds;

std::vector<nlohmann::ordered_json> linesOf(const std::string& text) {
    std::vector<nlohmann::ordered_json> lines;
    std::istringstream stream(text);
    for (std::string line; std::getline(stream, line);) {
        lines.push_back(nlohmann::ordered_json::parse(line));
    }
    return lines;
}

TEST_F(EndToEnd, DecodeGivesTheDisplayAfterTheLastPacket) {
    const std::string recording =
        record("a.pcap", {{milliseconds(0), registration(0)}, {seconds(5), registration(2)}});
    const Run end = run({"decode", recording});
    EXPECT_EQ(end.status, 0);
    EXPECT_EQ(end.err, "");
    const auto lines = linesOf(end.out);
    ASSERT_EQ(lines.size(), 1U);
    EXPECT_EQ(lines[0]["Process CO"]["MM Service State"], "REG_STATE_REGISTERING");
}

TEST_F(EndToEnd, DecodeOfTheCDMASampleShowsEveryRowFilled) {
    const Run end = run({"decode", "--every", "end", PALLAX_SOURCE_DIR "/samples/cdma-drive.pcap"});
    EXPECT_EQ(end.status, 0);
    EXPECT_EQ(end.err, "");
    EXPECT_EQ(end.out.find(":\"\""), std::string::npos) << end.out;
    const auto display = linesOf(end.out).at(0);
    EXPECT_EQ(display["1x"]["Frame Error Rate"], "1.73% (old)");
    EXPECT_EQ(display["EV-DO"]["Active Set"]["0;118"], "-3.98 dB");
    EXPECT_EQ(display["Data Rates"]["Forward Link"], "2264.00 kbps");
}

TEST_F(EndToEnd, DecodeOfTheObjectStreamShowsItsNestedObjects) {
    const Run end = run({"decode", PALLAX_SOURCE_DIR "/samples/ifx-stream.pcap"});
    EXPECT_EQ(end.status, 0);
    EXPECT_EQ(end.err, "");
    const auto display = linesOf(end.out).at(0);
    EXPECT_EQ(display["Neighbour Cells"][3], "103");
    EXPECT_EQ(display["RR"], "Idle");
}

TEST_F(EndToEnd, DecodeAtEachTickAndPacket) {
    const std::string recording = record("a.pcap", {{milliseconds(0), registration(0)},
                                                    {milliseconds(1500), registration(2)},
                                                    {seconds(7), registration(0)}});
    const auto ticks = linesOf(run({"decode", "--every", "tick", recording}).out);
    ASSERT_EQ(ticks.size(), 2U);
    EXPECT_EQ(ticks[0]["tick"], 1);
    EXPECT_EQ(ticks[0]["time"], "2023-11-14T22:13:22.000Z");
    EXPECT_EQ(ticks[0]["display"]["Process CO"]["MM Service State"], "REG_STATE_REGISTERING");
    EXPECT_EQ(ticks[1]["tick"], 4);
    EXPECT_EQ(ticks[1]["time"], "2023-11-14T22:13:28.000Z");
    EXPECT_EQ(ticks[1]["display"]["Process CO"]["MM Service State"], "REG_STATE_INACTIVE");

    const auto packets = linesOf(run({"decode", "--every", "packet", recording}).out);
    ASSERT_EQ(packets.size(), 3U);
    EXPECT_EQ(packets[1]["packet"], 2);
    EXPECT_EQ(packets[1]["time"], "2023-11-14T22:13:21.500Z");
    EXPECT_EQ(packets[1]["display"]["Process CO"]["MM Service State"], "REG_STATE_REGISTERING");
}

TEST_F(EndToEnd, DecodeOfTheSampleIsJsonAtItsEndEachTickAndEachPacket) {
    const std::string recording = gsmAttach();
    const auto packets = linesOf(run({"decode", "--every", "packet", recording}).out);
    ASSERT_EQ(packets.size(), 51U);
    for (std::size_t index = 0; index < packets.size(); ++index) {
        EXPECT_EQ(packets[index].size(), 3U);
        EXPECT_EQ(packets[index]["packet"], index + 1);
    }
    const auto ticks = linesOf(run({"decode", "--every", "tick", recording}).out);
    ASSERT_EQ(ticks.size(), 15U);
    for (std::size_t index = 0; index < ticks.size(); ++index) {
        EXPECT_EQ(ticks[index].size(), 3U);
        EXPECT_EQ(ticks[index]["tick"], index + 1);
        EXPECT_EQ(ticks[index]["display"].size(), doubles::kWholeGsm.registration.size());
    }
    EXPECT_EQ(ticks.back()["time"], "2023-11-14T22:13:50.000Z");
    const auto end = linesOf(run({"decode", "--every", "end", recording}).out);
    ASSERT_EQ(end.size(), 1U);
    EXPECT_EQ(end[0]["Process CS"]["MM State"], "MM_NULL");
    EXPECT_EQ(end[0], ticks.back()["display"]);
    EXPECT_EQ(end[0], packets.back()["display"]);
}

TEST_F(EndToEnd, DecodeToCsv) {
    const std::string recording =
        record("a.pcap", {{milliseconds(0), registration(0)}, {seconds(3), registration(2)}});
    const Run csv = run({"decode", "--every", "tick", "--format", "csv", recording});
    EXPECT_EQ(csv.status, 0);
    EXPECT_TRUE(csv.out.starts_with("time,path,value,number,unit\n")) << csv.out;
    EXPECT_NE(csv.out.find("2023-11-14T22:13:22.000Z,/Process CO/MM Service State,"
                           "REG_STATE_INACTIVE,,\n"),
              std::string::npos)
        << csv.out;
    EXPECT_NE(csv.out.find("2023-11-14T22:13:24.000Z,/Process CO/MM Service State,"
                           "REG_STATE_REGISTERING,,\n"),
              std::string::npos)
        << csv.out;
}

TEST_F(EndToEnd, DecodeReadsStandardInput) {
    const std::string recording = gsmAttach();
    EXPECT_EQ(run({"decode", "-"}, recording).out, run({"decode", recording}).out);
}

TEST_F(EndToEnd, DecodeAtATimeIsTheDisplayOfARecordingThatEndsThere) {
    const std::vector<Packet> packets{{std::chrono::milliseconds(0), registration(0)},
                                      {std::chrono::seconds(5), registration(1)},
                                      {std::chrono::seconds(9), registration(0)}};
    const std::string whole = record("whole.pcap", packets);
    const std::string cut = record("cut.pcap", {packets[0], packets[1]});
    const std::string expected = run({"decode", cut}).out;
    EXPECT_NE(expected, run({"decode", whole}).out);
    for (const char* time : {"+5s", "-4s", "22:13:26", "2023-11-14T22:13:28.999Z",
                             "2023-11-14 "
                             "22:13:25"}) {
        const Run at = run({"decode", "--at", time, whole});
        EXPECT_EQ(at.out, expected) << time;
        EXPECT_EQ(at.err, "");
        EXPECT_EQ(at.status, 0);
    }
    EXPECT_EQ(run({"decode", "--at", "+5s", "-"}, whole).out, expected);
    const Run pipe = run({"decode", "--at", "end", "-"}, whole);
    EXPECT_EQ(pipe.status, 1);
    EXPECT_EQ(pipe.err,
              "pallax: standard input: \"end\" cannot be used: the end of a stream is not "
              "known before it has been read.\n");
}

TEST_F(EndToEnd, DecodeOfEveryFieldIsTheWholeTable) {
    for (const char* sample :
         {"cdma-drive", "gsm-attach", "lte-drive", "umts-drive", "utran-drive"}) {
        const std::string path = PALLAX_SOURCE_DIR "/samples/" + std::string(sample) + ".pcap";
        EXPECT_EQ(run({"decode", "--format", "csv", "--select", "*", path}).out,
                  run({"decode", "--format", "csv", path}).out)
            << sample;
    }
    const Run unknown = run({"decode", "--select", "lte.no_such_field", gsmAttach()});
    EXPECT_EQ(unknown.status, 2);
    EXPECT_EQ(unknown.err,
              "pallax: No field is named \"lte.no_such_field\" (see pallax fields).\n");
}

TEST_F(EndToEnd, DecodeWritesValuesColumnsAndTables) {
    const std::string path = PALLAX_SOURCE_DIR "/samples/lte-drive.pcap";
    const std::string rsrp = "lte.serving_cell_measurements.measured_rsrp";
    const Run file = run({"decode", "--samples", "--select", rsrp, path});
    EXPECT_TRUE(file.out.starts_with(R"({"time":"2023-11-14T22:13:)")) << file.out;
    EXPECT_EQ(run({"decode", "--samples", "--select", rsrp, "-"}, path).out, file.out);
    EXPECT_EQ(run({"decode", "--samples", "--jobs", "2", "--select", rsrp, path, path}).out,
              file.out + file.out);
    const Run wide = run({"decode", "--wide", "--select", rsrp, path});
    EXPECT_TRUE(wide.out.starts_with("time,tick," + rsrp + "\n2023-11-14T22:13:22.036Z,1,"))
        << wide.out;
    const Run piped = run({"decode", "--wide", "-"}, path);
    EXPECT_EQ(piped.status, 1);
    EXPECT_EQ(piped.err, "pallax: standard input: --wide needs a file, because the columns must be "
                         "known before the first row.\n");
    const Run table =
        run({"decode", "--table", "Serving Cell Measurements", "--select", rsrp, path});
    EXPECT_TRUE(table.out.starts_with("Name           Value\nMeasured RSRP  -")) << table.out;
    const Run unknown = run({"decode", "--table", "Serving Cel Info", path});
    EXPECT_EQ(unknown.status, 2);
    EXPECT_EQ(unknown.err, "pallax: " + path +
                               " has no section \"Serving Cel Info\". Did you mean "
                               "\"serving_cell_info\"?\n");
    const Run reversed = run({"decode", "--from", "2023-11-15", "--to", "2023-11-14", path});
    EXPECT_EQ(reversed.status, 2);
    EXPECT_EQ(reversed.err, "pallax: The time of --from is later than that of --to.\n");
}

TEST_F(EndToEnd, DecodeOfPartsThatARecorderWroteIsThatOfTheWhole) {
    const std::vector<Packet> packets{{std::chrono::milliseconds(0), registration(0)},
                                      {std::chrono::seconds(5), registration(1)},
                                      {std::chrono::seconds(9), registration(0)}};
    const std::string whole = record("whole.pcap", packets);
    const std::string first = record("part-0001.pcap", {packets[0]});
    const std::string second = record("part-0002.pcap", {packets[1], packets[2]});
    for (const char* every : {"end", "tick", "packet"}) {
        EXPECT_EQ(run({"decode", "--every", every, "--join", second, first}).out,
                  run({"decode", "--every", every, whole}).out);
    }
    // Other commands join them by themselves.
    EXPECT_EQ(run({second, "--print", first, "--speed", "max"}).out,
              run({whole, "--print", "--speed", "max"}).out);
    EXPECT_EQ(run({"events", second, first}).out, run({"events", whole}).out);
    EXPECT_EQ(run({"sql", second, first, "select * from sample"}).out,
              run({"sql", whole, "select * from sample"}).out);
    const std::string third = record("part-0004.pcap", {packets[0]});
    const Run missing = run({second, "--print", first, third, "--speed", "max"});
    EXPECT_EQ(missing.status, 0);
    EXPECT_EQ(missing.err, "pallax: " + second + " and " + third +
                               " are read as one, without the part between them: " +
                               world.path("part-0003.pcap") + ".\n");
    const Run stream = run({"decode", "--join", first, "-"}, second);
    EXPECT_EQ(stream.status, 1);
    EXPECT_EQ(stream.err, "pallax: - cannot be joined: it can be read only once.\n");
}

TEST_F(EndToEnd, TheSystemLogIsWrittenUnmaskedToItsFile) {
    const std::string recording = record("a.pcap", {{milliseconds(0), registration(0)}});
    const std::string log = world.path("log");
    EXPECT_EQ(run({"decode", "--system-log", log, recording}).status, 0);
    const std::string lines = contentOf(log);
    EXPECT_TRUE(lines.find("<3>Creating ZOR_GSMLogGenerator object\n") != std::string::npos);
    EXPECT_TRUE(lines.find("<6>Log Header 0x81\n") != std::string::npos) << lines;
}

TEST_F(EndToEnd, ASystemLogThatCannotBeOpenedIsAFailure) {
    const std::string recording = record("a.pcap", {{milliseconds(0), registration(0)}});
    const std::string log = world.path("missing/log");
    const Run failed = run({"decode", "--system-log", log, recording});
    EXPECT_EQ(failed.status, 1);
    EXPECT_EQ(failed.out, "");
    EXPECT_EQ(failed.err,
              "pallax: The log file " + log + " cannot be written: No such file or directory.\n");
}

TEST_F(EndToEnd, ACutRecordingIsDecodedReportedAndAFailure) {
    const std::string recording =
        record("a.pcap", {{milliseconds(0), registration(2)}, {seconds(1), registration(0)}});
    std::filesystem::resize_file(recording, std::filesystem::file_size(recording) - 1);
    const Run cut = run({"decode", recording});
    EXPECT_EQ(cut.status, 1);
    EXPECT_EQ(cut.err, "pallax: " + recording + " ends in the middle of a packet.\n");
    ASSERT_EQ(linesOf(cut.out).size(), 1U);
    EXPECT_EQ(linesOf(cut.out)[0]["Process CO"]["MM Service State"], "REG_STATE_REGISTERING");
}

TEST_F(EndToEnd, ABadRecordingDoesNotKeepTheOthersFromBeingDecoded) {
    const std::string good = record("good.pcap", {{milliseconds(0), registration(0)}});
    const std::string missing = world.path("missing.pcap");
    const std::string noCapture = world.path("text.pcap");
    std::ofstream(noCapture) << "this is no capture, whatever its name says";
    const Run mixed = run({"decode", missing, noCapture, good});
    EXPECT_EQ(mixed.status, 1);
    EXPECT_EQ(linesOf(mixed.out).size(), 1U);
    EXPECT_NE(mixed.err.find(missing), std::string::npos) << mixed.err;
    EXPECT_NE(mixed.err.find(noCapture), std::string::npos) << mixed.err;
    EXPECT_EQ(std::count(mixed.err.begin(), mixed.err.end(), '\n'), 2) << mixed.err;
}

TEST_F(EndToEnd, ARecordThatThrowsIsReportedAndSkipped) {
    const std::string recording = record("a.pcap", {{milliseconds(0), registration(0)},
                                                    {milliseconds(1), unreadableSimFiles()},
                                                    {milliseconds(2), registration(2)}});
    const std::string sentence =
        "pallax: " + recording +
        ": packet 2 (log code 0xFF0000): the embedded property list cannot be parsed\n";
    const Run skipped = run({"decode", recording});
    EXPECT_EQ(skipped.status, 0);
    EXPECT_EQ(skipped.err, sentence);
    EXPECT_EQ(linesOf(skipped.out).at(0)["Process CO"]["MM Service State"],
              "REG_STATE_REGISTERING");

    const Run strict = run({"decode", "--strict", "--every", "packet", recording});
    EXPECT_EQ(strict.status, 70);
    EXPECT_EQ(strict.err, sentence);
    EXPECT_EQ(linesOf(strict.out).size(), 1U);
}

TEST_F(EndToEnd, AForeignLinkTypeNeedsTheTechnologyOption) {
    constexpr int kEthernet = 1;
    const std::string recording = record("a.pcap", {{milliseconds(0), registration(2)}}, kEthernet);
    const Run foreign = run({"decode", recording});
    EXPECT_EQ(foreign.status, 1);
    EXPECT_NE(foreign.err.find(recording), std::string::npos) << foreign.err;
    const Run told = run({"decode", "--technology", "gsm", recording});
    EXPECT_EQ(told.status, 0);
    EXPECT_EQ(linesOf(told.out).at(0)["Process CO"]["MM Service State"], "REG_STATE_REGISTERING");
}

TEST_F(EndToEnd, WrongUsageIsStatus2AndOneSentence) {
    const Run wrong = run({"decode", "--every", "day", "a.pcap"});
    EXPECT_EQ(wrong.status, 2);
    EXPECT_EQ(wrong.out, "");
    EXPECT_EQ(
        wrong.err,
        "pallax: --every: \"day\" is not one of end|tick|packet (see pallax decode --help)\n");
    EXPECT_EQ(run({"--version"}).status, 0);
}

TEST_F(EndToEnd, AFullDiskIsAFailureWithASentence) {
    doubles::PallaxProcess process(world, {"decode", gsmAttach()}, "/dev/null", "/dev/full");
    EXPECT_EQ(process.wait(), 1);
    EXPECT_EQ(process.err(),
              "pallax: Standard output cannot be written: No space left on device.\n");
}

TEST_F(EndToEnd, AClosedPipeEndsQuietly) {
    const std::string fifo = world.path("fifo");
    ASSERT_EQ(::mkfifo(fifo.c_str(), 0600), 0);
    std::vector<Packet> packets(5000, {milliseconds(0), registration(1)});
    const std::string recording = record("long.pcap", packets);
    // Opened first, because the program's own opening waits for a reader.
    const int reader = ::open(fifo.c_str(), O_RDONLY | O_NONBLOCK | O_CLOEXEC);
    ASSERT_GE(reader, 0);
    doubles::PallaxProcess process(world, {"decode", "--every", "packet", recording}, "/dev/null",
                                   fifo);
    std::string read(10, ' ');
    EXPECT_TRUE(doubles::eventually([&] {
        return ::read(reader, read.data(), read.size()) == static_cast<ssize_t>(read.size());
    }));
    EXPECT_EQ(read, "{\"packet\":");
    ::close(reader);
    EXPECT_EQ(process.wait(), 0);
    EXPECT_EQ(process.err(), "");
}

} // namespace
} // namespace pallax
