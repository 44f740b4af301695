#include "decoding/FieldSelection.h"
#include "tests/decoding/CommandFixture.h"
#include "tests/doubles/FakeResources.h"
#include "tests/doubles/Property.h"

#include <algorithm>

namespace pallax {
namespace {

using std::chrono::milliseconds;

constexpr std::chrono::seconds kEast = std::chrono::hours(1);

/// The options of decode that choose a part of what it writes.
class DecodeOptionsTest : public CommandFixture {
protected:
    void add(const std::string& name, Packets packets,
             const RecordedTechnology* technology = &doubles::kScriptedLte) {
        options.recordings.push_back(name);
        script(name, std::move(packets), technology);
    }
    /// Five packets, a second apart.
    static Packets fivePackets() {
        return {{milliseconds(0), "A=1"},
                {milliseconds(1000), "A=2"},
                {milliseconds(2000), "A=3"},
                {milliseconds(3000), "A=4"},
                {milliseconds(4000), "A=5"}};
    }
    static std::optional<TimeText> time(std::string_view text) {
        return TimeText::parse(text).value();
    }
    ExitStatus run() {
        Output output(write());
        DecodeCommand command(options, {resources, bundle, notices, doubles::kScriptedTechnologies},
                              open(), report(), nullptr, [](Time) { return kEast; });
        return command.run(output);
    }
    /// The values of A in the written displays.
    std::string shown() const {
        std::string values;
        for (std::size_t at = written.find("\"A\":\""); at != std::string::npos;
             at = written.find("\"A\":\"", at + 1)) {
            values += written[at + 5];
        }
        return values;
    }

