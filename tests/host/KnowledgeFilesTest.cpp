#include "host/KnowledgeFiles.h"

#include "host/UserFolders.h"
#include "tests/doubles/Files.h"

#include <gtest/gtest.h>

#include <cstdlib>
#include <filesystem>
#include <string>
#include <sys/stat.h>
#include <vector>

namespace pallax {
namespace {

using Folders = std::vector<std::filesystem::path>;

constexpr const char* kProviders =
    "<serviceproviders><country code=\"de\"><name>Germany</name><provider><name>One</name><gsm>"
    "<network-id mcc=\"262\" mnc=\"01\"/></gsm></provider></country></serviceproviders>";

class KnowledgeFiles : public testing::Test {
protected:
    /// Writes a file below the folder of that name.
    std::string write(const std::string& name, const std::string& content) {
        const auto path = std::filesystem::path(folder.path(name));
        std::filesystem::create_directories(path.parent_path());
        return folder.write(name, content);
    }
    Folders folders() const { return {folder.path("none"), folder.path("a"), folder.path("b")}; }

    doubles::TemporaryFolder folder;
};

TEST_F(KnowledgeFiles, NamesAreInTheFirstFolderWithTheFile) {
    write("b/mobile-broadband-provider-info/serviceproviders.xml", kProviders);
    write("a/xml/iso-codes/iso_3166-1.xml",
          "<iso_3166_entries><iso_3166_entry alpha_2_code=\"FR\" name=\"France\"/>"
          "</iso_3166_entries>");
    write("b/xml/iso-codes/iso_3166-1.xml", "never read");
    const InstalledNames installed = readInstalledNames(folders());
    EXPECT_TRUE(installed.complaints.empty());
    EXPECT_EQ(installed.names.operatorsOf({"262", "01"}).at(0).name, "One");
    EXPECT_EQ(installed.names.countryName("fr"), "France");
}

TEST_F(KnowledgeFiles, MissingFilesAreNoComplaint) {
    const InstalledNames installed = readInstalledNames(folders());
    EXPECT_TRUE(installed.complaints.empty());
    EXPECT_FALSE(installed.names.hasOperators());
    EXPECT_FALSE(installed.names.hasCountries());
}

TEST_F(KnowledgeFiles, ADamagedFileIsOneSentence) {
    const std::string providers =
        write("a/mobile-broadband-provider-info/serviceproviders.xml", "<serviceproviders>");
    std::filesystem::create_directories(folder.path("a/xml/iso-codes/iso_3166-1.xml"));
    const InstalledNames installed = readInstalledNames(folders());
    EXPECT_EQ(
        installed.complaints,
        (std::vector<std::string>{
            providers + " cannot be used: Start-end tags mismatch at byte 17.",
            folder.path("a/xml/iso-codes/iso_3166-1.xml") + " cannot be used: it is a folder."}));
}

TEST_F(KnowledgeFiles, AProfileIsTheProgramsOrTheUsers) {
    write("profiles/mine.conf", "source = mine\nrsrp = good -90\n");
    write("profiles/android.conf", "source = not looked at\n");
    const auto mine = loadProfile("mine", folder.path("profiles"));
    ASSERT_TRUE(mine);
    EXPECT_EQ(mine->name, "mine");
    EXPECT_EQ(mine->source, "mine");
    EXPECT_EQ(mine->gradeOf(Measure::Rsrp, -85), Grade::Good);
    const auto android = loadProfile("android", folder.path("profiles"));
    ASSERT_TRUE(android);
    EXPECT_EQ(android->source, builtInProfile("android")->source);
    EXPECT_TRUE(loadProfile("field", std::nullopt));
}

TEST_F(KnowledgeFiles, AnUnknownProfileIsToldWithTheKnownOnes) {
    write("profiles/mine.conf", "");
    write("profiles/notes.txt", "");
    write("outside.conf", "rsrp = good -90\n");
    for (const char* name : {"mimes", "", "../outside", "/etc/passwd"}) {
        const auto profile = loadProfile(name, folder.path("profiles"));
        ASSERT_FALSE(profile) << name;
        EXPECT_TRUE(profile.error().isUnknown);
        EXPECT_TRUE(profile.error().sentence.starts_with(
            "profile \"" + std::string(name) + "\" is not one of android|field|mine|operator"))
            << profile.error().sentence;
    }
    EXPECT_EQ(loadProfile("feld", std::nullopt).error().sentence,
              "profile \"feld\" is not one of android|field|operator. Did you mean \"field\"?");
}

TEST_F(KnowledgeFiles, AMistakeInAProfileIsASentence) {
    const std::string file = write("profiles/mine.conf", "rsrp = best -90\n");
    const auto profile = loadProfile("mine", folder.path("profiles"));
    ASSERT_FALSE(profile);
    EXPECT_FALSE(profile.error().isUnknown);
    EXPECT_EQ(profile.error().sentence, file + ", line 1: a border is a grade and a number, such "
                                               "as \"good -90\", not \"best -90\".");
    const std::string pipe = folder.path("profiles/pipe.conf");
    ASSERT_EQ(::mkfifo(pipe.c_str(), S_IRUSR | S_IWUSR), 0);
    EXPECT_EQ(loadProfile("pipe", folder.path("profiles")).error().sentence,
              pipe + " cannot be read: it is not a regular file.");
}

/// Restores the variables at the end: other tests of this process use them.
class UserFolders : public testing::Test {
protected:
    struct Variable {
        explicit Variable(const char* itsName) : name(itsName) {
            const char* value = std::getenv(name);
            before = value != nullptr ? std::optional<std::string>(value) : std::nullopt;
        }
        ~Variable() { before ? ::setenv(name, before->c_str(), 1) : ::unsetenv(name); }
        Variable(const Variable&) = delete;
        Variable& operator=(const Variable&) = delete;

        const char* name;
        std::optional<std::string> before;
    };
    Variable home{"HOME"};
    Variable configuration{"XDG_CONFIG_HOME"};
    Variable data{"XDG_DATA_DIRS"};
};

TEST_F(UserFolders, OfTheConfigurationAndItsProfiles) {
    ::setenv("HOME", "/home/user", 1);
    ::setenv("XDG_CONFIG_HOME", "/conf", 1);
    EXPECT_EQ(profileFolder(), "/conf/pallax/profiles");
    ::setenv("XDG_CONFIG_HOME", "relative", 1);
    EXPECT_EQ(profileFolder(), "/home/user/.config/pallax/profiles");
    ::unsetenv("XDG_CONFIG_HOME");
    EXPECT_EQ(configurationFolder(), "/home/user/.config");
    ::setenv("HOME", "", 1);
    EXPECT_EQ(profileFolder(), std::nullopt);
}

TEST_F(UserFolders, OfPackages) {
    ::unsetenv("XDG_DATA_DIRS");
    EXPECT_EQ(dataFolders(), (Folders{"/usr/local/share", "/usr/share"}));
    ::setenv("XDG_DATA_DIRS", "", 1);
    EXPECT_EQ(dataFolders(), (Folders{"/usr/local/share", "/usr/share"}));
    ::setenv("XDG_DATA_DIRS", "/a:relative::/b", 1);
    EXPECT_EQ(dataFolders(), (Folders{"/a", "/b"}));
}

} // namespace
} // namespace pallax
