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
    void installEntry() {
        for (const char* name : {"applications", "mime/packages", "dbus-1/services"}) {
            fs::create_directories(data(name));
        }
        const std::string id = "example.pallax.Pallax";
        // A desktop offers only entries whose programs exist.
        std::erase(world.environment, "PATH=/usr/bin:/bin");
        world.environment.push_back("PATH=" + fs::path(PALLAX_PROGRAM).parent_path().string() +
                                    ":/usr/bin:/bin");
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
    /// Runs the script, in which `tell` is a command that keeps what it reads, which is returned.
    std::string told(const std::string& script) const {
        const CommandRun run = runOnBus("tell() { cat >>" + world.path("told") + "; }\n" + script);
        EXPECT_EQ(run.out.find("DRIVE FAILED"), std::string::npos) << run.out;
        return contentOf(world.path("told"));
    }
    /// Installs a program that opens pages, which writes what it is to open into the file "told".
    void installBrowser() {
        const std::string program = world.path("browser");
        std::ofstream(program) << "#!/bin/sh\necho $1 >>" + world.path("told") + "\n";
        fs::permissions(program, fs::perms::owner_all);
        fs::create_directories(data("applications"));
        std::ofstream(data("applications/browser.desktop"))
            << "[Desktop Entry]\nType=Application\nName=Browser\nMimeType=text/html;\nExec=" +
                   program + " %u\n";
        std::ofstream(data("applications/mimeapps.list"))
            << "[Default Applications]\ntext/html=browser.desktop\n";
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
    const std::string lines =
        told(start(lteDrive()) + " & p=$!\n" + driving("has 'Zorell_LTE · lte-drive.pcap'") +
             "cd " PALLAX_SOURCE_DIR "/samples && " + start("lte-drive.pcap") +
             "; echo second $? | tell\n" + driving("windows 1") +
             "kill -TERM $p; wait $p; echo first $? | tell\n");
    EXPECT_EQ(lines, "second 0\nfirst 0\n");
}

TEST_F(EndToEndDesktop, AnotherSourceIsAnotherWindowOfTheApplication) {
    const std::string lines = told(
        start(lteDrive()) + " & p=$!\n" + driving("has 'Zorell_LTE · lte-drive.pcap'") +
        start("demo gsm") + " & q=$!\n" + driving("windows 2 has 'Zorell_GSM · simulated gsm'") +
        "busctl --user list --no-legend | grep -c '^example.pallax.Pallax ' | tell\n"
        "kill -TERM $p; wait $p; echo first $? | tell\n" +
        driving("windows 1 has 'Zorell_GSM · simulated gsm'") +
        "kill -TERM $q; wait $q; echo second $? | tell\n");
    EXPECT_EQ(lines, "1\nfirst 0\nsecond 0\n");
}

TEST_F(EndToEndDesktop, ARecordThatThrowsEndsItsOwnWindowOnly) {
    const std::string recording = record("fatal.pcap", {{milliseconds(0), registration(0)},
                                                        {milliseconds(10), unreadableSimFiles()}});
    const std::string lines =
        told(start("demo gsm") + " & p=$!\n" + driving("has 'Zorell_GSM · simulated gsm'") +
             start(recording + " --speed max") + " 2>" + world.path("told") + " & q=$!\n" +
             driving("has 'Pallax has stopped' press Close windows 1") +
             "wait $q; echo fatal $? | tell\n" + driving("has 'Zorell_GSM · simulated gsm'") +
             "kill -TERM $p; wait $p; echo other $? | tell\n");
    EXPECT_EQ(lines,
              "pallax: packet 2 (log code 0xFF0000): the embedded property list cannot be parsed\n"
              "fatal 70\nother 0\n");
}

TEST_F(EndToEndDesktop, AFileManagerOpensARecordingWithoutAShell) {
    if (!hasDesktopTools()) {
        GTEST_SKIP() << "desktop-file-utils, shared-mime-info or gio is not installed";
    }
    installEntry();
    const std::string copy = world.path("without-suffix");
    fs::copy_file(lteDrive(), copy);
    const std::string lines =
        told("gio info -a standard::content-type " + copy +
             " | grep -o 'application/.*' | tell\n"
             "gio mime application/x-pallax-recording | head -1 | grep -o example.* | tell\n"
             "gio open " +
             copy + "; echo $? | tell\n" + driving("has 'Zorell_LTE · without-suffix'") +
             "gio open " + copy + "; echo $? | tell\n" + driving("windows 1") + endAll());
    EXPECT_EQ(lines, "application/x-pallax-recording\n"
                     "example.pallax.Pallax.desktop\n0\n0\n");
}

TEST_F(EndToEndDesktop, TheDesktopEntryStartsASimulatedModem) {
    if (!hasDesktopTools()) {
        GTEST_SKIP() << "desktop-file-utils, shared-mime-info or gio is not installed";
    }
    installEntry();
    const std::string lines =
        told("gapplication action example.pallax.Pallax demo; echo $? | tell\n" +
             driving("has 'Zorell_LTE · simulated lte'") + endAll());
    EXPECT_EQ(lines, "0\n");
}

TEST_F(EndToEndDesktop, AFileThatCannotBeOpenedIsToldInADialog) {
    if (!hasDesktopTools()) {
        GTEST_SKIP() << "desktop-file-utils, shared-mime-info or gio is not installed";
    }
    installEntry();
    std::ofstream(world.path("damaged.pcap")) << "no capture";
    const std::string lines =
        told("gapplication launch example.pallax.Pallax " + world.path("damaged.pcap") +
             "; echo $? | tell\n" +
             driving("has 'Cannot Open' has 'pallax: " + world.path("damaged.pcap") +
                     " is not a recording: it is neither pcap nor pcapng.' press 'Close Close' "
                     "lacks 'Cannot Open'") +
             endAll());
    EXPECT_EQ(lines, "0\n");
}

TEST_F(EndToEndDesktop, AReportOpensInTheBrowserWhateverItsNameIs) {
    if (!hasDesktopTools()) {
        GTEST_SKIP() << "desktop-file-utils, shared-mime-info or gio is not installed";
    }
    installBrowser();
    const std::string copy = world.path("drive#1?%41.pcap");
    fs::copy_file(lteDrive(), copy);
    const std::string lines = told(start("'" + copy + "'") + " & p=$!\n" +
                                   driving("has 'SIM Info' menu 'Report in the Browser'") +
                                   "for i in $(seq 300); do test -s " + world.path("told") +
                                   " && break; sleep 0.1; done\nkill -TERM $p; wait $p\n");
    EXPECT_EQ(lines, world.path(".cache/pallax/drive#1?%41.pcap.html") + "\n");
}

TEST_F(EndToEndDesktop, RecentRecordingsAreOfferedUnlessTheyAreGoneOrSafe) {
    const std::string copy = world.path("tunnel.pcap");
    fs::copy_file(lteDrive(), copy);
    expectDriven(drive(copy, "has 'Zorell_LTE · tunnel.pcap' press Menu has Recent"));
    EXPECT_NE(contentOf(data("recently-used.xbel")).find("tunnel.pcap"), std::string::npos);
    expectDriven(drive(lteDrive() + " --safe", "has 'Updated 2023-11-14 at 22:13:24'"));
    EXPECT_EQ(contentOf(data("recently-used.xbel")).find("lte-drive.pcap"), std::string::npos);
    expectDriven(drive("demo", "has 'SIM Info' menu Recent entry tunnel.pcap windows 2 "
                               "has 'Zorell_LTE · tunnel.pcap'"));
    expectDriven(drive("demo", "has 'SIM Info' menu Recent entry 'Clear List' lacks Recent"));
    EXPECT_EQ(contentOf(data("recently-used.xbel")).find("tunnel.pcap"), std::string::npos);
}

} // namespace
} // namespace pallax