    DecodeOptions options;
    doubles::FakeResources resources;
};

TEST_F(DecodeOptionsTest, DisplaysOfAWindowAreWritten) {
    add("a.pcap", fivePackets());
    options.every = Every::Packet;
    const auto between = [this](std::optional<TimeText> from, std::optional<TimeText> to) {
        options.window = {std::move(from), std::move(to)};
        EXPECT_EQ(run(), kExitSuccess);
        return shown();
    };
    EXPECT_EQ(between(time("+1s"), time("-1s")), "234");
    EXPECT_EQ(between(time("23:13:22"), std::nullopt), "345");
    EXPECT_EQ(between(std::nullopt, time("2023-11-14T22:13:21.5Z")), "12");
    EXPECT_EQ(between(time("start"), time("end")), "12345");
    options.every = Every::Tick;
    EXPECT_EQ(between(time("start"), time("end")), "24") << "the last tick is after the end";
    EXPECT_EQ(between(time("start"), std::nullopt), "245");
    options.every = Every::Packet;
    EXPECT_EQ(between(time("+10s"), std::nullopt), "");
    EXPECT_EQ(between(std::nullopt, time("2023-11-14T22:13:19Z")), "");
    options.every = Every::Tick;
    EXPECT_EQ(between(time("+3s"), time("+4s")), "4"); // the tick at 4 s, of packets before
}

TEST_F(DecodeOptionsTest, AtIsTheDisplayAsIfTheRecordingEndedThere) {
    for (std::size_t length = 1; length <= 5; ++length) {
        options = {};
        Packets packets = fivePackets();
        packets.resize(length);
        add("short.pcap", packets);
        EXPECT_EQ(run(), kExitSuccess);
        const std::string expected = written;
        options = {};
        add("long.pcap", fivePackets());
        options.at = time("+" + std::to_string(length - 1) + ".9s");
        EXPECT_EQ(run(), kExitSuccess);
        EXPECT_EQ(written, expected);
    }
}

TEST_F(DecodeOptionsTest, AtATimeBeforeTheFirstPacketThereIsNoDisplay) {
    add("a.pcap", fivePackets());
    options.at = time("2023-11-14T22:13:19Z");
    EXPECT_EQ(run(), kExitFailure);
    EXPECT_EQ(written, "");
    EXPECT_EQ(reports, std::vector<std::string>{
                           "a.pcap: every packet is later than the time that is asked for."});
}

TEST_F(DecodeOptionsTest, WhereTheClockWasSetBackTheFirstStretchIsMeant) {
    add("a.pcap", {{milliseconds(100'000), "A=1"},
                   {milliseconds(0), "A=2"},
                   {milliseconds(5000), "A=3"},
                   {milliseconds(1000), "A=4"}});
    options.at = time("2023-11-14T22:13:24Z");
    EXPECT_EQ(run(), kExitSuccess);
    EXPECT_EQ(shown(), "2");
}

TEST_F(DecodeOptionsTest, ATimeThatNoStretchHasIsInTheOneThatEndsLatestBeforeIt) {
    add("a.pcap", {{milliseconds(50'000), "A=1"},
                   {milliseconds(60'000), "A=2"},
                   {milliseconds(0), "A=3"},
                   {milliseconds(10'000), "A=4"}});
    options.at = time("2023-11-14T22:14:30Z"); // 70 s
    EXPECT_EQ(run(), kExitSuccess);
    EXPECT_EQ(shown(), "2");
    options.at = time("2023-11-14T22:13:50Z"); // 30 s
    EXPECT_EQ(run(), kExitSuccess);
    EXPECT_EQ(shown(), "4");
    options.at = time("end");
    EXPECT_EQ(run(), kExitSuccess);
    EXPECT_EQ(shown(), "4");
    options.at = time("2023-11-14T22:13:19Z");
    EXPECT_EQ(run(), kExitFailure);
}

TEST_F(DecodeOptionsTest, AClockTimeMayLieInAStretchBeforeTheFirstPacket) {
    add("a.pcap",
        {{milliseconds(100'000), "A=1"}, {milliseconds(0), "A=2"}, {milliseconds(5000), "A=3"}});
    options.at = time("23:13:22");
    EXPECT_EQ(run(), kExitSuccess);
    EXPECT_EQ(shown(), "2");
    options.at = time("23:13:40"); // between the stretches
    EXPECT_EQ(run(), kExitSuccess);
    EXPECT_EQ(shown(), "3");
    options.at = time("23:13:19");
    EXPECT_EQ(run(), kExitFailure);
    EXPECT_EQ(reports,
              std::vector<std::string>{
                  "a.pcap: \"23:13:19\" is no time of the recording, which lasts from 2023-11-14 "
                  "23:13:20 to 2023-11-14 23:15:00."});
}

TEST_F(DecodeOptionsTest, FromAfterToIsAnError) {
    add("a.pcap", fivePackets());
    options.every = Every::Packet;
    options.window = {time("+3s"), time("+2s")};
    EXPECT_EQ(run(), kExitFailure);
    EXPECT_EQ(written, "");
    EXPECT_EQ(reports,
              std::vector<std::string>{"a.pcap: the time of --from is later than that of --to."});
    const auto areReversed = [](const char* from, const char* to) {
        return DecodeWindow::Texts{time(from), time(to)}.areReversed([](Time) { return kEast; });
    };
    EXPECT_TRUE(areReversed("2023-11-14T22:13:22Z", "2023-11-14T22:13:21Z"));
    EXPECT_TRUE(areReversed("2023-11-14 23:13:22", "2023-11-14T22:13:21Z"));
    EXPECT_FALSE(areReversed("2023-11-14 22:13:22", "2023-11-14T22:13:21Z"));
    EXPECT_FALSE(areReversed("2023-11-14T22:13:21Z", "2023-11-14T22:13:21Z"));
    EXPECT_FALSE(areReversed("+3s", "+2s"));
}

TEST_F(DecodeOptionsTest, AClockTimeThatIsNotInTheRecordingIsAnError) {
    add("a.pcap", fivePackets());
    options.at = time("14:03");
    EXPECT_EQ(run(), kExitFailure);
    EXPECT_EQ(written, "");
    EXPECT_EQ(reports,
              std::vector<std::string>{
                  "a.pcap: \"14:03\" is no time of the recording, which lasts from 2023-11-14 "
                  "23:13:20 to 2023-11-14 23:13:24."});
}

TEST_F(DecodeOptionsTest, CsvRowsMayBeginWithTheRecording) {
    options.format = DecodeFormat::Csv;
    options.recordingColumn = true;
    add("a,b.pcap", {{milliseconds(0), "A=1"}});
    add("c.pcap", {{milliseconds(0), "A=1"}});
    EXPECT_EQ(run(), kExitSuccess);
    EXPECT_EQ(written, "recording,time,path,value,number,unit\n"
                       "\"a,b.pcap\",2023-11-14T22:13:22.000Z,/Cell/A,1,,\n"
                       "c.pcap,2023-11-14T22:13:22.000Z,/Cell/A,1,,\n");
}

TEST_F(DecodeOptionsTest, TypedNumbersAreObjects) {
    add("a.pcap", {{milliseconds(0), "RSRP=-94.75dBm"}, {milliseconds(0), "A=1"}});
    options.typed = true;
    EXPECT_EQ(run(), kExitSuccess);
    EXPECT_EQ(written,
              R"({"Cell":{"RSRP":{"number":-94.75,"unit":"dBm","text":"-94.75 dBm"},"A":"1"}})"
              "\n");
}

TEST_F(DecodeOptionsTest, JoinedRecordingsAreOneInTheOrderOfTheirTimes) {
    add("second.pcap", {{milliseconds(3000), "B=2"}});
    add("first.pcap", {{milliseconds(0), "A=1"}});
    add("empty.pcap", {});
    options.join = true;
    EXPECT_EQ(run(), kExitSuccess);
    EXPECT_EQ(written, R"({"Cell":{"A":"1","B":"2"}})"
                       "\n");
    options.every = Every::Packet;
    EXPECT_EQ(run(), kExitSuccess);
    EXPECT_EQ(written, R"({"packet":1,"time":"2023-11-14T22:13:20.000Z","display":{"Cell":)"
                       R"({"A":"1"}}})"
                       "\n"
                       R"({"packet":2,"time":"2023-11-14T22:13:23.000Z","display":{"Cell":)"
                       R"({"A":"1","B":"2"}}})"
                       "\n");
    EXPECT_EQ(reports, std::vector<std::string>{});
}

TEST_F(DecodeOptionsTest, RecordingsOfTwoTechnologiesAreNotJoined) {
    static constexpr RecordedTechnology kOther{148, "Zorell_GSM", "gsm"};
    add("a.pcap", fivePackets());
    add("b.pcap", fivePackets(), &kOther);
    options.join = true;
    EXPECT_EQ(run(), kExitFailure);
    EXPECT_EQ(written, "");
    EXPECT_EQ(reports, std::vector<std::string>{"b.pcap cannot be joined: its link type is 148, "
                                                "that of a.pcap is 150."});
    options.recordings = {"a.pcap", "missing.pcap"};
    EXPECT_EQ(run(), kExitFailure);
    EXPECT_EQ(reports, std::vector<std::string>{"missing.pcap is not there."});
}

TEST_F(DecodeOptionsTest, AnyCutIntoPartsJoinsToTheWhole) {
    EXPECT_TRUE(doubles::holds([this] {
        Packets packets;
        milliseconds at{0};
        for (const std::uint8_t byte : doubles::any::bytes()) {
            at += milliseconds(1 + byte * 20);
            packets.push_back({at, std::string(1, static_cast<char>('A' + byte % 5)) + "=" +
                                       std::to_string(byte)});
        }
        options = {};
        options.every =
            doubles::any::elementOf(std::vector{Every::End, Every::Tick, Every::Packet});
        add("whole", packets);
        (void)run();
        const std::string whole = written;
        const std::vector<std::string> told = reports;
        options.recordings.clear();
        options.join = true;
        auto begin = packets.begin();
        do {
            const auto left = std::distance(begin, packets.end());
            const auto end = begin + std::min<std::ptrdiff_t>(left, doubles::any::between(1, 11));
            add("part" + std::to_string(options.recordings.size()), {begin, end});
            begin = end;
        } while (begin != packets.end());
        std::reverse(options.recordings.begin(), options.recordings.end());
        (void)run();
        RC_ASSERT(written == whole);
        RC_ASSERT(reports.size() == told.size());
    }));
}

class FieldSelectionTest : public testing::Test {
protected:
    PropertyList selected(const std::vector<std::string>& names) const {
        return FieldSelection(names, lte).of(display);
    }

    DirectoryResources resources{PALLAX_SOURCE_DIR "/resources"};
    FieldRegistry lte{gatherReference(*technologyOfCommandName("lte"), resources)};
    PropertyList display = Dictionary{
        {"Serving Cell Measurements",
         Dictionary{{"Measured RSRP", "-90.00 dBm"}, {"Measured RSRQ", "-9.00 dB"}}},
        {"Neighbor Cells List", Array{Dictionary{{"Physical Cell ID", "7"}, {"Measured RSRP", "1"}},
                                      Dictionary{{"Measured RSRP", "2"}}}},
        {"SIM Info", Dictionary{{"EF-ICCID", Dictionary{{"any", "thing"}}}}}};
};

TEST_F(FieldSelectionTest, KeepsOnlyTheFieldsAndTheirPlaces) {
    EXPECT_EQ(selected({"lte.serving_cell_measurements.measured_rsrp"}),
              PropertyList(Dictionary{
                  {"Serving Cell Measurements", Dictionary{{"Measured RSRP", "-90.00 dBm"}}}}));
    EXPECT_EQ(
        selected({"lte.neighbor_cells_list.physical_cell_id"}),
        PropertyList(Dictionary{
            {"Neighbor Cells List", Array{Dictionary{{"Physical Cell ID", "7"}}, Dictionary{}}}}));
    EXPECT_EQ(selected({"*.ef_iccid", "lte.serving*_rsr?"}),
              PropertyList(Dictionary{
                  {"Serving Cell Measurements",
                   Dictionary{{"Measured RSRP", "-90.00 dBm"}, {"Measured RSRQ", "-9.00 dB"}}},
                  {"SIM Info", Dictionary{{"EF-ICCID", Dictionary{{"any", "thing"}}}}}}));
    EXPECT_EQ(selected({"gsm.*"}), PropertyList(Dictionary{}));
    EXPECT_TRUE(FieldSelection({"lte.*"}, lte).of({}).isNull());
}

TEST_F(FieldSelectionTest, EveryFieldAtOnceIsTheWholeDisplay) {
    EXPECT_EQ(selected({"*"}), display);
}

TEST_F(FieldSelectionTest, ATextInPlaceOfAListIsKept) {
    display = Dictionary{{"Neighbor Cells List", ""}, {"Serving Cell Info", Dictionary{}}};
    EXPECT_EQ(selected({"*"}), PropertyList(Dictionary{{"Neighbor Cells List", ""}}));
}

TEST_F(FieldSelectionTest, ANameOfNoTechnologyIsUnknown) {
    const auto unknown = [this](const std::vector<std::string>& names) {
        return FieldSelection::unknownName(names, resources);
    };
    EXPECT_EQ(unknown({"lte.serving_cell_measurements.measured_rsrp", "gsm.*", "ifx.network.name"}),
              std::nullopt);
    EXPECT_EQ(unknown({"gsm.*", "lte.serving_cell"}), "lte.serving_cell");
    EXPECT_EQ(unknown({""}), "");
}

} // namespace
} // namespace pallax
