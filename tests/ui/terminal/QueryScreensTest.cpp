#include "tests/ui/pages/SampleTimeline.h"
#include "tests/ui/terminal/StageFixture.h"

#include <gtest/gtest.h>

#include <string>

namespace pallax::terminal {
namespace {

/// The page that asks in SQL, on a screen of each size.
class QueryScreensTest : public testing::Test {
protected:
    std::string screenOf(int columns, int rows, const Marks& marks = kUtf8Marks) {
        TerminalStage stage(marks);
        stage.tick(display());
        stage.frontEnd.setOrigin({"Zorell_LTE", "drive.pcap"});
        stage.moment = {drive.timeline.get(), drive.timeline->packets()};
        stage.type(";select time, kind, words from event");
        stage.press(Key::Enter);
        const std::string screen = stage.screen(columns, rows);
        EXPECT_EQ(faultOf(stage.frontEnd.draw()), "");
        return screen;
    }

    SampleTimeline drive;
};

TEST_F(QueryScreensTest, FillsTheComfortableScreen) {
    EXPECT_EQ(screenOf(80, 24), R"(
 Pallax › Query                                 Zorell_LTE · drive.pcap  4 rows
 ──────────────────────────────────────────────────────────────────────────────
             time  clock     kind          words
▌1700000007612032  22:13:27  cell-change   serving cell 386 → 488 after 8 s
 1700000024611220  22:13:44  context-up    context up: internet
 1700000039205684  22:13:59  context-down  context down: internet
 1700000051209038  22:14:11  context-up    context up: internet















 ──────────────────────────────────────────────────────────────────────────────
 Updated 2023-11-14 at 22:13:20      Enter go there  < > sort  / filter  ? help
)");
}

TEST_F(QueryScreensTest, FitsANarrowScreen) {
    EXPECT_EQ(screenOf(40, 20), R"(
 Pallax › Query      Zorell_LTE  4 rows
 ──────────────────────────────────────
             time  clock     kind      …
▌1700000007612032  22:13:27  cell-chan…
 1700000024611220  22:13:44  context-up
 1700000039205684  22:13:59  context-d…
 1700000051209038  22:14:11  context-up











 ──────────────────────────────────────
 Updated 2023-11-14 at 22:13:20  ? help
)");
}

TEST_F(QueryScreensTest, UsesAWideScreen) {
    EXPECT_EQ(screenOf(200, 60), R"(
 Pallax › Query                                                                                                                                                         Zorell_LTE · drive.pcap  4 rows
 ──────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────
             time  clock     kind          words
▌1700000007612032  22:13:27  cell-change   serving cell 386 → 488 after 8 s
 1700000024611220  22:13:44  context-up    context up: internet
 1700000039205684  22:13:59  context-down  context down: internet
 1700000051209038  22:14:11  context-up    context up: internet



















































 ──────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────
 Updated 2023-11-14 at 22:13:20                                                                                                                     ; query  Enter go there  < > sort  / filter  ? help
)");
}

TEST_F(QueryScreensTest, NeedsOnlyAscii) {
    EXPECT_EQ(screenOf(80, 24, kAsciiMarks), R"(
 Pallax > Query                                  Zorell_LTE, drive.pcap  4 rows
 ------------------------------------------------------------------------------
             time  clock     kind          words
>1700000007612032  22:13:27  cell-change   serving cell 386 -> 488 after 8 s
 1700000024611220  22:13:44  context-up    context up: internet
 1700000039205684  22:13:59  context-down  context down: internet
 1700000051209038  22:14:11  context-up    context up: internet















 ------------------------------------------------------------------------------
 Updated 2023-11-14 at 22:13:20      Enter go there  < > sort  / filter  ? help
)");
}

} // namespace
} // namespace pallax::terminal
