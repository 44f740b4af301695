#include "tests/window/EndToEndWindow.h"

#include <filesystem>
#include <fstream>

namespace pallax {
namespace {

/// What an engineer looks up in a recording, as in the terminal.
class EndToEndWindowSession : public EndToEndWindow {
protected:
    void set(const std::string& settings) const {
        std::filesystem::create_directories(world.path("config/pallax"));
        std::ofstream(world.path("config/pallax/pallax.conf")) << settings;
    }
    void expectInLteDrive(const std::string& steps) const {
        expectDriven(drive(sample("lte-drive.pcap") + " --speed max",
                           "has 'Updated 2023-11-14 at 22:15:20' focus 'SIM Info' " + steps));
    }
    void expectInUtranDrive(const std::string& steps) {
        const std::string path = world.path("utran.pcap");
        const std::string pallax = PALLAX_BINARY_DIR "/pallax";
        ASSERT_EQ(
            doubles::runCommand(pallax + " simulate utran --seed 7 --seconds 60 -o " + path).status,
            0);
        expectDriven(drive(path + " --speed max", "has 'End of the recording' " + steps));
    }
    static std::string goTo(const std::string& place) {
        return "key : type \"Go to a time, or to where a condition becomes true=" + place +
               "\" key Return ";
    }
    static std::string find(const std::string& text) {
        return "type 'Find a text in names and values=" + text + "' ";
    }
};

TEST_F(EndToEndWindowSession, TheCellAndItsQualityTakeNoKey) {
    set("first-screen = overview\n");
    expectDriven(drive(sample("lte-drive.pcap") + " --speed max",
                       "has 'eNodeB 104475 sector 1 · PCI 184 · TAC 6699 · *' "
                       "has 'RSRP · -92.75 dBm · excellent*'"));
}

TEST_F(EndToEndWindowSession, TheNeighboursAreFoundByTheirName) {
    set("lists = table\n");
    expectInLteDrive("key f " + find("neighbor cells list") +
                     "open 'Name Neighbor Cells List' "
                     "open 'Neighbor Cells List, 2' has 'Physical Cell ID 184, Measured RSSI *'");
}

TEST_F(EndToEndWindowSession, AListBecomesATableByOneKey) {
    expectInLteDrive("open 'Neighbor Cells List, 2' has 'Show as Table' key t "
                     "has 'Physical Cell ID 184, Measured RSSI -64.00 dBm*'");
}

TEST_F(EndToEndWindowSession, TheCurveOfALevelIsFoundByItsName) {
    expectInLteDrive("key f " + find("measured rsrp") +
                     "open 'Name Measured RSRP, *Serving*' "
                     "open 'Measured RSRP: *' has 'Curve: *' has 'the last 5 minutes'");
}

TEST_F(EndToEndWindowSession, WhatChangedSinceAnInstantIsAPage) {
    expectInLteDrive(goTo("22:14") +
                     "has '22:14:00, held*' key m has 'Marked 22:14:00*' "
                     "key '$' has Hold key d has 'Changes from 22:14:00 to 22:15:*' "
                     "has 'Physical Cell ID*'");
}

TEST_F(EndToEndWindowSession, AStateIsReachedByACondition) {
    expectInUtranDrive("focus 'SIM Info' key ^ has '*, held*' " + goTo("state = 'Cell DCH'") +
                       "has '22:13:30, held*'");
}

TEST_F(EndToEndWindowSession, AWordIsFoundInTheWholeRecording) {
    expectInUtranDrive("focus 'SIM Info' key f press 'Whole Recording' " + find("cell dch") +
                       "open 'Time 22:13:29, Name State, Value Cell DCH*' has '22:13:30, held*' "
                       "key n lacks '22:13:30, held*'");
}

} // namespace
} // namespace pallax
