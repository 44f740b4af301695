#include "ui/gtk/RecordingBar.h"

#include "tests/ui/gtk/WindowStage.h"
#include "tests/ui/gtk/XDisplay.h"

namespace pallax::gtk {
namespace {

class RecordingBarTest : public DisplayTest {};

TEST_F(RecordingBarTest, TellsFilePacketsSizeAndTime) {
    WindowStage stage(360, 720);
    int stops = 0;
    RecordingBar bar(stage.guard, [&] { ++stops; });
    stage.frame.addBar(bar.widget());
    stage.settle();
    EXPECT_EQ(stage.dump().find("button: Stop"), std::string::npos) << "nothing is recorded";
    bar.show({.file = "drive.pcapng",
              .packets = 1234,
              .bytes = 45600,
              .time = std::chrono::seconds(3723)});
    stage.settle();
    EXPECT_NE(stage.dump().find("text: drive.pcapng\ntext: 1234 packets, 45.6\u00a0kB, 1:02:03\n"
                                "button: Stop\n"),
              std::string::npos)
        << stage.dump();
    stage.press("Stop");
    EXPECT_EQ(stops, 1);
    bar.hide();
    stage.settle();
    EXPECT_EQ(stage.dump().find("drive.pcapng"), std::string::npos);
}

} // namespace
} // namespace pallax::gtk
