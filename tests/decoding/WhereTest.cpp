#include "LogGenerator/Technologies/Technologies.h"
#include "decoding/DecodeCommand.h"
#include "decoding/DroppedNotices.h"
#include "decoding/EventsCommand.h"
#include "decoding/RequiredTemplates.h"
#include "host/Snapshot.h"
#include "tests/decoding/ScriptedRadio.h"
#include "tests/doubles/FakeBundle.h"
#include "tests/doubles/ManualClock.h"
#include "tests/doubles/RecordBuilder.h"

#include <gtest/gtest.h>

#include <map>

// --where of decode and events.

namespace pallax {
namespace {

using doubles::Record;
using doubles::ScriptedRecording;
using std::chrono::milliseconds;
using std::chrono::seconds;
using Lines = std::vector<std::string>;
using Packets = std::vector<ScriptedRecording::Packet>;

/// The serving cell.
ScriptedRecording::Packet cell(milliseconds since, std::uint16_t pci) {
    const ByteBuffer bytes = Record(0xB0C2).padTo(14).u16(pci).u16(1850).padTo(38).bytes();
    return {since, {bytes.begin(), bytes.end()}};
}

ScriptedRecording::Packet message(milliseconds since, const std::string& content) {
    return {since, "<plist><dict>" + content + "</dict></plist>"};
}

class WhereTest : public testing::Test {
protected:
    void add(const std::string& name, Packets packets,
             const RecordedTechnology* technology = technologyOfCommandName("lte")) {
        decode.recordings.push_back(name);
        events.recordings.push_back(name);
        recordings[name] =
            std::make_unique<ScriptedRecording>(name, std::move(packets), technology);
    }

    /// What decode writes of each display: the number of its tick or packet.
    Lines decoded(const std::string& where) {
        decode.where = where;
        written.clear();
        Output output([this](std::string_view block) { written += block; });
        status = DecodeCommand(decode, environment, open(), report()).run(output);
        return linesIn(written);
    }
    Lines happened(const std::string& where) {
        events.where = where;
        written.clear();
        Output output([this](std::string_view block) { written += block; });
        status = EventsCommand(events, environment, open(), report(), zone).run(output);
        return linesIn(written);
    }
    /// The first number of each line.
    static Lines numbersIn(const Lines& lines) {
        Lines numbers;
        for (const std::string& line : lines) {
            const std::size_t start = line.find(':') + 1;
            numbers.push_back(line.substr(start, line.find(',') - start));
        }
        return numbers;
    }

    DecodeCommand::Open open() {
        return [this](const std::string& path) -> Recording::OpenResult {
            return std::move(recordings.at(path));
        };
    }
    DecodeCommand::Report report() {
        return [this](std::string_view sentence) { reports.emplace_back(sentence); };
    }
    static Lines linesIn(const std::string& text) {
        Lines lines;
        for (std::size_t start = 0; start < text.size();) {
            const std::size_t end = text.find('\n', start);
            lines.push_back(text.substr(start, end - start));
            start = end + 1;
        }
        return lines;
    }

