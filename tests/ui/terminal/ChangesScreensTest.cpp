#include "tests/timeline/TimelineFixture.h"
#include "tests/ui/drawing/GridSupport.h"
#include "tests/ui/terminal/TerminalStage.h"
#include "travel/Travel.h"

#include <gtest/gtest.h>

#include <chrono>
#include <string>

namespace pallax::terminal {
namespace {

using namespace std::chrono_literals;

/// What differs after half a minute, and the instant that is held, on a screen of each size.
class ChangesScreensTest : public testing::Test {
protected:
    ChangesScreensTest() {
        _fixture.drive(5, 120s);
        _timeline = _fixture.indexed();
    }
    std::string screenOf(const char* keys, int columns, int rows, const Marks& marks = kUtf8Marks) {
        Travel travel{{[this] { return _timeline.get(); }, [this] { return _timeline->packets(); },
                       [] { return Simulation::kStart + 120s; },
                       [] { return std::chrono::steady_clock::time_point(); },
                       [](Time) { return 0s; }}};
        TerminalStage stage(marks, &travel);
        stage.tick(_timeline->displayAt(_timeline->packets()));
        stage.frontEnd.setOrigin({"Zorell_LTE", "drive.pcap"});
        for (const char* place : {":+60s", ":+90s"}) {
            stage.type(place);
            stage.press(Key::Enter);
            stage.type(place == std::string(":+60s") ? "m" : keys);
        }
        const std::string screen = stage.screen(columns, rows);
        EXPECT_EQ(faultOf(stage.frontEnd.draw()), "");
        return screen;
    }

private:
    TimelineFixture _fixture{"lte"};
    std::unique_ptr<Timeline> _timeline;
};

TEST_F(ChangesScreensTest, FillTheComfortableScreen) {
    EXPECT_EQ(screenOf("d", 80, 24), R"(
 Pallax › Changes from 22:14:20 to 22:14:50       Zorell_LTE  held, 30 s behind
 ──────────────────────────────────────────────────────────────────────────────
 Serving Cell Measurements
   Measured RSRP  -77.75 dBm → -81.00 dBm (-3.25 dB)
   Average RSRP   -78.25 dBm → -81.00 dBm (-2.75 dB)
   Measured RSRQ  -5.75 dB → -6.00 dB (-0.25 dB)
   Measured RSSI  -52.00 dBm → -55.00 dBm (-3.00 dB)
   Srxlev         44 dBm → 41 dBm (-3 dB)

 Connected mode LTE Intra-frequency Measurement
   Subframe Number        7059 → 7906
   Serving Filtered RSRP  -79.75 dBm → -89.50 dBm (-9.75 dB)
   Serving Filtered RSRQ  -8.62 dB → -10.12 dB (-1.50 dB)

 Neighbor Cells List
   Physical Cell ID 243
     Measured RSSI  -52.50 dBm → -55.00 dBm (-2.50 dB)
     Measured RSRP  -87.50 dBm → -91.00 dBm (-3.50 dB)
     Average RSRP   -87.50 dBm → -91.00 dBm (-3.50 dB)
     Measured RSRQ  -15.50 dB → -16.50 dB (-1.00 dB)
     Average RSRQ   -15.50 dB → -15.75 dB (-0.25 dB)
     Srxlev         34 dBm → 31 dBm (-3 dB)
 ─────────────────────────────────────────────────────────────────────── ↓ 16 ─
 ▕──┴─┴─┴──┴◆┴──●┴─┴──▏ 22:14:50        , . step  Space play  $ present  ? help
)");
}

TEST_F(ChangesScreensTest, FitANarrowScreen) {
    EXPECT_EQ(screenOf("d", 40, 20), R"(
 …anges from 22:14:20 to 22:14:50  held
 ──────────────────────────────────────
 Serving Cell Measurements
   Measured RSRP  -77.75 dBm → -81.00 …
   Average RSRP   -78.25 dBm → -81.00 …
   Measured RSRQ  -5.75 dB → -6.00 dB …
   Measured RSSI  -52.00 dBm → -55.00 …
   Srxlev         44 dBm → 41 dBm (-3 …

 Connected mode LTE Intra-frequency Me…
   Subframe Number        7059 → 7906
   Serving Filtered RSRP  -79.75 dBm →…
   Serving Filtered RSRQ  -8.62 dB → -…

 Neighbor Cells List
   Physical Cell ID 243
     Measured RSSI  -52.50 dBm → -55.0…
     Measured RSRP  -87.50 dBm → -91.0…
 ─────────────────────────────── ↓ 20 ─
 ▕─────◆─●──▏ 22:14:50           ? help
)");
}

TEST_F(ChangesScreensTest, UseAWideScreen) {
    EXPECT_EQ(screenOf("d", 200, 60), R"(
 Pallax › Changes from 22:14:20 to 22:14:50                                                                                                                  Zorell_LTE · drive.pcap  held, 30 s behind
 ──────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────
 Serving Cell Measurements
   Measured RSRP  -77.75 dBm → -81.00 dBm (-3.25 dB)
   Average RSRP   -78.25 dBm → -81.00 dBm (-2.75 dB)
   Measured RSRQ  -5.75 dB → -6.00 dB (-0.25 dB)
   Measured RSSI  -52.00 dBm → -55.00 dBm (-3.00 dB)
   Srxlev         44 dBm → 41 dBm (-3 dB)

 Connected mode LTE Intra-frequency Measurement
   Subframe Number        7059 → 7906
   Serving Filtered RSRP  -79.75 dBm → -89.50 dBm (-9.75 dB)
   Serving Filtered RSRQ  -8.62 dB → -10.12 dB (-1.50 dB)

 Neighbor Cells List
   Physical Cell ID 243
     Measured RSSI  -52.50 dBm → -55.00 dBm (-2.50 dB)
     Measured RSRP  -87.50 dBm → -91.00 dBm (-3.50 dB)
     Average RSRP   -87.50 dBm → -91.00 dBm (-3.50 dB)
     Measured RSRQ  -15.50 dB → -16.50 dB (-1.00 dB)
     Average RSRQ   -15.50 dB → -15.75 dB (-0.25 dB)
     Srxlev         34 dBm → 31 dBm (-3 dB)

 Reselection Candidates List
   Candidate RAT Type GERAN, ARFCN 85, Band 8, BSIC ID 48  gone
   Candidate RAT Type CDMA1XRTT, Band 0, Channel 283, Pilot 348  new
     Candidate Priority  1

 Measured Neighbor Cells
   Physical Cell ID 243
     Filtered RSRP  -88.75 dBm → -89.00 dBm (-0.25 dB)
     Filtered RSRQ  -18.75 dB → -9.62 dB (+9.12 dB)

 Detected Cells
   Physical Cell ID 242  gone

 PDP Context Info
   #2  new  { APN = internet; Address = 10.17.4.21; State = Active; }




















 ──────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────
 ▕────┴────┴─────┴────────┴◆───┴───────●──┴───┴─────▏ 22:14:50                                                                              [ ] event  : go to  , . step  Space play  $ present  ? help
)");
}

TEST_F(ChangesScreensTest, NeedOnlyAscii) {
    EXPECT_EQ(screenOf("d", 80, 24, kAsciiMarks), R"(
 Pallax > Changes from 22:14:20 to 22:14:50       Zorell_LTE  held, 30 s behind
 ------------------------------------------------------------------------------
 Serving Cell Measurements
   Measured RSRP  -77.75 dBm -> -81.00 dBm (-3.25 dB)
   Average RSRP   -78.25 dBm -> -81.00 dBm (-2.75 dB)
   Measured RSRQ  -5.75 dB -> -6.00 dB (-0.25 dB)
   Measured RSSI  -52.00 dBm -> -55.00 dBm (-3.00 dB)
   Srxlev         44 dBm -> 41 dBm (-3 dB)

 Connected mode LTE Intra-frequency Measurement
   Subframe Number        7059 -> 7906
   Serving Filtered RSRP  -79.75 dBm -> -89.50 dBm (-9.75 dB)
   Serving Filtered RSRQ  -8.62 dB -> -10.12 dB (-1.50 dB)

 Neighbor Cells List
   Physical Cell ID 243
     Measured RSSI  -52.50 dBm -> -55.00 dBm (-2.50 dB)
     Measured RSRP  -87.50 dBm -> -91.00 dBm (-3.50 dB)
     Average RSRP   -87.50 dBm -> -91.00 dBm (-3.50 dB)
     Measured RSRQ  -15.50 dB -> -16.50 dB (-1.00 dB)
     Average RSRQ   -15.50 dB -> -15.75 dB (-0.25 dB)
     Srxlev         34 dBm -> 31 dBm (-3 dB)
 ----------------------------------------------------------------------- v 16 -
 [--'-'-'--'m'--o'-'--] 22:14:50        , . step  Space play  $ present  ? help
)");
}

} // namespace
} // namespace pallax::terminal
