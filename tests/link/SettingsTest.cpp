#include "link/Settings.h"

#include "tests/doubles/Files.h"

#include <gtest/gtest.h>

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <sys/stat.h>
#include <unistd.h>

namespace pallax {
namespace {

std::string sentenceFor(std::string_view text) {
    const auto settings = parseSettings(text, "pallax.conf");
    return settings ? "no error" : settings.error().sentence;
}

TEST(Settings, AProfileIsItsName) {
    EXPECT_EQ(parseSettings("", "pallax.conf")->profile, std::nullopt);
    EXPECT_EQ(parseSettings("profile = survey", "pallax.conf")->profile, "survey");
    EXPECT_EQ(sentenceFor("profile ="), "pallax.conf, line 1: profile needs a name.");
}

TEST(Settings, AreReadLineByLine) {
    const auto settings = parseSettings("# a comment\n"
                                        "\n"
                                        "  on-fatal-record =  skip \r\n"
                                        "snapshot-directory=/tmp/a = b\n"
                                        "system-log-level = 4\n"
                                        "after-reconnect = fresh\n"
                                        "first-screen = overview\n"
                                        "lists = table\n"
                                        "journal-hours = 2\n"
                                        "journal-mebibytes = 65536\n"
                                        "alarm = weak: measured_rsrp < -110 for 10s bell\n"
                                        "alarm = lost: a = 'b = c'\n"
                                        "save-button-marker = /tmp/marker",
                                        "pallax.conf");
    ASSERT_TRUE(settings);
    EXPECT_EQ(settings->onFatalRecord, OnFatalRecord::Skip);
    EXPECT_EQ(settings->snapshotDirectory, "/tmp/a = b");
    EXPECT_EQ(settings->saveButtonMarker, "/tmp/marker");
    EXPECT_EQ(settings->systemLogLevel, 4);
    EXPECT_EQ(settings->afterReconnect, AfterReconnect::Fresh);
    EXPECT_EQ(settings->firstScreen, FirstScreen::Overview);
    EXPECT_EQ(settings->lists, Lists::Table);
    EXPECT_EQ(settings->journal.age, std::chrono::hours(2));
    EXPECT_EQ(settings->journal.bytes, std::uint64_t{64} << 30U);
    ASSERT_EQ(settings->alarms.size(), 2U);
    EXPECT_EQ(settings->alarms[0].name, "weak");
    EXPECT_EQ(settings->alarms[1].condition, "a = 'b = c'");
    EXPECT_EQ(parseSettings("after-reconnect = keep", "pallax.conf")->afterReconnect,
              AfterReconnect::Keep);
    for (const auto& [word, curves] : {std::pair("braille", CurveCharacters::Braille),
                                       std::pair("blocks", CurveCharacters::Blocks),
                                       std::pair("ascii", CurveCharacters::Ascii)}) {
        EXPECT_EQ(parseSettings(std::string("curves = ") + word, "pallax.conf")->curves, curves);
    }
    EXPECT_EQ(parseSettings("first-screen = panes", "pallax.conf")->firstScreen,
              FirstScreen::Panes);
    EXPECT_EQ(parseSettings("lists = rows", "pallax.conf")->lists, Lists::Rows);
}

TEST(Settings, WithoutAFileTheDefaultsHold) {
    const auto settings = loadSettings({"/does/not/exist"});
    ASSERT_TRUE(settings);
    EXPECT_EQ(settings->onFatalRecord, OnFatalRecord::Stop);
    EXPECT_EQ(settings->snapshotDirectory, std::nullopt);
    EXPECT_EQ(settings->saveButtonMarker, std::nullopt);
    EXPECT_EQ(settings->systemLogLevel, 3);
    EXPECT_EQ(settings->afterReconnect, AfterReconnect::Keep);
    EXPECT_EQ(settings->firstScreen, FirstScreen::Panes);
    EXPECT_EQ(settings->lists, Lists::Rows);
    EXPECT_EQ(settings->curves, std::nullopt) << "what the terminal has";
    EXPECT_EQ(settings->journal.age, std::chrono::hours(24));
    EXPECT_EQ(settings->journal.bytes, std::uint64_t{256} << 20U);
    EXPECT_TRUE(settings->alarms.empty());
}

TEST(Settings, AMistakeIsOneSentenceWithFileAndLine) {
    EXPECT_EQ(sentenceFor("\n\ncolour = red\n"),
              "pallax.conf, line 3: there is no setting \"colour\".");
    EXPECT_EQ(sentenceFor("on-fatal-record = maybe"),
              "pallax.conf, line 1: on-fatal-record is \"stop\" or \"skip\", not \"maybe\".");
    EXPECT_EQ(sentenceFor("after-reconnect = never"),
              "pallax.conf, line 1: after-reconnect is \"keep\" or \"fresh\", not \"never\".");
    EXPECT_EQ(sentenceFor("first-screen = graph"),
              "pallax.conf, line 1: first-screen is \"panes\" or \"overview\", not \"graph\".");
    EXPECT_EQ(sentenceFor("lists = grid"),
              "pallax.conf, line 1: lists is \"rows\" or \"table\", not \"grid\".");
    EXPECT_EQ(sentenceFor("\nalarm = weak"),
              "pallax.conf, line 2: an alarm is written \"NAME: CONDITION [for SECONDS] [bell]\".");
    EXPECT_EQ(sentenceFor("alarm = a: x <"),
              "pallax.conf, line 1: alarm \"a\": This is not a whole condition.");
    EXPECT_EQ(sentenceFor("alarm = a: x\nalarm = b: x\nalarm = a: y"),
              "pallax.conf, line 3: there is already an alarm \"a\".");
    EXPECT_EQ(sentenceFor("curves = dots"),
              "pallax.conf, line 1: curves is \"braille\", \"blocks\" or \"ascii\", not \"dots\".");
    EXPECT_EQ(sentenceFor("snapshot-directory ="),
              "pallax.conf, line 1: snapshot-directory needs a path.");
    for (const char* level : {"8", "-1", "4x", "", "warning", "99999999999"}) {
        EXPECT_EQ(sentenceFor(std::string("\nsystem-log-level = ") + level),
                  std::string("pallax.conf, line 2: system-log-level is a number from 0 to 7, "
                              "not \"") +
                      level + "\".");
    }
    for (const char* hours : {"0", "8761", "1.5", "1h", ""}) {
        EXPECT_EQ(sentenceFor(std::string("journal-hours = ") + hours),
                  std::string("pallax.conf, line 1: journal-hours is a number from 1 to 8760, "
                              "not \"") +
                      hours + "\".");
    }
    for (const char* size : {"0", "-5", "65537", "1G"}) {
        EXPECT_EQ(sentenceFor(std::string("journal-mebibytes = ") + size),
                  std::string("pallax.conf, line 1: journal-mebibytes is a number from 1 to 65536, "
                              "not \"") +
                      size + "\".");
    }
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
    EXPECT_EQ(settings.error().sentence, folder.path() + " cannot be read: it is a folder.");
}

TEST_F(SettingsFileTest, ANamedPipeIsRefusedWithoutWaitingForIt) {
    const std::string pipe = folder.path("pipe");
    ASSERT_EQ(::mkfifo(pipe.c_str(), S_IRUSR | S_IWUSR), 0);
    const auto settings = loadSettings({pipe});
    ASSERT_FALSE(settings);
    EXPECT_EQ(settings.error().sentence, pipe + " cannot be read: it is not a regular file.");
}

TEST_F(SettingsFileTest, AMebibyteIsTheMost) {
    const std::string file = folder.write("large", std::string(1U << 20U, '\n'));
    EXPECT_TRUE(loadSettings({file}));
    (void)folder.write("large", std::string((1U << 20U) + 1, '\n'));
    const auto settings = loadSettings({file});
    ASSERT_FALSE(settings);
    EXPECT_EQ(settings.error().sentence, file + " cannot be read: it has more than 1048576 bytes.");
}

TEST_F(SettingsFileTest, AFileThatCannotBeCheckedIsNotMissing) {
    const std::string circle = folder.path("circle");
    std::filesystem::create_symlink(circle, circle);
    const std::string file = folder.write("file", "");
    const auto settings = loadSettings({circle + "/pallax.conf", file});
    ASSERT_FALSE(settings);
    EXPECT_EQ(settings.error().sentence, circle + "/pallax.conf cannot be read: Too many levels "
                                                  "of symbolic links.");
    EXPECT_TRUE(loadSettings({file + "/pallax.conf", folder.path("none/pallax.conf")}))
        << "a file has no files below it";
}

TEST_F(SettingsFileTest, AFolderThatMayNotBeEnteredIsAnError) {
    const std::string file = folder.write("pallax.conf", "on-fatal-record = skip\n");
    std::filesystem::permissions(folder.path(), std::filesystem::perms::none);
    const bool isRoot = ::geteuid() == 0;
    constexpr uid_t kNobody = 65534;
    if (isRoot) {
        ASSERT_EQ(::seteuid(kNobody), 0);
    }
    const auto settings = loadSettings({file});
    if (isRoot) {
        ASSERT_EQ(::seteuid(0), 0);
    }
    std::filesystem::permissions(folder.path(), std::filesystem::perms::owner_all);
    ASSERT_FALSE(settings);
    EXPECT_EQ(settings.error().sentence, file + " cannot be read: Permission denied.");
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
