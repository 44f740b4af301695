#include "cli/Settings.h"

#include "tests/doubles/Files.h"

#include <gtest/gtest.h>

#include <cstdlib>
#include <filesystem>
#include <fstream>

namespace pallax {
namespace {

std::string sentenceFor(std::string_view text) {
    const auto settings = parseSettings(text, "pallax.conf");
    return settings ? "no error" : settings.error().sentence;
}

TEST(Settings, AreReadLineByLine) {
    const auto settings = parseSettings("# a comment\n"
                                        "\n"
                                        "  on-fatal-record =  skip \r\n"
                                        "snapshot-directory=/tmp/a = b\n"
                                        "save-button-marker = /tmp/marker",
                                        "pallax.conf");
    ASSERT_TRUE(settings);
    EXPECT_EQ(settings->onFatalRecord, OnFatalRecord::Skip);
    EXPECT_EQ(settings->snapshotDirectory, "/tmp/a = b");
    EXPECT_EQ(settings->saveButtonMarker, "/tmp/marker");
}

TEST(Settings, WithoutAFileTheDefaultsHold) {
    const auto settings = loadSettings({"/does/not/exist"});
    ASSERT_TRUE(settings);
    EXPECT_EQ(settings->onFatalRecord, OnFatalRecord::Stop);
    EXPECT_EQ(settings->snapshotDirectory, std::nullopt);
    EXPECT_EQ(settings->saveButtonMarker, std::nullopt);
}

TEST(Settings, AMistakeIsOneSentenceWithFileAndLine) {
    EXPECT_EQ(sentenceFor("\n\ncolour = red\n"),
              "pallax.conf, line 3: there is no setting \"colour\".");
    EXPECT_EQ(sentenceFor("on-fatal-record = maybe"),
              "pallax.conf, line 1: on-fatal-record is \"stop\" or \"skip\", not \"maybe\".");
    EXPECT_EQ(sentenceFor("snapshot-directory ="),
              "pallax.conf, line 1: snapshot-directory needs a path.");
    EXPECT_EQ(sentenceFor("skip"), "pallax.conf, line 1: a setting is written \"key = value\".");
}

class SettingsFileTest : public testing::Test {
protected:
    doubles::TemporaryFolder folder;
};

TEST_F(SettingsFileTest, TheFirstFileThatExistsHoldsAlone) {
    const std::string first = folder.write("first", "snapshot-directory = /a\n");
    const std::string second = folder.write("second", "on-fatal-record = skip\n");
    const auto settings = loadSettings({folder.path("missing"), first, second});
    ASSERT_TRUE(settings);
    EXPECT_EQ(settings->snapshotDirectory, "/a");
    EXPECT_EQ(settings->onFatalRecord, OnFatalRecord::Stop);
}

TEST_F(SettingsFileTest, AFolderInItsPlaceCannotBeRead) {
    const auto settings = loadSettings({folder.path()});
    ASSERT_FALSE(settings);
    EXPECT_EQ(settings.error().sentence, folder.path() + " cannot be read.");
}

TEST(SettingsFiles, AreTheUsersThenTheSystems) {
    ::setenv("HOME", "/home/somebody", 1);
    ::setenv("XDG_CONFIG_HOME", "/conf", 1);
    EXPECT_EQ(settingsFiles(), (std::vector<std::string>{"/conf/pallax/pallax.conf",
                                                         "/etc/xdg/pallax/pallax.conf"}));
    ::unsetenv("XDG_CONFIG_HOME");
    EXPECT_EQ(settingsFiles(),
              (std::vector<std::string>{"/home/somebody/.config/pallax/pallax.conf",
                                        "/etc/xdg/pallax/pallax.conf"}));
}

} // namespace
} // namespace pallax
