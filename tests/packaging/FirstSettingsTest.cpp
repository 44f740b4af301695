#include "link/Settings.h"
#include "tests/doubles/Files.h"

#include <gtest/gtest.h>

#include <cstdlib>
#include <filesystem>
#include <fstream>

namespace pallax {
namespace {

using doubles::contentOf;

/// The script that `run` calls before it opens the viewer.
class FirstSettings : public testing::Test {
protected:
    /// Runs it with only these variables in the environment and returns its exit status.
    int run(const std::string& environment) const {
        const std::string command = "env -i PATH=/usr/bin:/bin " + environment + " " +
                                    PALLAX_SOURCE_DIR + "/scripts/first-settings 2>" +
                                    folder.path("err");
        return std::system(command.c_str()); // NOLINT(cert-env33-c): the script is ours
    }
    std::string home() const { return "HOME=" + folder.path(); }

    doubles::TemporaryFolder folder;
    std::string file = folder.path(".config/pallax/pallax.conf");
    std::string snapshots = folder.path(".local/state/pallax/snapshots");
};

TEST_F(FirstSettings, AreWrittenOnceAndTheSnapshotFolderIsMade) {
    EXPECT_EQ(run(home()), 0);
    EXPECT_TRUE(std::filesystem::is_directory(snapshots));
    const SettingsResult settings = loadSettings({file});
    ASSERT_TRUE(settings);
    EXPECT_EQ(settings->snapshotDirectory, snapshots);
    EXPECT_EQ(settings->saveButtonMarker, snapshots);
    EXPECT_EQ(settings->onFatalRecord, OnFatalRecord::Stop);
    EXPECT_EQ(settings->afterReconnect, AfterReconnect::Fresh);
    EXPECT_EQ(settings->firstScreen, FirstScreen::Overview);
    EXPECT_EQ(settings->lists, Lists::Table);
    EXPECT_EQ(contentOf(folder.path("err")),
              "Settings were written to " + file + "; snapshots go to " + snapshots + ".\n");

    EXPECT_EQ(run(home()), 0);
    EXPECT_EQ(contentOf(folder.path("err")), "");
}

TEST_F(FirstSettings, ThatTheUserHasAreKept) {
    std::filesystem::create_directories(folder.path(".config/pallax"));
    std::ofstream(file) << "on-fatal-record = skip\n";
    EXPECT_EQ(run(home()), 0);
    EXPECT_EQ(contentOf(file), "on-fatal-record = skip\n");
    EXPECT_FALSE(std::filesystem::exists(snapshots));
}

TEST_F(FirstSettings, AMissingSnapshotFolderIsMadeAgain) {
    EXPECT_EQ(run(home()), 0);
    std::filesystem::remove_all(snapshots);
    EXPECT_EQ(run(home()), 0);
    EXPECT_TRUE(std::filesystem::is_directory(snapshots));
}

TEST_F(FirstSettings, FollowTheFoldersOfTheEnvironment) {
    EXPECT_EQ(run(home() + " XDG_CONFIG_HOME=" + folder.path("c") +
                  " XDG_STATE_HOME=" + folder.path("s")),
              0);
    EXPECT_TRUE(std::filesystem::exists(folder.path("c/pallax/pallax.conf")));
    EXPECT_TRUE(std::filesystem::is_directory(folder.path("s/pallax/snapshots")));
    EXPECT_FALSE(std::filesystem::exists(file));
}

TEST_F(FirstSettings, AreNotWrittenToARelativeFolderNorWithoutAHome) {
    EXPECT_EQ(run(home() + " XDG_CONFIG_HOME=relative"), 0);
    EXPECT_TRUE(std::filesystem::exists(file)) << "where the viewer reads them";
    EXPECT_EQ(run(""), 0);
}

} // namespace
} // namespace pallax
