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

    /// As `drive`, with a picture of the screen at the end, beside another program.
    doubles::CommandRun driveOnPhone(const std::string& arguments, const std::string& steps,
                                     const std::string& beside = "true",
                                     const std::string& last = "") const {
        return runOnBus("phoc -C " + world.path("phoc.ini") + " >/dev/null 2>&1 & c=$!\n" +
                        "until [ -S $XDG_RUNTIME_DIR/wayland-0 ]; do sleep 0.05; done\n"
                        "export WAYLAND_DISPLAY=wayland-0 GDK_BACKEND=wayland\n" +
                        beside + " >/dev/null 2>&1 & b=$!\n" PALLAX_PROGRAM " " + arguments +
                        " & p=$!\n" + driving(steps) + last + "grim " + world.path("screen.png") +
                        "; kill -TERM $p; wait $p; s=$?; kill $b $c; exit $s\n");
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

TEST_F(EndToEndPhone, TheKeyboardOnTheScreenComesUpForTheSearch) {
    if (!isInstalled("squeekboard")) {
        GTEST_SKIP() << "squeekboard is not installed";
    }
    std::erase(world.environment, "GSETTINGS_BACKEND=memory");
    world.environment.push_back("GSETTINGS_BACKEND=keyfile");
    std::filesystem::create_directories(world.path("config/glib-2.0/settings"));
    std::ofstream(world.path("config/glib-2.0/settings/keyfile"))
        << "[org/gnome/desktop/a11y/applications]\nscreen-keyboard-enabled=true\n";
    const std::string visible = "busctl --user get-property sm.puri.OSK0 /sm/puri/OSK0 "
                                "sm.puri.OSK0 Visible";
    const auto becomes = [&](const std::string& state) {
        return "for i in $(seq 100); do [ \"$(" + visible + ")\" = 'b " + state +
               "' ] && break; sleep 0.1; done; " + visible + " >>" + world.path("visible") + "\n";
    };
    expectDriven(driveOnPhone("demo lte", "has 'SIM Info'", "squeekboard",
                              becomes("false") + driving("menu 'Search Rows'") + becomes("true")));
    EXPECT_EQ(contentOf(world.path("visible")), "b false\nb true\n");
}

} // namespace
} // namespace pallax