    DecodeOptions decode;
    EventsOptions events;
    ExitStatus status = kExitSuccess;
    std::map<std::string, std::unique_ptr<Recording>> recordings;
    std::string written;
    Lines reports;
    DirectoryResources resources{PALLAX_SOURCE_DIR "/resources"};
    doubles::FakeBundle bundle;
    DroppedNotices notices;
    DecoderEnvironment environment{resources, bundle, notices, technologies()};
    doubles::ManualClock zone;
};

const Packets kCells = {cell(seconds(0), 10), cell(seconds(1), 20), cell(seconds(3), 30),
                        cell(seconds(5), 20), cell(seconds(6), 10)};

TEST_F(WhereTest, WritesThePacketsAfterWhichItHolds) {
    decode.every = Every::Packet;
    add("a.pcap", kCells);
    EXPECT_EQ(numbersIn(decoded("serving_cell_info_physical_cell_id = 20")), (Lines{"2", "4"}));
    EXPECT_EQ(status, kExitSuccess);
    EXPECT_EQ(reports, Lines{});
}

TEST_F(WhereTest, WritesTheTicksAtWhichItHolds) {
    decode.every = Every::Tick;
    add("a.pcap", kCells);
    EXPECT_EQ(
        numbersIn(decoded("serving_cell_info_physical_cell_id > 15 and packet < 4 and tick > 0 "
                          "and serving_cell_info_physical_cell_id_age = 1")),
        (Lines{"1", "2"}))
        << written;
    EXPECT_EQ(reports, Lines{});
}

TEST_F(WhereTest, WritesTheDisplayAtTheEndIfItHoldsThere) {
    add("a.pcap", kCells);
    EXPECT_EQ(decoded("serving_cell_info_physical_cell_id = 20"), Lines{});
    EXPECT_EQ(status, kExitSuccess);
    add("b.pcap", kCells);
    decode.recordings = {"b.pcap"};
    EXPECT_EQ(
        decoded("serving_cell_info_physical_cell_id = 10 and tick is null and packet = 5").size(),
        1U);
}

TEST_F(WhereTest, ARowOfCsvIsAChangeSinceTheDisplayThatWasWrittenBefore) {
    decode.every = Every::Packet;
    decode.format = DecodeFormat::Csv;
    add("a.pcap", {cell(seconds(0), 10), cell(seconds(1), 20), cell(seconds(3), 10),
                   cell(seconds(4), 20), cell(seconds(5), 30), cell(seconds(6), 20)});
    Lines cells;
    for (const std::string& line : decoded("serving_cell_info_physical_cell_id <> 10 and "
                                           "serving_cell_info_physical_cell_id <> 30")) {
        if (line.find("Physical Cell ID") != std::string::npos) {
            cells.push_back(line);
        }
    }
    EXPECT_EQ(cells, Lines{"2023-11-14T22:13:21.000Z,/Serving Cell Info/Physical Cell ID,20,20,"})
        << "the cells between are in no display that is written";
}

TEST_F(WhereTest, TheWindowComesFirst) {
    decode.every = Every::Packet;
    decode.window.from = TimeText::parse("+4s").value();
    decode.select = {"lte.serving_cell_info.physical_cell_id"};
    add("a.pcap", kCells);
    EXPECT_EQ(decoded("serving_cell_info_physical_cell_id = 20"),
              Lines{R"({"packet":4,"time":"2023-11-14T22:13:25.000Z","display":)"
                    R"({"Serving Cell Info":{"Physical Cell ID":"20"}}})"});
}

TEST_F(WhereTest, AWrongConditionIsOneSentenceAndEndsTheCommand) {
    add("a.pcap", kCells);
    add("b.pcap", kCells);
    const Lines sentences{
        "--where: no such column: serving_cell_info_physical_cell_ib. Did you mean "
        "\"serving_cell_info_physical_cell_id\"? (line 1, column 1 of the condition)"};
    EXPECT_EQ(decoded("serving_cell_info_physical_cell_ib = 20"), Lines{});
    EXPECT_EQ(status, kExitWrongUsage);
    EXPECT_EQ(reports, sentences);
    add("c.pcap", kCells);
    events.recordings = {"c.pcap", "c.pcap"};
    reports.clear();
    EXPECT_EQ(happened("serving_cell_info_physical_cell_ib = 20"), Lines{});
    EXPECT_EQ(status, kExitWrongUsage);
    EXPECT_EQ(reports, sentences);
}

TEST_F(WhereTest, AValueThatCannotBeComputedEndsTheCommand) {
    add("a.pcap", kCells);
    EXPECT_THROW(
        (void)decoded(
            "quality('lte.serving_cell_measurements.measured_rsrp', packet, 'unknown') is null"),
        ConditionFailure);
    add("b.pcap", kCells);
    events.recordings = {"b.pcap"};
    try {
        (void)happened(
            "quality('lte.serving_cell_measurements.measured_rsrp', packet, 'unknown') is null");
        FAIL();
    } catch (const ConditionFailure& failure) {
        EXPECT_STREQ(failure.what(), "--where: there is no profile \"unknown\"");
    }
}

TEST_F(WhereTest, ASnapshotHasNoPackets) {
    add("a.pallax", {}, &kSnapshotTechnology);
    EXPECT_EQ(decoded("packet = 1"), Lines{});
    EXPECT_EQ(status, kExitFailure);
    EXPECT_EQ(reports, Lines{"a.pallax is a snapshot, which holds a few displays and no packets."});
}

TEST_F(WhereTest, ANameThatAnObjectStreamNeverShowsIsTold) {
    decode.every = Every::Packet;
    add("a.pcap",
        {message(seconds(0), "<key>RR</key><string>IDLE</string>"),
         message(seconds(1), "<key>Fan</key><string>7 Hz</string>")},
        technologyOfCommandName("ifx"));
    EXPECT_EQ(numbersIn(decoded("fan > 6 and foil is null")), Lines{"2"});
    EXPECT_EQ(status, kExitSuccess);
    EXPECT_EQ(reports, Lines{"a.pcap: no packet has the field \"foil\" of the condition."});
    add("b.pcap", {message(seconds(0), "<key>RR</key><string>IDLE</string>")},
        technologyOfCommandName("ifx"));
    events.recordings = {"b.pcap"};
    EXPECT_EQ(happened("foil is null"), Lines{});
    EXPECT_EQ(reports.back(), "b.pcap: no packet has the field \"foil\" of the condition.");
}

TEST_F(WhereTest, EventsSeeTheStateAfterTheirPacket) {
    add("a.pcap", kCells);
    const Lines lines =
        happened("kind = 'cell-change' and serving_cell_info_physical_cell_id = 20 and packet < 4 "
                 "and words like '%10%' and tick is null");
    ASSERT_EQ(lines.size(), 1U);
    EXPECT_NE(lines.front().find("serving cell 10 → 20"), std::string::npos) << lines.front();
    EXPECT_EQ(status, kExitSuccess);
    EXPECT_EQ(reports, Lines{});
}

TEST_F(WhereTest, AGapHasTheStateAfterIt) {
    add("a.pcap", {cell(seconds(0), 10), cell(seconds(100), 20)});
    EXPECT_EQ(happened("serving_cell_info_physical_cell_id = 20 and kind = 'gap'").size(), 1U);
}

} // namespace
} // namespace pallax
