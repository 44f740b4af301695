#include "ui/drawing/Plot.h"

#include "tests/ui/drawing/GridSupport.h"
#include "ui/drawing/Dots.h"

#include <gtest/gtest.h>

#include <string>

namespace pallax::terminal {
namespace {

using std::chrono::seconds;

constexpr Time kBegin{seconds(1700000000)}; // 22:13:20

CurvePoint at(int second, double value) {
    return {kBegin + seconds(second), value, value, value, value};
}

/// A plot of a minute.
Plot plotOf(std::vector<std::vector<CurvePoint>> curves) {
    Plot plot{kBegin, kBegin + seconds(60), {}, "dBm", {}, {}, {}};
    for (auto& points : curves) {
        const std::string mark =
            curves.size() > 1 ? std::string(1, static_cast<char>('a' + plot.curves.size())) : "";
        plot.curves.push_back({mark, {std::move(points), seconds(20), false}});
    }
    return plot;
}

std::string drawn(const Plot& plot, int columns, int rows, const Marks& marks = kUtf8Marks) {
    Grid grid(columns, rows);
    drawPlot(grid, marks, plot, {0, 0, columns, rows}, labelColumns(plot, rows));
    EXPECT_EQ(faultOf(grid), "");
    return "\n" + grid.text();
}

const std::vector<CurvePoint>& slope() {
    static const std::vector<CurvePoint> points{at(0, -100), at(10, -95), at(20, -88),
                                                at(30, -82), at(40, -84), at(59, -91)};
    return points;
}

Marks withCurves(Curves curves) {
    Marks marks = kUtf8Marks;
    marks.curves = curves;
    return marks;
}

TEST(Plot, DrawsACurveBetweenRoundValuesAndTimes) {
    EXPECT_EQ(drawn(plotOf({slope()}), 50, 7), R"(
 -80 ┤                    ⢀⡠⠤⢄⣀⡀
     │                ⢀⡠⠔⠊⠁    ⠈⠉⠉⠒⠒⠤⠤⣀⡀
     │            ⢀⡠⠔⠊⠁                ⠈⠉⠑⠒⠤⠤⣀⡀
 -90 ┤        ⢀⡠⠔⠊⠁                           ⠈⠉⠑⠂
     │    ⢀⡠⠔⠊⠁
-100 ┤⣀⠤⠒⠉⠁
 dBm └── 22:13:30 ──────────── 22:14:00 ──────────
)");
}

TEST(Plot, DrawsWithBlocksWhereBrailleIsNotThere) {
    EXPECT_EQ(drawn(plotOf({slope()}), 50, 7, withCurves(Curves::Blocks)), R"(
 -80 ┤                     ▄▄▄▄▄
     │                ▄▄▀▀▀     ▀▀▀▀▀▄▄▄▄
     │            ▄▄▀▀                   ▀▀▀▄▄▄▄
 -90 ┤        ▄▄▀▀                              ▀▀
     │    ▄▄▀▀
-100 ┤▄▄▀▀
 dBm └── 22:13:30 ──────────── 22:14:00 ──────────
)");
}

TEST(Plot, DrawsInAscii) {
    EXPECT_EQ(drawn(plotOf({slope()}), 50, 7, kAsciiMarks), R"(
 -80 +
     |                  ***************
     |             *****               *******
 -90 +         ****                           ****
     |    *****
-100 +****
 dBm +-- 22:13:30 ------------ 22:14:00 ----------
)");
}

TEST(Plot, LeavesAGapWhereNothingWasRead) {
    EXPECT_EQ(drawn(plotOf({{at(0, -90), at(10, -90), at(45, -95), at(55, -95)}}), 50, 4), R"(
-90 ┤⠉⠉⠉⠉⠉⠉⠉⠉
    │
-95 ┤                                 ⢀⣀⣀⣀⣀⣀⣀⣀⡀
dBm └── 22:13:30 ───────────── 22:14:00 ──────────
)");
}

TEST(Plot, APointReachesFromTheLeastToTheGreatestValue) {
    EXPECT_EQ(drawn(plotOf({{{kBegin + seconds(30), -90, -100, -80, -90}}}), 20, 7), R"(
 -80 ┤       ⡇
     │       ⡇
     │       ⡇
 -90 ┤       ⡇
     │       ⡇
-100 ┤       ⡇
 dBm └────── 22:14 ─
)");
}

TEST(Plot, SeveralCurvesHaveTheirMarksAtTheirEnds) {
    EXPECT_EQ(drawn(plotOf({slope(), {at(0, -82), at(20, -82), at(40, -91), at(58, -91)}}), 50, 7),
              R"(
 -80 ┤⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤⠤⣀   ⢀⡠⠤⢄⣀⡀
     │               ⢀⡩⠕⠪⠥⣀   ⠈⠉⠉⠒⠒⠤⢄⣀⡀
     │            ⣀⠤⠊⠁     ⠉⠑⠒⠤⣀⡀     ⠈⠉⠒⠢⠤⣀⣀
 -90 ┤        ⢀⡠⠔⠉              ⠈⠑⠒⠒⠒⠒⠒⠒⠒⠒⠒⠒⠒⠛⠓⠂ a
     │    ⢀⡠⠔⠊⠁                                  b
-100 ┤⣀⠤⠒⠉⠁
 dBm └── 22:13:30 ─────────── 22:14:00 ─────────
)");
}

TEST(Plot, EventsHaveMarksAndTheCursorALine) {
    Plot plot = plotOf({slope()});
    plot.events = {{kBegin + seconds(15), "cell change"}};
    plot.cursor = kBegin + seconds(45);
    plot.ahead = seconds(3600);
    EXPECT_EQ(drawn(plot, 50, 7), R"(
 -80 ┤                    ⢀⡠⠤⢄⣀⡀       │
     │                ⢀⡠⠔⠊⠁    ⠈⠉⠉⠒⠒⠤⠤⣀⡀
     │            ⢀⡠⠔⠊⠁                ⠈⠉⠑⠒⠤⠤⣀⡀
 -90 ┤        ⢀⡠⠔⠊⠁                    │      ⠈⠉⠑⠂
     │    ⢀⡠⠔⠊⠁                        │
-100 ┤⣀⠤⠒⠉⠁      ┆                     │
 dBm └── 23:13:30 ──────────── 23:14:00 ──────────
)");
    EXPECT_EQ(drawn(plot, 50, 7, kAsciiMarks), R"(
 -80 +                                 |
     |                  ***************|
     |             *****               *******
 -90 +         ****                    |      ****
     |    *****                        |
-100 +****       :                     |
 dBm +-- 23:13:30 ------------ 23:14:00 ----------
)");
}

TEST(Plot, TheCursorIsShownByStyleToo) {
    Plot plot = plotOf({slope()});
    plot.cursor = kBegin + seconds(45);
    Grid grid(50, 7);
    drawPlot(grid, kUtf8Marks, plot, {0, 0, 50, 7}, labelColumns(plot, 7));
    int accents = 0;
    for (int y = 0; y < 7; ++y) {
        for (int x = 0; x < 50; ++x) {
            accents += grid.at(x, y).style.accent ? 1 : 0;
        }
    }
    EXPECT_EQ(accents, 6);
}

TEST(Plot, ACurveAndItsMarkHaveItsTint) {
    Plot plot = plotOf({slope(), {at(0, -82), at(20, -82), at(40, -91), at(58, -91)}});
    plot.curves[0].tint = Tint::Blue;
    plot.curves[1].tint = Tint::Orange;
    Grid grid(50, 7);
    drawPlot(grid, kUtf8Marks, plot, {0, 0, 50, 7}, labelColumns(plot, 7));
    EXPECT_EQ(styleOf(grid, "a"), (Style{.bold = true, .tint = Tint::Blue}));
    EXPECT_EQ(styleOf(grid, "b"), (Style{.bold = true, .tint = Tint::Orange}));
    EXPECT_EQ(styleOf(grid, "⣀⠤⠒⠉⠁"), Style{.tint = Tint::Blue});
    EXPECT_EQ(styleOf(grid, "⠤⠤⠤⠤⠤"), Style{.tint = Tint::Orange});
    EXPECT_EQ(styleOf(grid, "⢀⡩⠕⠪"), Style{.tint = Tint::Blue}) << "where both are, the first";
    EXPECT_EQ(styleOf(grid, "dBm"), Style{.dim = true});
}

TEST(Plot, FitsIntoAreasOfAnySize) {
    Plot plot = plotOf({slope(), {at(0, 1e300), at(30, -1e300)}, {}, {at(5, 0.0001)}});
    plot.events = {{kBegin - seconds(5), "before"}, {kBegin + seconds(500), "after"}};
    plot.cursor = kBegin + seconds(61);
    for (const Marks& marks : {kUtf8Marks, kAsciiMarks, withCurves(Curves::Blocks)}) {
        for (int columns = 0; columns < 60; columns += 3) {
            for (int rows = 0; rows < 12; ++rows) {
                (void)drawn(plot, columns, rows, marks);
            }
        }
    }
}

TEST(Plot, IsEmptyWithoutPoints) {
    EXPECT_TRUE(plotOf({{}, {}}).isEmpty());
    EXPECT_FALSE(plotOf({{}, slope()}).isEmpty());
    (void)drawn(plotOf({{}}), 40, 6);
}

TEST(Plot, ReadsTheLatestPointAtATime) {
    const Curve curve{slope(), seconds(20), false};
    EXPECT_EQ(pointAt(curve, kBegin - seconds(1)), nullptr);
    EXPECT_EQ(pointAt(curve, kBegin)->last, -100);
    EXPECT_EQ(pointAt(curve, kBegin + seconds(29))->last, -88);
    EXPECT_EQ(pointAt(curve, kBegin + seconds(99))->last, -91);
}

TEST(Sparkline, IsACurveInOneRow) {
    const Curve curve{slope(), seconds(20), false};
    const Time end = kBegin + seconds(60);
    EXPECT_EQ(sparkline(kUtf8Marks, curve, kBegin, end, 12), "⣀⠤⠤⠒⠒⠉⠉⠉⠉⠒⠒⠤");
    EXPECT_EQ(sparkline(kAsciiMarks, curve, kBegin, end, 12), "__..--'''''-");
    EXPECT_EQ(sparkline(withCurves(Curves::Blocks), curve, kBegin, end, 12), "▄▄▄▀▀▀▀▀▀▀▄▄");
    EXPECT_EQ(sparkline(kUtf8Marks, {}, kBegin, end, 12), "");
    EXPECT_EQ(sparkline(kUtf8Marks, curve, kBegin, end, 0), "");
}

TEST(Dots, AreBitsOfACharacter) {
    for (const auto& [curves, x, y, text] :
         {std::tuple(Curves::Braille, 0, 0, "⠁"), std::tuple(Curves::Braille, 1, 3, "⢀"),
          std::tuple(Curves::Blocks, 0, 0, "▀"), std::tuple(Curves::Blocks, 0, 1, "▄"),
          std::tuple(Curves::Ascii, 0, 0, "*")}) {
        Dots dots(1, 1, curves);
        EXPECT_EQ(dots.textAt(0, 0), "");
        dots.set(x, y);
        dots.set(-1, 0);
        dots.set(0, dots.down());
        EXPECT_EQ(dots.textAt(0, 0), text);
    }
    Dots all(1, 1, Curves::Braille);
    all.line(0, 0, 0, 3);
    all.line(1, 3, 1, 0);
    EXPECT_EQ(all.textAt(0, 0), "⣿");
}

} // namespace
} // namespace pallax::terminal
