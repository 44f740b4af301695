#include "decoding/EventsCommand.h"

#include "LogGenerator/Technologies/Technologies.h"
#include "plist/PropertyListCodec.h"
#include "tests/decoding/CommandFixture.h"
#include "tests/doubles/Files.h"
#include "tests/doubles/ManualClock.h"
#include "tests/doubles/RecordBuilder.h"

#include <filesystem>
#include <fstream>
#include <functional>

namespace pallax {
namespace {

using doubles::Record;
using doubles::ScriptedRecording;
using std::chrono::seconds;

/// Another serving cell, so many seconds after the first packet.
ScriptedRecording::Packet cell(int second, std::uint16_t pci) {
    return {seconds(second), textOf(Record(0xB0C2).padTo(14).u16(pci).u16(1850).padTo(38).bytes())};
}

class EventsCommandTest : public CommandFixture {
protected:
    void add(const std::string& name, Packets packets, const char* technology = "lte",
             std::optional<RecordingError> atEnd = std::nullopt) {
        options.recordings.push_back(name);
        script(name, std::move(packets), technologyOfCommandName(technology), std::move(atEnd));
    }
    ExitStatus run() {
        const auto openNow = [this](const std::string& path) {
            if (opening) {
                opening(path);
            }
            return open()(path);
        };
        Output output(write());
        return EventsCommand(options, {resources, bundle, notices, technologies()}, openNow,
                             report(), zone)
            .run(output);
    }

