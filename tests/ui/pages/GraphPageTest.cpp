#include "tests/ui/pages/ValueStage.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <set>
#include <string>

namespace pallax::terminal {
namespace {

constexpr const char* kServing = "Serving Cell Measurements";

class GraphPageTest : public ValueStage {
protected:
    /// Two levels in dBm and one in dB.
    void addLevels(TerminalStage& on) {
        show(on, last());
        select(on, kServing, "Measured RSRP");
        on.type("v");
        on.press(Key::Down);
        on.type("v");
        on.press(Key::Down);
        on.type("v");
    }
    std::string screenOf(int columns, int rows, const Marks& marks = kUtf8Marks) {
        TerminalStage another(marks);
        addLevels(another);
        another.type("V");
        const std::string screen = another.screen(columns, rows);
        EXPECT_EQ(faultOf(another.frontEnd.draw()), "");
        return screen;
    }
};

TEST_F(GraphPageTest, ValuesOfOneUnitShareAPlot) {
    EXPECT_EQ(screenOf(80, 24), R"(
 Pallax › Graph
 ──────────────────────────────────────────────────────────────────────────────
 a  -86.25 dBm  Measured RSRP, Serving Cell Measurements
 b  -87.00 dBm  Average RSRP, Serving Cell Measurements
  -60 ┤
      │
      │                                                               ⣦⣴⡄
  -80 ┤⣼⣤⢠⡄   ⣠⣄⡀                               ⡄              ⣰⣷      ⠈⢷
      │⠁⠹⡾    ⠋⠉⠃       ⡀       ⣠⣰⢷⡄   ⣀⣠ ⢠⡀    ⣇      ⢀ ⢀   ⠰⣼⠁⠈⠇      ⠘⡇  ⢰ a
      │  ⠁           ⠘⡾⣾⡇    ⢀⣴⡷⡟⠛     ⠘⠹⡾⠿⠃    ⠛⣷⣶⡇   ⠘⣧⡾    ⠉          ⠁    b
 -100 ┤┆  ┆┆  ┆ ┆    ┆ ⠃┆ ┆  ⠘⠏⠃⠃  ┆ ┆ ┆  ┆┆ ┆  ┆⠁⠁┆  ┆┆⠟⠃┆  ┆┆  ┆    ┆  ┆  ┆
  dBm └┆──┆┆─ 22:16 ─┆─┆┆─┆ 22:17 ─┆─┆─┆─ 22:18 ┆──┆──┆ 22:19 ┆──┆─── 22:20 ┆
 c  -7.00 dB  Measured RSRQ, Serving Cell Measurements
   -5 ┤⣴⣄     ⢰⣶⡆               ⢀⢀⣦⡄    ⡀       ⡆              ⣠⣶     ⣿⣷⣶   ⢀
      │⠛⢿⣾⡇   ⣾⠘⠃    ⢰⣰⣰⡇      ⢀⣿⣿⠙⠃   ⢻⣷⣀⢸     ⣷  ⡀   ⢰⡀⣴   ⢠⢠⠿⠻⡆    ⠈⠛⢻   ⢸ c
      │  ⠋    ⠛      ⠘⡿⣿⡇     ⣶⣾⡟      ⠘⢹⣿⣾⡇    ⠛⣷⣼⡇   ⠘⣇⡟   ⠘⣿  ⠁      ⠘⡇
  -10 ┤               ⠇⣿⠁     ⣿⣿⡇        ⠉⢿⡇     ⣿⣿⡇    ⣿⡇    ⢿          ⡇
      │                ⠿     ⢸⣿⡇⡇         ⢸⠁     ⠃⠁     ⡏⡇    ⢸          ⠃
      │                       ⠏⡇⡇         ⠘             ⡇⡇    ⢸
  -15 ┤┆  ┆┆  ┆ ┆    ┆ ┆┆ ┆  ┆┆⠁⠁  ┆ ┆ ┆  ┆┆ ┆  ┆  ┆  ┆┆⠇⠇┆  ┆⠸  ┆    ┆  ┆  ┆
   dB └┆──┆┆─ 22:16 ─┆─┆┆─┆ 22:17 ─┆─┆─┆─ 22:18 ┆──┆──┆ 22:19 ┆──┆─── 22:20 ┆
 the last 5 minutes
 ──────────────────────────────────────────────────────────────────────────────
 Updated 2023-11-14 at 22:13:20                       - + zoom  V panes  ? help
)");
}

TEST_F(GraphPageTest, FitsANarrowScreen) {
    EXPECT_EQ(screenOf(40, 20), R"(
 Pallax › Graph
 ──────────────────────────────────────
 a  -86.25 dBm  Measured RSRP, Serving
 b  -87.00 dBm  Average RSRP, Serving C
  -60 ┤
      │                           ⣤
  -80 ┤⣦⡄ ⣤⡀      ⢀     ⢠     ⢀⣾  ⠙⡇
      │⠸⠃ ⠉⠁ ⣤⡄  ⣴⡾⠃⢰⢦⣧ ⢸⣤⡀⢠⣴ ⠸⠙   ⠗⠛ a
 -100 ┤┆┆ ┆┆ ⠙⠃┆⠰⠿ ┆┆⠈⠁┆┆⠛┆┆⠿┆┆┆  ┆┆┆ b
  dBm └┆ 22:16 ┆┆┆─┆ 22:18 ┆┆┆┆┆──┆┆┆
 c  -7.00 dB  Measured RSRQ, Serving Ce
   -5 ┤⣶⡀ ⣾⠆ ⢀⡀  ⢠⣼⡆⢀⡄⡀ ⢰   ⢀  ⣾  ⣿⡆⢠
      │⢹⠇ ⡇  ⣿⡇  ⣼⡏⠁⠸⢷⡇ ⢸⣴⡀⢸⣾ ⢸⠹  ⠈⡇⡞ c
  -10 ┤      ⢹⡇ ⢀⣿   ⠘⣿  ⣿⠃ ⣿ ⢸    ⡟
      │      ⠈⠃ ⢸⣿    ⡇  ⠁  ⣿ ⢸    ⠁
  -15 ┤┆┆ ┆┆ ┆┆┆┆⠛ ┆┆ ┆┆┆ ┆┆⣿┆⠸┆  ┆┆┆
   dB └┆ 22:16 ┆┆┆─┆ 22:18 ┆┆┆┆┆──┆┆┆
 the last 5 minutes
 ──────────────────────────────────────
 Updated 2023-11-14 at 22:13:20  ? help
)");
}

TEST_F(GraphPageTest, UsesAWideScreen) {
    EXPECT_EQ(screenOf(200, 60), R"(
 Pallax › Graph
 ──────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────
 a  -86.25 dBm  Measured RSRP, Serving Cell Measurements
 b  -87.00 dBm  Average RSRP, Serving Cell Measurements
  -70 ┤
      │
      │                                                                                                                                                                            ⡀  ⢠
      │                                                                                                                                                                            ⣧⢠⡄⢸⣧
  -75 ┤                                                                                                                                                                           ⢰⢿⣾⣷⡾⣿
      │                                                                                                                                                                           ⠘⠘⣿⢸⡇⢿⡆
      │  ⡄                                                                                                                                                        ⣤                   ⠁⠸⡇
      │ ⢸⡇                                                                                                                                                      ⢀⡀⣿⡀                    ⢿
  -80 ┤ ⣸⣇⢠⡆  ⢀⣄            ⢠⣀                                                                                        ⡀                                         ⢸⡇⣿⡇                    ⢸⡇
      │ ⣿⢸⣿⡇  ⢸⣿            ⣿⣿⡀                                                                                       ⡇                                         ⡾⣿⠋⣿⡄                   ⠘⡇
      │ ⡏⠸⡟⢹  ⡾⠁          ⣸⣷⡏⣿⣿⣼                                                                                      ⢸                                        ⣿⡇⠸ ⢿⡇                    ⣇
      │ ⠃  ⢸⡀ ⡇           ⡿⠙⠃⠛⠟⣿⡷                                               ⢸⣶                                    ⢸                                       ⢸⡟⠁   ⡇                    ⢻⡆
  -85 ┤    ⢸⡇⢠⡇           ⠁     ⠇                                               ⣼⢿⡇                                   ⢸                                     ⡄ ⢸     ⣷                    ⢸⡇         ⢠
      │    ⠈⣿⣿⡇                                                                 ⡏⠘⣧⣤⡄                  ⢠⡆             ⢸                                    ⢠⣇⡄⢸     ⠹                     ⣷         ⢸ a
      │     ⢸⡇⠁                                                             ⣰  ⣀⡇ ⢻⣿⠇          ⡀⣀⣰⡀    ⢸⣇             ⠸⡆                         ⡀         ⠘⣿⣷⣸                           ⢸⡄        ⠸ b
      │     ⢸⠁                                 ⡀      ⡄                    ⢀⣿ ⣴⣿⠃  ⠁           ⣷⣿⣿⣿    ⢸⣿⣠             ⡇⢠⡀                ⢰⡄    ⢰⡇          ⠻⢹⣿                           ⠸⡇
  -90 ┤                                        ⣧ ⣸⡆  ⡄⡇                 ⢰  ⢸⠛⣿⠿⣿               ⣿⠋⡏⢹  ⡀⣄⣿⠸⣿             ⣿⣿⡇     ⡄          ⠘⣷⡀   ⣾⡇           ⠸⠻
      │                                        ⢸ ⣿⣧  ⣧⠇               ⢰⡄⢸⣇⣧⢸ ⠟ ⠛               ⠹  ⢸⡄⡀⣷⣿⢿ ⠟             ⠈⠋⡇⢀⢠ ⡆⢸⡇           ⣿⡇  ⢸⡇
      │                                        ⢸⣆⡇⢸ ⢸⢻                ⣸⣇⢸⣿⣿⣸                      ⠈⣧⣷⣿⡟⢸                 ⢱⣾⣾⢰⣿⣾             ⣷⡆ ⢸⠃
      │                                         ⣿⡇⢸⢰⣾⠸                ⣿⢻⣼⠘⠹⣿                       ⢿⠟⠉⠃⠘                 ⢸⡿⢿⣾⢹⢿             ⣿⣧⢰⢸
  -95 ┤                                         ⠻⠃⢸⣿⠏                ⣄⡏⠘⣿  ⣿                       ⠈                     ⠘⡇⠸⡟ ⠈             ⢿⢿⣿⡏
      │                                           ⠘⡿                 ⣿⡇ ⢹  ⣿                                                ⠁               ⢸⠈⡿⡇
      │                                                              ⣿⡇    ⢹                                                                ⢸ ⠃⡇
      │                                                              ⠉⠇    ⠈                                                                ⠸  ⠁
 -100 ┤ ┆      ┆  ┆       ┆     ┆              ┆     ┆┆     ┆        ┆┆ ┆  ┆        ┆     ┆    ┆       ┆  ┆     ┆     ┆        ┆      ┆   ┆ ┆  ┆ ┆┆        ┆  ┆      ┆            ┆        ┆        ┆
  dBm └─ 22:15:30 ┆───────┆ 22:16:00 ───────── 22:16:30 ────┆──── 22:17:00 ┆──────── 22:17:30 ─┆─────── 22:18:00 ─────┆─── 22:18:30 ──┆───┆─┆ 22:19:00 ────┆──┆─ 22:19:30 ────────┆ 22:20:00 ───────┆
 c  -7.00 dB  Measured RSRQ, Serving Cell Measurements
   -4 ┤
      │
      │                      ⡄⡄                                                  ⡄                                                                                ⣤                ⣧⣿⡇⢠⡄
      │ ⣿⣧⢠                 ⣿⣿⣿⣼⣧                                               ⣼⣿⡄⣤                                  ⣧                                         ⢠⡄⣿⣿⡄             ⢸⣿⣿⣿⣼⣿⣿
   -6 ┤ ⣿⣿⣾⣀               ⢀⣿⣿⣿⣿⣿                                           ⡀  ⡆⣿⣿⣇⣿⡆            ⣀                    ⣿                                         ⣸⣷⣿⣿⡇             ⠘⢻⣿⣿⣿⣿⣿⡆          ⢀
      │ ⣿⢻⣿⣿⡆⡀⣶⣶          ⣀⢸⡇ ⠛⣿⠃                ⢀   ⡀⡆                    ⢀⣧ ⢰⣷⠟⠛⣿⣿⡇          ⡆⣶⣿⡀    ⢰⡆             ⢸                          ⡀             ⣶⣿⢻⠛⢻⣇              ⠘ ⢻⡟⠛⣿⡇          ⢸
      │ ⠘⠘⡇⢻⣷⣿⣿⣿          ⣿⣾⠃                  ⣆ ⣾⡀  ⡇⡇                    ⢸⣿⢰⣾⣿  ⠘⠘           ⣷⣿⣿⣷    ⢸⣷             ⢸⣶⡀                 ⢰⡆   ⢀⣰⡇          ⡀ ⢀⣿⡇⢸  ⣿                 ⠃  ⣇          ⢸ c
      │     ⢻⣿⡟⡇          ⣿⣿                   ⣿ ⣿⣷  ⡇⡇                   ⡀⢸⠛⣾⣿⠃               ⢻⣿⡇⣿ ⢀⡆ ⢸⢻              ⣿⣷      ⡆          ⢸⣇⡆  ⢸⣿⡇         ⢰⡇ ⢸     ⣿                    ⢻⡀         ⠘
   -8 ┤     ⢸⡟            ⠘⣿                   ⢻⢀⣿⣿  ⣇⠇               ⣀   ⣇⢸ ⣿                 ⢸⠘ ⢸ ⣾⣷ ⢸⢸              ⣿⣿⡆   ⣰⢀⡇           ⢻⣷  ⢸⣿⡇         ⢸⡇ ⢸     ⠛                    ⢸⡇
      │     ⠘              ⠃                   ⢸⢸⡇⢻  ⣿                ⣿⡆⢰ ⣿⢸ ⠃                    ⢸⣶⣿⣿⣆⣾⢸⡆             ⠘⠘⡇ ⡆ ⣿⣾⡇           ⠘⣿⡇ ⢸⠃          ⠘⣷⡆⢸                          ⠘⣇
      │                                        ⢸⣾⡇⢸ ⢠⢻                ⣿⡇⢸⣰⢻⢸                       ⣿⣿⣿⣿⣿⢸⡇               ⣷ ⣷⣀⣿⣿⡇            ⣿⣷ ⢸            ⣿⣇⢸                           ⢸
      │                                         ⡏ ⢸ ⣸⠘                ⡟⡇⢸⣿⢸⢸                       ⠛ ⠘⢻⣿⠘⣷               ⢸⢸⣿⣿⢻⣿⠃            ⣿⣿⣶⢸             ⢻⢸                           ⢸
  -10 ┤                                         ⠇ ⢸ ⣿                 ⡇⢇⢸⣿⠈⣾                          ⢸⣿ ⣿               ⢸⣼⢸⣿⠸⣿             ⣿⢿⣿⢸             ⢸⢸                           ⢸⡄
      │                                           ⠸⣼⣿                 ⡇⢸⢸⠿ ⣿                          ⠈⢿ ⣿               ⢸⡿⠸⣿ ⠿             ⣿⠈⣿⢸             ⢸⣿                           ⠸⡇
      │                                            ⣿⢹                ⡇⡇⢸⢸  ⣿                           ⢸ ⠉               ⠸⡇ ⠉               ⢿ ⢹⡸             ⠸⣿                            ⡇
      │                                            ⢹⢸                ⡇⡇⠸⣾  ⣿                           ⢸                  ⠁                 ⢸ ⢸⡇              ⣿                            ⠁
  -12 ┤                                            ⠈⠈                ⣧⡇ ⣿  ⣿                           ⢸                                    ⢸ ⠸⡇              ⣿
      │                                                              ⣿⡇ ⣿  ⣿                           ⢸                                    ⢸  ⡇              ⢿
      │                                                              ⠹⠇ ⣿  ⣿                           ⠈                                    ⢸  ⡇              ⢸
      │                                                                 ⢻  ⢹                                                                ⢸  ⡇              ⢸
  -14 ┤                                                                 ⢸  ⠈                                                                ⢸  ⡇              ⢸
      │                                                                                                                                     ⢸  ⡇              ⢸
      │                                                                                                                                     ⠘  ⠃
      │
  -16 ┤ ┆      ┆  ┆       ┆     ┆              ┆     ┆┆     ┆        ┆┆ ┆  ┆        ┆     ┆    ┆       ┆  ┆     ┆     ┆        ┆      ┆   ┆ ┆  ┆ ┆┆        ┆  ┆      ┆            ┆        ┆        ┆
   dB └─ 22:15:30 ┆───────┆ 22:16:00 ───────── 22:16:30 ────┆──── 22:17:00 ┆──────── 22:17:30 ─┆─────── 22:18:00 ─────┆─── 22:18:30 ──┆───┆─┆ 22:19:00 ────┆──┆─ 22:19:30 ────────┆ 22:20:00 ───────┆
 the last 5 minutes
 ──────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────
 Updated 2023-11-14 at 22:13:20                                                                                                                                               - + zoom  V panes  ? help
)");
}

TEST_F(GraphPageTest, NeedsOnlyAscii) {
    const std::string screen = screenOf(80, 24, kAsciiMarks);
    EXPECT_EQ(screen, R"(
 Pallax > Graph
 ------------------------------------------------------------------------------
 a  -86.25 dBm  Measured RSRP, Serving Cell Measurements
 b  -87.00 dBm  Average RSRP, Serving Cell Measurements
  -60 +
      |
      |                                                               ***
  -80 +****   ***                 *             *             ***     ***
      |***    ***    ** *      *****   ** **    **     * *   *****      **  * a
      |              ****    *****     *****    ****   ***    *               b
 -100 +:  ::  : :    : :: :  **:*  : : :  :: :  :  :  ::**:  ::  :    :  :  :
  dBm +:--::- 22:16 -:-::-: 22:17 -:-:-:- 22:18 :--:--: 22:19 :--:--- 22:20 :
 c  -7.00 dB  Measured RSRQ, Serving Cell Measurements
   -5 +**     ***                 **            *              **     ***
      |****   ***    ****       ****   ** *     *      * *   *****    ***   * c
      | ***   *      ****     ****     *****    ****   ***   **  *      **  *
  -10 +               ***    ****       ****     ***    **    *          *
      |                *     ****         *      *      **    *          *
      |                       ***         *             **    *
  -15 +:  ::  : :    : :: :  ::::  : : :  :: :  :  :  ::**:  :*  :    :  :  :
   dB +:--::- 22:16 -:-::-: 22:17 -:-:-:- 22:18 :--:--: 22:19 :--:--- 22:20 :
 the last 5 minutes
 ------------------------------------------------------------------------------
 Updated 2023-11-14 at 22:13:20                       - + zoom  V panes  ? help
)");
    EXPECT_TRUE(std::all_of(screen.begin(), screen.end(),
                            [](char each) { return static_cast<unsigned char>(each) < 0x80; }));
}

TEST_F(GraphPageTest, TheKeyPutsAValueInAndTakesItAway) {
    show(last());
    select(kServing, "Measured RSRP");
    stage.type("v");
    EXPECT_TRUE(shows("In the graph (1 of 6): V opens it."));
    stage.type("V");
    EXPECT_TRUE(shows("Pallax › Graph"));
    EXPECT_TRUE(shows(" dBm  Measured RSRP, Serving Cell Measurements"));
    stage.type("V");
    EXPECT_EQ(stage.depth(), 2U);
    stage.type("v");
    EXPECT_TRUE(shows("No longer in the graph."));
    stage.type("V");
    EXPECT_TRUE(shows("No values: v in a pane adds one."));
    stage.press(Key::Left);
    EXPECT_FALSE(shows("Pallax › Graph"));
}

TEST_F(GraphPageTest, AValuesPagePutsItInTheGraphToo) {
    show(last());
    select(kServing, "Measured RSRP");
    stage.type("iv");
    EXPECT_TRUE(shows("In the graph (1 of 6): V opens it."));
    stage.type("V");
    EXPECT_TRUE(shows("Pallax › Graph"));
    stage.press(Key::Escape);
    EXPECT_TRUE(shows("› Measured RSRP")) << "the page below it";
}

TEST_F(GraphPageTest, OnlyNumbersHaveACurve) {
    show(last());
    select("SIM Info", "EF-LOCI");
    stage.type("v");
    EXPECT_TRUE(shows("Only numbers have a curve."));
    stage.moment = {};
    stage.type("v");
    EXPECT_TRUE(shows("Only numbers have a curve."));
}

TEST_F(GraphPageTest, EachCurveHasATintAndSoHasItsLetterInTheLegend) {
    addLevels(stage);
    stage.type("V");
    const Grid grid = draw();
    EXPECT_EQ(styleOf(grid, "a  "), Style{.tint = Tint::Blue});
    EXPECT_EQ(styleOf(grid, "b  "), Style{.tint = Tint::Orange});
    EXPECT_EQ(styleOf(grid, "c  "), Style{.tint = Tint::Green});
    EXPECT_EQ(styleOf(grid, "-86.25 dBm"), Style{});
    std::set<Tint> curves;
    for (int y = 0; y < grid.rows(); ++y) {
        for (int x = 8; x < grid.columns(); ++x) {
            curves.insert(grid.at(x, y).style.tint);
        }
    }
    EXPECT_EQ(curves, (std::set{Tint::None, Tint::Green, Tint::Blue, Tint::Orange}));
}

TEST_F(GraphPageTest, TheCursorReadsAllCurves) {
    addLevels(stage);
    stage.type("V");
    const std::string latest = stage.screen();
    stage.press(Key::Home);
    EXPECT_NE(stage.screen(), latest);
    EXPECT_TRUE(shows("\n 22:15:22")) << stage.screen();
    stage.type("+");
    EXPECT_TRUE(shows("\n 22:19:19")) << stage.screen();
    stage.press(Key::Escape);
    stage.type("V");
    (void)stage.screen();
    stage.type("-");
    EXPECT_TRUE(shows("the last 15 minutes"));
}

TEST_F(GraphPageTest, WithoutATimelineThereAreOnlyValues) {
    addLevels(stage);
    stage.moment = {};
    stage.values = &drive.timeline->latestValues();
    stage.type("V");
    EXPECT_TRUE(shows(" dBm  Measured RSRP, Serving Cell Measurements"));
    EXPECT_TRUE(shows("\n There are no curves yet."));
    EXPECT_FALSE(shows("└"));
    stage.press(Key::Left);
    EXPECT_FALSE(shows("Pallax › Graph"));
}

TEST_F(GraphPageTest, AnotherTechnologyHasNoneOfTheValues) {
    addLevels(stage);
    stage.type("V");
    stage.moment = {};
    EXPECT_TRUE(shows("No values: v in a pane adds one."));
}

} // namespace
} // namespace pallax::terminal
