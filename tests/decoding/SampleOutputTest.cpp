#include "decoding/SampleOutput.h"

#include "host/Snapshot.h"
#include "plist/PropertyListCodec.h"
#include "tests/decoding/ValuesFixture.h"

namespace pallax {
namespace {

using doubles::Record;
using std::chrono::milliseconds;
using std::chrono::seconds;

/// `decode --samples`.
class SampleOutputTest : public ValuesFixture {
protected:
    SampleOutputTest() { options.view = DecodeView::Samples; }
};

TEST_F(SampleOutputTest, ALineHasOneValueOfOnePacket) {
    options.select = {"lte.measured_neighbor_cells.*_rsrp", "lte.serving*.download_bandwidth"};
    add("a.pcap", {{milliseconds(0), neighbors({275})},
                   {milliseconds(250), neighbors({7, 275})},
                   {milliseconds(500), textOf(Record(0xB0C2).padTo(38).bytes())}});
    EXPECT_EQ(run(), kExitSuccess);
    EXPECT_EQ(written, R"({"time":"2023-11-14T22:13:20.000Z","packet":1,)"
                       R"("field":"lte.measured_neighbor_cells.filtered_rsrp","index":1,)"
                       R"("entry":"Physical Cell ID 275","raw":167,"value":-98.25,"unit":"dBm"})"
                       "\n"
                       R"({"time":"2023-11-14T22:13:20.250Z","packet":2,)"
                       R"("field":"lte.measured_neighbor_cells.filtered_rsrp","index":1,)"
                       R"("entry":"Physical Cell ID 7","raw":167,"value":-98.25,"unit":"dBm"})"
                       "\n"
                       R"({"time":"2023-11-14T22:13:20.250Z","packet":2,)"
                       R"("field":"lte.measured_neighbor_cells.filtered_rsrp","index":2,)"
                       R"("entry":"Physical Cell ID 275","raw":167,"value":-98.25,"unit":"dBm"})"
                       "\n"
                       R"({"time":"2023-11-14T22:13:20.500Z","packet":3,)"
                       R"("field":"lte.serving_cell_info.download_bandwidth","index":null,)"
                       R"("entry":null,"raw":0,"value":"Unknown","unit":null})"
                       "\n");
    options.format = DecodeFormat::Csv;
    EXPECT_EQ(run(), kExitSuccess);
    EXPECT_EQ(written, "time,packet,field,index,entry,raw,value,unit\n"
                       "2023-11-14T22:13:20.000Z,1,lte.measured_neighbor_cells.filtered_rsrp,1,"
                       "Physical Cell ID 275,167,-98.25,dBm\n"
                       "2023-11-14T22:13:20.250Z,2,lte.measured_neighbor_cells.filtered_rsrp,1,"
                       "Physical Cell ID 7,167,-98.25,dBm\n"
                       "2023-11-14T22:13:20.250Z,2,lte.measured_neighbor_cells.filtered_rsrp,2,"
                       "Physical Cell ID 275,167,-98.25,dBm\n"
                       "2023-11-14T22:13:20.500Z,3,lte.serving_cell_info.download_bandwidth,,,0,"
                       "Unknown,\n");
}

TEST_F(SampleOutputTest, ANumberInATextIsTheValueAndTheRestItsUnit) {
    const auto message = serializeBinary(
        Dictionary{{"Cell", Dictionary{{"Level", "-96.0 dBm"}, {"Load", "7%"}, {"Name", "a, 1 b"}}},
                   {"Count", "62"}});
    add("a.pcap", {{milliseconds(0), textOf(*message)}}, "ifx");
    options.format = DecodeFormat::Csv;
    EXPECT_EQ(run(), kExitSuccess);
    EXPECT_EQ(written, "time,packet,field,index,entry,raw,value,unit\n"
                       "2023-11-14T22:13:20.000Z,1,ifx.cell.level,,,,-96,dBm\n"
                       "2023-11-14T22:13:20.000Z,1,ifx.cell.load,,,,7,%\n"
                       "2023-11-14T22:13:20.000Z,1,ifx.cell.name,,,,\"a, 1 b\",\n"
                       "2023-11-14T22:13:20.000Z,1,ifx.count,,,,62,\n");
}

TEST_F(SampleOutputTest, OfAPacketThatCannotBeReadNothingIsWritten) {
    options.select = {"lte.measured_neighbor_cells.filtered_rsrp"};
    options.format = DecodeFormat::Csv;
    options.recordingColumn = true;
    const std::string unreadable = textOf(Record(0xFF0000).u8(1).bytes());
    add("a,b.pcap", {{seconds(0), unreadable}, {seconds(1), neighbors({1})}});
    EXPECT_EQ(run(), kExitSuccess);
    EXPECT_EQ(written, "recording,time,packet,field,index,entry,raw,value,unit\n"
                       "\"a,b.pcap\",2023-11-14T22:13:21.000Z,2,"
                       "lte.measured_neighbor_cells.filtered_rsrp,1,Physical Cell ID 1,167,-98.25,"
                       "dBm\n");
    EXPECT_EQ(reports,
              std::vector<std::string>{"a,b.pcap: packet 1 (log code 0xFF0000): the embedded "
                                       "property list cannot be parsed"});
}

TEST_F(SampleOutputTest, TheWindowIsThatOfThePackets) {
    options.select = {"lte.measured_neighbor_cells.physical_cell_id"};
    options.window = {TimeText::parse("+1s").value(), TimeText::parse("+2s").value()};
    Packets packets;
    for (std::uint16_t second = 0; second < 5; ++second) {
        packets.push_back({seconds(second), neighbors({second})});
    }
    add("a.pcap", packets);
    EXPECT_EQ(run(), kExitSuccess);
    EXPECT_EQ(written, R"({"time":"2023-11-14T22:13:21.000Z","packet":2,)"
                       R"("field":"lte.measured_neighbor_cells.physical_cell_id","index":1,)"
                       R"("entry":"Physical Cell ID 1","raw":1,"value":1,"unit":null})"
                       "\n"
                       R"({"time":"2023-11-14T22:13:22.000Z","packet":3,)"
                       R"("field":"lte.measured_neighbor_cells.physical_cell_id","index":1,)"
                       R"("entry":"Physical Cell ID 2","raw":2,"value":2,"unit":null})"
                       "\n");
}

TEST_F(SampleOutputTest, ASnapshotHasNone) {
    options.recordings = {"a.pallax"};
    script("a.pallax", {}, &kSnapshotTechnology);
    EXPECT_EQ(run(), kExitFailure);
    EXPECT_EQ(reports, std::vector<std::string>{
                           "a.pallax is a snapshot, which holds a few displays and no packets."});
}

} // namespace
} // namespace pallax
