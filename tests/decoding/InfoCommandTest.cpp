#include "decoding/InfoCommand.h"

#include "tests/decoding/CommandFixture.h"
#include "tests/doubles/ManualClock.h"
#include "tests/doubles/Property.h"
#include "tests/doubles/RecordBuilder.h"

#include <nlohmann/json.hpp>

namespace pallax {
namespace {

using doubles::Record;
using std::chrono::milliseconds;
using std::chrono::seconds;

constexpr LogCode kIdleMeasurement = 0xB17F;
constexpr std::size_t kIdleMeasurementLength = 33;
constexpr LogCode kServingCell = 0xB0C1;

std::string idleMeasurement(std::size_t length = kIdleMeasurementLength) {
    return textOf(Record(kIdleMeasurement).padTo(length).prefixed());
}

class InfoCommandTest : public CommandFixture {
protected:
    void add(const std::string& name, Packets packets, std::string_view technology = "lte",
             std::optional<RecordingError> atEnd = std::nullopt) {
        options.files.push_back(name);
        script(name, std::move(packets), technologyOfCommandName(technology), std::move(atEnd));
    }
    ExitStatus run() {
        const DirectoryResources resources(PALLAX_SOURCE_DIR "/resources");
        Output output(write());
        return InfoCommand(options, {resources, zone, open(), report()}).run(output);
    }
    nlohmann::ordered_json json() {
        options.json = true;
        EXPECT_EQ(run(), kExitSuccess);
        return nlohmann::ordered_json::parse(written);
    }

