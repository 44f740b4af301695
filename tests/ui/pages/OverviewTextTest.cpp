#include "tests/ui/pages/SampleOverview.h"
#include "tests/ui/terminal/StageFixture.h"

#include <gtest/gtest.h>

#include <string>

namespace pallax::terminal {
namespace {

/// The whole screen with the overview of a sample.
std::string screenOf(const char* sample, int columns, int rows, const Marks& marks = kUtf8Marks) {
    TerminalStage stage(marks);
    stage.tick(display());
    stage.overview = overviewOf(sample);
    stage.frontEnd.setOrigin({"Zorell", std::string(sample) + ".pcap"});
    stage.type("o");
    const std::string screen = stage.screen(columns, rows);
    EXPECT_EQ(faultOf(stage.frontEnd.draw()), "");
    return screen;
}

TEST(OverviewText, OfLteFillsTheComfortableScreen) {
    EXPECT_EQ(screenOf("lte-drive", 80, 24), R"(
 Pallax › Overview                                      Zorell · lte-drive.pcap
 ──────────────────────────────────────────────────────────────────────────────
 Operator    Sample Net 262-42 · home network
 Cell        eNodeB 104475 sector 1 · PCI 184 · TAC 6699
             EARFCN 1850 · band 3 · 1870.0 MHz · uplink 1775.0 MHz
             bandwidth 20 MHz · antenna ports 4
 Levels      RSRP  -92.75 dBm  excellent  ▆▆▆▆▁▁▁▁
             RSRQ   -12.62 dB  good       ▆▆▆▁▁▁▁▁
             quality by the profile android
 Neighbours  PCI 285  RSRP  -90.00 dBm  excellent  0 s ago  ▆▆▆▆▁▁▁▁
             PCI 286  RSRP  -97.00 dBm  excellent  0 s ago  ▆▆▆▆▁▁▁▁
             PCI 387  RSRP  -98.50 dBm  good       0 s ago  ▆▆▆▁▁▁▁▁
 Contexts    ims Active · internet Active
 Events      22:15:19  serving cell 286 → 184 after 4 s
             22:15:18  context up: internet
             22:15:14  serving cell 82 → 286 after 17 s
             22:15:01  context down: internet
             22:14:57  serving cell 285 → 82 after 13 s
             22:14:44  serving cell 183 → 285 after 69 s
             22:14:42  context up: internet
             22:14:27  context down: internet
             22:14:09  context up: internet
 ──────────────────────────────────────────────────────────────────────────────
 Updated 2023-11-14 at 22:13:20                                 o panes  ? help
)");
}

TEST(OverviewText, OnANarrowScreenListsHaveTheirNamesAboveThem) {
    EXPECT_EQ(screenOf("lte-drive", 40, 20), R"(
 Pallax › Overview  Zorell · …rive.pcap
 ──────────────────────────────────────
 Sample Net 262-42 · home network
 eNodeB 104475 sector 1 · PCI 184
 TAC 6699
 EARFCN 1850 · band 3 · 1870.0 MHz
 uplink 1775.0 MHz · bandwidth 20 MHz
 antenna ports 4
 RSRP  -92.75 dBm  excellent  ▆▆▆▆▁▁▁▁
 RSRQ   -12.62 dB  good       ▆▆▆▁▁▁▁▁
 quality by the profile android
 Neighbours
 PCI 285  RSRP  -90.00 dBm  excellent
 PCI 286  RSRP  -97.00 dBm  excellent
 PCI 387  RSRP  -98.50 dBm  good
 Contexts
 ims Active · internet Active
 Events
 ──────────────────────────────── ↓ 3 ─
 Updated 2023-11-14 at 22:13:20  ? help
)");
}

TEST(OverviewText, OnAWideScreenTheListsStandBesideTheRest) {
    EXPECT_EQ(screenOf("lte-drive", 200, 60), R"(
 Pallax › Overview                                                                                                                                                              Zorell · lte-drive.pcap
 ──────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────
 Operator    Sample Net 262-42 · home network                                                        Neighbours  PCI 285  RSRP  -90.00 dBm  excellent  0 s ago  ▆▆▆▆▁▁▁▁
                                                                                                                 PCI 286  RSRP  -97.00 dBm  excellent  0 s ago  ▆▆▆▆▁▁▁▁
 Cell        eNodeB 104475 sector 1 · PCI 184 · TAC 6699                                                         PCI 387  RSRP  -98.50 dBm  good       0 s ago  ▆▆▆▁▁▁▁▁
             EARFCN 1850 · band 3 · 1870.0 MHz · uplink 1775.0 MHz · bandwidth 20 MHz
             antenna ports 4                                                                         Events      22:15:19  serving cell 286 → 184 after 4 s
                                                                                                                 22:15:18  context up: internet
 Levels      RSRP  -92.75 dBm  excellent  ▆▆▆▆▁▁▁▁                                                               22:15:14  serving cell 82 → 286 after 17 s
             RSRQ   -12.62 dB  good       ▆▆▆▁▁▁▁▁                                                               22:15:01  context down: internet
             quality by the profile android                                                                      22:14:57  serving cell 285 → 82 after 13 s
                                                                                                                 22:14:44  serving cell 183 → 285 after 69 s
 Contexts    ims Active · internet Active                                                                        22:14:42  context up: internet
                                                                                                                 22:14:27  context down: internet
                                                                                                                 22:14:09  context up: internet
                                                                                                                 22:13:53  context down: internet
                                                                                                                 22:13:35  serving cell 182 → 183 after 15 s
                                                                                                                 22:13:29  context up: internet








































 ──────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────
 Updated 2023-11-14 at 22:13:20                                                                                                                                                         o panes  ? help
)");
}

TEST(OverviewText, WithAsciiMarksIsAscii) {
    EXPECT_EQ(screenOf("lte-drive", 80, 24, kAsciiMarks), R"(
 Pallax > Overview                                       Zorell, lte-drive.pcap
 ------------------------------------------------------------------------------
 Operator    Sample Net 262-42, home network
 Cell        eNodeB 104475 sector 1, PCI 184, TAC 6699
             EARFCN 1850, band 3, 1870.0 MHz, uplink 1775.0 MHz
             bandwidth 20 MHz, antenna ports 4
 Levels      RSRP  -92.75 dBm  excellent  ####....
             RSRQ   -12.62 dB  good       ###.....
             quality by the profile android
 Neighbours  PCI 285  RSRP  -90.00 dBm  excellent  0 s ago  ####....
             PCI 286  RSRP  -97.00 dBm  excellent  0 s ago  ####....
             PCI 387  RSRP  -98.50 dBm  good       0 s ago  ###.....
 Contexts    ims Active, internet Active
 Events      22:15:19  serving cell 286 -> 184 after 4 s
             22:15:18  context up: internet
             22:15:14  serving cell 82 -> 286 after 17 s
             22:15:01  context down: internet
             22:14:57  serving cell 285 -> 82 after 13 s
             22:14:44  serving cell 183 -> 285 after 69 s
             22:14:42  context up: internet
             22:14:27  context down: internet
             22:14:09  context up: internet
 ------------------------------------------------------------------------------
 Updated 2023-11-14 at 22:13:20                                 o panes  ? help
)");
}

TEST(OverviewText, OfGsmAndUmtsHasACellOfEach) {
    EXPECT_EQ(screenOf("umts-drive", 80, 24), R"(
 Pallax › Overview                                     Zorell · umts-drive.pcap
 ──────────────────────────────────────────────────────────────────────────────
 Operator    Sample Net 262-42
 GSM cell    cell 12081 · BSIC 33 · 63 s ago
             ARFCN 42 · band P-GSM 900 · 943.4 MHz · 30 s ago
 UMTS cell   RNC 164 cell 388 · PSC 388
             UARFCN 10713 · band I · 2142.6 MHz · uplink 1952.6 MHz
 Levels      UMTS RSCP   -84 dB  excellent  ▆▆▆▁▁▁▁▁
             UMTS Ec/Io   -9 dB  fair       ▆▆▆▆▆▁▁▁
             quality by the profile android
 State       MM_IDLE · GMM_REGISTERED · RR_INACTIVE · RRC Disconnected
 Neighbours  GSM ARFCN 17 BSIC 42       RSSI   -91 dBm  good  1 s ago  ▆▆▁▁▁▁▁▁
             GSM ARFCN 86 BSIC 17       RSSI   -95 dBm  good  1 s ago  ▆▆▁▁▁▁▁▁
             GSM ARFCN 771 BSIC 5       RSSI   -97 dBm  good  1 s ago  ▆▆▁▁▁▁▁▁
             UMTS PSC 212 UARFCN 10713  RSCP  -103 dBm  fair  0 s ago  ▆▁▁▁▁▁▁▁
             UMTS PSC 97 UARFCN 10713   RSCP  -109 dBm  poor  0 s ago  ▆▁▁▁▁▁▁▁
 Contexts    internet Active · mms Inactive
 Events      22:15:14  UMTS serving cell 212 → 388 after 65 s
             22:15:14  RRC CELL_DCH → Disconnected
             22:15:00  RRC Disconnected → CELL_DCH
             22:14:55  RRC CELL_DCH → Disconnected
             22:14:55  GMM GMM_ROUTING_AREA_UPDATE_INITIATED → GMM_REGISTERED
 ──────────────────────────────────────────────────────────────────────────────
 Updated 2023-11-14 at 22:13:20                                 o panes  ? help
)");
}

TEST(OverviewText, OfCdmaHasACellOfEachSystem) {
    EXPECT_EQ(screenOf("cdma-drive", 80, 24), R"(
 Pallax › Overview                                     Zorell · cdma-drive.pcap
 ──────────────────────────────────────────────────────────────────────────────
 1x cell     SID 4139 · NID 65 · base station 2395
             channel 384 · band 0 · 881.52 MHz
 EV-DO cell  PN 118
             channel 466 · band 0 · 883.98 MHz
 Levels      1x AGC       -65.92 dBm  excellent  ▆▆▆▆▆▁▁▁
             1x Ec/Io       -2.35 dB  excellent  ▆▆▆▆▆▆▆▁
             EV-DO AGC       -59 dBm  excellent  ▆▆▆▆▆▆▁▁
             EV-DO Ec/Io    -3.98 dB
             quality by the profile android
 State       1x Slotted mode sleep state [7] · EV-DO Connected [5]
             EV-DO session Open [4]
 Events      22:14:04  EV-DO Access [4] → Connected [5]
             22:14:03  EV-DO Idle [3] → Access [4]
             22:13:53  1x Traffic [8] → Slotted mode sleep state [7]
             22:13:47  EV-DO serving cell 24 × 64chips → 118 × 64chips after 7…
             22:13:40  EV-DO serving cell 118 × 64chips → 24 × 64chips after 1…
             22:13:30  1x Slotted mode sleep state [7] → Traffic [8]
             22:13:30  EV-DO serving cell 24 × 64chips → 118 × 64chips after 7…
             22:13:25  1x serving cell 2399 → 2395 after 5 s
             22:13:23  EV-DO session AT-initiated neg [2] → Open [4]
 ──────────────────────────────────────────────────────────────────────────────
 Updated 2023-11-14 at 22:13:20                                 o panes  ? help
)");
}

TEST(OverviewText, OfUtranHasLevelsWithoutAUnit) {
    EXPECT_EQ(screenOf("utran-drive", 80, 24), R"(
 Pallax › Overview                                    Zorell · utran-drive.pcap
 ──────────────────────────────────────────────────────────────────────────────
 Operator    Sample Net 262-42 · home network
 Cell        RNC 167 cell 43037 · PSC 95 · LAC 6699 · 15 s ago
             UARFCN 10096 · band 34 · 2019.2 MHz · uplink 2019.2 MHz
 Levels      RSCP  0.371094
 State       RRC Cell PCH
 Neighbours  PSC 61 UARFCN 10096   RSCP  0.394531  0 s ago
             PSC 122 UARFCN 10088  RSCP  0.343750  0 s ago
             PSC 34 UARFCN 10104   RSCP  0.335938  0 s ago
             PSC 68 UARFCN 10104   RSCP  0.312500  0 s ago
             PSC 28 UARFCN 10088   RSCP  0.246094  0 s ago
             PSC 88 UARFCN 10088   RSCP  0.207031  0 s ago
             PSC 1 UARFCN 10096    RSCP  0.207031  0 s ago
             PSC 55 UARFCN 10104   RSCP  0.199219  0 s ago
 Contexts    mms Active
 Events      22:15:16  RRC Cell Fach → Cell PCH
             22:15:15  context down: internet
             22:15:15  RRC Cell DCH → Cell Fach
             22:14:56  context up: internet
             22:14:56  RRC Connecting → Cell DCH
             22:14:55  RRC Disconnected → Connecting
 ──────────────────────────────────────────────────────────────────────────────
 Updated 2023-11-14 at 22:13:20                                 o panes  ? help
)");
}

TEST(OverviewText, OfAnObjectStreamHasWhatItsMessagesTell) {
    EXPECT_EQ(screenOf("ifx-stream", 80, 24), R"(
 Pallax › Overview                                     Zorell · ifx-stream.pcap
 ──────────────────────────────────────────────────────────────────────────────
 Operator    Sample Net 262-42
 Cell        cell 31004 · BSIC 4,1 · LAC 6701
             ARFCN 85 · band P-GSM 900 · 952.0 MHz
 Levels      RxLev  -65 dBm  excellent  ▆▆▆▆▆▆▁▁
             quality by the profile android
 State       RR Idle
 Neighbours  ARFCN 71 BSIC 2,5  RxLev  -79 dBm  excellent  0 s ago  ▆▆▆▆▁▁▁▁
             ARFCN 62 BSIC 2,3  RxLev  -89 dBm  excellent  0 s ago  ▆▆▆▁▁▁▁▁
             ARFCN 17 BSIC 4,2  RxLev  -92 dBm  good       0 s ago  ▆▆▁▁▁▁▁▁
 Events      22:13:46  RR Dedicated → Idle
             22:13:40  serving cell 71 → 85 after 11 s
             22:13:35  RR Connection Establishment → Dedicated
             22:13:33  RR Idle → Connection Establishment
             22:13:29  serving cell 62 → 71 after 9 s






 ──────────────────────────────────────────────────────────────────────────────
 Updated 2023-11-14 at 22:13:20                                 o panes  ? help
)");
}

/// The curves of the levels of a sample, which all rise, in this many columns.
std::vector<std::string> curvesIn(int columns) {
    Overview overview = overviewOf("cdma-drive");
    overview.curvesTo = overview.curvesFrom + std::chrono::seconds(9);
    Curve rising{{}, std::chrono::seconds(2), false};
    for (int second = 0; second < 10; ++second) {
        const double value = second;
        rising.points.push_back(
            {overview.curvesFrom + std::chrono::seconds(second), value, value, value, value});
    }
    for (const StatusCell& cell : overview.status.cells) {
        for (const StatusValue& level : cell.levels) {
            overview.curves.push_back({{level.field, level.entry, ""}, rising});
        }
    }
    std::vector<std::string> curves;
    const OverviewText text = overviewText(overview, kAsciiMarks, {0, columns}, 24);
    for (const TextRow& row : text.columns.at(0).rows) {
        for (const TextPiece& piece : row) {
            if (piece.text.find("__") != std::string::npos) {
                curves.push_back(piece.text);
            }
        }
    }
    return curves;
}

TEST(OverviewText, CurvesTakeTheRoomBesideTheLevels) {
    using Curves = std::vector<std::string>;
    EXPECT_EQ(curvesIn(90), Curves(4, "_____........--------'''"));
    EXPECT_EQ(curvesIn(80), Curves(4, "____........-------'''"));
    EXPECT_EQ(curvesIn(70), Curves(4, "__....----''"));
    EXPECT_EQ(curvesIn(68), Curves());
}

} // namespace
} // namespace pallax::terminal
