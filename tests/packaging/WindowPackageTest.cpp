#include "tests/doubles/Files.h"
#include "tests/doubles/Shell.h"

#include <gtest/gtest.h>

#include <filesystem>

namespace pallax {
namespace {

namespace fs = std::filesystem;
using doubles::contentOf;
using doubles::isInstalled;
using doubles::runCommand;

constexpr const char* kId = "example.pallax.Pallax";

std::string source(const std::string& suffix) {
    return std::string(PALLAX_SOURCE_DIR "/packaging/") + kId + suffix;
}

/// The second Debian package that the test MakePackage makes.
class WindowPackage : public testing::Test {
protected:
    void SetUp() override {
        if (!isInstalled("dpkg-deb") || !isInstalled("dpkg-shlibdeps")) {
            GTEST_SKIP() << "dpkg-dev is not installed";
        }
        ASSERT_TRUE(fs::is_directory(PALLAX_PACKAGE_FOLDER)) << "ctest -R MakePackage makes it";
    }
    static std::string package() { return PALLAX_PACKAGE_FOLDER "/pallax-window_*.deb"; }
    static std::string dependsOf(const std::string& packageFile) {
        return runCommand("dpkg-deb -f " + packageFile + " Depends").out;
    }

    doubles::TemporaryFolder folder;
};

TEST_F(WindowPackage, HasTheGraphicalLibrariesAndTheOtherPackageHasNot) {
    const std::string window = dependsOf(package());
    EXPECT_NE(window.find("libadwaita-1-0 "), std::string::npos) << window;
    EXPECT_NE(window.find("pallax (= "), std::string::npos) << window;
    const std::string terminal = dependsOf(PALLAX_PACKAGE_FOLDER "/pallax_*.deb");
    EXPECT_EQ(terminal.find("libadwaita"), std::string::npos) << terminal;
    EXPECT_EQ(terminal.find("libgtk"), std::string::npos) << terminal;
}

TEST_F(WindowPackage, HoldsTheProgramAndWhatDesktopsShowOfIt) {
    ASSERT_EQ(runCommand("dpkg-deb -x " + package() + " " + folder.path("root")).status, 0);
    for (const char* name :
         {"bin/pallax-window", "share/applications/example.pallax.Pallax.desktop",
          "share/metainfo/example.pallax.Pallax.metainfo.xml",
          "share/icons/hicolor/scalable/apps/example.pallax.Pallax.svg",
          "share/dbus-1/services/example.pallax.Pallax.service",
          "share/bash-completion/completions/pallax-window",
          "share/zsh/vendor-completions/_pallax-window",
          "share/fish/vendor_completions.d/pallax-window.fish", "share/man/man1/pallax-window.1.gz",
          "share/doc/pallax-window/changelog.gz", "share/doc/pallax-window/copyright"}) {
        EXPECT_TRUE(fs::exists(folder.path(std::string("root/usr/") + name))) << name;
    }
    EXPECT_FALSE(fs::exists(folder.path("root/usr/bin/pallax")));
    EXPECT_EQ(
        contentOf(folder.path("root/usr/share/dbus-1/services/example.pallax.Pallax.service")),
        "[D-BUS Service]\nName=example.pallax.Pallax\n"
        "Exec=/usr/bin/pallax-window --gapplication-service\n");
}

TEST_F(WindowPackage, LintianFindsNoError) {
    if (!isInstalled("lintian")) {
        GTEST_SKIP() << "lintian is not installed";
    }
    const auto run = runCommand("lintian --allow-root --fail-on error " + package());
    EXPECT_EQ(run.status, 0) << run.out;
}

/// What bash offers for the last word of a command line of pallax-window.
std::string offered(const std::string& words, int last) {
    const std::string program = PALLAX_BINARY_DIR "/pallax-window";
    return runCommand("cd / && bash -c 'source <(" + program + " completion bash); COMP_WORDS=(" +
                      words + "); COMP_CWORD=" + std::to_string(last) +
                      "; _pallax_window; echo ${COMPREPLY[@]}'")
        .out;
}

TEST(WindowDescription, ShellsCompleteWhatAWindowTakes) {
    EXPECT_EQ(offered("pallax-window dem", 1), "demo\n");
    EXPECT_EQ(offered("pallax-window deco", 1), "\n");
    EXPECT_EQ(offered("pallax-window --s", 1), "--safe --speed\n");
    EXPECT_EQ(offered("pallax-window --pr", 1), "--profile\n") << "not --print";
    EXPECT_EQ(offered("pallax-window demo l", 2), "lte\n");
    EXPECT_EQ(offered("pallax-window demo --pl", 2), "\n");
}

TEST(WindowDescription, CompletionsAreWellFormed) {
    const std::string program = PALLAX_BINARY_DIR "/pallax-window completion ";
    if (isInstalled("zsh")) {
        EXPECT_EQ(runCommand("bash -c 'zsh -n <(" + program + "zsh)'").out, "");
    }
    if (isInstalled("fish")) {
        EXPECT_EQ(runCommand("bash -c 'fish -n <(" + program + "fish)'").out, "");
    }
}

TEST(WindowDescription, ScreenshotsAreThoseOfTheDocuments) {
    const std::string text = contentOf(source(".metainfo.xml"));
    for (const char* name :
         {"window.png", "window-graph.png", "window-phone.png", "window-phone-table.png"}) {
        EXPECT_NE(text.find(std::string("/docs/") + name + "</image>"), std::string::npos) << name;
        EXPECT_TRUE(fs::exists(std::string(PALLAX_SOURCE_DIR "/docs/") + name)) << name;
    }
}

TEST(WindowDescription, OfTheDesktopIsValid) {
    if (!isInstalled("desktop-file-validate")) {
        GTEST_SKIP() << "desktop-file-validate is not installed";
    }
    const auto run = runCommand("desktop-file-validate " + source(".desktop"));
    EXPECT_EQ(run.status, 0) << run.out;
    EXPECT_EQ(run.out, "");
}

TEST(WindowDescription, OfSoftwareCentresIsValid) {
    if (!isInstalled("appstreamcli")) {
        GTEST_SKIP() << "appstreamcli is not installed";
    }
    const auto run = runCommand("appstreamcli validate --no-net " + source(".metainfo.xml"));
    EXPECT_EQ(run.status, 0) << run.out;
}

TEST(WindowDescription, ManualPageIsWellFormed) {
    if (!isInstalled("man")) {
        GTEST_SKIP() << "man is not installed";
    }
    const auto run = runCommand(
        "LC_ALL=C.UTF-8 MANROFFSEQ= man --warnings -E UTF-8 -l -Tutf8 -Z " PALLAX_SOURCE_DIR
        "/docs/man/pallax-window.1 2>&1 >/dev/null");
    EXPECT_EQ(run.status, 0);
    EXPECT_EQ(run.out, "");
}

} // namespace
} // namespace pallax
