#include "tests/doubles/Files.h"
#include "tests/doubles/Shell.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <set>
#include <unistd.h>

namespace pallax {
namespace {

namespace fs = std::filesystem;
using doubles::contentOf;
using doubles::isInstalled;
using doubles::runCommand;
using doubles::TemporaryFolder;

/// The Debian package that the test MakePackage makes.
class Package : public testing::Test {
protected:
    void SetUp() override {
        if (!isInstalled("dpkg-deb") || !isInstalled("dpkg-shlibdeps")) {
            GTEST_SKIP() << "dpkg-dev is not installed";
        }
        ASSERT_TRUE(fs::is_directory(PALLAX_PACKAGE_FOLDER)) << "ctest -R MakePackage makes it";
    }

    static std::string package() { return PALLAX_PACKAGE_FOLDER "/pallax_*.deb"; }

    /// Everything below a folder except the package manager's files, as paths from there.
    static std::set<std::string> content(const std::string& root) {
        std::set<std::string> names;
        for (auto entry = fs::recursive_directory_iterator(root);
             entry != fs::recursive_directory_iterator(); ++entry) {
            const std::string name = fs::relative(entry->path(), root).string();
            if (name == "var") {
                entry.disable_recursion_pending();
            } else {
                names.insert(name);
            }
        }
        return names;
    }

    TemporaryFolder folder;
};

TEST_F(Package, RunsFromWhereItIsUnpacked) {
    const std::string depends = runCommand("dpkg-deb -f " + package() + " Depends").out;
    for (const char* library : {"libc6 ", "libedit2 ", "libncursesw6 ", "libpcap0.8 ",
                                "libpugixml1v5 ", "libzstd1 ", "zlib1g "}) {
        EXPECT_NE(depends.find(library), std::string::npos) << depends;
    }
    ASSERT_EQ(runCommand("dpkg-deb -x " + package() + " " + folder.path("root")).status, 0);
    EXPECT_NE(contentOf(folder.path("root/usr/lib/systemd/user/pallax.service"))
                  .find("\nExecStart=/usr/bin/pallax service "),
              std::string::npos);
    EXPECT_TRUE(fs::exists(folder.path("root/usr/share/zsh/vendor-completions/_pallax")));
    const auto demo = runCommand("env -u PALLAX_RESOURCES " + folder.path("root/usr/bin/pallax") +
                                 " demo --print --seconds 4 --speed max");
    EXPECT_EQ(demo.status, 0);
    EXPECT_NE(demo.out.find("\nServing Cell Info\n"), std::string::npos) << demo.out;
}

TEST_F(Package, DoesNotKnowWhereItWasBuilt) {
    ASSERT_EQ(runCommand("dpkg-deb -x " + package() + " " + folder.path("root")).status, 0);
    EXPECT_EQ(contentOf(folder.path("root/usr/bin/pallax")).find(PALLAX_SOURCE_DIR "/resources"),
              std::string::npos);
}

TEST_F(Package, HasCompressedManualPagesAndAChangelog) {
    ASSERT_EQ(runCommand("dpkg-deb -x " + package() + " " + folder.path("root")).status, 0);
    std::size_t pages = 0;
    for (const std::string& name : content(folder.path("root/usr/share/man"))) {
        const bool isPage = name.find('/') != std::string::npos;
        pages += isPage ? 1 : 0;
        EXPECT_TRUE(!isPage || name.ends_with(".gz")) << name;
    }
    EXPECT_GE(pages, 8U);
    const auto log =
        runCommand("gzip -dc " + folder.path("root/usr/share/doc/pallax/changelog.gz"));
    EXPECT_EQ(log.status, 0) << log.out;
    EXPECT_TRUE(log.out.starts_with("pallax (")) << log.out;
}

TEST_F(Package, LintianFindsNoError) {
    if (!isInstalled("lintian")) {
        GTEST_SKIP() << "lintian is not installed";
    }
    const std::string asRoot = ::geteuid() == 0 ? "--allow-root " : "";
    const auto run = runCommand("lintian " + asRoot + "--fail-on error " + package());
    EXPECT_EQ(run.status, 0) << run.out;
}

TEST_F(Package, IsInstalledAndPurgedWithoutATrace) {
    if (::geteuid() != 0) {
        GTEST_SKIP() << "only root can install packages, also into a folder";
    }
    for (const char* name : {"var/lib/dpkg/info", "var/lib/dpkg/updates"}) {
        fs::create_directories(folder.path(name));
    }
    folder.write("var/lib/dpkg/status", "");
    const std::string dpkg = "dpkg --root=" + folder.path() + " --force-depends ";
    const auto installed = runCommand(dpkg + "--install " + package());
    ASSERT_EQ(installed.status, 0) << installed.out;
    EXPECT_TRUE(content(folder.path()).contains("usr/bin/pallax"));
    const auto purged = runCommand(dpkg + "--purge pallax");
    EXPECT_EQ(purged.status, 0) << purged.out;
    EXPECT_EQ(content(folder.path()), std::set<std::string>());
}

} // namespace
} // namespace pallax
