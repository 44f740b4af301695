#include "watching/WatchCommand.h"

#include "LogGenerator/Technologies/Technologies.h"
#include "tests/decoding/CommandFixture.h"
#include "tests/doubles/ManualClock.h"
#include "tests/doubles/RecordBuilder.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using doubles::Record;
using doubles::ScriptedRecording;
using std::chrono::seconds;
using Lines = std::vector<std::string>;

/// A serving cell on this channel, so many seconds after the first packet.
ScriptedRecording::Packet on(int second, std::uint16_t channel) {
    return {seconds(second),
            textOf(Record(0xB0C2).padTo(14).u16(150).u16(channel).padTo(38).bytes())};
}

/// Channel 7 from 22:13:22 to 22:13:28, and again at the end, at 22:13:32.
std::vector<ScriptedRecording::Packet> twiceOnChannel7() {
    return {on(0, 1), on(3, 7), on(5, 7), on(7, 7), on(9, 1), on(11, 7)};
}

class NotedAction final : public WatchAction {
public:
    void run(const std::string& time, const Variables& variables) override {
        runs.push_back(time);
        latest = variables;
        if (running) {
            running();
        }
    }
    void look() override { ++looks; }
    void finish() override { isFinished = true; }

    Lines runs;
    Variables latest;
    int looks = 0;
    bool isFinished = false;
    std::function<void()> running;
};

class WatchCommandTest : public CommandFixture {
protected:
    void add(const std::string& name, Packets packets, const char* technology = "lte",
             std::optional<RecordingError> atEnd = std::nullopt) {
        options.recordings.push_back(name);
        script(name, std::move(packets), technologyOfCommandName(technology), std::move(atEnd));
    }
    ExitStatus run() {
        Output output(write());
        const DecoderEnvironment decoder{resources, bundle, notices, technologies()};
        const ExitStatus status =
            WatchCommand(options, {decoder, open(), report(), zone, action}).run(output);
        output.flush();
        return status;
    }

    WatchOptions options{"download_frequency = 7", {}};
    DirectoryResources resources{PALLAX_SOURCE_DIR "/resources"};
    doubles::ManualClock zone;
    NotedAction action;
};

TEST_F(WatchCommandTest, TellsEachTimeThatTheConditionBecomesTrueAndEnds) {
    zone.setZone({std::chrono::hours(1), false});
    add("a.pcap", twiceOnChannel7());
    EXPECT_EQ(run(), kExitFailure);
    EXPECT_EQ(written,
              "2023-11-14 23:13:24.000  holds             download_frequency = 7\n"
              "2023-11-14 23:13:30.000  ended             download_frequency = 7 (held for "
              "6 s)\n"
              "2023-11-14 23:13:32.000  holds             download_frequency = 7\n");
    EXPECT_TRUE(reports.empty());
    EXPECT_EQ(action.runs, (Lines{"2023-11-14T22:13:24.000Z", "2023-11-14T22:13:32.000Z"}));
    EXPECT_TRUE(action.isFinished);
    EXPECT_EQ(action.looks, 6) << "after each packet";
}

TEST_F(WatchCommandTest, NothingIsWrittenIfTheConditionNeverHolds) {
    options.condition = "download_frequency = 8 or download_frequency_age > 60";
    add("a.pcap", twiceOnChannel7());
    EXPECT_EQ(run(), kExitSuccess);
    EXPECT_EQ(written, "");
    EXPECT_TRUE(reports.empty());
    EXPECT_TRUE(action.runs.empty());
}

TEST_F(WatchCommandTest, ADurationLeavesOutWhatHoldsForLess) {
    options.needed = seconds(4);
    add("a.pcap", twiceOnChannel7());
    EXPECT_EQ(run(), kExitFailure);
    EXPECT_EQ(written,
              "2023-11-14 22:13:28.000  holds             download_frequency = 7\n"
              "2023-11-14 22:13:30.000  ended             download_frequency = 7 (held for "
              "6 s)\n");
    options.needed = seconds(7);
    EXPECT_EQ(run(), kExitSuccess);
    EXPECT_EQ(written, "");
}

