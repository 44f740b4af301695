#include "tests/ui/terminal/StageFixture.h"
#include "ui/terminal/PaneView.h"

#include <gtest/gtest.h>

#include <utility>

namespace pallax::terminal {
namespace {

using PaneViewBarsTest = StageFixture;

TEST_F(PaneViewBarsTest, BreadcrumbsAreShortenedFromTheLeft) {
    stage.tick(
        Dictionary{{"Outer Section", Dictionary{{"Middle", Dictionary{{"Inner", Dictionary{}}}}}}});
    stage.press(Key::Enter, 3);
    ASSERT_EQ(stage.depth(), 4U);
    const std::pair<int, const char*> expected[] = {
        {80, " Pallax › Outer Section › Middle › Inner"},
        {41, " Pallax › Outer Section › Middle › Inner"},
        {40, " … › Outer Section › Middle › Inner"},
        {36, " … › Outer Section › Middle › Inner"},
        {35, " … › Middle › Inner"},
        {20, " … › Middle › Inner"},
    };
    for (const auto& [columns, title] : expected) {
        stage.frontEnd.resize(columns, 12);
        EXPECT_EQ(stage.line(0), title) << columns;
    }
}

TEST_F(PaneViewBarsTest, ATitleWiderThanTheScreenIsCut) {
    openSection({}, "A section with a very long name");
    stage.frontEnd.resize(20, 5);
    EXPECT_EQ(stage.line(0), " … › A section wit…");
}

TEST_F(PaneViewBarsTest, HintsThatDoNotFitAreLeftOutFromTheLeft) {
    stage.tick(display());
    const std::pair<int, const char*> expected[] = {
        {58, " Updated 2023-11-14 at 22:13:20  / filter  s Save  ? help"},
        {57, " Updated 2023-11-14 at 22:13:20           s Save  ? help"},
        {48, " Updated 2023-11-14 at 22:13:20  s Save  ? help"},
        {47, " Updated 2023-11-14 at 22:13:20         ? help"},
        {40, " Updated 2023-11-14 at 22:13:20  ? help"},
        {39, " Updated 2023-11-14 at 22:13:20      ?"},
        {34, " Updated 2023-11-14 at 22:13:20 ?"},
        {33, " Updated 2023-11-14 at 22:13:20"},
        {32, " Updated 2023-11-14 at 22:13:20"},
        {31, " …dated 2023-11-14 at 22:13:20"},
        {20, " …11-14 at 22:13:20"},
    };
    for (const auto& [columns, toolbar] : expected) {
        stage.frontEnd.resize(columns, 12);
        EXPECT_EQ(stage.line(11), toolbar) << columns;
    }
}

TEST_F(PaneViewBarsTest, WithoutTheSaveButtonThereIsNoHintOfIt) {
    stage.savingAllowed = false;
    stage.tick(display());
    stage.frontEnd.resize(58, 12);
    EXPECT_EQ(stage.line(11), " Updated 2023-11-14 at 22:13:20          / filter  ? help");
}

TEST_F(PaneViewBarsTest, ANoteStandsBehindTheStatus) {
    stage.tick(display());
    stage.frontEnd.setNote("End of the recording");
    stage.frontEnd.resize(80, 12);
    EXPECT_EQ(stage.line(11),
              " Updated 2023-11-14 at 22:13:20  End of the recording  / filter  s Save  ? help");
    EXPECT_EQ(styleAt(33, 11), Style{.dim = true});
}

TEST_F(PaneViewBarsTest, ANoteThatDoesNotFitBehindTheStatusStandsInTheRuleAboveIt) {
    stage.tick(display());
    stage.frontEnd.setNote("End of the recording");
    stage.frontEnd.resize(54, 8);
    EXPECT_EQ(stage.line(7), " Updated 2023-11-14 at 22:13:20  End of the recording");
    EXPECT_EQ(stage.screen(40, 8), R"(
 Pallax
 ──────────────────────────────────────
▌Serving Cell Measurements             ›
 Measured Neighbor Cells             3 ›
 Empty List                            ›
 SIM Info                              ›
 End of the recording ─────────── ↓ 1 ─
 Updated 2023-11-14 at 22:13:20  ? help
)");
    stage.frontEnd.resize(20, 8);
    EXPECT_EQ(stage.line(6), " End of the r ↓ 1 ─");
}

TEST_F(PaneViewBarsTest, TheStatusTextsTimeNamesItsZone) {
    stage.zone = "+0200";
    stage.frontEnd.resize(40, 12);
    EXPECT_EQ(stage.line(11), " ⠋ Connecting            s Save  ? help") << "no time is shown";
    stage.tick(display());
    const std::pair<int, const char*> expected[] = {
        {80, " Updated 2023-11-14 at 22:13:20 +0200                  / filter  s Save  ? help"},
        {40, " Updated 2023-11-14 at 22:13:20 +0200 ?"},
        {38, " Updated 2023-11-14 at 22:13:20 +0200"},
        {37, " Updated 2023-11-14 at 22:13:20    ?"},
        {20, " …11-14 at 22:13:20"},
    };
    for (const auto& [columns, toolbar] : expected) {
        stage.frontEnd.resize(columns, 12);
        EXPECT_EQ(stage.line(11), toolbar) << columns;
    }
    stage.frontEnd.resize(80, 12);
    EXPECT_EQ(styleAt(33, 11), Style{.dim = true});
    stage.frontEnd.setNote("End of the recording");
    EXPECT_EQ(stage.line(11),
              " Updated 2023-11-14 at 22:13:20 +0200  End of the recording      s Save  ? help");
    stage.frontEnd.setMessage("Saved");
    EXPECT_EQ(stage.line(11).find("+0200"), std::string::npos);
}

TEST_F(PaneViewBarsTest, AFilterBeingTypedIsAPromptWithTheMatchesUnderlined) {
    stage.tick(display());
    stage.press(Key::Enter);
    stage.type("/rsrp");
    EXPECT_EQ(stage.screen(80, 24), R"(
 Pallax › Serving Cell Measurements                                      2 of 6
 ──────────────────────────────────────────────────────────────────────────────
▌Measured RSRP                                                      -94.75 dBm
 Average RSRP                                                       -95.00 dBm


















 ──────────────────────────────────────────────────────────────────────────────
 / rsrp                                                        Esc clear filter
)");
    EXPECT_EQ(stage.screen(20, 5), R"(
 … › Servin… 2 of 6
 ──────────────────
▌Measured RSRP   …
 ──────────── ↓ 1 ─
 / rsrp
)");
    EXPECT_EQ(stage.screen(40, 12), R"(
 … › Serving Cell Measurements   2 of 6
 ──────────────────────────────────────
▌Measured RSRP              -94.75 dBm
 Average RSRP               -95.00 dBm






 ──────────────────────────────────────
 / rsrp                Esc clear filter
)");
    const Grid grid = draw();
    EXPECT_EQ(grid.at(9, 2).style, (Style{.bold = true, .accent = true}));
    EXPECT_EQ(grid.at(10, 2).style, (Style{.bold = true, .underline = true, .accent = true}));
    EXPECT_EQ(grid.at(13, 2).style, (Style{.bold = true, .underline = true, .accent = true}));
    EXPECT_EQ(grid.at(12, 3).style, (Style{.bold = true, .underline = true}));
    EXPECT_EQ(grid.at(13, 3).style, Style{});
    EXPECT_EQ(grid.at(33, 0).style, Style{.dim = true}); // "2 of 6"
    EXPECT_EQ(grid.at(1, 11).style, Style{.bold = true});
    EXPECT_EQ(grid.cursor(), (Position{7, 11}));
}

TEST_F(PaneViewBarsTest, AMatchInAValueIsUnderlined) {
    stage.tick(display());
    stage.press(Key::Enter);
    stage.type("/DBM");
    stage.frontEnd.resize(40, 12);
    EXPECT_EQ(stage.line(3), " Average RSRP               -95.00 dBm");
    EXPECT_EQ(styleAt(34, 3), Style{});
    EXPECT_EQ(styleAt(35, 3), Style{.underline = true});
    EXPECT_EQ(styleAt(37, 3), Style{.underline = true});
}

TEST_F(PaneViewBarsTest, AMatchInsideACombinedCharacterUnderlinesAllOfIt) {
    openSection({{"Cafe\u0301 au lait", "e\u0301"}});
    stage.frontEnd.resize(40, 12);
    stage.type("/e");
    EXPECT_EQ(stage.line(2), "▌Cafe\u0301 au lait                        e\u0301");
    EXPECT_EQ(styleAt(3, 2), (Style{.bold = true, .accent = true}));
    EXPECT_EQ(styleAt(4, 2), (Style{.bold = true, .underline = true, .accent = true}));
    EXPECT_EQ(styleAt(5, 2), (Style{.bold = true, .accent = true}));
    EXPECT_EQ(styleAt(37, 2), (Style{.underline = true, .accent = true}));
    stage.press(Key::Backspace);
    stage.type("\u0301");
    EXPECT_EQ(stage.line(2), "▌Cafe\u0301 au lait                        e\u0301");
    EXPECT_EQ(styleAt(4, 2), (Style{.bold = true, .underline = true, .accent = true}));
}

TEST_F(PaneViewBarsTest, AKeptFilterStaysInSightByItsCountAndItsHint) {
    stage.tick(display());
    stage.press(Key::Enter);
    stage.type("/rsrp");
    stage.press(Key::Enter);
    EXPECT_EQ(stage.screen(80, 24), R"(
 Pallax › Serving Cell Measurements                                      2 of 6
 ──────────────────────────────────────────────────────────────────────────────
▌Measured RSRP                                                      -94.75 dBm
 Average RSRP                                                       -95.00 dBm


















 ──────────────────────────────────────────────────────────────────────────────
 Updated 2023-11-14 at 22:13:20                Esc clear filter  s Save  ? help
)");
    EXPECT_EQ(draw().cursor(), std::nullopt);
}

TEST_F(PaneViewBarsTest, AFilterLongerThanItsRoomScrollsWithItsCursor) {
    stage.tick(display());
    stage.frontEnd.resize(20, 5);
    stage.type("/0123456789abcdefghi");
    EXPECT_EQ(stage.line(4), " / 456789abcdefghi");
    EXPECT_EQ(draw().cursor(), (Position{18, 4}));
    stage.press(Key::Home);
    EXPECT_EQ(stage.line(4), " / 0123456789abcde");
    EXPECT_EQ(draw().cursor(), (Position{3, 4}));
}

TEST_F(PaneViewBarsTest, TheFiltersCursorStandsBehindWideCharacters) {
    stage.tick(display());
    stage.frontEnd.resize(40, 12);
    stage.type("/漢e\u0301");
    EXPECT_EQ(stage.line(11), " / 漢e\u0301                 Esc clear filter");
    EXPECT_EQ(draw().cursor(), (Position{6, 11}));
}

TEST_F(PaneViewBarsTest, IsLoadingIsToldByASpinningIndicator) {
    EXPECT_FALSE(isLoading({}));
    EXPECT_FALSE(isLoading({ui::Label{}, ui::ActivityIndicator{}}));
    ui::ActivityIndicator spinning;
    spinning.isSpinning = true;
    EXPECT_TRUE(isLoading({ui::Label{}, spinning}));
}

} // namespace
} // namespace pallax::terminal
