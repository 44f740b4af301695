#include "cli/CommandLine.h"
#include "cli/Completion.h"
#include "cli/ManualPage.h"
#include "tests/doubles/Files.h"
#include "tests/doubles/Pattern.h"
#include "tests/doubles/Shell.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <set>

namespace pallax {
namespace {

namespace fs = std::filesystem;
using doubles::contentOf;
using doubles::isInstalled;
using doubles::runCommand;

/// An installation into a prefix of its own.
class Installation : public testing::Test {
protected:
    Installation() {
        const auto run =
            runCommand(PALLAX_CMAKE " --install " PALLAX_BINARY_DIR " --prefix " + prefix.path());
        EXPECT_EQ(run.status, 0) << run.out;
    }

    /// The files below a folder of the installation, as paths from there.
    std::set<std::string> files(const std::string& folder) const {
        std::set<std::string> names;
        const fs::path root = prefix.path(folder);
        for (const auto& entry : fs::recursive_directory_iterator(root)) {
            if (entry.is_regular_file()) {
                names.insert(fs::relative(entry.path(), root).string());
            }
        }
        return names;
    }

    doubles::TemporaryFolder prefix;
};

TEST_F(Installation, TheInstalledProgramDecodesARecordingWithTheInstalledTemplates) {
    const std::string decode =
        prefix.path("bin/pallax") + " decode " PALLAX_SOURCE_DIR "/samples/gsm-attach.pcap";
    const auto run = runCommand("env -u PALLAX_RESOURCES " + decode);
    EXPECT_EQ(run.status, 0) << run.out;
    EXPECT_TRUE(run.out.starts_with("{\"")) << run.out;

    // It reads its own templates: without them, the folder exists but is empty.
    for (const std::string& name : files("share/pallax")) {
        fs::remove(prefix.path("share/pallax/" + name));
    }
    const auto without = runCommand("env -u PALLAX_RESOURCES " + decode);
    EXPECT_EQ(without.status, 1);
    EXPECT_EQ(without.out, "pallax: The display template " +
                               prefix.path("share/pallax/ZOR_GSM.plist") +
                               " cannot be loaded: No such file or directory.\n");
}

TEST_F(Installation, EveryManualPageAndCompletionIsThere) {
    std::set<std::string> pages{"man5/pallax.conf.5", "man7/pallax-privacy.7",
                                "man7/pallax-recording.7", "man7/pallax-sections.7",
                                "man7/pallax-sql.7"};
#ifdef PALLAX_HAS_WINDOW
    pages.insert("man1/pallax-window.1");
#endif
    const CommandDescription program = CommandLine().description();
    for (const std::string& name : manualPages(program)) {
        pages.insert("man1/" + name + ".1");
        EXPECT_EQ(contentOf(prefix.path("share/man/man1/" + name + ".1")),
                  manualPage(program, name));
    }
    EXPECT_EQ(files("share/man"), pages);
    EXPECT_EQ(contentOf(prefix.path("share/bash-completion/completions/pallax")),
              completionScript(program, "bash"));
    EXPECT_EQ(contentOf(prefix.path("share/zsh/site-functions/_pallax")),
              completionScript(program, "zsh"));
    EXPECT_EQ(contentOf(prefix.path("share/fish/vendor_completions.d/pallax.fish")),
              completionScript(program, "fish"));
}

TEST_F(Installation, WhatTheDocumentsLeadToIsThere) {
    std::size_t links = 0;
    for (const std::string& name : files("share/doc/pallax")) {
        if (!name.ends_with(".md")) {
            continue;
        }
        const std::string text = contentOf(prefix.path("share/doc/pallax/" + name));
        const fs::path folder = fs::path(prefix.path("share/doc/pallax/" + name)).parent_path();
        for (const auto& link : doubles::matchesIn(text, "\\]\\(([^)#:]+)\\)")) {
            EXPECT_TRUE(fs::exists(folder / link[1])) << name << ": " << link[1];
            ++links;
        }
    }
    EXPECT_GE(links, 10U) << "the README, the tour and the tables of the records have links";
}

TEST_F(Installation, TheServiceUnitStartsTheInstalledProgram) {
    const std::string unit = prefix.path("lib/systemd/user/pallax.service");
    EXPECT_NE(contentOf(unit).find("\nExecStart=" + prefix.path("bin/pallax") +
                                   " service $PALLAX_SERVICE\n"),
              std::string::npos);
    if (!isInstalled("systemd-analyze")) {
        GTEST_SKIP() << "systemd-analyze is not installed; the unit is not checked further";
    }
    const auto run = runCommand("XDG_RUNTIME_DIR=" + prefix.path() +
                                " SYSTEMD_LOG_LEVEL=warning systemd-analyze verify --user "
                                "--man=no --recursive-errors=no " +
                                unit);
    EXPECT_EQ(run.status, 0);
    EXPECT_EQ(run.out, "");
}

TEST_F(Installation, TheDesktopEntryOpensRecordingsInATerminal) {
    const std::string entry = contentOf(prefix.path("share/applications/pallax.desktop"));
    for (const char* line :
         {"Terminal=true", "Exec=pallax %f", "MimeType=application/x-pallax-recording;"}) {
        EXPECT_NE(entry.find(std::string("\n") + line + "\n"), std::string::npos) << line;
    }
}

TEST_F(Installation, TheTypeOfRecordingsIsTakenByTheDatabase) {
    if (!isInstalled("update-mime-database")) {
        GTEST_SKIP() << "update-mime-database is not installed";
    }
    const auto run = runCommand("XDG_DATA_DIRS=" + prefix.path("share") + " update-mime-database " +
                                prefix.path("share/mime"));
    EXPECT_EQ(run.status, 0) << run.out;
    EXPECT_EQ(run.out, "");
    EXPECT_NE(contentOf(prefix.path("share/mime/globs2"))
                  .find(":application/x-pallax-recording:*.pcapng\n"),
              std::string::npos);
}

} // namespace
} // namespace pallax