    InfoOptions options;
    doubles::ManualClock zone;
};

TEST_F(InfoCommandTest, TextTellsEverythingAtAGlance) {
    zone.setZone({std::chrono::hours(1), false});
    add("a.pcap", {{milliseconds(0), idleMeasurement()},
                   {milliseconds(500), idleMeasurement()},
                   {seconds(100), idleMeasurement(kIdleMeasurementLength - 1)},
                   {seconds(101), textOf(Record(kServingCell).padTo(40).bytes())},
                   {seconds(50), textOf(Record(0x1234).bytes())},
                   {seconds(51), std::string(12, '\1'), true},
                   {seconds(52), '\2' + idleMeasurement().substr(3)}});
    EXPECT_EQ(run(), kExitSuccess);
    EXPECT_EQ(written, R"(a.pcap
  format      script
  technology  lte (link type 150)
  packets     7 (0.1 a second)
  first       2023-11-14 23:13:20 +0100
  last        2023-11-14 23:14:12 +0100
  duration    103.0 s
  gaps        1: 99.5 s before packet 3
  steps back  1: 51.0 s at packet 5
  bad stamps  1, the first at packet 6
  unknown     1
  damaged     3

   packets  code      record
         3  0xB17F    Idle-mode measurement of the serving cell -> /Serving Cell Measurements (1 damaged)
         1  0x1234    unknown
         1  0xB0C1    Antennas of the serving cell -> /Serving Cell Info

  fills       /Serving Cell Info, /Serving Cell Measurements
  not filled  /Connected mode LTE Intra-frequency Measurement, /Measured Neighbor Cells, /Detected Cells, /Neighbor Measurements, /Neighbor Cells List, /Reselection Candidates, /Reselection Candidates List, /SIM Info, /PDP Context Info
)");
    EXPECT_EQ(reports, std::vector<std::string>{});
}

TEST_F(InfoCommandTest, JsonHasTheSame) {
    add("a.pcap", {{milliseconds(0), idleMeasurement()}, {seconds(61), "x"}});
    EXPECT_EQ(
        json().dump(),
        R"({"file":"a.pcap","format":"script","technology":"lte","link_type":150,"packets":2,)"
        R"("bytes":36,"first":"2023-11-14T22:13:20.000Z","last":"2023-11-14T22:14:21.000Z",)"
        R"("seconds":61,"gaps":{"count":1,"first":[{"packet":2,"seconds":61}]},)"
        R"("steps_back":{"count":0,"first":[]},"bad_stamps":{"count":0,"first":[]},)"
        R"("error":null,"damaged":1,"unknown":0,"codes":[{"code":"0xB17F","packets":1,)"
        R"("damaged":0,"known":true,"name":"Idle-mode measurement of the serving cell",)"
        R"("sections":["/Serving Cell Measurements"]}],)"
        R"("fills":["/Serving Cell Measurements"],"not_filled":["/Serving Cell Info",)"
        R"("/Connected mode LTE Intra-frequency Measurement","/Measured Neighbor Cells",)"
        R"("/Detected Cells","/Neighbor Measurements","/Neighbor Cells List",)"
        R"("/Reselection Candidates","/Reselection Candidates List","/SIM Info",)"
        R"("/PDP Context Info"]})");
}

TEST_F(InfoCommandTest, MessagesOfAnObjectStreamAreCountedByForm) {
    add("i.pcap",
        {{seconds(0), "<?xml version='1.0'?>"},
         {seconds(0), "bplist00..."},
         {seconds(0), "bplist00..."},
         {seconds(0), "{ a = b; }"},
         {seconds(0), "<0fbd77>"},
         {seconds(0), ""}},
        "ifx");
    EXPECT_EQ(run(), kExitSuccess);
    EXPECT_NE(written.find("\n  messages    1 XML, 2 binary, 2 text\n  damaged     1\n"),
              std::string::npos)
        << written;
    EXPECT_EQ(written.find("packets  code"), std::string::npos);
    written.clear();
    options = {};
    add("i.pcap", {{seconds(0), "bplist00..."}}, "ifx");
    EXPECT_EQ(json()["messages"].dump(), R"({"xml":0,"binary":1,"text":0})");
}

TEST_F(InfoCommandTest, ADamagedFileIsDescribedAsFarAsItIsWhole) {
    add("cut.pcap", {{seconds(0), idleMeasurement()}}, "lte",
        RecordingError{RecordingError::Kind::CutShort, "cut.pcap ends in the middle of a packet."});
    options.files.emplace_back("missing.pcap");
    add("whole.pcap", {});
    EXPECT_EQ(run(), kExitFailure);
    EXPECT_EQ(reports, (std::vector<std::string>{"cut.pcap ends in the middle of a packet.",
                                                 "missing.pcap is not there."}));
    EXPECT_TRUE(
        written.starts_with("cut.pcap\n  format      script\n  technology  lte (link type 150)\n"
                            "  packets     1\n"));
    EXPECT_NE(written.find("\n\nwhole.pcap\n  format"), std::string::npos);
}

TEST_F(InfoCommandTest, OfAForeignTechnologyOnlyTimesAreTold) {
    add("f.pcap", {{seconds(0), "x"}}, "none");
    EXPECT_EQ(run(), kExitFailure);
    EXPECT_EQ(reports, std::vector<std::string>{"f.pcap has a foreign link type"});
    EXPECT_TRUE(
        written.starts_with("f.pcap\n  format      script\n  technology  unknown (link type 1)\n"
                            "  packets     1\n  first "))
        << written;
    EXPECT_EQ(written.find("damaged"), std::string::npos);
}

TEST_F(InfoCommandTest, ManyIrregularStampsAreCountedButNotListed) {
    Packets packets;
    for (int number = 0; number < 20; ++number) {
        packets.push_back({seconds(100 * number), ""});
    }
    add("a.pcap", packets, "ifx");
    const auto gaps = json()["gaps"];
    EXPECT_EQ(gaps["count"], 19);
    EXPECT_EQ(gaps["first"].size(), 8U);
    written.clear();
    options = {};
    add("a.pcap", packets, "ifx");
    EXPECT_EQ(run(), kExitSuccess);
    EXPECT_NE(written.find("gaps        19: 100.0 s before packet 2, "), std::string::npos);
    EXPECT_NE(written.find("before packet 9, ...\n"), std::string::npos);
}

TEST(RecordingSummary, CountsEveryPacketOnce) {
    const auto reference = gatherReference(*technologyOfCommandName("gsm"),
                                           DirectoryResources(PALLAX_SOURCE_DIR "/resources"));
    const RecordingSummary::Codes codes(reference);
    const std::vector<LogCode> known = codesOf(reference);
    EXPECT_TRUE(doubles::holds([&] {
        RecordingSummary summary(&codes);
        std::uint64_t bytes = 0;
        std::map<LogCode, std::uint64_t> drawn;
        for (ByteBuffer message : doubles::any::buffers()) {
            if (doubles::any::boolean()) {
                const LogCode code = doubles::any::elementOf(known);
                message = Record(code).append(message).bytes();
                ++drawn[code];
            }
            summary.add({Time(), message});
            bytes += message.size();
        }
        std::uint64_t counted = summary.notRecords();
        for (const auto& [code, count] : summary.codes()) {
            counted += count.packets;
            RC_ASSERT(count.damaged <= count.packets);
            RC_ASSERT(count.packets >= drawn[code]);
        }
        RC_ASSERT(counted == summary.packets());
        RC_ASSERT(summary.bytes() == bytes);
        RC_ASSERT(summary.damaged() + summary.unknown() <= counted);
    }));
}

TEST(RecordingSummary, StretchesOfCenturiesAddUpToTheLongestDuration) {
    RecordingSummary summary(nullptr);
    for (int round = 0; round < 3; ++round) {
        summary.add({kEarliestTime, {}});
        summary.add({kLatestTime, {}});
    }
    EXPECT_EQ(summary.duration(), std::chrono::nanoseconds::max());
}

TEST_F(InfoCommandTest, TheNumberedPartsOfARecordingAreOne) {
    add("a-0002.pcap", {{seconds(10), idleMeasurement()}, {seconds(11), idleMeasurement()}});
    add("a-0001.pcap", {{seconds(0), idleMeasurement()}});
    const auto whole = json();
    EXPECT_EQ(whole["file"], "a-0001.pcap and 1 more");
    EXPECT_EQ(whole["packets"], 3);
    add("a-0004.pcap", {});
    EXPECT_EQ(json()["file"], "a-0001.pcap and 2 more");
    EXPECT_EQ(reports, std::vector<std::string>{"a-0002.pcap and a-0004.pcap are read as one, "
                                                "without the part between them: a-0003.pcap."});
}

TEST_F(InfoCommandTest, ANameIsOneLine) {
    add("a\nb.pcap", {});
    EXPECT_EQ(run(), kExitSuccess);
    EXPECT_TRUE(written.starts_with("a\\x0Ab.pcap\n  format")) << written;
}

} // namespace
} // namespace pallax
