#include "tests/ui/pages/SampleDisplay.h"
#include "tests/ui/terminal/StageFixture.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace pallax::terminal {
namespace {

/// A list of a sample's display as a table.
class TableScreensTest : public testing::Test {
protected:
    explicit TableScreensTest(const Marks& marks = kUtf8Marks) : stage(marks) {}
    void open(const std::string& sample, const char* list) {
        shown.emplace(sample);
        stage.entryPart = [this](const std::string& path) {
            return shown->watch.namesCell(path)    ? EntryPart::Cell
                   : shown->watch.identifies(path) ? EntryPart::Identity
                                                   : EntryPart::None;
        };
        stage.frontEnd.showListsAsTables(true);
        stage.tick(shown->driver.display());
        openList(list);
    }

    void openList(const char* list) {
        stage.type("/");
        stage.type(list);
        stage.press(Key::Home);
        stage.press(Key::Enter);
        stage.press(Key::Home);
        stage.press(Key::Enter);
    }

    std::optional<SampleDisplay> shown;
    TerminalStage stage;
};

TEST_F(TableScreensTest, OfLte) {
    open("lte-drive", "Neighbor Cells List");
    EXPECT_EQ(stage.screen(80, 24), R"(
 Pallax › Neighbor Cells List                                           2 cells
 ──────────────────────────────────────────────────────────────────────────────
 Physical  Measured  Measured   Average  Measured  Average  Srxlev  Frequency
  Cell ID  RSSI dBm  RSRP dBm  RSRP dBm   RSRQ dB  RSRQ dB     dBm     Offset  …
▌     184    -64.00    -94.00    -94.00     -9.75    -9.75      28         22
      285    -64.00    -97.00    -96.00    -12.00   -12.00      26         32
















 ──────────────────────────────────────────────────────────────────────────────
 Updated 2023-11-14 at 22:13:20     r reverse  t rows  / filter  s Save  ? help
)");
    EXPECT_EQ(stage.screen(40, 20), R"(
 Pallax › Neighbor Cells List   2 cells
 ──────────────────────────────────────
 Physical  Measured  Measured   Average
  Cell ID  RSSI dBm  RSRP dBm  RSRP dBm…
▌     184    -64.00    -94.00    -94.00
      285    -64.00    -97.00    -96.00












 ──────────────────────────────────────
 Updated 2023-11-14 at 22:13:20  ? help
)");
    EXPECT_EQ(stage.screen(200, 60), R"(
 Pallax › Neighbor Cells List                                                                                                                                                                   2 cells
 ──────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────
 Physical  Measured  Measured   Average  Measured  Average  Srxlev  Frequency  Ant 0 Frame  Ant 0 Sample  Ant 1 Frame  Ant 1 Sample
  Cell ID  RSSI dBm  RSRP dBm  RSRP dBm   RSRQ dB  RSRQ dB     dBm     Offset       Offset        Offset       Offset        Offset
▌     184    -64.00    -94.00    -94.00     -9.75    -9.75      28         22          103        149688          103        149688
      285    -64.00    -97.00    -96.00    -12.00   -12.00      26         32          359         11549          359         11549




















































 ──────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────
 Updated 2023-11-14 at 22:13:20                                                                                                                   < > sort  r reverse  t rows  / filter  s Save  ? help
)");
}

TEST_F(TableScreensTest, OfUmts) {
    open("umts-drive", "UMTS Set");
    EXPECT_EQ(stage.screen(80, 8), R"(
 Pallax › UMTS Set                                                      2 cells
 ──────────────────────────────────────────────────────────────────────────────
 UARFCN  Scrambling Code  RSCP dBm  Energy Per Chip dB
▌ 10713              212      -103                 -20
  10713               97      -109                 -20

 ──────────────────────────────────────────────────────────────────────────────
 Updated 2023-11-14 at 22:13:20     r reverse  t rows  / filter  s Save  ? help
)");
}

TEST_F(TableScreensTest, OfUtran) {
    open("utran-drive", "CCTRCH SIR");
    EXPECT_EQ(stage.screen(80, 8), R"(
 Pallax › CCTRCH SIR                                                  2 entries
 ──────────────────────────────────────────────────────────────────────────────
 CCTRCH ID  TSNUM  SIR
▌        1      4    6›
         2      5    6›

 ──────────────────────────────────────────────────────────────────────────────
 Updated 2023-11-14 at 22:13:20     r reverse  t rows  / filter  s Save  ? help
)");
    stage.press(Key::Left);
    stage.press(Key::Escape);
    openList("Neighbor Cell List");
    EXPECT_EQ(stage.screen(80, 16), R"(
 Pallax › Neighbor Cell List                                           10 cells
 ──────────────────────────────────────────────────────────────────────────────
         Cell    Filter
 UARFCN    ID      RSCP  Status  inJDCS
▌ 10096    95  0.371094  ASET    TRUE
  10096    61  0.394531  MSET    FALSE
  10088   122  0.343750  MSET    FALSE
  10104    34  0.335938  MSET    FALSE
  10104    68  0.312500  MSET    FALSE
  10088    28  0.246094  MSET    FALSE
  10088    88  0.207031  DSET    FALSE
  10104    55  0.199219  DSET    FALSE
  10096     1  0.207031  DSET    FALSE
  10104    21  0.175781  DSET    FALSE
 ──────────────────────────────────────────────────────────────────────────────
 Updated 2023-11-14 at 22:13:20     r reverse  t rows  / filter  s Save  ? help
)");
}

class AsciiTableScreensTest : public TableScreensTest {
protected:
    AsciiTableScreensTest() : TableScreensTest(kAsciiMarks) {}
};

TEST_F(AsciiTableScreensTest, OfLte) {
    open("lte-drive", "Neighbor Cells List");
    EXPECT_EQ(stage.screen(80, 24), R"(
 Pallax > Neighbor Cells List                                           2 cells
 ------------------------------------------------------------------------------
 Physical  Measured  Measured   Average  Measured  Average  Srxlev  Frequency
  Cell ID  RSSI dBm  RSRP dBm  RSRP dBm   RSRQ dB  RSRQ dB     dBm     Offset  ~
>     184    -64.00    -94.00    -94.00     -9.75    -9.75      28         22
      285    -64.00    -97.00    -96.00    -12.00   -12.00      26         32
















 ------------------------------------------------------------------------------
 Updated 2023-11-14 at 22:13:20     r reverse  t rows  / filter  s Save  ? help
)");
}

} // namespace
} // namespace pallax::terminal