TEST_F(WatchCommandTest, OnceEndsAtTheFirstTime) {
    options.once = true;
    add("a.pcap", twiceOnChannel7(), "lte",
        RecordingError{RecordingError::Kind::CutShort, "a.pcap ends in the middle of a packet."});
    add("b.pcap", twiceOnChannel7());
    EXPECT_EQ(run(), kExitFailure);
    EXPECT_EQ(written,
              "a.pcap: 2023-11-14 22:13:24.000  holds             download_frequency = 7\n");
    EXPECT_TRUE(reports.empty()) << "the end is not read";
    EXPECT_EQ(action.runs, Lines{"2023-11-14T22:13:24.000Z"});
    EXPECT_LT(action.looks, 6);
    EXPECT_TRUE(action.isFinished);
}

TEST_F(WatchCommandTest, OnceReadsToTheEndUntilThen) {
    options.once = true;
    options.condition = "download_frequency = 7 and packet = 6"; // the last tick
    add("a.pcap", twiceOnChannel7());
    EXPECT_EQ(run(), kExitFailure);
    EXPECT_EQ(written,
              "2023-11-14 22:13:32.000  holds             download_frequency = 7 and packet "
              "= 6\n");
}

TEST_F(WatchCommandTest, TheActionGetsTheColumnsOfTheConditionAndNoOthers) {
    options.condition = "download_frequency = 7 and lte.serving_cell_info.upload_frequency = 0 and "
                        "measured_rsrp is null and packet > 0 and tick > 0";
    add("a.pcap", twiceOnChannel7());
    bool wasWritten = false;
    action.running = [&] { wasWritten = written.ends_with("tick > 0\n"); };
    EXPECT_EQ(run(), kExitFailure);
    EXPECT_TRUE(wasWritten) << "before the action writes";
    EXPECT_EQ(action.latest, (WatchAction::Variables{
                                 {"PALLAX_CONDITION", options.condition},
                                 {"PALLAX_TIME", "2023-11-14T22:13:32.000Z"},
                                 {"PALLAX_PACKET", "6"},
                                 {"PALLAX_SOURCE", "a.pcap"},
                                 {"PALLAX_DOWNLOAD_FREQUENCY", "7"},
                                 {"PALLAX_MEASURED_RSRP", ""},
                                 {"PALLAX_TICK", "6"},
                                 {"PALLAX_UPLOAD_FREQUENCY", "0"},
                             }));
}

TEST_F(WatchCommandTest, EachRecordingBeginsWithoutAState) {
    add("a.pcap", {on(0, 7)});
    add("b.pcap", {on(10, 7), on(13, 1)});
    EXPECT_EQ(run(), kExitFailure);
    EXPECT_EQ(written,
              "a.pcap: 2023-11-14 22:13:22.000  holds             download_frequency = 7\n"
              "b.pcap: 2023-11-14 22:13:32.000  holds             download_frequency = 7\n"
              "b.pcap: 2023-11-14 22:13:34.000  ended             download_frequency = 7 (held for "
              "2 s)\n");
}

TEST_F(WatchCommandTest, TheNumberedPartsAreOne) {
    add("a-0001.pcap", {on(0, 7)});
    add("a-0002.pcap", {on(3, 7)});
    add("a-0004.pcap", {on(6, 1)});
    EXPECT_EQ(run(), kExitFailure);
    EXPECT_EQ(written,
              "2023-11-14 22:13:22.000  holds             download_frequency = 7\n"
              "2023-11-14 22:13:28.000  ended             download_frequency = 7 (held for "
              "6 s)\n");
    EXPECT_EQ(reports,
              Lines{"a-0002.pcap and a-0004.pcap are read as one, without the part between "
                    "them: a-0003.pcap."});
}

