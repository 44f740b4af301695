#include "host/BuildBundle.h"
#include "host/Descriptor.h"
#include "host/DirectoryResources.h"
#include "host/FilePreferences.h"
#include "host/Files.h"
#include "host/HostFileSystem.h"
#include "host/WallClock.h"
#include "plist/PropertyListCodec.h"
#include "tests/doubles/Pattern.h"
#include "tests/doubles/RuntimeFolder.h"

#include <gtest/gtest.h>

#include <array>
#include <csignal>
#include <cstdlib>
#include <ctime>
#include <fcntl.h>
#include <filesystem>
#include <sys/resource.h>
#include <sys/stat.h>

namespace pallax {
namespace {

class HostFilesTest : public testing::Test {
protected:
    PropertyList parsed(std::string_view name) const {
        const auto content = readFile(_folder.file(name), kLargestPropertyList);
        const auto result = parsePropertyList(content ? Bytes(*content) : Bytes());
        return result ? *result : PropertyList();
    }
    std::vector<std::string> namesIn(std::string_view folder) const {
        std::vector<std::string> names;
        for (const auto& entry : std::filesystem::directory_iterator(_folder.file(folder))) {
            names.push_back(entry.path().filename());
        }
        return names;
    }

    doubles::RuntimeFolder _folder;
};

TEST_F(HostFilesTest, APropertyListIsWrittenAsXmlAndAFailureIsTold) {
    HostFileSystem files;
    const PropertyList object(Dictionary{{"Description", "tunnel"}});
    EXPECT_TRUE(files.writePropertyList(_folder.file("a.pallax"), object));
    EXPECT_EQ(parsed("a.pallax"), object);
    EXPECT_FALSE(files.writePropertyList(_folder.file("absent/a.pallax"), object));
}

TEST_F(HostFilesTest, APropertyListIsItsUsersAloneAlsoWhereItReplacesAFile) {
    HostFileSystem files;
    const auto modeOf = [](const std::string& path) {
        struct stat status {};
        EXPECT_EQ(::lstat(path.c_str(), &status), 0);
        return status.st_mode & 0777U;
    };
    const std::string path = _folder.file("a.pallax");
    EXPECT_TRUE(files.writePropertyList(path, "first, and longer"));
    EXPECT_EQ(modeOf(path), 0600U);
    ASSERT_EQ(::chmod(path.c_str(), 0644), 0);
    EXPECT_TRUE(files.writePropertyList(path, "second"));
    EXPECT_EQ(modeOf(path), 0600U);
    EXPECT_EQ(parsed("a.pallax"), PropertyList("second"));
}

TEST_F(HostFilesTest, WhatCannotBeWrittenWholeIsRemoved) {
    HostFileSystem files;
    rlimit before{};
    ::getrlimit(RLIMIT_FSIZE, &before);
    const rlimit small{10, before.rlim_max};
    const auto handler = std::signal(SIGXFSZ, SIG_IGN);
    ::setrlimit(RLIMIT_FSIZE, &small);
    const bool isWritten = files.writePropertyList(_folder.file("a.pallax"), "snapshot");
    ::setrlimit(RLIMIT_FSIZE, &before);
    (void)std::signal(SIGXFSZ, handler);
    EXPECT_FALSE(isWritten);
    EXPECT_FALSE(files.exists(_folder.file("a.pallax")));
}

TEST_F(HostFilesTest, ALinkAPipeAndADeviceAreNotWrittenTo) {
    HostFileSystem files;
    const std::string target = _folder.write("target", "before");
    const std::string link = _folder.file("link");
    std::filesystem::create_symlink(target, link);
    EXPECT_FALSE(files.writePropertyList(link, "snapshot"));
    EXPECT_EQ(doubles::contentOf(target), "before");
    std::filesystem::create_symlink(_folder.file("absent"), _folder.file("dangling"));
    EXPECT_FALSE(files.writePropertyList(_folder.file("dangling"), "snapshot"));
    EXPECT_FALSE(files.exists(_folder.file("absent")));

    std::filesystem::create_hard_link(target, _folder.file("second name"));
    EXPECT_FALSE(files.writePropertyList(_folder.file("second name"), "snapshot"));
    EXPECT_EQ(doubles::contentOf(target), "before");

    const std::string pipe = _folder.file("pipe");
    ASSERT_EQ(::mkfifo(pipe.c_str(), 0600), 0);
    EXPECT_FALSE(files.writePropertyList(pipe, "snapshot")) << "does not wait for a reader";
    const Descriptor reader(::open(pipe.c_str(), O_RDWR | O_NONBLOCK | O_CLOEXEC));
    EXPECT_FALSE(files.writePropertyList(pipe, "snapshot"));
    std::array<char, 1> nothing{};
    EXPECT_EQ(::read(reader.number(), nothing.data(), 1), -1);

    EXPECT_FALSE(files.writePropertyList("/dev/null", "snapshot"));
    EXPECT_FALSE(files.writePropertyList(_folder.path(), "snapshot"));
}

TEST_F(HostFilesTest, APropertyListIsWrittenInPlace) {
    HostFileSystem files;
    const std::string path = _folder.write("a.pallax", std::string(4096, 'x'));
    struct stat before {};
    ASSERT_EQ(::stat(path.c_str(), &before), 0);
    ASSERT_TRUE(files.writePropertyList(path, PropertyList("tunnel")));
    struct stat after {};
    ASSERT_EQ(::stat(path.c_str(), &after), 0);
    EXPECT_EQ(after.st_ino, before.st_ino) << "the file is not replaced";
    EXPECT_TRUE(doubles::contentOf(path).starts_with("<?xml version=\"1.0\" encoding=\"UTF-8\"?>"))
        << doubles::contentOf(path);
    EXPECT_EQ(parsed("a.pallax"), PropertyList("tunnel"));
}

TEST_F(HostFilesTest, WhatCannotBeSerialisedLeavesTheFileAlone) {
    HostFileSystem files;
    (void)_folder.write("a.pallax", "before");
    EXPECT_FALSE(files.writePropertyList(_folder.file("a.pallax"), PropertyList()));
    EXPECT_EQ(doubles::contentOf(_folder.file("a.pallax")), "before");
}

TEST_F(HostFilesTest, ExistsSeesFilesAndFolders) {
    const HostFileSystem files;
    EXPECT_TRUE(files.exists(_folder.path()));
    EXPECT_FALSE(files.exists(_folder.file("absent")));
}

TEST_F(HostFilesTest, PreferencesAreKeptPerDomainInOneFileEach) {
    FilePreferences preferences(_folder.file("p"));
    preferences.setValue("PLShowGSMRSSI", PropertyList::boolean(false), "com.norvane.screen");
    EXPECT_FALSE(std::filesystem::exists(_folder.file("p"))); // only synchronize writes it
    EXPECT_TRUE(preferences.synchronize("com.norvane.screen"));
    EXPECT_TRUE(preferences.synchronize("nothing was set here"));
    EXPECT_EQ(parsed("p/com.norvane.screen.plist"),
              PropertyList(Dictionary{{"PLShowGSMRSSI", PropertyList::boolean(false)}}));
    EXPECT_EQ(namesIn("p"), (std::vector<std::string>{"com.norvane.screen.plist"}));
}

TEST_F(HostFilesTest, OtherValuesOfADomainStay) {
    {
        FilePreferences preferences(_folder.file("p"));
        preferences.setValue("kept", "old", "a/domain");
        preferences.setValue("changed", "old", "a/domain");
        ASSERT_TRUE(preferences.synchronize("a/domain"));
    }
    FilePreferences preferences(_folder.file("p"));
    preferences.setValue("changed", "new", "a/domain");
    ASSERT_TRUE(preferences.synchronize("a/domain"));
    preferences.postChangedNotice("a/domain", "changed");
    EXPECT_EQ(parsed("p/a%2Fdomain.plist"),
              PropertyList(Dictionary{{"kept", "old"}, {"changed", "new"}}));
}

TEST_F(HostFilesTest, AnUnreadablePreferenceFileIsNotOverwritten) {
    ASSERT_EQ(::mkdir(_folder.file("p").c_str(), 0700), 0);
    (void)_folder.write("p/d.plist", "<plist><broken");
    FilePreferences preferences(_folder.file("p"));
    preferences.setValue("key", "value", "d");
    EXPECT_FALSE(preferences.synchronize("d"));
    EXPECT_EQ(doubles::contentOf(_folder.file("p/d.plist")), "<plist><broken");
}

TEST_F(HostFilesTest, PreferencesLieInTheUsersConfiguration) {
    (void)::setenv("XDG_CONFIG_HOME", "/some/config", 1);
    EXPECT_EQ(FilePreferences::userFolder(), "/some/config/pallax/preferences");
    (void)::unsetenv("XDG_CONFIG_HOME");
    (void)::setenv("HOME", "/some/home", 1);
    EXPECT_EQ(FilePreferences::userFolder(), "/some/home/.config/pallax/preferences");
}

TEST_F(HostFilesTest, ResourcesAreFoundByNameAndListedSorted) {
    const std::string text = "<plist version=\"1.0\"><dict/></plist>";
    std::filesystem::create_directories(_folder.file("r/sub"));
    (void)_folder.write("r/Z.plist", text);
    (void)_folder.write("r/broken.plist", "<plist>");
    (void)_folder.write("r/readme.txt", "x");
    (void)_folder.write("r/sub/UTRAN.plist", text);
    const DirectoryResources resources(_folder.file("r"));
    EXPECT_EQ(resources.propertyList("Z"), PropertyList(Dictionary()));
    EXPECT_EQ(resources.propertyList("broken"), std::nullopt);
    EXPECT_EQ(resources.propertyList("absent"), std::nullopt);
    EXPECT_EQ(resources.propertyList("sub/UTRAN"), std::nullopt);
    EXPECT_EQ(resources.propertyList(""), std::nullopt);
    EXPECT_EQ(resources.propertyListPaths(),
              (std::vector<std::string>{_folder.file("r/Z.plist"), _folder.file("r/broken.plist"),
                                        _folder.file("r/sub/UTRAN.plist")}));
    EXPECT_EQ(DirectoryResources(_folder.file("absent")).propertyListPaths(),
              std::vector<std::string>());
}

TEST_F(HostFilesTest, AResourceThatCannotBeLoadedIsNamedWithTheReason) {
    const DirectoryResources resources(_folder.path());
    const auto reasonOf = [&](const std::string& name) {
        const auto loaded = resources.load(name);
        const std::string begin =
            "The display template " + _folder.file(name + ".plist") + " cannot be loaded: ";
        return loaded ? "none"
               : loaded.error().sentence.starts_with(begin)
                   ? loaded.error().sentence.substr(begin.size())
                   : loaded.error().sentence;
    };
    EXPECT_EQ(reasonOf("absent"), "No such file or directory.");
    std::filesystem::create_directories(_folder.file("folder.plist"));
    EXPECT_EQ(reasonOf("folder"), "it is a folder.");
    (void)_folder.write("cut.plist", "<plist version=\"1.0\"><dict>");
    EXPECT_EQ(reasonOf("cut"), "at byte 26: malformed XML: Start-end tags mismatch.");
    (void)_folder.write("list.plist", "( a, b )");
    EXPECT_EQ(reasonOf("list"), "it is not a dictionary.");
    (void)_folder.write("good.plist", "{ a = b; }");
    EXPECT_EQ(*resources.load("good"), PropertyList(Dictionary{{"a", "b"}}));
    EXPECT_EQ(DirectoryResources("/nonexistent").list().error().sentence,
              "The display templates in /nonexistent cannot be listed: No such file or directory.");
}

TEST_F(HostFilesTest, TheResourceFolderMayBeChosen) {
    (void)::setenv("PALLAX_RESOURCES", "/some/folder", 1);
    EXPECT_EQ(DirectoryResources::programFolder(), "/some/folder");
    (void)::unsetenv("PALLAX_RESOURCES");
    EXPECT_TRUE(DirectoryResources::programFolder().ends_with("/share/pallax"));
}

TEST_F(HostFilesTest, TheResourceFolderIsFoundFromTheProgram) {
    const std::string program = _folder.file("prefix/bin/pallax");
    std::filesystem::create_directories(_folder.file("prefix/bin"));
    EXPECT_EQ(DirectoryResources::folderFor(program), _folder.file("prefix/share/pallax"));
    std::filesystem::create_directories(_folder.file("prefix/share/pallax"));
    EXPECT_EQ(DirectoryResources::folderFor(program), _folder.file("prefix/share/pallax"));
    std::filesystem::create_directories(_folder.file("prefix/bin/share/pallax"));
    EXPECT_EQ(DirectoryResources::folderFor(program), _folder.file("prefix/bin/share/pallax"));
}

TEST_F(HostFilesTest, AFileAboveTheLimitIsNotRead) {
    (void)_folder.write("f", "12345");
    EXPECT_EQ(readFile(_folder.file("f"), 5)->size(), 5U);
    EXPECT_EQ(readFile(_folder.file("f"), 4), std::nullopt);
    EXPECT_EQ(readFile(_folder.file("absent"), 4), std::nullopt);
    EXPECT_EQ(readFile(_folder.path(), 4), std::nullopt);
}

TEST_F(HostFilesTest, OnlyARegularFileIsReadAndNoPipeIsWaitedFor) {
    const std::string pipe = _folder.file("pipe");
    ASSERT_EQ(::mkfifo(pipe.c_str(), S_IRUSR | S_IWUSR), 0);
    const auto failureFor = [](const std::string& path) {
        const auto content = readRegularFile(path, 4);
        const ReadFailure failure = content ? ReadFailure() : content.error();
        return (failure.isMissing ? "missing: " : "") + failure.reason;
    };
    EXPECT_EQ(failureFor(pipe), "it is not a regular file");
    EXPECT_EQ(failureFor("/dev/zero"), "it is not a regular file");
    EXPECT_EQ(failureFor(_folder.path()), "it is a folder");
    EXPECT_EQ(failureFor(_folder.write("f", "12345")), "it has more than 4 bytes");
    EXPECT_EQ(failureFor(_folder.write("f", "1234")), "");
    EXPECT_EQ(failureFor(_folder.file("absent")), "missing: No such file or directory");
    EXPECT_EQ(failureFor(_folder.file("f/g")), "missing: Not a directory");
}

TEST_F(HostFilesTest, APipeInThePreferencesPlaceKeepsNobodyWaiting) {
    ASSERT_EQ(::mkdir(_folder.file("p").c_str(), 0700), 0);
    ASSERT_EQ(::mkfifo(_folder.file("p/d.plist").c_str(), S_IRUSR | S_IWUSR), 0);
    FilePreferences preferences(_folder.file("p"));
    preferences.setValue("key", "value", "d");
    EXPECT_FALSE(preferences.synchronize("d"));
}

TEST(BuildBundle, HasAVersionAndTheMomentOfTheBuild) {
    const BuildBundle bundle;
    const std::string version = bundle.version().value_or("none");
    EXPECT_TRUE(doubles::isMatch(version, "[0-9]+\\.[0-9]+\\.[0-9]+")) << version;
    const std::string form = "[A-Z][a-z]{2} [ 1-3][0-9] [0-9]{4} [0-9]{2}:[0-9]{2}:[0-9]{2}";
    EXPECT_TRUE(doubles::isMatch(bundle.buildDate(), form)) << bundle.buildDate();
}

TEST(WallClock, KnowsTheZoneInForceAtATime) {
    (void)::setenv("TZ", "CET-1CEST,M3.5.0,M10.5.0/3", 1);
    ::tzset();
    const WallClock clock;
    const auto winter = clock.zone(Time(std::chrono::seconds(1700000000)));
    EXPECT_EQ(winter.offset, std::chrono::hours(1));
    EXPECT_FALSE(winter.daylightSaving);
    const auto summer = clock.zone(Time(std::chrono::seconds(1690000000)));
    EXPECT_EQ(summer.offset, std::chrono::hours(2));
    EXPECT_TRUE(summer.daylightSaving);
    (void)::unsetenv("TZ");
    ::tzset();
}

TEST(WallClock, IsTheMachinesClock) {
    const auto before = std::chrono::system_clock::now();
    const Time now = WallClock().now();
    EXPECT_GE(now, before);
    EXPECT_LE(now, std::chrono::system_clock::now());
}

/// Sets the umask for a scope.
class ScopedUmask {
public:
    explicit ScopedUmask(mode_t mask) : _before(::umask(mask)) {}
    ~ScopedUmask() { (void)::umask(_before); }
    ScopedUmask(const ScopedUmask&) = delete;
    ScopedUmask& operator=(const ScopedUmask&) = delete;

private:
    mode_t _before;
};

TEST(ReplaceFile, HasTheUsualModeOrIsPrivate) {
    const doubles::RuntimeFolder folder;
    const std::string path = folder.file("new");
    const auto modeAfter = [&path](FileMode mode) {
        EXPECT_TRUE(replaceFile(path, "content", mode));
        struct stat status {};
        (void)::stat(path.c_str(), &status);
        return status.st_mode & 07777U;
    };
    {
        const ScopedUmask umask(027);
        EXPECT_EQ(modeAfter(FileMode::Usual), 0640U);
    }
    ASSERT_EQ(::chmod(path.c_str(), 0604), 0);
    EXPECT_EQ(modeAfter(FileMode::Usual), 0604U) << "that of the file before";
    EXPECT_EQ(modeAfter(FileMode::Private), 0600U);
    EXPECT_EQ(doubles::contentOf(path), "content");
    EXPECT_EQ(std::distance(std::filesystem::directory_iterator(folder.path()), {}), 1);
}

} // namespace
} // namespace pallax
