#include "decoding/TableOutput.h"

#include "plist/PropertyListCodec.h"
#include "tests/decoding/ValuesFixture.h"

namespace pallax {
namespace {

using std::chrono::seconds;

/// `decode --table`.
class TableOutputTest : public ValuesFixture {
protected:
    TableOutputTest() { options.view = DecodeView::Table; }

    std::string tableOf(const char* section) {
        options.table = section;
        EXPECT_EQ(run(), kExitSuccess);
        return written;
    }
    void addObject(const PropertyList& object) {
        add("a.pcap", {{seconds(0), textOf(*serializeBinary(object))}}, "ifx");
    }
};

TEST_F(TableOutputTest, AListHasARowForEachEntryAndItsUnitsInTheHead) {
    add("a.pcap", {{seconds(0), neighbors({275})}, {seconds(3), neighbors({7, 275})}});
    const std::string head = "Physical Cell ID  Filtered RSRP (dBm)  Filtered RSRQ (dB)\n";
    const std::string cell7 = "               7               -98.25              -11.25\n";
    const std::string cell275 = "             275               -98.25              -11.25\n";
    for (const char* name : {"Measured Neighbor Cells", "measured_neighbor_cells",
                             "lte.measured_neighbor_cells", "measured neighbor-cells"}) {
        EXPECT_EQ(tableOf(name), head + cell7 + cell275);
    }
    options.at = TimeText::parse("+2s").value();
    EXPECT_EQ(tableOf("measured_neighbor_cells"), head + cell275);
    options.select = {"*.filtered_rsrq"};
    EXPECT_EQ(tableOf("measured_neighbor_cells"), "Filtered RSRQ (dB)\n            -11.25\n");
}

TEST_F(TableOutputTest, ASectionHasARowForEachKey) {
    addObject(Dictionary{
        {"Cell",
         Dictionary{{"Level", "-96.0 dBm"}, {"Near", Array{"0", "x", "y"}}, {"Name", "a\nb"}}},
        {"Other", "1"}});
    EXPECT_EQ(tableOf("Cell"), "Name   Value\n"
                               "Level  -96.0 dBm\n"
                               "Near   2 entries\n"
                               "Name   a\\x0Ab\n");
}

TEST_F(TableOutputTest, AUnitThatNotAllNumbersHaveStaysInTheCells) {
    addObject(
        Dictionary{{"Cells", Dictionary{{"one", Dictionary{{"Level", "-96.0 dBm"}, {"C1", "1 dB"}}},
                                        {"two", Dictionary{{"Level", "none"}, {"C1", "2"}}}}},
                   {"Other", "1"}});
    EXPECT_EQ(tableOf("cells"), "Name  Level (dBm)  C1\n"
                                "one   -96.0        1 dB\n"
                                "two   none         2\n");
}

TEST_F(TableOutputTest, AnUnknownSectionSuggestsNames) {
    add("a.pcap", {{seconds(0), neighbors({275})}});
    options.table = "measured_neigbor_cells";
    EXPECT_EQ(run(), kExitWrongUsage);
    EXPECT_EQ(written, "");
    EXPECT_EQ(reports,
              std::vector<std::string>{"a.pcap has no section \"measured_neigbor_cells\". Did you "
                                       "mean \"measured_neighbor_cells\"?"});
    options.table = "weather";
    EXPECT_EQ(run(), kExitWrongUsage);
    EXPECT_EQ(reports, std::vector<std::string>{"a.pcap has no section \"weather\"."});
}

TEST_F(TableOutputTest, ASectionWithoutDataHasNoTable) {
    add("a.pcap", {{seconds(0), neighbors({275})}});
    EXPECT_EQ(tableOf("Detected Cells"), "");
    EXPECT_EQ(reports, std::vector<std::string>{"a.pcap: nothing is shown in \"Detected Cells\"."});
}

TEST_F(TableOutputTest, OfSeveralRecordingsEachHasItsName) {
    add("a.pcap", {{seconds(0), neighbors({275})}});
    add("b\n.pcap", {{seconds(0), neighbors({7})}});
    options.select = {"*.physical_cell_id"};
    EXPECT_EQ(tableOf("measured_neighbor_cells"), "a.pcap:\n"
                                                  "Physical Cell ID\n"
                                                  "             275\n"
                                                  "\n"
                                                  "b\\x0A.pcap:\n"
                                                  "Physical Cell ID\n"
                                                  "               7\n");
}

} // namespace
} // namespace pallax
