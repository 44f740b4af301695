#include "tests/ui/terminal/StageFixture.h"

#include <gtest/gtest.h>

#include <string>

namespace pallax::terminal {
namespace {

using namespace std::chrono_literals;

/// Whatever warns at once, on a screen of each size: alarms, a stream that stands still, and values
/// that are overdue.
class WarningScreensTest : public testing::Test {
protected:
    static std::string screenOf(int columns, int rows, const Marks& marks = kUtf8Marks) {
        TerminalStage stage(marks);
        stage.frontEnd.setOrigin({"Zorell_LTE", "drive.pcap"});
        stage.overdue = {{"/Serving Cell Measurements/Measured RSRP", 14s},
                         {"/Serving Cell Measurements/E-ARFCN", 200s}};
        stage.showAges();
        stage.tick(display());
        stage.press(Key::Enter);
        stage.frontEnd.setAlarms({"weak signal", "no service"});
        stage.frontEnd.setStream("no data for 6 s");
        const std::string screen = stage.screen(columns, rows);
        EXPECT_EQ(faultOf(stage.frontEnd.draw()), "");
        return screen;
    }
};

TEST_F(WarningScreensTest, FillTheComfortableScreen) {
    EXPECT_EQ(screenOf(80, 24), R"(
 Pallax › Serving Cell Measurements  ! weak signal, no service  no data for 6 s
 ──────────────────────────────────────────────────────────────────────────────
▌Version                                                                     1
 E-ARFCN                                                           3 min  1850
 Physical Cell ID                                                          274
 Measured RSRP                                                14 s  -94.75 dBm
 Average RSRP                                                       -95.00 dBm
 Measured RSRQ                                                        -9.50 dB














 ──────────────────────────────────────────────────────────────────────────────
 Updated 2023-11-14 at 22:13:20                        / filter  s Save  ? help
)");
}

TEST_F(WarningScreensTest, FitANarrowScreen) {
    EXPECT_EQ(screenOf(40, 20), R"(
 … › Serv…  ! 2 alarms  no data for 6 s
 ──────────────────────────────────────
▌Version                             1
 E-ARFCN                   3 min  1850
 Physical Cell ID                  274
 Measured RSRP        14 s  -94.75 dBm
 Average RSRP               -95.00 dBm
 Measured RSRQ                -9.50 dB










 ──────────────────────────────────────
 Updated 2023-11-14 at 22:13:20  ? help
)");
}

TEST_F(WarningScreensTest, UseAWideScreen) {
    EXPECT_EQ(screenOf(200, 60), R"(
 Pallax › Serving Cell Measurements                                                                                                 Zorell_LTE · drive.pcap  ! weak signal, no service  no data for 6 s
 ──────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────
▌Version                                                                                                                                                                                             1
 E-ARFCN                                                                                                                                                                                   3 min  1850
 Physical Cell ID                                                                                                                                                                                  274
 Measured RSRP                                                                                                                                                                        14 s  -94.75 dBm
 Average RSRP                                                                                                                                                                               -95.00 dBm
 Measured RSRQ                                                                                                                                                                                -9.50 dB


















































 ──────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────
 Updated 2023-11-14 at 22:13:20                                                                                                                                                / filter  s Save  ? help
)");
}

TEST_F(WarningScreensTest, AnAsciiTerminalGetsAscii) {
    EXPECT_EQ(screenOf(80, 24, kAsciiMarks), R"(
 Pallax > Serving Cell Measurements  ! weak signal, no service  no data for 6 s
 ------------------------------------------------------------------------------
>Version                                                                     1
 E-ARFCN                                                           3 min  1850
 Physical Cell ID                                                          274
 Measured RSRP                                                14 s  -94.75 dBm
 Average RSRP                                                       -95.00 dBm
 Measured RSRQ                                                        -9.50 dB














 ------------------------------------------------------------------------------
 Updated 2023-11-14 at 22:13:20                        / filter  s Save  ? help
)");
}

} // namespace
} // namespace pallax::terminal
