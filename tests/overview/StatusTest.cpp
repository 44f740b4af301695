#include "overview/Status.h"

#include "tests/overview/ValuesFixture.h"

#include <string>
#include <vector>

namespace pallax {
namespace {

using Lines = std::vector<std::string>;

const NetworkNames& names() {
    static const NetworkNames all = [] {
        NetworkNames known;
        (void)known.addProviders(
            "<serviceproviders><country code='de'><provider primary='true'><name>Netz</name><gsm>"
            "<network-id mcc='262' mnc='01'/></gsm></provider></country></serviceproviders>");
        (void)known.addCountries("<iso_3166_entries><iso_3166_entry alpha_2_code='DE' "
                                 "name='Germany'/></iso_3166_entries>");
        return known;
    }();
    return all;
}

Status statusAt(int second, const ValuesFixture& fixture) {
    return statusOf(fixture.values, ValuesFixture::at(second), names(),
                    *builtInProfile(kDefaultProfile));
}

Lines linesOf(const std::vector<StatusValue>& values) {
    Lines lines;
    for (const StatusValue& value : values) {
        lines.push_back(value.name + " " + value.text +
                        (value.grade ? " " + std::string(nameOf(*value.grade)) : ""));
    }
    return lines;
}

Lines linesOf(const std::vector<StatusNeighbour>& neighbours) {
    Lines lines;
    for (const StatusNeighbour& neighbour : neighbours) {
        lines.push_back(neighbour.system + " " + neighbour.cell + " " + neighbour.level.text);
    }
    return lines;
}

TEST(Status, OfNothingIsEmpty) {
    for (const RecordedTechnology& technology : recordedTechnologies()) {
        const ValuesFixture fixture(technology.commandName);
        EXPECT_TRUE(statusAt(0, fixture).isEmpty()) << technology.commandName;
    }
}

TEST(Status, ACellHasItsIdentityChannelBandAndFrequency) {
    ValuesFixture lte("lte");
    lte.read(0, {{"Serving Cell Info", Dictionary{{"Physical Cell ID", "150"},
                                                  {"Download Frequency", "1850"},
                                                  {"Cell Identity", "26744321"},
                                                  {"Tracking Area Code", "6699"}}}});
    const Status status = statusAt(3, lte);
    ASSERT_EQ(status.cells.size(), 1U);
    const StatusCell& cell = status.cells.front();
    EXPECT_EQ(cell.system, "LTE");
    EXPECT_EQ(cell.site, "eNodeB 104470 sector 1");
    EXPECT_EQ(linesOf(cell.identity), (Lines{"cell 26744321", "PCI 150", "TAC 6699"}));
    EXPECT_EQ(cell.channel->text, "1850");
    EXPECT_EQ(cell.channel->field, "lte.serving_cell_info.download_frequency");
    EXPECT_EQ(cell.channel->read, ValuesFixture::at(0));
    EXPECT_EQ(cell.band, "3");
    EXPECT_EQ(cell.megahertz, 1870.0);
    EXPECT_EQ(status.time, ValuesFixture::at(3));
    EXPECT_EQ(status.profile, "android");
}

TEST(Status, TheCarrierHasItsUplinkAndWhatElseTheModemTells) {
    ValuesFixture lte("lte");
    lte.read(0, {{"Serving Cell Info", Dictionary{{"Download Frequency", "1850"},
                                                  {"Upload Frequency", "19850"},
                                                  {"Download Bandwidth", "20 MHz"},
                                                  {"Num Tx Antennas", "2"}}}});
    EXPECT_EQ(statusAt(1, lte).cells.front().details,
              (Lines{"uplink 1775.0 MHz", "bandwidth 20 MHz", "antenna ports 2"}));
    lte.read(2, {{"Serving Cell Info", Dictionary{{"Upload Frequency", "65535"},
                                                  {"Download Bandwidth", "Unknown"},
                                                  {"Num Tx Antennas", "2"}}}});
    EXPECT_EQ(statusAt(3, lte).cells.front().details,
              (Lines{"uplink channel 65535", "antenna ports 2"}));
}

TEST(Status, OfUmtsACellIsThatOfAController) {
    ValuesFixture gsm("gsm");
    gsm.read(0, {{"UMTS RR Info", Dictionary{{"Cell ID", "10748279"}}},
                 {"GSM Serving Cell", Dictionary{{"Cell ID", "12135"}, {"ARFCN", "600"}}}});
    const Status status = statusAt(0, gsm);
    ASSERT_EQ(status.cells.size(), 2U);
    EXPECT_EQ(status.cells[0].site, "cell 12135");
    EXPECT_EQ(status.cells[0].band, "DCS 1800/PCS 1900") << "the number has two meanings";
    EXPECT_EQ(status.cells[0].megahertz, std::nullopt);
    EXPECT_EQ(status.cells[1].site, "RNC 164 cell 375");
    EXPECT_EQ(status.cells[1].channel, std::nullopt);
}

TEST(Status, AChannelThatIsNoneHasNoBand) {
    ValuesFixture lte("lte");
    lte.read(0, {{"Serving Cell Info", Dictionary{{"Download Frequency", "99999999999"}}}});
    const StatusCell cell = statusAt(0, lte).cells.front();
    EXPECT_EQ(cell.channel->text, "99999999999");
    EXPECT_EQ(cell.band, "");
    EXPECT_EQ(cell.megahertz, std::nullopt);
}

TEST(Status, OfLevelsWithOneNameTheLatestCounts) {
    const Dictionary idle{
        {"Serving Cell Measurements",
         Dictionary{{"Measured RSRP", "-92.25 dBm"}, {"Measured RSRQ", "-19.00 dB"}}}};
    const Dictionary connected{{"Connected mode LTE Intra-frequency Measurement",
                                Dictionary{{"Serving Filtered RSRP", "-110.00 dBm"}}}};
    ValuesFixture lte("lte");
    lte.read(0, idle).read(1, connected);
    EXPECT_EQ(linesOf(statusAt(1, lte).cells.front().levels),
              (Lines{"RSRP -110.00 dBm fair", "RSRQ -19.00 dB poor"}));
    lte.read(2, idle);
    EXPECT_EQ(linesOf(statusAt(2, lte).cells.front().levels),
              (Lines{"RSRP -92.25 dBm excellent", "RSRQ -19.00 dB poor"}));
}

Dictionary neighbour(const char* pci, const char* rsrp) {
    return {{"Physical Cell ID", pci}, {"Measured RSRP", rsrp}};
}

TEST(Status, NeighboursAreByLevelAndOldOnesComeLast) {
    ValuesFixture lte("lte");
    lte.read(0, {{"Serving Cell Info", Dictionary{{"Physical Cell ID", "150"}}},
                 {"Neighbor Cells List",
                  Array{neighbour("1", "-80.00 dBm"), neighbour("2", "-99.00 dBm")}}});
    const auto connected = [](const char* pci, const char* rsrp) {
        return Dictionary{{"Physical Cell ID", pci}, {"Filtered RSRP", rsrp}};
    };
    lte.read(11, {{"Measured Neighbor Cells",
                   Array{connected("3", "-100.00 dBm"), connected("2", "-90.00 dBm"),
                         connected("150", "-70.00 dBm"), connected("4", "Not Present")}}});
    EXPECT_EQ(linesOf(statusAt(11, lte).neighbours),
              (Lines{"LTE PCI 2 -90.00 dBm", "LTE PCI 3 -100.00 dBm", "LTE PCI 1 -80.00 dBm"}))
        << "the latest level of PCI 2; PCI 150 serves; PCI 4 has no level";
    EXPECT_EQ(linesOf(statusAt(10, lte).neighbours).front(), "LTE PCI 1 -80.00 dBm")
        << "after 10 s it is not old yet";
}

TEST(Status, TheServingCellGetsItsLevelFromAList) {
    ValuesFixture gsm("gsm");
    gsm.read(0,
             {{"GSM Serving Cell", Dictionary{{"ARFCN", "14"}, {"BSIC", "50"}}},
              {"UMTS RR Info", Dictionary{{"Scrambling Code", "117"}}},
              {"GSM Set", Array{Dictionary{{"ARFCN", "14"}, {"BSIC", "50"}, {"RSSI", "-66 dBm"}},
                                Dictionary{{"ARFCN", "14"}, {"BSIC", "51"}, {"RSSI", "-60 dBm"}}}},
              {"Active Set", Array{Dictionary{{"Scrambling Code", "117"},
                                              {"RSCP", "-68 dB"},
                                              {"Energy Per Chip", "-3 dB"}}}}});
    const Status status = statusAt(0, gsm);
    EXPECT_EQ(linesOf(status.cells[0].levels), Lines{"RSSI -66 dBm excellent"});
    EXPECT_EQ(linesOf(status.cells[1].levels),
              (Lines{"RSCP -68 dB excellent", "Ec/Io -3 dB good"}));
    EXPECT_EQ(linesOf(status.neighbours), Lines{"GSM ARFCN 14 BSIC 51 -60 dBm"});
}

TEST(Status, OfCdmaTheBandClassDecidesTheFrequency) {
    const auto pilots = [](const char* reference) {
        return Dictionary{{"_sorted", "_sorted"}, {"0;117", reference}, {"1;9", "-9.00 dB"}};
    };
    ValuesFixture cdma("cdma");
    cdma.read(0,
              {{"1x", Dictionary{{"Receiver 0", Dictionary{{"Band Class", "1900 MHz PCS band [1]"},
                                                           {"Channel", "384"},
                                                           {"AGC", "N/A"}}},
                                 {"Active Set", pilots("(ref pilot) -2.08 dB")}}},
               {"EV-DO", Dictionary{{"Serving PN Offset", "117 × 64chips"},
                                    {"Channel", "N/A"},
                                    {"Active Set", pilots("-5.00 dB")}}}});
    const Status status = statusAt(0, cdma);
    ASSERT_EQ(status.cells.size(), 2U);
    EXPECT_EQ(status.cells[0].band, "1");
    EXPECT_EQ(status.cells[0].megahertz, 1949.2);
    EXPECT_EQ(linesOf(status.cells[0].levels), Lines{"Ec/Io -2.08 dB"});
    EXPECT_EQ(linesOf(status.cells[1].identity), Lines{"PN 117"});
    EXPECT_EQ(status.cells[1].channel, std::nullopt);
    EXPECT_EQ(linesOf(status.cells[1].levels), Lines{"Ec/Io -5.00 dB"});
    EXPECT_EQ(linesOf(status.neighbours), (Lines{"1x PN 9 -9.00 dB", "EV-DO PN 9 -9.00 dB"}));
}

TEST(Status, EachFurtherServingCellIsACell) {
    ValuesFixture ifx("ifx");
    ifx.read(0, {{"Serving Cell", Dictionary{{"Technology", "LTE"},
                                             {"Cell ID", "13828439"},
                                             {"EARFCN", "1850"},
                                             {"Physical Cell ID", "121"},
                                             {"RSRP", "-104.0 dBm"}}},
                 {"Further Serving Cells", Array{Dictionary{{"Technology", "LTE"},
                                                            {"EARFCN", "6300"},
                                                            {"Physical Cell ID", "44"},
                                                            {"RSRP", "-99.0 dBm"}},
                                                 Dictionary{{"Technology", "NR"},
                                                            {"Cell ID", "4886718346"},
                                                            {"TAC", "33997"},
                                                            {"NR-ARFCN", "640000"},
                                                            {"Physical Cell ID", "501"},
                                                            {"RSRP", "-94.0 dBm"},
                                                            {"SINR", "-3.0 dB"}}}}});
    const Status status = statusAt(0, ifx);
    ASSERT_EQ(status.cells.size(), 3U);
    EXPECT_EQ(status.cells[0].site, "eNodeB 54017 sector 87");
    EXPECT_EQ(status.cells[1].system, "LTE");
    EXPECT_EQ(linesOf(status.cells[1].identity), Lines{"PCI 44"});
    EXPECT_EQ(status.cells[1].band, "20");
    EXPECT_EQ(linesOf(status.cells[1].levels), Lines{"RSRP -99.0 dBm good"});
    EXPECT_EQ(status.cells[1].levels[0].entry, "EARFCN 6300, Physical Cell ID 44");
    EXPECT_EQ(status.cells[2].system, "NR");
    EXPECT_EQ(linesOf(status.cells[2].identity),
              (Lines{"cell 4886718346", "PCI 501", "TAC 33997"}));
    EXPECT_EQ(status.cells[2].site, "cell 4886718346");
    EXPECT_EQ(status.cells[2].band, "n48/n77/n78");
    EXPECT_EQ(status.cells[2].megahertz, 3600.0);
    EXPECT_EQ(linesOf(status.cells[2].levels),
              (Lines{"RSRP -94.0 dBm excellent", "SINR -3.0 dB poor"}));
    EXPECT_TRUE(status.neighbours.empty());
}

TEST(Status, ATdScdmaCellHasItsNeighboursAndFrequency) {
    ValuesFixture ifx("ifx");
    ifx.read(0, {{"Serving Cell", Dictionary{{"Technology", "TD-SCDMA"},
                                             {"LAC", "33997"},
                                             {"Cell ID", "13828439"},
                                             {"UARFCN", "10054"},
                                             {"Cell Parameter ID", "17"},
                                             {"RSCP", "-85.0 dBm"}}},
                 {"Neighbour Cells", Array{Dictionary{{"Technology", "TD-SCDMA"},
                                                      {"UARFCN", "10054"},
                                                      {"Cell Parameter ID", "18"},
                                                      {"RSCP", "-90.0 dBm"}},
                                           Dictionary{{"Technology", "UMTS"},
                                                      {"UARFCN", "10713"},
                                                      {"Scrambling Code", "212"},
                                                      {"RSCP", "-97.0 dBm"}}}}});
    const Status status = statusAt(0, ifx);
    ASSERT_EQ(status.cells.size(), 1U);
    EXPECT_EQ(status.cells[0].system, "TD-SCDMA");
    EXPECT_EQ(status.cells[0].site, "RNC 211 cell 343");
    EXPECT_EQ(linesOf(status.cells[0].identity), (Lines{"cell 13828439", "CPID 17", "LAC 33997"}));
    EXPECT_EQ(status.cells[0].megahertz, 2010.8);
    EXPECT_EQ(linesOf(status.cells[0].levels), Lines{"RSCP -85.0 dBm excellent"});
    EXPECT_EQ(linesOf(status.neighbours), (Lines{"TD-SCDMA UARFCN 10054 CPID 18 -90.0 dBm",
                                                 "UMTS UARFCN 10713 PSC 212 -97.0 dBm"}));
}

TEST(Status, ACdmaCellOfAModemHasItsNeighbours) {
    ValuesFixture ifx("ifx");
    ifx.read(0,
             {{"Serving Cell", Dictionary{{"Technology", "CDMA"},
                                          {"SID", "4139"},
                                          {"NID", "65535"},
                                          {"Base Station ID", "601"},
                                          {"PN", "28"},
                                          {"Ec/Io", "-8.0 dB"}}},
              {"Neighbour Cells",
               Array{Dictionary{{"Technology", "CDMA"}, {"PN", "117"}, {"Ec/Io", "-14.0 dB"}}}}});
    const Status status = statusAt(0, ifx);
    ASSERT_EQ(status.cells.size(), 1U);
    EXPECT_EQ(linesOf(status.cells[0].identity),
              (Lines{"cell 601", "PN 28", "NID 65535", "SID 4139"}));
    EXPECT_EQ(linesOf(status.neighbours), Lines{"CDMA PN 117 -14.0 dB"});
}

TEST(Status, ANameOfTheNetworkComesFirst) {
    ValuesFixture ifx("ifx");
    ifx.read(0, {{"Network", Dictionary{{"Name", "Own Name"}, {"MCC", "262"}, {"MNC", "01"}}}});
    const auto network = statusAt(0, ifx).network;
    ASSERT_TRUE(network);
    EXPECT_EQ(network->name, "Own Name");
    EXPECT_EQ(network->source, NameSource::Network);
    EXPECT_EQ(network->country, "Germany");
    EXPECT_FALSE(network->isHome);
}

TEST(Status, AModemThatIsNotRegisteredHasTheNetworkOfItsSim) {
    const auto operatorOf = [](const Dictionary& registration) {
        ValuesFixture ifx("ifx");
        ifx.read(0, {{"Registration", registration},
                     {"SIM", Dictionary{{"Operator", "Home"}, {"Operator Code", "26242"}}}});
        return *statusAt(0, ifx).network;
    };
    const auto searching = operatorOf({{"State", "searching"}, {"Technology", "unknown"}});
    EXPECT_EQ(searching.name, "Home");
    EXPECT_TRUE(searching.isHome);
    const auto roaming = operatorOf({{"State", "roaming"}, {"Operator Code", "26201"}});
    EXPECT_EQ(roaming.name, "Netz");
    EXPECT_FALSE(roaming.isHome);
}

TEST(Status, TheNameInTheSimIsThatOfItsOwnNetworkOnly) {
    const auto operatorOf = [](const char* mnc) {
        ValuesFixture gsm("gsm");
        gsm.read(0, {{"Serving PLMN",
                      Dictionary{{"Mobile Country Code", "262"}, {"Mobile Network Code", mnc}}},
                     {"SIM Info",
                      Dictionary{{"EF-ACTING HPLMN", "26242"}, {"EF-PLMN NETWORK NAME", "Home"}}}});
        return *statusAt(0, gsm).network;
    };
    EXPECT_EQ(operatorOf("42 ").name, "Home");
    EXPECT_EQ(operatorOf("42 ").source, NameSource::Sim);
    EXPECT_EQ(operatorOf("01").name, "Netz") << "it roams";
    EXPECT_EQ(operatorOf("01").source, NameSource::Database);
    EXPECT_EQ(operatorOf("99").name, "");
    EXPECT_EQ(operatorOf("99").code, (NetworkCode{"262", "99"}));
}

TEST(Status, WithoutAServingNetworkThatOfTheSimIsTheHomeNetwork) {
    ValuesFixture lte("lte");
    lte.read(0, {{"SIM Info", Dictionary{{"EF-ACTING HPLMN", "26242"}}}});
    const auto network = statusAt(0, lte).network;
    ASSERT_TRUE(network);
    EXPECT_TRUE(network->isHome);
    EXPECT_EQ(network->code, (NetworkCode{"262", "42"}));
    EXPECT_EQ(network->name, "");
}

TEST(Status, HasStatesAndContexts) {
    ValuesFixture utran("utran");
    utran.read(
        0, {{"RRC Info", Dictionary{{"State", "Cell PCH"}}},
            {"PDP Context Info", Array{Dictionary{{"APN", "mms"}, {"State", "Active"}}, "odd"}}});
    const Status status = statusAt(0, utran);
    EXPECT_EQ(linesOf(status.states), Lines{"RRC Cell PCH"});
    ASSERT_EQ(status.contexts.size(), 2U);
    EXPECT_EQ(status.contexts[0].name, "mms");
    EXPECT_EQ(status.contexts[0].state, "Active");
    EXPECT_EQ(status.contexts[1].name, "odd");
    EXPECT_EQ(status.contexts[1].state, "");
}

} // namespace
} // namespace pallax
