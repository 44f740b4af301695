#include "tests/ui/pages/ValueStage.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <string>

namespace pallax::terminal {
namespace {

constexpr const char* kLevels = "Serving Cell Measurements";
constexpr const char* kLevel = "Measured RSRP";

class ValueScreensTest : public ValueStage {
protected:
    std::string screenOf(int columns, int rows, const Marks& marks = kUtf8Marks) {
        TerminalStage another(marks);
        another.frontEnd.setOrigin({"Zorell_LTE", "drive.pcap"});
        show(another, last());
        select(another, kLevels, kLevel);
        another.type("i");
        const std::string screen = another.screen(columns, rows);
        EXPECT_EQ(faultOf(another.frontEnd.draw()), "");
        return screen;
    }
};

TEST_F(ValueScreensTest, TellsEverythingAboutAValue) {
    EXPECT_EQ(screenOf(80, 24), R"(
 Pallax › Serving Cell Measurements › Measured RSRP     Zorell_LTE · drive.pcap
 ──────────────────────────────────────────────────────────────────────────────
 -86.25 dBm  excellent                                                  1 s old
 android: poor -128, fair -118, good -108, excellent -98
 Reference signal received power of the serving cell, as last measured.
 raw 215 x 0.25 - 140 · bits 0-8 of bytes 21-22 · log code 0xB17F · packet
 16798
 range -140 to -12.25
  -70 ┤
      │                                                                 ⣆⣰
      │                                                                 ⢿⣿⡇
      │⢰                                                         ⣼⡀       ⣇
  -80 ┤⣾⣿⢰⡇   ⢀⣷⡀                                ⡆              ⢀⣿⣧       ⢿
      │⠇⢹⣸⠁   ⡟⠹⢷                 ⢠⡆             ⡇              ⢸⠉⢹       ⢸
      │ ⠘⣿      ⠈                ⡀⢸⢿⡆    ⡀ ⢰     ⡇             ⣼⣸ ⠸       ⠸⡆  ⢸
  -90 ┤  ⠇            ⡄⡄⢰      ⢀ ⣷⣿⠘⠁   ⢻⣿ ⣼⡇    ⢻⡆ ⢀   ⢰⡆ ⡇   ⠘⡿          ⠇
      │               ⣧⢧⣾      ⣾⣶⡟⠛     ⠘⢹⣼⣿⠃    ⠘⣧⣶⡾    ⢧⢸⠇
      │               ⢹⢸⡟     ⢀⣿⢹⠇       ⠈⠏⠉      ⢿⡿⠇    ⢸⣿
      │                ⠸      ⢸⡿⢸                  ⠁     ⢸⢿
 -100 ┤┆  ┆┆  ┆ ┆     ┆ ┆┆ ┆  ⠈⠃ ┆  ┆ ┆ ┆  ┆┆ ┆  ┆  ┆  ┆┆⠘┆┆   ┆┆ ┆     ┆  ┆  ┆
  dBm └┆──┆┆─ 22:16 ──┆─┆┆─┆ 22:17 ─┆─┆─┆─ 22:18 ┆──┆──┆ 22:19 ┆┆─┆──── 22:20 ┆
 min -98.5  mean about -87.56  max -73 dBm  of the last 5 minutes
 ──────────────────────────────────────────────────────────────────────────────
 Updated 2023-11-14 at 22:13:20               - + zoom  v graph  y copy  ? help
)");
}

TEST_F(ValueScreensTest, FitsANarrowScreen) {
    EXPECT_EQ(screenOf(40, 20), R"(
 …ing Cell Measurements › Measured RSRP
 ──────────────────────────────────────
 -86.25 dBm  excellent          1 s old
 android: poor -128, fair -118, good
 -108, excellent -98
 Reference signal received power of the
 serving cell, as last measured.
 raw 215 x 0.25 - 140 · bits 0-8 of
 bytes 21-22 · log code 0xB17F · packet
 16798
 range -140 to -12.25
  -60 ┤
      │                            ⢀⣤
  -80 ┤⣦⡄ ⣠⡄       ⣀     ⢠      ⢰⣇ ⠈⠹⡆
      │⠸⠃ ⠁⠁ ⢠⣤  ⢀⣴⡟ ⢰⣦⣧ ⢸⣄⡄ ⣄⡆ ⠿⠘   ⠗⠙
 -100 ┤┆┆┆┆┆ ⠈⠛┆┆⠾⠻┆ ┆⠈⠁┆┆⠛⠁┆⠻⠁ ┆┆ ┆ ┆┆
  dBm └┆ 22:16 ┆┆┆┆┆─ 22:18 ┆┆┆─┆┆─┆─┆┆
 min -98.5  mean about -87.56  max -73
 ──────────────────────────────────────
 Updated 2023-11-14 at 22:13:20  ? help
)");
}

TEST_F(ValueScreensTest, UsesAWideScreen) {
    EXPECT_EQ(screenOf(200, 60), R"(
 Pallax › Serving Cell Measurements › Measured RSRP                                                                                                                             Zorell_LTE · drive.pcap
 ──────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────
 -86.25 dBm  excellent (android: poor -128, fair -118, good -108, excellent -98)                                                                                                                1 s old
 Reference signal received power of the serving cell, as last measured.
 raw 215 x 0.25 - 140 · bits 0-8 of bytes 21-22 · log code 0xB17F · packet 16798
 range -140 to -12.25
  -72 ┤
      │                                                                                                                                                                                 ⢀
      │                                                                                                                                                                              ⡆  ⢸
  -74 ┤                                                                                                                                                                             ⢠⡇  ⢸
      │                                                                                                                                                                             ⢸⡇⣧⡇⣼⣧
      │                                                                                                                                                                             ⢸⣇⣿⣷⣿⣿
      │                                                                                                                                                                             ⢸⣿⣿⣿⡇⣿
  -76 ┤                                                                                                                                                                             ⢸⢿⣿⣿⡇⣿
      │                                                                                                                                                                             ⠈⢸⣿⢹⡇⢿
      │                                                                                                                                                                              ⠈⠉⠘ ⢸⡆
  -78 ┤  ⡀                                                                                                                                                         ⢰⡆                    ⢸⡇
      │ ⢠⡇                                                                                                                                                         ⢸⡇                     ⡇
      │ ⢸⡇                                                                                                                                                         ⢸⡇                     ⣿
      │ ⢸⡇                                                                                                                                                        ⣿⢸⣷                     ⣿⡀
  -80 ┤ ⢸⡇⢀⡆   ⡀            ⢀                                                                                                                                     ⣿⢸⣿                     ⣿⡇
      │ ⣼⢧⢸⡇  ⢠⣧            ⢸⡇⡄                                                                                        ⢠                                          ⣿⣼⣿                     ⢹⡇
      │ ⣿⢸⣿⡇  ⢸⣿            ⢸⣧⡇                                                                                        ⢸                                          ⣿⣿⢹⡇                    ⠸⡇
  -82 ┤ ⣿⢸⣿⢣  ⢸⡟            ⣸⣿⣇⣀                                                                                       ⢸                                         ⢸⡏⣿⢸⣿                     ⡇
      │ ⡇⢸⣿⢸  ⢸⡇           ⣦⣿⢻⣿⣿                                                                                       ⢸                                        ⢰⣾⠃⡟⠘⣿                     ⡇
      │ ⡇⠈⠇⢸  ⣼⠁          ⢸⣿⡏⢸⣿⣿                                                                                       ⢸                                        ⢸⣿ ⠁ ⢿                     ⣧
      │ ⡇  ⢸  ⣿           ⣿⠿⠇⢸⣿⣿⣿⡄                                               ⢸⡄                                    ⢸                                        ⣿⡏   ⢸                     ⢿⡀
  -84 ┤ ⠁  ⢸⡀ ⡏           ⣿  ⠈⠋⡟⣿⠃                                               ⢸⡇                                    ⢸                                        ⡟⡇   ⠘⡆                    ⢸⡇
      │    ⠘⡇ ⡇           ⠃     ⡟                                                ⣾⣷                                    ⢸⡀                                       ⡇     ⡇                    ⢸⡇
      │     ⣧⢠⡇                 ⠁                                                ⡇⢿⡄                                   ⢸⡇                                    ⢸  ⡇     ⡇                    ⢸⡇         ⢠
      │     ⣿⣼⡇                                                                  ⡇⢸⡇                                    ⡇                                    ⢸  ⡇     ⣧                    ⠈⡇         ⢸
  -86 ┤     ⢹⣿⡇                                                                  ⡇⢸⡇⣰                   ⢀⡇              ⡇                                    ⢸⢰ ⡇     ⣿                     ⡇         ⢸
      │     ⢸⣿⡇                                                                 ⢰⡇⠘⣷⣿                   ⢸⡇              ⡇                                    ⣾⣾ ⡇                           ⡇         ⢸
      │     ⢸⡇                                                               ⡇  ⢸  ⣿⣿             ⢸     ⢸⡇              ⡇                                    ⢹⣿⡇⡇                           ⢸         ⠸
  -88 ┤     ⢸⡇                                                              ⢠⡇ ⢸⢸  ⠉⡿           ⡇⣤⣼⣇    ⢸⣿              ⡇                         ⢠          ⢸⣿⣿⡇                           ⢸⡀
      │     ⢸                                         ⢀                     ⢸⣷⢀⣾⣼               ⣷⣿⣿⣿    ⢸⣿⢀             ⡇ ⡀                 ⡆     ⣾           ⢻⣿⡇                           ⢸⡇
      │     ⠘                                  ⢰  ⡀   ⢸                     ⢸⣿⢸⣿⣿               ⣿⣿⣿⣿    ⣸⢻⣾             ⢷⣀⡇                 ⣇     ⣿            ⣿⡇                            ⠃
      │                                        ⢸  ⣧   ⢸                  ⡄  ⢸⢹⣼⣿⣿               ⣿⠇⡇⢸    ⣿⢸⣿             ⢸⣿⡇                 ⢿    ⢠⣿            ⡿⡇
  -90 ┤                                        ⢸⡀⢀⣿  ⢸⢸                  ⡇  ⢸⠸⣿⠉⡟               ⡿ ⠇⢸  ⡄⣧⣿⠈⣿             ⢸⣿⡇     ⡇           ⢸⣄   ⣸⡿            ⠁⠁
      │                                        ⢸⡇⢸⣿  ⢸⢸                ⢀ ⣷⣶ ⢸ ⡟ ⡇               ⡇  ⢸  ⣇⣿⣿ ⣿             ⠘⡟⡇   ⢀ ⣇           ⢸⣿   ⣿
      │                                        ⠘⡇⢸⣿⡆ ⢸⡇                ⢸⡀⣿⣿⡆⣾ ⠃                 ⠃  ⢸⡆⡀⣿⣿⢻ ⠃               ⢸⢀⢰ ⢸ ⣿           ⢸⣿   ⣿
  -92 ┤                                         ⡇⢸ ⡇ ⣾⡇                ⢸⡇⣿⣿⣿⡏                      ⠘⡇⣿⣿⣿⢸                 ⢸⢸⣼ ⣿⢠⡇            ⢸⡄  ⡿
      │                                         ⣿⣸ ⡇ ⣿⡇                ⣼⡇⣿⣿⣿⡇                       ⣧⣿⣿⡏⢸                 ⢸⣾⣿ ⣿⣼⡇            ⢸⣧  ⡇
      │                                         ⢸⣿ ⡇⣀⣿⡇                ⣿⡇⡇⡟⣿⡇                       ⣿⣿⠘⡇⢸                 ⢸⣿⣿⢰⣿⣿⡇            ⢸⣿⢀ ⡇
      │                                         ⢸⣿ ⡇⣿⡟                 ⡇⣇⡇ ⢸⡇                       ⢻⡇                    ⢸⣿⣿⢸⣿⣿             ⢸⣿⣸ ⡇
  -94 ┤                                         ⢸⣿ ⣧⣿⠇                 ⡇⣿⡇ ⢸⡇                       ⠸                     ⢸⡇⠈⣿⡏⠹             ⢸⣿⣿⢀⠇
      │                                         ⠈⠏ ⣿⡿                ⢠ ⡇⢹⡇ ⢸⡇                                             ⠈⡇ ⣿⠁              ⢸⡿⣿⣼
      │                                            ⣿⡇                ⢸⡆⡇⢸⡇ ⠈⡇                                                ⡇               ⢸⡇⣿⣿
  -96 ┤                                            ⢻⡇                ⢸⡇⡇ ⡇  ⡇                                                                ⢸⡇⢻⣿
      │                                            ⠸                 ⢸⣿⡇ ⠇  ⡇                                                                ⠘⡇⢸⣿
      │                                                              ⢸⣿⡇    ⡇                                                                 ⡇⠸⢿
      │                                                               ⣿⡇    ⡇                                                                 ⡇ ⢸
  -98 ┤                                                               ⠛⡇                                                                      ⡇
      │                                                                ⠁                                                                      ⠁
      │
 -100 ┤ ┆      ┆   ┆      ┆      ┆             ┆     ┆ ┆     ┆       ┆ ┆ ┆  ┆       ┆      ┆    ┆       ┆  ┆     ┆     ┆        ┆       ┆   ┆ ┆  ┆┆┆         ┆  ┆     ┆             ┆        ┆        ┆
  dBm └─ 22:15:30 ─┆──────┆ 22:16:00 ───────── 22:16:30 ─────┆──── 22:17:00 ┆───────┆ 22:17:30 ─┆─────── 22:18:00 ─────┆─── 22:18:30 ───┆───┆─ 22:19:00 ─────┆──┆─ 22:19:30 ────────┆ 22:20:00 ───────┆
 min -98.5  mean about -87.56  max -73 dBm  of the last 5 minutes
 ──────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────
 Updated 2023-11-14 at 22:13:20                                                                                                                                       - + zoom  v graph  y copy  ? help
)");
}

TEST_F(ValueScreensTest, NeedsOnlyAscii) {
    const std::string screen = screenOf(80, 24, kAsciiMarks);
    EXPECT_EQ(screen, R"(
 Pallax > Serving Cell Measurements > Measured RSRP      Zorell_LTE, drive.pcap
 ------------------------------------------------------------------------------
 -86.25 dBm  excellent                                                  1 s old
 android: poor -128, fair -118, good -108, excellent -98
 Reference signal received power of the serving cell, as last measured.
 raw 215 x 0.25 - 140, bits 0-8 of bytes 21-22, log code 0xB17F, packet 16798
 range -140 to -12.25
  -70 +
      |                                                                 **
      |                                                                 ***
      |*                                                         *      ***
  -80 +****    *                                 *               **       *
      |****   ***                  *             *              ***       *
      |***    ***                 **       *     *             ** *       *   *
      |  *                       ****   ** **    *      *  *   ** *       **  *
  -90 +  *            ***      ****     *****    ****   ****   **          *
      |               ***      ***      *****     ***    ***
      |               ***     ****        *       ***    **
      |                *      ***                        **
 -100 +:  ::  : :     : :: :  :: :  : : :  :: :  :  :  :::::   :: :     :  :  :
  dBm +:--::- 22:16 --:-::-: 22:17 -:-:-:- 22:18 :--:--: 22:19 ::-:---- 22:20 :
 min -98.5  mean about -87.56  max -73 dBm  of the last 5 minutes
 ------------------------------------------------------------------------------
 Updated 2023-11-14 at 22:13:20               - + zoom  v graph  y copy  ? help
)");
    EXPECT_TRUE(std::all_of(screen.begin(), screen.end(),
                            [](char each) { return static_cast<unsigned char>(each) < 0x80; }));
}

class RowCurvesTest : public ValueStage {};

TEST_F(RowCurvesTest, AWideScreenHasCurvesInTheRowsOfLevels) {
    show(last());
    select(kLevels, kLevel);
    EXPECT_EQ(stage.screen(100, 16), R"(
 Pallax › Serving Cell Measurements
 ──────────────────────────────────────────────────────────────────────────────────────────── ↑ 4 ─
▌Measured RSRP                                          ⠲⠒⠒⠒⠤⣤⢄⣀⣤⠶⠤⢤⠤⠒⣦⡤⢤⡤⠴⠶⠒⠉⠳⠴        -86.25 dBm
 Average RSRP                                           ⠲⠒⠒⠒⠤⣤⢄⣀⣤⠦⠤⠤⠤⠒⣦⡤⢤⡤⠤⠶⠒⠉⠳⠴        -87.00 dBm
 Measured RSRQ                                          ⠛⠓⠚⠋⠒⠾⠢⠤⣾⠛⠉⠓⠗⠉⠷⠖⢲⡖⠒⡟⠊⠉⠻⠚          -7.00 dB
 Average RSRQ                                           ⠙⠑⠚⠉⠒⠺⠒⢤⣾⠋⠉⠛⠗⠉⠷⠖⢲⡖⠒⡟⠊⠉⠹⠊          -6.75 dB
 Measured RSSI                                          ⠲⠒⠲⠦⠤⣤⢄⣀⣤⡤⠤⢤⡤⠒⣦⡤⢤⡤⠤⠶⠒⠉⠳⠤        -60.00 dBm
 Qrxlevmin                                              ⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤          -122 dBm
 P_Max                                                  ⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤            23 dBm
 Max UE Tx Power                                        ⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤            23 dBm
 Srxlev                                                 ⠲⠒⠒⠒⠤⣤⢄⣀⣤⠦⠤⠤⠤⠒⣦⡤⢤⡤⠤⠶⠒⠉⠳⠤            35 dBm
 Num of Consecutive DRX Cycles of S < 0                                                          0
 S Intra Search                                         ⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤             62 dB
 S Non Intra Search                                     ⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤            26 dBm
 ──────────────────────────────────────────────────────────────────────────────────────────── ↓ 2 ─
 Updated 2023-11-14 at 22:13:20                                            / filter  s Save  ? help
)");
    const std::string wide = stage.screen(99, 16);
    stage.moment = {};
    EXPECT_EQ(stage.screen(99, 16), wide) << "a narrower screen has none";
    EXPECT_EQ(stage.screen(100, 16).find("⠤"), std::string::npos)
        << "nor a viewer without a timeline";
}

TEST_F(RowCurvesTest, TheyAreDim) {
    show(last());
    select(kLevels, kLevel);
    stage.frontEnd.resize(100, 16);
    int dim = 0;
    const Grid grid = draw();
    for (int x = 0; x < 100; ++x) {
        dim += grid.at(x, 5).style.dim && grid.at(x, 5).text != " " ? 1 : 0;
    }
    EXPECT_GT(dim, 10);
}

TEST_F(RowCurvesTest, TheOverviewHasThemBesideTheLevels) {
    show(last());
    const Status status = statusOf(drive.timeline->latestValues(), stage.displayTime.now,
                                   stage.names, *builtInProfile(kDefaultProfile));
    stage.overview.status.time = status.time;
    stage.overview.status.cells = status.cells;
    stage.type("o");
    EXPECT_EQ(stage.screen(80, 10), R"(
 Pallax › Overview
 ──────────────────────────────────────────────────────────────────────────────
 Cell        eNodeB 104467 sector 1 · PCI 185 · TAC 6700
             EARFCN 1850 · band 3 · 1870.0 MHz · uplink 1775.0 MHz
             bandwidth 20 MHz · antenna ports 2 · 61 s ago
 Levels      RSRP  -86.25 dBm  excellent  ▆▆▆▆▁▁▁▁  ⠲⠒⠒⠒⠤⣤⢄⣀⣤⠶⠤⢤⠤⠒⣦⡤⢤⡤⠴⠶⠒⠉⠳⠴
             RSRQ    -7.00 dB  excellent  ▆▆▆▆▆▆▁▁  ⠛⠓⠚⠋⠒⠾⠢⠤⣾⠛⠉⠓⠗⠉⠷⠖⢲⡖⠒⡟⠊⠉⠻⠚
             quality by the profile
 ──────────────────────────────────────────────────────────────────────────────
 Updated 2023-11-14 at 22:13:20                                 o panes  ? help
)");
    EXPECT_EQ(faultOf(draw()), "");
    stage.moment = {};
    EXPECT_EQ(stage.screen(80, 10).find("⠤"), std::string::npos);
}

} // namespace
} // namespace pallax::terminal
