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
          "share/man/man1/pallax-window.1.gz", "share/doc/pallax-window/changelog.gz",
          "share/doc/pallax-window/copyright"}) {
        EXPECT_TRUE(fs::exists(folder.path(std::string("root/usr/") + name))) << name;
    }
    EXPECT_FALSE(fs::exists(folder.path("root/usr/bin/pallax")));
}

TEST_F(WindowPackage, LintianFindsNoError) {
    if (!isInstalled("lintian")) {
        GTEST_SKIP() << "lintian is not installed";
    }
    const auto run = runCommand("lintian --allow-root --fail-on error " + package());
    EXPECT_EQ(run.status, 0) << run.out;
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