TEST_F(WatchCommandTest, ARecordingThatCannotBeReadIsNotOneWithoutTheCondition) {
    options.recordings.emplace_back("missing.pcap");
    options.condition = "download_frequency = 8";
    add("b.pcap", twiceOnChannel7(), "lte",
        RecordingError{RecordingError::Kind::CutShort, "b.pcap ends in the middle of a packet."});
    EXPECT_EQ(run(), kExitCouldNotTell);
    EXPECT_EQ(reports,
              (Lines{"missing.pcap is not there.", "b.pcap ends in the middle of a packet."}));
    options.condition = "download_frequency = 7";
    EXPECT_EQ(run(), kExitFailure) << "it held before the damage";
    EXPECT_EQ(reports.size(), 2U);
    options.recordings.erase(options.recordings.begin());
    options.condition = "download_frequency = 8";
    EXPECT_EQ(run(), kExitCouldNotTell) << "the damage alone";
}

TEST_F(WatchCommandTest, ARecordThatThrowsIsLeftOut) {
    options.condition = "service_type = 'x'";
    const ByteBuffer unreadable = Record(0xFF0000).append({'n', 'o', ' ', '{'}).prefixed();
    add("a.pcap", {{seconds(0), textOf(unreadable)}}, "gsm");
    EXPECT_EQ(run(), kExitCouldNotTell);
    EXPECT_EQ(reports, Lines{"a.pcap: packet 1 (log code 0xFF0000): the embedded property list "
                             "cannot be parsed"});
}

TEST_F(WatchCommandTest, AWrongConditionIsToldBeforeAnythingIsOpened) {
    options.condition = "download_frequency = ";
    options.recordings = {"missing.pcap"};
    EXPECT_EQ(run(), kExitWrongUsage);
    EXPECT_EQ(reports, Lines{"CONDITION: This is not a whole condition."});
    options.condition = "tme > 1";
    EXPECT_EQ(run(), kExitCouldNotTell) << "only a technology tells the columns";
    options.technology = technologyOfCommandName("lte");
    EXPECT_EQ(run(), kExitWrongUsage);
    EXPECT_EQ(reports, Lines{"CONDITION: no such column: tme. Did you mean \"time\"? (line 1, "
                             "column 1 of the condition)"});
}

TEST_F(WatchCommandTest, AColumnThatTheTechnologyDoesNotHaveEndsTheCommand) {
    options.condition = "download_frequencyd = 7";
    add("a.pcap", twiceOnChannel7());
    add("b.pcap", twiceOnChannel7());
    EXPECT_EQ(run(), kExitWrongUsage);
    EXPECT_EQ(reports, Lines{"CONDITION: no such column: download_frequencyd. Did you mean "
                             "\"download_frequency\"? (line 1, column 1 of the condition)"});
}

TEST_F(WatchCommandTest, AValueThatCannotBeComputedIsNoAnswer) {
    options.condition = "quality('lte.serving_cell_measurements.measured_rsrp', packet, 'x') is "
                        "null";
    add("a.pcap", twiceOnChannel7());
    try {
        (void)run();
        FAIL() << "it was computed";
    } catch (const ConditionFailure& failure) {
        EXPECT_STREQ(failure.what(), "CONDITION: there is no profile \"x\"");
    }
}

TEST_F(WatchCommandTest, AFieldThatAnObjectStreamNeverShowsIsNoted) {
    options.condition = "unheard_of > 1";
    add("a.pcap", {{seconds(0), "<plist><dict><key>RR</key><string>IDLE</string></dict></plist>"}},
        "ifx");
    EXPECT_EQ(run(), kExitSuccess);
    EXPECT_EQ(reports, Lines{"a.pcap: no packet has the field \"unheard_of\" of the condition."});
}

TEST_F(WatchCommandTest, TheTechnologyOfAForeignLinkTypeIsGiven) {
    options.recordings = {"a.pcap"};
    script("a.pcap", twiceOnChannel7(), nullptr);
    EXPECT_EQ(run(), kExitCouldNotTell);
    EXPECT_EQ(reports, Lines{"a.pcap has a foreign link type"});
    options.technology = technologyOfCommandName("lte");
    EXPECT_EQ(run(), kExitFailure);
    EXPECT_TRUE(reports.empty());
}

} // namespace
} // namespace pallax
