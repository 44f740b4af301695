#include "decoding/DecodeCommand.h"

#include "tests/decoding/CommandFixture.h"
#include "tests/doubles/FakeResources.h"

namespace pallax {
namespace {

using doubles::kFirstPacket;
using doubles::ScriptedGenerator;
using doubles::ScriptedRecording;
using std::chrono::hours;
using std::chrono::milliseconds;
using std::chrono::seconds;

class DecodeCommandTest : public CommandFixture {
protected:
    DecodeCommandTest() { ScriptedGenerator::generations.clear(); }

    void add(const std::string& name, Packets packets,
             const RecordedTechnology* technology = &doubles::kScriptedLte,
             std::optional<RecordingError> atEnd = std::nullopt) {
        options.recordings.push_back(name);
        script(name, std::move(packets), technology, std::move(atEnd));
    }
    ExitStatus run() {
        Output output(write());
        DecodeCommand command(options, {resources, bundle, notices, doubles::kScriptedTechnologies},
                              open(), report());
        return command.run(output);
    }

    DecodeOptions options;
    doubles::FakeResources resources;
};

TEST_F(DecodeCommandTest, EndGivesTheDisplayAfterTheLastPacket) {
    add("a.pcap", {{milliseconds(0), "RSRP=-90dBm"}, {milliseconds(1), "RSRP=-94.75dBm"}});
    EXPECT_EQ(run(), kExitSuccess);
    EXPECT_EQ(written, "{\"Cell\":{\"RSRP\":\"-94.75 dBm\"}}\n");
    EXPECT_EQ(reports, std::vector<std::string>{});
}

TEST_F(DecodeCommandTest, TickGivesALineForEachTickThatSawNewData) {
    options.every = Every::Tick;
    add("a.pcap", {{milliseconds(0), "A=1"},
                   {milliseconds(1999), "A=2"},
                   {milliseconds(2000), "A=3"},
                   {milliseconds(9000), "A=4"}});
    EXPECT_EQ(run(), kExitSuccess);
    EXPECT_EQ(written,
              R"({"tick":1,"time":"2023-11-14T22:13:22.000Z","display":{"Cell":{"A":"2"}}})"
              "\n"
              R"({"tick":2,"time":"2023-11-14T22:13:24.000Z","display":{"Cell":{"A":"3"}}})"
              "\n"
              R"({"tick":5,"time":"2023-11-14T22:13:30.000Z","display":{"Cell":{"A":"4"}}})"
              "\n");
}

TEST_F(DecodeCommandTest, PacketGivesALineForEachPacket) {
    options.every = Every::Packet;
    add("a.pcap", {{milliseconds(0), "A=1"}, {milliseconds(1500), "A=2"}});
    EXPECT_EQ(run(), kExitSuccess);
    EXPECT_EQ(written,
              R"({"packet":1,"time":"2023-11-14T22:13:20.000Z","display":{"Cell":{"A":"1"}}})"
              "\n"
              R"({"packet":2,"time":"2023-11-14T22:13:21.500Z","display":{"Cell":{"A":"2"}}})"
              "\n");
}

TEST_F(DecodeCommandTest, ARecordingWithoutPacketsHasNoDisplay) {
    add("a.pcap", {});
    EXPECT_EQ(run(), kExitSuccess);
    EXPECT_EQ(written, "null\n");
    EXPECT_TRUE(ScriptedGenerator::generations.empty());
}

TEST_F(DecodeCommandTest, EveryModeGeneratesTheDisplayAtTheTicksOfTheRecording) {
    for (const Every every : {Every::End, Every::Tick, Every::Packet}) {
        ScriptedGenerator::generations.clear();
        options = {};
        options.every = every;
        add("a.pcap", {{milliseconds(0), "A=1"},
                       {milliseconds(100), "A=2"},
                       {hours(24 * 365 * 30), "A=3"},
                       {milliseconds(50), "A=4"}});
        EXPECT_EQ(run(), kExitSuccess);
        EXPECT_EQ(ScriptedGenerator::generations,
                  (std::vector<ScriptedGenerator::Generated>{
                      {kFirstPacket + seconds(2), 6},
                      {kFirstPacket + hours(24 * 365 * 30) + seconds(2), 3},
                      {kFirstPacket + milliseconds(2050), 3}}));
    }
}

TEST_F(DecodeCommandTest, AtAStepBackTheTickGridRestartsAndTheTickNumbersContinue) {
    options.every = Every::Tick;
    add("a.pcap", {{seconds(0), "A=1"},
                   {seconds(3), "A=2"},
                   {seconds(-3600), "A=3"},
                   {milliseconds(-3'598'001), "A=4"},
                   {milliseconds(-3'598'000), "A=5"}});
    EXPECT_EQ(run(), kExitSuccess);
    EXPECT_EQ(written,
              R"({"tick":1,"time":"2023-11-14T22:13:22.000Z","display":{"Cell":{"A":"1"}}})"
              "\n"
              R"({"tick":2,"time":"2023-11-14T22:13:24.000Z","display":{"Cell":{"A":"2"}}})"
              "\n"
              R"({"tick":3,"time":"2023-11-14T21:13:22.000Z","display":{"Cell":{"A":"4"}}})"
              "\n"
              R"({"tick":4,"time":"2023-11-14T21:13:24.000Z","display":{"Cell":{"A":"5"}}})"
              "\n");
    EXPECT_EQ(reports, std::vector<std::string>{
                           "a.pcap: packet 3 is 3603.0 s earlier than the latest packet before it; "
                           "ticks are counted from there."});
}

TEST_F(DecodeCommandTest, AGapIsToldOnceForEachRecording) {
    for (const char* name : {"a.pcap", "b.pcap"}) {
        add(name, {{seconds(0), "A=1"}, {seconds(60), "A=2"}, {milliseconds(120'100), "A=3"}});
    }
    EXPECT_EQ(run(), kExitSuccess);
    EXPECT_EQ(reports,
              (std::vector<std::string>{"a.pcap: no packets for 60.1 s before packet 3.",
                                        "b.pcap: no packets for 60.1 s before packet 3."}));
}

TEST_F(DecodeCommandTest, OfStampsOutOfRangeTheFirstIsTold) {
    add("a.pcap", {{seconds(0), "A=1"}, {seconds(1), "A=2", true}, {seconds(2), "A=3", true}});
    EXPECT_EQ(run(), kExitSuccess);
    EXPECT_EQ(reports,
              std::vector<std::string>{"a.pcap: the stamp of packet 2 is not between 1970 and "
                                       "2255; the nearest time replaces it and others like it."});
}

TEST_F(DecodeCommandTest, AStretchWithoutTicksDoesNotGrowWithoutBound) {
    options.every = Every::Tick;
    constexpr std::size_t kQuarterMebibyte = std::size_t{1} << 18U;
    const std::string packet = "A=" + std::string(kQuarterMebibyte - 2, 'x');
    add("a.pcap", Packets(10, {milliseconds(0), packet}));
    EXPECT_EQ(run(), kExitSuccess);
    EXPECT_EQ(ScriptedGenerator::generations,
              (std::vector<ScriptedGenerator::Generated>{{kFirstPacket, 5 * kQuarterMebibyte},
                                                         {kFirstPacket, 5 * kQuarterMebibyte},
                                                         {kFirstPacket + seconds(2), 0}}));
    EXPECT_EQ(std::count(written.begin(), written.end(), '\n'), 1);
}

TEST_F(DecodeCommandTest, EachRecordingHasItsOwnStateAndNumbers) {
    options.every = Every::Packet;
    add("a.pcap", {{milliseconds(0), "A=1"}});
    add("b.pcap", {{milliseconds(0), "B=2"}});
    EXPECT_EQ(run(), kExitSuccess);
    EXPECT_EQ(written,
              R"({"packet":1,"time":"2023-11-14T22:13:20.000Z","display":{"Cell":{"A":"1"}}})"
              "\n"
              R"({"packet":1,"time":"2023-11-14T22:13:20.000Z","display":{"Cell":{"B":"2"}}})"
              "\n");
}

TEST_F(DecodeCommandTest, ARecordThatThrowsIsReportedAndSkipped) {
    options.every = Every::Packet;
    add("a.pcap",
        {{milliseconds(0), "A=1"}, {milliseconds(1), "!a bad list"}, {milliseconds(2), "A=3"}});
    EXPECT_EQ(run(), kExitSuccess);
    EXPECT_EQ(reports, std::vector<std::string>{"a.pcap: packet 2 (no log code): a bad list"});
    EXPECT_EQ(written,
              R"({"packet":1,"time":"2023-11-14T22:13:20.000Z","display":{"Cell":{"A":"1"}}})"
              "\n"
              R"({"packet":3,"time":"2023-11-14T22:13:20.002Z","display":{"Cell":{"A":"3"}}})"
              "\n");
}

TEST_F(DecodeCommandTest, ATickWhosePacketsAllThrewSawNoNewData) {
    options.every = Every::Tick;
    add("a.pcap", {{milliseconds(0), "A=1"}, {seconds(2), "!bad"}, {seconds(5), "A=3"}});
    EXPECT_EQ(run(), kExitSuccess);
    EXPECT_NE(written.find("{\"tick\":1,"), std::string::npos);
    EXPECT_EQ(written.find("{\"tick\":2,"), std::string::npos);
    EXPECT_NE(written.find("{\"tick\":3,"), std::string::npos);
}

TEST_F(DecodeCommandTest, StrictStopsAtARecordThatThrows) {
    options.strict = true;
    options.every = Every::Packet;
    add("a.pcap", {{milliseconds(0), "A=1"}, {milliseconds(1), "!bad"}, {milliseconds(2), "A=3"}});
    add("b.pcap", {{milliseconds(0), "B=1"}});
    EXPECT_EQ(run(), kExitFatalRecord);
    EXPECT_EQ(reports, std::vector<std::string>{"a.pcap: packet 2 (no log code): bad"});
    EXPECT_EQ(written,
              R"({"packet":1,"time":"2023-11-14T22:13:20.000Z","display":{"Cell":{"A":"1"}}})"
              "\n");
}

TEST_F(DecodeCommandTest, ACutRecordingIsDecodedUpToTheCut) {
    add("cut.pcap", {{milliseconds(0), "A=1"}}, &doubles::kScriptedLte,
        RecordingError{RecordingError::Kind::CutShort, "cut.pcap ends in the middle of packet 2"});
    add("b.pcap", {{milliseconds(0), "B=2"}});
    EXPECT_EQ(run(), kExitFailure);
    EXPECT_EQ(written, "{\"Cell\":{\"A\":\"1\"}}\n{\"Cell\":{\"B\":\"2\"}}\n");
    EXPECT_EQ(reports, std::vector<std::string>{"cut.pcap ends in the middle of packet 2"});
}

TEST_F(DecodeCommandTest, AMissingRecordingDoesNotKeepTheOthersFromBeingDecoded) {
    options.recordings.emplace_back("missing.pcap");
    add("b.pcap", {{milliseconds(0), "B=2"}});
    EXPECT_EQ(run(), kExitFailure);
    EXPECT_EQ(written, "{\"Cell\":{\"B\":\"2\"}}\n");
    EXPECT_EQ(reports, std::vector<std::string>{"missing.pcap is not there."});
}

TEST_F(DecodeCommandTest, AForeignLinkTypeNeedsTheTechnologyOption) {
    add("foreign.pcap", {{milliseconds(0), "A=1"}}, nullptr);
    EXPECT_EQ(run(), kExitFailure);
    EXPECT_EQ(written, "");
    EXPECT_EQ(reports, std::vector<std::string>{"foreign.pcap has a foreign link type"});

    options = {};
    options.technology = &doubles::kScriptedLte;
    add("foreign.pcap", {{milliseconds(0), "A=1"}}, nullptr);
    EXPECT_EQ(run(), kExitSuccess);
    EXPECT_EQ(written, "{\"Cell\":{\"A\":\"1\"}}\n");
}

TEST_F(DecodeCommandTest, ATechnologyWithoutAGeneratorIsNamed) {
    add("other.pcap", {{milliseconds(0), "A=1"}}, &doubles::kUnknownToGenerators);
    EXPECT_EQ(run(), kExitFailure);
    EXPECT_EQ(reports, std::vector<std::string>{
                           "other.pcap: there is no log generator for the technology Another."});
}

/// A recording that knows its size, like a file.
class ScriptedFile final : public Recording {
public:
    explicit ScriptedFile(ScriptedRecording recording) : _recording(std::move(recording)) {}
    const std::string& name() const override { return _recording.name(); }
    int linkType() const override { return _recording.linkType(); }
    const RecordedTechnology* technology() const override { return _recording.technology(); }
    RecordingError foreignLinkType() const override { return _recording.foreignLinkType(); }
    std::optional<RecordedPacket> next() override { return _recording.next(); }
    std::optional<std::uint64_t> position() const override { return 0; }
    const std::optional<RecordingError>& error() const override { return _recording.error(); }

private:
    ScriptedRecording _recording;
};

TEST_F(DecodeCommandTest, WhatARecordingGivesThatIsWaitedForIsWrittenAtOnceAndAFileInBlocks) {
    options.every = Every::Packet;
    const Packets packets{{milliseconds(0), "A=1"}, {milliseconds(1), "A=2"}};
    options.recordings.emplace_back("file.pcap");
    opens["file.pcap"] = [&packets] {
        return std::make_unique<ScriptedFile>(ScriptedRecording("file.pcap", packets));
    };
    add("pipe", packets);
    EXPECT_EQ(run(), kExitSuccess);
    const std::string first =
        R"({"packet":1,"time":"2023-11-14T22:13:20.000Z","display":{"Cell":{"A":"1"}}})"
        "\n";
    const std::string second =
        R"({"packet":2,"time":"2023-11-14T22:13:20.001Z","display":{"Cell":{"A":"2"}}})"
        "\n";
    EXPECT_EQ(blocks, (std::vector<std::string>{first + second, first, second}));
}

TEST_F(DecodeCommandTest, ATemplateThatCannotBeLoadedIsNotAFatalRecord) {
    add("a.pcap", {{milliseconds(0), "A=1"}});
    add("b.pcap", {{milliseconds(0), "?the template is gone"}});
    try {
        (void)run();
        ADD_FAILURE() << "nothing was thrown";
    } catch (const TemplateFailure& failure) {
        EXPECT_STREQ(failure.what(), "the template is gone");
    }
    EXPECT_EQ(written, "{\"Cell\":{\"A\":\"1\"}}\n") << "earlier displays are written";
    EXPECT_EQ(reports, std::vector<std::string>{});
}

TEST_F(DecodeCommandTest, CsvGivesARowForEachChangeFromTickToTick) {
    options.every = Every::Tick;
    options.format = DecodeFormat::Csv;
    add("a.pcap", {{milliseconds(0), "State=Idle"},
                   {milliseconds(1), "RSRP=-94.75dBm"},
                   {seconds(2), "RSRP=-95dBm"},
                   {seconds(4), "State"},
                   {seconds(4), "Note=a,\"b\""}});
    EXPECT_EQ(run(), kExitSuccess);
    EXPECT_EQ(written, "time,path,value,number,unit\n"
                       "2023-11-14T22:13:22.000Z,/Cell/State,Idle,,\n"
                       "2023-11-14T22:13:22.000Z,/Cell/RSRP,-94.75 dBm,-94.75,dBm\n"
                       "2023-11-14T22:13:24.000Z,/Cell/RSRP,-95.00 dBm,-95.00,dBm\n"
                       "2023-11-14T22:13:26.000Z,/Cell/Note,\"a,\"\"b\"\"\",,\n"
                       "2023-11-14T22:13:26.000Z,/Cell/State,,,\n");
}

TEST_F(DecodeCommandTest, CsvAtTheEndGivesTheFinalValuesWithTheTimeOfTheLastPacket) {
    options.format = DecodeFormat::Csv;
    options.every = Every::End;
    add("a.pcap", {{milliseconds(0), "A=1"}, {milliseconds(2500), "A=2"}});
    add("b.pcap", {{milliseconds(0), "A=2"}});
    EXPECT_EQ(run(), kExitSuccess);
    EXPECT_EQ(written, "time,path,value,number,unit\n"
                       "2023-11-14T22:13:22.500Z,/Cell/A,2,,\n"
                       "2023-11-14T22:13:20.000Z,/Cell/A,2,,\n");
}

} // namespace
} // namespace pallax
