#include "tests/doubles/Files.h"
#include "tests/doubles/Shell.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <fstream>

namespace pallax {
namespace {

/// The script with which `run` and `test` check for missing packages. Stand-ins answer its
/// questions to the system.
class NeedPackages : public testing::Test {
protected:
    NeedPackages() {
        standIn("dpkg-query", R"(case "$*" in *" there") printf installed;; *) exit 1;; esac)");
        standIn("apt-get", "echo \"$DEBIAN_FRONTEND apt-get $*\"");
    }
    void standIn(const std::string& name, const std::string& text) const {
        std::ofstream(folder.path(name)) << "#!/bin/sh\n" << text << '\n';
        std::filesystem::permissions(folder.path(name), std::filesystem::perms::owner_all);
    }
    /// Runs it as the user with that number.
    doubles::CommandRun run(const std::string& user, const std::string& packages) const {
        standIn("id", "echo " + user);
        return doubles::runCommand("PATH=" + folder.path() + ":$PATH " + PALLAX_SOURCE_DIR +
                                   "/scripts/need-packages " + packages);
    }

    doubles::TemporaryFolder folder;
};

TEST_F(NeedPackages, ThatAreThereAreNotInstalledAgain) {
    const auto done = run("0", "there");
    EXPECT_EQ(done.status, 0);
    EXPECT_EQ(done.out, "");
}

TEST_F(NeedPackages, ThatAreMissingAreNamedInOneCommandToWhoIsNotRoot) {
    const auto done = run("1000", "first there second");
    EXPECT_EQ(done.status, 1);
    EXPECT_EQ(done.out, "Packages are missing. Install them with:\n"
                        "  sudo apt-get install --no-install-recommends first second\n");
}

TEST_F(NeedPackages, ThatAreMissingAreInstalledByRoot) {
    const auto done = run("0", "there first");
    EXPECT_EQ(done.status, 0);
    EXPECT_EQ(done.out, "Installing first\n"
                        "noninteractive apt-get update -qq\n"
                        "noninteractive apt-get install -qq --no-install-recommends first\n");
}

TEST_F(NeedPackages, AFailedInstallationIsAFailure) {
    standIn("apt-get", "exit 100");
    EXPECT_EQ(run("0", "first").status, 100);
}

} // namespace
} // namespace pallax
