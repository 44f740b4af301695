#include "tests/window/EndToEndWindow.h"

#include <filesystem>

namespace pallax {
namespace {

namespace fs = std::filesystem;
using doubles::CommandRun;
using doubles::contentOf;
using doubles::isInstalled;
using doubles::runCommand;
using std::chrono::milliseconds;

/// As a desktop and several starts use the program.
class EndToEndDesktop : public EndToEndWindow {
protected:
    /// Installs the desktop entry, the MIME type and what the bus starts into the user's folder.
    void installEntry() const {
        for (const char* name : {"applications", "mime/packages", "dbus-1/services"}) {
            fs::create_directories(data(name));
        }
        const std::string id = "example.pallax.Pallax";
        fs::copy_file(packaging(id + ".desktop"), data("applications/" + id + ".desktop"));
        fs::copy_file(packaging("pallax.xml"), data("mime/packages/pallax.xml"));
        std::string service = contentOf(packaging(id + ".service.in"));
        const std::string program = "@PALLAX_WINDOW_PROGRAM@";
        ASSERT_NE(service.find(program), std::string::npos);
        service.replace(service.find(program), program.size(), PALLAX_PROGRAM);
        std::ofstream(data("dbus-1/services/" + id + ".service")) << service;
        ASSERT_EQ(runCommand("update-mime-database " + data("mime")).status, 0);
        ASSERT_EQ(runCommand("update-desktop-database " + data("applications")).status, 0);
    }
    static bool hasDesktopTools() {
        return isInstalled("update-mime-database") && isInstalled("update-desktop-database") &&
               isInstalled("gio");
    }
    std::string data(const std::string& name) const { return world.path("data/" + name); }
    static std::string packaging(const std::string& name) {
        return PALLAX_SOURCE_DIR "/packaging/" + name;
    }
    static std::string start(const std::string& arguments) {
        return PALLAX_PROGRAM " " + arguments;
    }
    /// Ends all windows, and the process that the bus has started.
    static std::string endAll() {
        return "for p in $(busctl --user list --no-legend | awk '/pallax/ {print $2}' | sort -u)\n"
               "do kill -TERM $p 2>/dev/null; done\nwait\n";
    }
    std::string lteDrive() const { return sample("lte-drive.pcap"); }
};

TEST_F(EndToEndDesktop, ASecondStartOfTheSameSourceBringsItsWindowToTheFront) {
    const CommandRun run = runOnBus(
        start(lteDrive()) + " & p=$!\n" + driving("has 'Zorell_LTE · lte-drive.pcap'") +
        "cd " PALLAX_SOURCE_DIR "/samples && " + start("lte-drive.pcap") + "; echo second $?\n" +
        driving("windows 1") + "kill -TERM $p; wait $p; echo first $?\n");
    EXPECT_EQ(run.out, "second 0\nfirst 0\n");
}

TEST_F(EndToEndDesktop, AnotherSourceIsAnotherWindowOfTheApplication) {
    const CommandRun run = runOnBus(
        start(lteDrive()) + " & p=$!\n" + driving("has 'Zorell_LTE · lte-drive.pcap'") +
        start("demo gsm") + " & q=$!\n" + driving("windows 2 has 'Zorell_GSM · simulated gsm'") +
        "busctl --user list --no-legend | grep -c '^example.pallax.Pallax '\n"
        "kill -TERM $p; wait $p; echo first $?\n" +
        driving("windows 1 has 'Zorell_GSM · simulated gsm'") +
        "kill -TERM $q; wait $q; echo second $?\n");
    EXPECT_EQ(run.out, "1\nfirst 0\nsecond 0\n");
}

TEST_F(EndToEndDesktop, ARecordThatThrowsEndsItsOwnWindowOnly) {
    const std::string recording = record("fatal.pcap", {{milliseconds(0), registration(0)},
                                                        {milliseconds(10), unreadableSimFiles()}});
    const CommandRun run = runOnBus(
        start("demo gsm") + " & p=$!\n" + driving("has 'Zorell_GSM · simulated gsm'") +
        start(recording + " --speed max") + " & q=$!\n" +
        driving("has 'Pallax has stopped' press Close windows 1") + "wait $q; echo fatal $?\n" +
        driving("has 'Zorell_GSM · simulated gsm'") + "kill -TERM $p; wait $p; echo other $?\n");
    EXPECT_EQ(run.out,
              "pallax: packet 2 (log code 0xFF0000): the embedded property list cannot be parsed: "
              "the data is no property list\nfatal 70\nother 0\n");
}

TEST_F(EndToEndDesktop, AFileManagerOpensARecordingWithoutAShell) {
    if (!hasDesktopTools()) {
        GTEST_SKIP() << "desktop-file-utils, shared-mime-info or gio is not installed";
    }
    installEntry();
    const std::string copy = world.path("without-suffix");
    fs::copy_file(lteDrive(), copy);
    const CommandRun run =
        runOnBus("gio info -a standard::content-type " + copy +
                 " | grep -o 'application/.*'\n"
                 "gio mime application/x-pallax-recording | head -1\n"
                 "gio open " +
                 copy + "; echo $?\n" + driving("has 'Zorell_LTE · without-suffix'") + "gio open " +
                 copy + "; echo $?\n" + driving("windows 1") + endAll());
    EXPECT_EQ(run.out, "application/x-pallax-recording\n"
                       "Default application for “application/x-pallax-recording”: "
                       "example.pallax.Pallax.desktop\n0\n0\n");
}

TEST_F(EndToEndDesktop, TheDesktopEntryStartsASimulatedModem) {
    if (!hasDesktopTools()) {
        GTEST_SKIP() << "desktop-file-utils, shared-mime-info or gio is not installed";
    }
    installEntry();
    const CommandRun run = runOnBus("gapplication action example.pallax.Pallax demo; echo $?\n" +
                                    driving("has 'Zorell_* · simulated *'") + endAll());
    EXPECT_EQ(run.out, "0\n");
}

TEST_F(EndToEndDesktop, AFileThatCannotBeOpenedIsToldInADialog) {
    if (!hasDesktopTools()) {
        GTEST_SKIP() << "desktop-file-utils, shared-mime-info or gio is not installed";
    }
    installEntry();
    std::ofstream(world.path("damaged.pcap")) << "no capture";
    const CommandRun run = runOnBus(
        "gapplication launch example.pallax.Pallax " + world.path("damaged.pcap") + "; echo $?\n" +
        driving("has 'Cannot Open' has '*damaged.pcap is not a recording*' press Close "
                "lacks 'Cannot Open'") +
        endAll());
    EXPECT_NE(run.out.find("0\n"), std::string::npos) << run.out;
    EXPECT_EQ(run.out.find("DRIVE FAILED"), std::string::npos) << run.out;
}

TEST_F(EndToEndDesktop, RecentRecordingsAreOfferedUnlessTheyAreGoneOrSafe) {
    const std::string copy = world.path("tunnel.pcap");
    fs::copy_file(lteDrive(), copy);
    expectDriven(drive(copy, "has 'Zorell_LTE · tunnel.pcap' has 'SIM Info'"));
    EXPECT_NE(contentOf(data("recently-used.xbel")).find("tunnel.pcap"), std::string::npos);
    expectDriven(drive(lteDrive() + " --safe", "has 'SIM Info'"));
    EXPECT_EQ(contentOf(data("recently-used.xbel")).find("lte-drive.pcap"), std::string::npos);
    expectDriven(drive("demo", "has 'SIM Info' menu Recent menuitem 'Clear List' lacks nothing"));
    EXPECT_EQ(contentOf(data("recently-used.xbel")).find("tunnel.pcap"), std::string::npos);
}

} // namespace
} // namespace pallax
