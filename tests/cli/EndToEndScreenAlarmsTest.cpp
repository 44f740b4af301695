#include "tests/cli/EndToEndScreen.h"

#include <fstream>

namespace pallax {
namespace {

/// Alarms of the settings on the screen.
class EndToEndScreenAlarms : public EndToEndScreen {
protected:
    void arm(const std::string& rules) const {
        std::ofstream(world.path("config/pallax/pallax.conf")) << rules;
    }
};

TEST_F(EndToEndScreenAlarms, AnAlarmIsInTheTitleAndAmongTheEventsAndRingsTheBellOnce) {
    arm("alarm = last cell: serving_physical_cell_id = 184 bell\n"
        "alarm = never: measured_rsrp > 0 bell\n");
    PallaxTerminal terminal(world, {lteDrive(), "--speed", "max"}, {});
    ASSERT_TRUE(terminal.shows("End of the recording"));
    EXPECT_TRUE(terminal.shows("Zorell_LTE · lte-drive.pcap  ! last cell"));
    EXPECT_EQ(terminal.bytes().find('\a'), terminal.bytes().rfind('\a'));
    EXPECT_NE(terminal.bytes().find('\a'), std::string::npos);
    terminal.type("o");
    EXPECT_TRUE(terminal.shows("alarm: last cell"));
    EXPECT_EQ(terminal.screen().text().find("never"), std::string::npos);
    terminal.type("oe");
    EXPECT_TRUE(terminal.shows("› Events"));
    EXPECT_TRUE(terminal.shows("alarm: last cell"));
    terminal.type("/alarm:\r\r"); // goes to the only row
    EXPECT_TRUE(terminal.shows("held"));
    terminal.type("q");
    EXPECT_EQ(terminal.wait(), 0);
}

TEST_F(EndToEndScreenAlarms, AnAlarmThatHasEndedIsOnlyAnEvent) {
    arm("alarm = start: tick < 4\n");
    PallaxTerminal terminal(world, {lteDrive(), "--speed", "max"}, {.rows = 40});
    ASSERT_TRUE(terminal.shows("End of the recording"));
    EXPECT_EQ(terminal.screen().text().find("!"), std::string::npos);
    EXPECT_EQ(terminal.bytes().find('\a'), std::string::npos);
    terminal.type("q");
    EXPECT_EQ(terminal.wait(), 0);
}

TEST_F(EndToEndScreenAlarms, ARuleWithoutItsFieldIsToldOnTheScreen) {
    arm("alarm = other: mm_state is null\n");
    PallaxTerminal terminal(world, {lteDrive(), "--speed", "max"}, {});
    EXPECT_TRUE(terminal.shows("┌ Alarms that are left out"));
    EXPECT_TRUE(terminal.shows("other: no such column: mm_state"));
    terminal.type("\r");
    EXPECT_TRUE(terminal.showsNoMore("no such column"));
    ASSERT_TRUE(terminal.shows("End of the recording"));
    EXPECT_EQ(terminal.screen().text().find("no such column"), std::string::npos) << "told once";
    terminal.type("q");
    EXPECT_EQ(terminal.wait(), 0);
}

TEST_F(EndToEndScreenAlarms, ARuleWithoutItsFieldIsToldOnStandardErrorWhereTheTreeIsPrinted) {
    arm("alarm = other: mm_state is null\n"
        "alarm = weak: measured_rsrp < -110\n");
    const Run run = this->run({lteDrive(), "--print", "--speed", "max"});
    EXPECT_EQ(run.status, 0);
    EXPECT_EQ(run.err, "pallax: Alarms that are left out: other: no such column: mm_state "
                       "(line 1, column 1 of the condition).\n");
}

TEST_F(EndToEndScreenAlarms, AWrongRuleEndsTheProgram) {
    arm("\nalarm = weak: measured_rsrp <\n");
    const Run run = this->run({lteDrive(), "--print"});
    EXPECT_EQ(run.status, 1);
    EXPECT_EQ(run.err, "pallax: " + world.path("config/pallax/pallax.conf") +
                           ", line 2: alarm \"weak\": This is not a whole condition.\n");
}

} // namespace
} // namespace pallax