    EventsOptions options;
    std::function<void(const std::string& path)> opening;
    DirectoryResources resources{PALLAX_SOURCE_DIR "/resources"};
    doubles::ManualClock zone;
};

TEST_F(EventsCommandTest, ALineHasTheLocalTimeTheKindAndTheWords) {
    zone.setZone({std::chrono::hours(1), false});
    add("a.pcap", {cell(0, 150), cell(31, 182), cell(35, 150)});
    EXPECT_EQ(run(), kExitSuccess);
    EXPECT_EQ(written,
              "2023-11-14 23:13:51.000  cell-change       serving cell 150 → 182 after 31 s\n"
              "2023-11-14 23:13:55.000  ping-pong         serving cell 182 → 150 after 4 s "
              "(ping-pong)\n");
    EXPECT_TRUE(reports.empty());
}

TEST_F(EventsCommandTest, JsonHasThePacketAndTheFields) {
    options.json = true;
    add("a.pcap", {cell(0, 150), cell(31, 182)});
    EXPECT_EQ(run(), kExitSuccess);
    EXPECT_EQ(written, R"({"recording":"a.pcap","time":"2023-11-14T22:13:51.000Z","packet":2,)"
                       R"("kind":"cell-change","words":"serving cell 150 → 182 after 31 s",)"
                       R"("fields":["lte.serving_cell_info.physical_cell_id",)"
                       R"("lte.serving_cell_info.download_frequency"]})"
                       "\n");
}

TEST_F(EventsCommandTest, OfSeveralRecordingsEachLineNamesItsOwnAndOneThatFailsStopsNoOther) {
    add("a.pcap", {cell(0, 1), cell(100, 2)});
    options.recordings.emplace_back("missing.pcap");
    add("b.pcap", {cell(0, 3), cell(20, 4)}, "lte",
        RecordingError{RecordingError::Kind::CutShort, "b.pcap ends in the middle of a packet."});
    EXPECT_EQ(run(), kExitFailure);
    EXPECT_EQ(written,
              "a.pcap: 2023-11-14 22:15:00.000  gap               no packets for 100.0 s\n"
              "a.pcap: 2023-11-14 22:15:00.000  cell-change       serving cell 1 → 2\n"
              "b.pcap: 2023-11-14 22:13:40.000  cell-change       serving cell 3 → 4 after 20 s\n");
    EXPECT_EQ(reports, (std::vector<std::string>{"missing.pcap is not there.",
                                                 "b.pcap ends in the middle of a packet."}));
}

TEST_F(EventsCommandTest, TheSecondPartOfARecordingContinuesTheStateOfTheFirst) {
    add("a-0002.pcap", {cell(31, 182)});
    add("a-0001.pcap", {cell(0, 150)});
    EXPECT_EQ(run(), kExitSuccess);
    EXPECT_EQ(written, "2023-11-14 22:13:51.000  cell-change       serving cell 150 → 182 after "
                       "31 s\n");
    EXPECT_TRUE(reports.empty());
    options.json = true;
    EXPECT_EQ(run(), kExitSuccess);
    EXPECT_TRUE(written.starts_with(R"({"recording":"a-0001.pcap and 1 more",)")) << written;
    options.json = false;
    add("a-0004.pcap", {cell(40, 7)});
    add("other.pcap", {cell(0, 1), cell(9, 2)});
    EXPECT_EQ(run(), kExitSuccess);
    EXPECT_EQ(written, "a-0001.pcap and 2 more: 2023-11-14 22:13:51.000  cell-change       serving "
                       "cell 150 → 182 after 31 s\n"
                       "a-0001.pcap and 2 more: 2023-11-14 22:14:00.000  cell-change       serving "
                       "cell 182 → 7 after 9 s\n"
                       "other.pcap: 2023-11-14 22:13:29.000  cell-change       serving cell 1 → 2 "
                       "after 9 s\n");
    EXPECT_EQ(reports, std::vector<std::string>{"a-0002.pcap and a-0004.pcap are read as one, "
                                                "without the part between them: a-0003.pcap."});
}

TEST_F(EventsCommandTest, TheSecondPartAloneBeginsWithoutAState) {
    add("a-0002.pcap", {cell(31, 182)});
    EXPECT_EQ(run(), kExitSuccess);
    EXPECT_EQ(written, "");
    EXPECT_TRUE(reports.empty());
}

TEST_F(EventsCommandTest, ANameIsPartOfOneLine) {
    add("a\n\x1B.pcap", {cell(0, 1), cell(9, 2)});
    add("b", {});
    EXPECT_EQ(run(), kExitSuccess);
    EXPECT_TRUE(written.starts_with("a\\x0A\\x1B.pcap: 2023")) << written;
}

TEST_F(EventsCommandTest, AFatalRecordIsTheLastEventOfItsRecording) {
    const std::string unreadable = textOf(Record(0xFF0000).u8(1).bytes());
    add("a.pcap", {cell(0, 1), {seconds(1), unreadable}, cell(2, 2)});
    EXPECT_EQ(run(), kExitFatalRecord);
    EXPECT_EQ(written, "2023-11-14 22:13:21.000  fatal-record      fatal record: the embedded "
                       "property list cannot be parsed\n");
    EXPECT_EQ(reports,
              std::vector<std::string>{"a.pcap: packet 2 cannot be read; the events end there."});
}

TEST_F(EventsCommandTest, ATechnologyThatIsNamedOverridesTheLinkType) {
    add("a.pcap", {cell(0, 1), cell(9, 2)}, "gsm");
    options.technology = technologyOfCommandName("lte");
    EXPECT_EQ(run(), kExitSuccess);
    EXPECT_NE(written.find("serving cell 1 → 2"), std::string::npos);
}

TEST_F(EventsCommandTest, AForeignLinkTypeIsAnError) {
    add("a.pcap", {cell(0, 1)}, "umts");
    EXPECT_EQ(run(), kExitFailure);
    EXPECT_EQ(reports, std::vector<std::string>{"a.pcap has a foreign link type"});
}

TEST_F(EventsCommandTest, TooManyPathsOfMessagesAreTold) {
    Dictionary many;
    for (int number = 0; number < 5000; ++number) {
        many.set("P" + std::to_string(number), "1");
    }
    add("a.pcap", {{seconds(0), *serializeXml(many)}}, "ifx");
    EXPECT_EQ(run(), kExitFailure);
    EXPECT_EQ(reports, std::vector<std::string>{
                           "a.pcap: Only the first 4,096 paths of the messages are fields."});
}

TEST_F(EventsCommandTest, ARecordingThatChangesMeanwhileIsTold) {
    const doubles::TemporaryFolder folder;
    const std::string path = folder.write("drive.pcap", "content");
    const auto reportAfter = [&](std::function<void()> change) {
        options.recordings.clear();
        add(path, {cell(0, 1), cell(20, 2)});
        (void)folder.write("drive.pcap", "content");
        opening = [&change](const std::string& /*path*/) { change(); };
        EXPECT_EQ(run(), kExitFailure);
        return reports.size() == 1 ? reports.front() : std::to_string(reports.size());
    };
    EXPECT_EQ(reportAfter([&] { std::ofstream(path, std::ios::app) << "more"; }),
              path + " has grown while it was read.");
    EXPECT_EQ(reportAfter([&] { std::filesystem::resize_file(path, 3); }),
              path + " has become shorter while it was read.");
    EXPECT_EQ(reportAfter([&] {
                  (void)folder.write("other.pcap", "content");
                  std::filesystem::rename(folder.path("other.pcap"), path);
              }),
              path + " was replaced or removed while it was read.");
    EXPECT_EQ(reportAfter([&] { std::filesystem::remove(path); }),
              path + " was replaced or removed while it was read.");
}

TEST_F(EventsCommandTest, EventsOfAStreamAreWrittenWhenTheyHappen) {
    add("a.pcap", {cell(0, 1), cell(20, 2), cell(40, 3)});
    EXPECT_EQ(run(), kExitSuccess);
    EXPECT_EQ(blocks.size(), 2U); // a scripted recording has no position, like a pipe
}

} // namespace
} // namespace pallax
