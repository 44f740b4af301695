#include "tests/ui/pages/SampleTimeline.h"
#include "tests/ui/terminal/StageFixture.h"

#include <gtest/gtest.h>

#include <string>

namespace pallax::terminal {
namespace {

/// Events and hits of a search in a recording, on screens that other tests leave out.
class EventsScreensTest : public testing::Test {
protected:
    std::string screenOf(const char* keys, int columns, int rows, const Marks& marks = kUtf8Marks) {
        TerminalStage stage(marks);
        stage.tick(display());
        stage.frontEnd.setOrigin({"Zorell_LTE", "drive.pcap"});
        stage.moment = {drive.timeline.get(), drive.timeline->packets()};
        for (const char* key = keys; *key != '\0'; ++key) {
            if (*key == '\t') {
                stage.press(Key::Tab);
            } else {
                stage.type(std::string(1, *key));
            }
        }
        const std::string screen = stage.screen(columns, rows);
        EXPECT_EQ(faultOf(stage.frontEnd.draw()), "");
        return screen;
    }

    SampleTimeline drive;
};

TEST_F(EventsScreensTest, EventsOnAWideScreen) {
    EXPECT_EQ(screenOf("e", 200, 60), R"(
 Pallax › Events                                                                                                                                                      Zorell_LTE · drive.pcap  4 events
 ──────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────
 Time      Kind          What
▌22:14:11  context-up    context up: internet
 22:13:59  context-down  context down: internet
 22:13:44  context-up    context up: internet
 22:13:27  cell-change   serving cell 386 → 488 after 8 s



















































 ──────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────
 Updated 2023-11-14 at 22:13:20                                                                                                                     e panes  Enter go there  < > sort  / filter  ? help
)");
}

TEST_F(EventsScreensTest, EventsInAscii) {
    EXPECT_EQ(screenOf("e", 80, 24, kAsciiMarks), R"(
 Pallax > Events                               Zorell_LTE, drive.pcap  4 events
 ------------------------------------------------------------------------------
 Time      Kind          What
>22:14:11  context-up    context up: internet
 22:13:59  context-down  context down: internet
 22:13:44  context-up    context up: internet
 22:13:27  cell-change   serving cell 386 -> 488 after 8 s















 ------------------------------------------------------------------------------
 Updated 2023-11-14 at 22:13:20      Enter go there  < > sort  / filter  ? help
)");
}

TEST_F(EventsScreensTest, HitsInARecordingOnAComfortableScreen) {
    EXPECT_EQ(screenOf("f\tinternet", 80, 24), R"(
 Pallax › Find in the whole recording           Zorell_LTE · drive.pcap  4 hits
 ──────────────────────────────────────────────────────────────────────────────
 Time      Name          Value                                                 …
▌22:13:44  context-up    context up: internet
 22:13:44                { APN = internet; Address = 10.17.4.21; State = Activ…
 22:13:59  context-down  context down: internet
 22:14:11  context-up    context up: internet















 ──────────────────────────────────────────────────────────────────────────────
 find: internet                                                  Tab this frame
)");
}

TEST_F(EventsScreensTest, HitsInARecordingOnANarrowScreen) {
    EXPECT_EQ(screenOf("f\tinternet", 40, 20), R"(
 Pallax › Find in the whole re…  4 hits
 ──────────────────────────────────────
 Time      Name          Value         …
▌22:13:44  context-up    context up: i…
 22:13:44                { APN = inter…
 22:13:59  context-down  context down:…
 22:14:11  context-up    context up: i…











 ──────────────────────────────────────
 find: internet          Tab this frame
)");
}

TEST_F(EventsScreensTest, HitsInARecordingOnAWideScreen) {
    EXPECT_EQ(screenOf("f\tinternet", 200, 60), R"(
 Pallax › Find in the whole recording                                                                                                                                   Zorell_LTE · drive.pcap  4 hits
 ──────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────
 Time      Name          Value                                                      Where
▌22:13:44  context-up    context up: internet
 22:13:44                { APN = internet; Address = 10.17.4.21; State = Active; }  PDP Context Info, #2
 22:13:59  context-down  context down: internet
 22:14:11  context-up    context up: internet



















































 ──────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────
 find: internet                                                                                                                                                                          Tab this frame
)");
}

TEST_F(EventsScreensTest, HitsInARecordingInAscii) {
    EXPECT_EQ(screenOf("f\tinternet", 80, 24, kAsciiMarks), R"(
 Pallax > Find in the whole recording            Zorell_LTE, drive.pcap  4 hits
 ------------------------------------------------------------------------------
 Time      Name          Value                                                 ~
>22:13:44  context-up    context up: internet
 22:13:44                { APN = internet; Address = 10.17.4.21; State = Activ~
 22:13:59  context-down  context down: internet
 22:14:11  context-up    context up: internet















 ------------------------------------------------------------------------------
 find: internet                                                  Tab this frame
)");
}

} // namespace
} // namespace pallax::terminal
