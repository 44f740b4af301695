#include "tests/window/EndToEndWindow.h"

namespace pallax {
namespace {

using doubles::contentOf;
using doubles::isInstalled;

/// The program in a compositor of phones, inside the X server.
class EndToEndPhone : public EndToEndWindow {
protected:
    void SetUp() override {
        EndToEndWindow::SetUp();
        if (!IsSkipped() && (!isInstalled("phoc") || !isInstalled("grim"))) {
            GTEST_SKIP() << "phoc or grim is not installed";
        }
        world.environment.insert(world.environment.end(),
                                 {"WLR_BACKENDS=x11", "WLR_RENDERER=pixman"});
        std::ofstream(world.path("phoc.ini"))
            << "[core]\nxwayland=false\n[output:X11-1]\nmode = 360x720\nscale = 1\n";
    }

    /// As `drive`, with a picture of the screen at the end.
    doubles::CommandRun driveOnPhone(const std::string& arguments, const std::string& steps) const {
        return runOnBus(
            "phoc -C " + world.path("phoc.ini") + " >/dev/null 2>&1 & c=$!\n" +
            "until [ -S $XDG_RUNTIME_DIR/wayland-0 ]; do sleep 0.05; done\n"
            "export WAYLAND_DISPLAY=wayland-0 GDK_BACKEND=wayland\n" PALLAX_PROGRAM " " +
            arguments + " & p=$!\n" + driving(steps) + "grim " + world.path("screen.png") +
            "; kill -TERM $p; wait $p; s=$?; kill $c; exit $s\n");
    }
};

TEST_F(EndToEndPhone, TheWindowFillsTheScreen) {
    expectDriven(driveOnPhone("demo lte", "has 'SIM Info' menu Overview has Operator"));
    const std::string picture = contentOf(world.path("screen.png"));
    constexpr std::size_t kSize = 16; // of a PNG: width and height follow, big-endian
    ASSERT_GT(picture.size(), kSize + 8);
    EXPECT_EQ(picture.substr(kSize, 8), std::string("\x00\x00\x01\x68\x00\x00\x02\xd0", 8))
        << "360 by 720";
    constexpr std::size_t kEmpty = 5000;
    EXPECT_GT(picture.size(), kEmpty) << "something is drawn";
}

} // namespace
} // namespace pallax
