#include "decoding/WideOutput.h"

#include "host/Snapshot.h"
#include "tests/decoding/ValuesFixture.h"

namespace pallax {
namespace {

using doubles::Record;
using std::chrono::milliseconds;
using std::chrono::seconds;

/// `decode --wide`.
class WideOutputTest : public ValuesFixture {
protected:
    WideOutputTest() {
        options.view = DecodeView::Wide;
        options.select = {"lte.measured_neighbor_cells.filtered_rsrp",
                          "lte.serving_cell_info.download_bandwidth"};
    }
};

TEST_F(WideOutputTest, AnEntryHasItsColumnWhereverItStandsInTheList) {
    add("a.pcap", {{seconds(0), neighbors({275})},
                   {seconds(3), neighbors({7, 275})},
                   {seconds(5), textOf(Record(0xB0C2).padTo(38).bytes())},
                   {seconds(8), neighbors({9})}});
    const std::string columns = "lte.serving_cell_info.download_bandwidth,"
                                "lte.measured_neighbor_cells.filtered_rsrp[Physical Cell ID 275],"
                                "lte.measured_neighbor_cells.filtered_rsrp[Physical Cell ID 7],"
                                "lte.measured_neighbor_cells.filtered_rsrp[Physical Cell ID 9]\n";
    EXPECT_EQ(run(), kExitSuccess);
    EXPECT_EQ(written, "time,tick," + columns +
                           "2023-11-14T22:13:22.000Z,1,,-98.25,,\n"
                           "2023-11-14T22:13:24.000Z,2,,-98.25,-98.25,\n"
                           "2023-11-14T22:13:26.000Z,3,Unknown,-98.25,-98.25,\n"
                           "2023-11-14T22:13:30.000Z,5,Unknown,,,-98.25\n");
    EXPECT_EQ(reports, std::vector<std::string>());
    options.every = Every::Packet;
    EXPECT_EQ(run(), kExitSuccess);
    EXPECT_EQ(written, "time,packet," + columns +
                           "2023-11-14T22:13:20.000Z,1,,-98.25,,\n"
                           "2023-11-14T22:13:23.000Z,2,,-98.25,-98.25,\n"
                           "2023-11-14T22:13:25.000Z,3,Unknown,-98.25,-98.25,\n"
                           "2023-11-14T22:13:28.000Z,4,Unknown,,,-98.25\n");
    options.every = std::nullopt;
    options.recordingColumn = true;
    options.at = TimeText::parse("+3.5s").value();
    EXPECT_EQ(run(), kExitSuccess);
    EXPECT_EQ(written, "recording,time,packet,"
                       "lte.measured_neighbor_cells.filtered_rsrp[Physical Cell ID 275],"
                       "lte.measured_neighbor_cells.filtered_rsrp[Physical Cell ID 7]\n"
                       "a.pcap,2023-11-14T22:13:23.000Z,2,-98.25,-98.25\n");
}

TEST_F(WideOutputTest, AConditionChoosesItsRows) {
    add("a.pcap", {{seconds(0), neighbors({275})},
                   {seconds(3), textOf(Record(0xB0C2).padTo(38).bytes())},
                   {seconds(8), neighbors({9})}});
    options.select = {"lte.serving_cell_info.download_bandwidth"};
    options.where = "lte.serving_cell_info.download_bandwidth = 'Unknown' and packet <> 3";
    options.every = Every::Packet;
    EXPECT_EQ(run(), kExitSuccess);
    EXPECT_EQ(written, "time,packet,lte.serving_cell_info.download_bandwidth\n"
                       "2023-11-14T22:13:23.000Z,2,Unknown\n");
    options.every = Every::Tick;
    EXPECT_EQ(run(), kExitSuccess);
    EXPECT_EQ(written, "time,tick,lte.serving_cell_info.download_bandwidth\n"
                       "2023-11-14T22:13:24.000Z,2,Unknown\n");
}

TEST_F(WideOutputTest, WhatIsOddIsToldOnce) {
    add("a.pcap",
        {{seconds(0), textOf(Record(0xFF0000).u8(1).bytes())}, {seconds(100), neighbors({275})}});
    EXPECT_EQ(run(), kExitSuccess);
    EXPECT_EQ(written, "time,tick,lte.measured_neighbor_cells.filtered_rsrp[Physical Cell ID 275]\n"
                       "2023-11-14T22:15:02.000Z,51,-98.25\n");
    EXPECT_EQ(reports, (std::vector<std::string>{
                           "a.pcap: packet 1 (log code 0xFF0000): the embedded property "
                           "list cannot be parsed",
                           "a.pcap: no packets for 100.0 s before packet 2."}));
}

TEST_F(WideOutputTest, TooManyColumnsAreRefused) {
    Packets packets;
    for (std::uint16_t cell = 0; cell < 16385; cell = static_cast<std::uint16_t>(cell + 20)) {
        std::vector<std::uint16_t> cells;
        for (std::uint16_t next = 0; next < 20; ++next) {
            cells.push_back(static_cast<std::uint16_t>(cell + next));
        }
        packets.push_back({milliseconds(cell), neighbors(cells)});
    }
    add("a.pcap", packets);
    EXPECT_EQ(run(), kExitFailure);
    EXPECT_EQ(written, "");
    EXPECT_EQ(reports, std::vector<std::string>{
                           "a.pcap has more than 16384 columns; choose fields with --select."});
}

TEST_F(WideOutputTest, AStreamIsRefused) {
    class Stream final : public doubles::ScriptedRecording {
    public:
        using ScriptedRecording::ScriptedRecording;
        bool isStream() const override { return true; }
    };
    options.recordings = {"-"};
    opens["-"] = [] { return std::make_unique<Stream>("standard input", Packets{}); };
    EXPECT_EQ(run(), kExitFailure);
    EXPECT_EQ(reports, std::vector<std::string>{
                           "standard input: --wide needs a file, because the columns must be known "
                           "before the first row."});
}

TEST_F(WideOutputTest, OfAnEmptyRecordingThereIsAHead) {
    add("a.pcap", {});
    EXPECT_EQ(run(), kExitSuccess);
    EXPECT_EQ(written, "time,tick\n");
}

TEST_F(WideOutputTest, ASnapshotHasNoColumns) {
    options.recordings = {"a.pallax"};
    script("a.pallax", {}, &kSnapshotTechnology);
    EXPECT_EQ(run(), kExitFailure);
    EXPECT_EQ(reports, std::vector<std::string>{
                           "a.pallax is a snapshot, which holds a few displays and no packets."});
}

} // namespace
} // namespace pallax
