#pragma once

#include "tests/cli/EndToEnd.h"
#include "tests/doubles/Shell.h"
#include "tests/ui/gtk/XServer.h"

#include <filesystem>
#include <fstream>
#include <string>

namespace pallax {

/// The real program in an X server and on a session bus of its own, driven as a screen reader does.
class EndToEndWindow : public EndToEnd {
protected:
    void SetUp() override {
        if (_server.display().empty() || !doubles::isInstalled("dbus-run-session") ||
            doubles::runCommand(
                "/usr/bin/python3 -c 'import gi; gi.require_version(\"Atspi\", \"2.0\")'")
                    .status != 0) {
            GTEST_SKIP() << "Xvfb, dbus-run-session or python3-gi with Atspi is not installed";
        }
        world.environment = {"DISPLAY=" + _server.display(), "GDK_BACKEND=x11",
                             "GSK_RENDERER=cairo",           "GSETTINGS_BACKEND=memory",
                             "ADW_DISABLE_PORTAL=1",         "PATH=/usr/bin:/bin",
                             "HOME=" + world.path(),         "XDG_DATA_HOME=" + world.path("data")};
    }

    /// Snapshots can be saved into this folder, which is the marker, too.
    std::string offerSaving(const std::string& folder) const {
        std::filesystem::create_directories(world.path("config/pallax"));
        std::filesystem::create_directories(world.path("marker"));
        std::ofstream(world.path("config/pallax/pallax.conf"))
            << "snapshot-directory = " << folder
            << "\nsave-button-marker = " << world.path("marker") << "\n";
        return folder;
    }

    /// Starts the program with the arguments, takes the steps of drive.py, and ends the program
    /// with SIGTERM unless the steps end it. The status is the program's; the text is what both
    /// wrote.
    doubles::CommandRun drive(const std::string& arguments, const std::string& steps) const {
        return runOnBus(PALLAX_PROGRAM " " + arguments + " & p=$!\n" + driving(steps) +
                        "kill -TERM $p 2>/dev/null; wait $p; exit $?\n");
    }

    /// Runs the script of a shell on a session bus of its own.
    doubles::CommandRun runOnBus(const std::string& text) const {
        const std::string script = world.path("script");
        std::ofstream(script) << text;
        std::string command = "env -i ";
        for (const std::string& variable : doubles::programEnvironment(world)) {
            command += variable + " ";
        }
        return doubles::runCommand(command + "dbus-run-session -- sh " + script);
    }

    /// The line of a script that takes the steps of drive.py.
    static std::string driving(const std::string& steps) {
        return "/usr/bin/python3 -W ignore " PALLAX_SOURCE_DIR "/tests/window/drive.py " + steps +
               " || echo DRIVE FAILED\n";
    }

    std::string sample(const std::string& name) const {
        return PALLAX_SOURCE_DIR "/samples/" + name;
    }

    void expectDriven(const doubles::CommandRun& run, int status = 0) const {
        EXPECT_EQ(run.out.find("DRIVE FAILED"), std::string::npos) << run.out;
        EXPECT_EQ(run.status, status) << run.out;
    }

private:
    doubles::XServer _server;
};

} // namespace pallax
